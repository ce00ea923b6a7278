#include "geometry/fewest/BothWays.h"

#include <algorithm>
#include <cstddef>
#include <limits>
#include <utility>

namespace Vorn::Fewest {

namespace {

/// A gate and the place on it where a chain crosses it.
struct Joint {
  Gate gate;
  double offset = 0.0;
};

/// The joint as the path in the other direction has it: what was left is right. At a cusp the piece
/// behind, which comes first now, crosses the gate the other way already.
Joint Reversed(Joint joint, std::int32_t count) {
  joint.gate.split = count - joint.gate.split;
  if (joint.gate.isCusp) return joint;
  Gate& gate = joint.gate;
  gate.across = {-gate.across.x, -gate.across.y};
  gate.least = -std::exchange(gate.greatest, -gate.least);
  return {gate, -joint.offset};
}

}  // namespace

std::size_t CountRuns(std::span<std::int32_t const> runStarts, std::int32_t points) {
  auto const end = std::lower_bound(runStarts.begin(), runStarts.end(), points);
  return static_cast<std::size_t>(end - runStarts.begin());
}

Path Reversed(Path const& path) {
  Path reversed = path;
  std::reverse(reversed.points.begin(), reversed.points.end());
  std::swap(reversed.before, reversed.behind);
  return reversed;
}

Chain Reversed(Chain const& chain, std::int32_t count) {
  Chain reversed;
  for (std::size_t k = chain.pieces.size(); k-- > 0;) {
    ChainPiece const& piece = chain.pieces[k];
    reversed.pieces.push_back(
        {count - piece.end, count - piece.first, Scaled(piece.circle, -1.0), piece.ratio});
    if (k == 0) break;
    Joint const joint = Reversed({chain.gates[k - 1], chain.offsets[k - 1]}, count);
    reversed.gates.push_back(joint.gate);
    reversed.offsets.push_back(joint.offset);
  }
  return reversed;
}

Circuit Reversed(Circuit const& circuit, std::int32_t count) {
  Circuit reversed;
  for (std::size_t k = circuit.size(); k-- > 0;) {
    // A piece starts where it ended.
    CircuitPiece const& next = circuit[(k + 1) % circuit.size()];
    Joint const one = Reversed({next.gate, next.low}, count);
    Joint const other = Reversed({next.gate, next.high}, count);
    reversed.push_back({one.gate, std::min(one.offset, other.offset),
                        std::max(one.offset, other.offset), Scaled(circuit[k].circle, -1.0), 0});
    reversed.back().gate.split %= count;
  }
  return reversed;
}

Chain FindChainBothWays(Path const& path, double share, std::span<std::int32_t const> runStarts,
                        std::function<void(std::int32_t)> const& tell) {
  Chain forwards = FindChain(path, share, tell);
  if (!forwards.pieces.empty() && forwards.pieces.size() <= runStarts.size()) return forwards;
  std::size_t const limit =
      forwards.pieces.empty() ? std::numeric_limits<std::size_t>::max() : forwards.pieces.size();
  Chain const backwards =
      FindChainWhile(Reversed(path), share, [&](std::size_t pieces, std::int32_t covered) {
        return pieces + CountRuns(runStarts, path.Count() - covered) < limit;
      });
  bool const isShorter = !backwards.pieces.empty() && backwards.pieces.size() < limit;
  return isShorter ? Reversed(backwards, path.Count()) : forwards;
}

}  // namespace Vorn::Fewest
