#include "geometry/fewest/Circuit.h"

#include <algorithm>
#include <cstddef>
#include <iterator>
#include <limits>

#include "geometry/fewest/BothWays.h"
#include "geometry/fewest/Levels.h"

namespace Vorn::Fewest {

namespace {

/// The path and once more its points.
Path Twice(Path const& path) {
  Path twice = path;
  twice.points.reserve(2 * path.points.size());
  std::copy(path.points.begin(), path.points.end(), std::back_inserter(twice.points));
  Wrap(&twice);
  return twice;
}

/// The pieces from level `first` on that lead to the farthest end of the last level. `ends` are
/// the farthest ends of all levels.
Circuit CircuitFrom(Levels const& levels, std::span<std::int32_t const> ends, std::size_t first,
                    std::int32_t turn) {
  std::vector<State> const& last = levels.Last();
  auto const farthest = std::max_element(
      last.begin(), last.end(),
      [](State const& one, State const& other) { return one.reach.end < other.reach.end; });
  std::vector<Link> const links =
      levels.LinksThrough(static_cast<std::size_t>(farthest - last.begin()));
  Circuit circuit;
  std::int32_t const end = links[first].opening.gate.split + turn;
  for (std::size_t k = first; k < links.size(); ++k) {
    Opening const& opening = links[k].opening;
    // The pieces before may lead to the first gate already.
    if (opening.gate.split >= end) break;
    Opening const before = StartAt(opening.gate, opening.low);
    double const high = opening.gate.isCusp ? -opening.high : opening.high;
    circuit.push_back({before.gate, std::min(before.low, high), std::max(before.low, high),
                       links[k].guess, ends[k] % turn});
    circuit.back().gate.split %= turn;
  }
  return circuit;
}

}  // namespace

Circuit FindCircuit(Path const& path, double share, GoesOn const& goesOn) {
  std::int32_t const turn = path.Count();
  if (turn > std::numeric_limits<std::int32_t>::max() / 2) return {};
  Path const twice = Twice(path);
  Levels levels(twice, share);
  std::vector<std::int32_t> ends;
  while (true) {
    std::int32_t const farthest = levels.FindFarthest();
    if (farthest == twice.Count() || !goesOn(levels.Count(), farthest)) return {};
    if (ends.empty() && farthest >= turn) return {};
    auto const same = std::lower_bound(ends.begin(), ends.end(), farthest - turn);
    bool const isInStep = same != ends.end() && *same == farthest - turn;
    auto const first = static_cast<std::size_t>(same - ends.begin()) + 1;
    ends.push_back(farthest);
    if (isInStep) return CircuitFrom(levels, ends, first, turn);
    if (!levels.Add(farthest)) return {};
  }
}

Circuit FindCircuitBackwards(Path const& path, double share,
                             std::span<std::int32_t const> runStarts, std::size_t limit) {
  std::int32_t const count = path.Count();
  // From a start within a piece a lap takes one piece more than the circuit.
  GoesOn const goesOn = [&](std::size_t pieces, std::int32_t covered) {
    return covered >= count || pieces + CountRuns(runStarts, count - covered) <= limit;
  };
  return Reversed(FindCircuit(Reversed(path), share, goesOn), count);
}

}  // namespace Vorn::Fewest
