// The longest run of points that one arc can follow, by growing the run from its shortest length.

#pragma once

#include <cstdint>
#include <optional>

#include "geometry/fitting/arc/ArcCell.h"
#include "geometry/fitting/runs/Pieces.h"

namespace Vorn::Fitting {

/// What the search is asked.
struct ArcSearchTask {
  /// The run from the first point on; its count is the most points that the arc may take.
  Run run;
  /// The fewest points that the arc may have.
  std::int32_t minCount = kFewestArcPoints;
  /// A fixed end is kept to where the arc reaches the last measured point. Deliberate: shorter
  /// tries end exactly at their own last point then, but for the first one, which ends at the fixed
  /// end.
  Ends ends;
  /// Told after every successful length.
  GeometryUtils::ProgressBase const& progress;
  /// Whether the cell of the arc is asked for.
  AfterFailure cellUse = AfterFailure::NoCell;
};

/// What the search found.
struct ArcSearchResult {
  /// Ok when some length succeeded. Otherwise the code that ended the search: SelfIntersection for
  /// points that turn back, leave the order or take a step of a right angle or more, else the code
  /// of the last try. Failed when there was no length to try.
  ErrorCode code = ErrorCode::Failed;
  /// With Ok the longest arc. With SelfIntersection an arc that fits its run, but whose points do
  /// not follow it, when the search ended with one. Otherwise nothing.
  std::optional<FittedArc> arc;
  /// Defined when it was asked for: with Ok the cell of the arc, deliberately emptied when points
  /// that do not follow the arc ended the search and the samples could be thinned; otherwise what
  /// the last try left.
  Cells::CellSequence centres;
};

/// Tries growing lengths over the same start. Nearly straight beginnings are stepped over; the
/// search ends at the first other failure, at a point out of the arc's order or at a change of its
/// sense, and the last success stands. O(m^2) triples for a run of m points.
ArcSearchResult FindLongestArc(ArcSearchTask const& task);

}  // namespace Vorn::Fitting
