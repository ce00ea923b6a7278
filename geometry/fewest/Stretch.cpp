#include "geometry/fewest/Stretch.h"

#include <algorithm>

#include "math/Assert.h"

namespace Vorn::Fewest {

namespace {

/// Moves the points that a piece or a gate counts.
ChainPiece Moved(ChainPiece piece, std::int32_t by) {
  piece.first += by;
  piece.end += by;
  return piece;
}
Gate Moved(Gate gate, std::int32_t by) {
  gate.split += by;
  return gate;
}

Outside PointsBefore(Path const& path, std::int32_t first) {
  Outside before;
  for (std::int32_t i = first - 1; i >= 0 && before.count < 2; --i) before.Add(path.At(i));
  for (std::int32_t i = 0; before.count < 2 && path.before.At(i) != nullptr; ++i) {
    before.Add(*path.before.At(i));
  }
  return before;
}

Outside PointsFrom(Path const& path, std::int32_t end) {
  Outside behind;
  for (std::int32_t i = end; i < path.Count() && behind.count < 2; ++i) behind.Add(path.At(i));
  for (std::int32_t i = 0; behind.count < 2 && path.behind.At(i) != nullptr; ++i) {
    behind.Add(*path.behind.At(i));
  }
  return behind;
}

}  // namespace

Stretch Stretch::Widened(std::size_t count) const {
  std::size_t const more = (Size() + 1) / 2;
  return {first - std::min(first, more), std::min(count, end + more)};
}

bool HasOuterPoints(Chain const& chain, Stretch const& stretch) {
  ChainPiece const& first = chain.pieces[stretch.first];
  ChainPiece const& last = chain.pieces[stretch.end - 1];
  return first.first < first.end && last.first < last.end;
}

Path PathOf(Path const& path, Chain const& chain, Stretch const& stretch) {
  VORN_ASSERT(HasOuterPoints(chain, stretch));
  std::int32_t const first = chain.pieces[stretch.first].first;
  std::int32_t const end = chain.pieces[stretch.end - 1].end;
  Path part;
  part.points.assign(path.points.begin() + first, path.points.begin() + end);
  part.limits = path.limits;
  part.leastTolerance = path.leastTolerance;
  part.before = PointsBefore(path, first);
  part.behind = PointsFrom(path, end);
  part.start = path.start;
  part.finish = path.finish;
  if (stretch.first > 0) {
    std::size_t const k = stretch.first - 1;
    part.start = StartAt(Moved(chain.gates[k], -first), chain.offsets[k]);
  }
  if (stretch.end < chain.pieces.size()) {
    std::size_t const k = stretch.end - 1;
    part.finish = EndAt(chain.gates[k], chain.offsets[k]);
  }
  part.finish.gate.split = end - first;
  return part;
}

Chain PartOf(Chain const& chain, Stretch const& stretch) {
  std::int32_t const first = chain.pieces[stretch.first].first;
  Chain part;
  part.pieces.reserve(stretch.end - stretch.first);
  part.gates.reserve(stretch.end - stretch.first);
  for (std::size_t k = stretch.first; k < stretch.end; ++k) {
    part.pieces.push_back(Moved(chain.pieces[k], -first));
    if (k + 1 == stretch.end) break;
    part.gates.push_back(Moved(chain.gates[k], -first));
    part.offsets.push_back(chain.offsets[k]);
  }
  return part;
}

Chain MovedBy(Chain chain, std::int32_t by) {
  for (ChainPiece& piece : chain.pieces) piece = Moved(piece, by);
  for (Gate& gate : chain.gates) gate = Moved(gate, by);
  return chain;
}

void Put(Chain const& part, Stretch const& stretch, Chain* chain) {
  std::int32_t const first = chain->pieces[stretch.first].first;
  for (std::size_t k = 0; k < part.pieces.size(); ++k) {
    chain->pieces[stretch.first + k] = Moved(part.pieces[k], first);
    if (k + 1 == part.pieces.size()) break;
    chain->gates[stretch.first + k] = Moved(part.gates[k], first);
    chain->offsets[stretch.first + k] = part.offsets[k];
  }
}

}  // namespace Vorn::Fewest
