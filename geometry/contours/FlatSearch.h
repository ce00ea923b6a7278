// The search of a flat polyline for pieces that cross, by looking at pairs that come near each
// other. It stands for the plain walk over all pairs where none of these is invalid.

#pragma once

#include <cstdint>
#include <vector>

#include "geometry/contours/FlatPairs.h"

namespace Vorn::Flat {

/// How many pieces after its own a piece meets the first one that it is tested against. Consecutive
/// straight pieces share their joint, so the one right after is passed over.
constexpr std::int64_t FirstStep(std::int32_t kind) { return kind == kVertexRun ? 2 : 1; }

/// A piece against all that start in [begin, run.end), read with the layout of the run. O(n).
Verdict CheckAgainst(Data const& data, FlatPiece const& piece, Run const& run, std::int64_t begin);

/// Looks for near pairs. The restarts of the plain walk add nothing to them: what a piece meets in
/// a run is also met in the last run that is laid out alike.
class FlatSearch {
 public:
  /// Both must stay.
  FlatSearch(Data const& data, std::vector<Run> const& runs) : data_(data), runs_(runs) {}

  /// Whether no pair of the walk is invalid; certain only when true. O(n).
  bool AreAllPairsValid() const;

  /// Whether any pair of the walk crosses, all of them being valid.
  bool HasCrossing() const;

 private:
  /// Whether all pieces of a run are inside the data and none of its arcs makes a pair invalid.
  bool IsValid(Run const& run, bool hasStraight) const;
  /// What the pieces of run r are compared with after it: for either layout the longest stretch.
  std::vector<Run> LaterStretches(std::size_t r) const;
  /// Whether two pieces of the run cross, from FirstStep of its kind apart on.
  bool HasCrossingWithin(Run const& run) const;
  /// Whether a piece of the run crosses one of the stretch.
  bool HasCrossingBetween(Run const& run, Run const& stretch) const;

  Data const& data_;
  std::vector<Run> const& runs_;
};

}  // namespace Vorn::Flat
