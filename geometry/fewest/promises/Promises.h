#pragma once

#include <cstddef>
#include <limits>
#include <vector>

#include "vorn/FewestPieces.h"
#include "vorn/GeometryUtils.h"

/// What a contour of fewest pieces promises about the points that it covers, measured on the
/// finished contour with nothing taken over from the search.
namespace Vorn::Promises {

/// The points that one piece covers.
using PieceRange = FewestPieces::Range;

/// A contour of one or more pieces and the points that it stands for. Only refers to them.
struct Chain {
  std::vector<WPoint> const& points;                ///< finite, every tolerance above 0
  std::vector<GeometryUtils::Elem> const& contour;  ///< the start and one element for each piece
  std::vector<PieceRange> const& ranges;            ///< one for each piece
  bool isClosed = false;
  /// Largest angle, in radians, between neighbours on one arc; infinite for no limit.
  double largestStep = std::numeric_limits<double>::infinity();
  /// How far a piece may leave the straight path from point to point, in addition to the
  /// tolerances; infinite for no limit.
  double farthestBetweenPoints = std::numeric_limits<double>::infinity();
};

enum class Promise {
  /// Every element is a segment or an arc with finite numbers, a radius above 0 and a direction,
  /// and the ranges hold every point once, in order. Nothing else is measured where this fails.
  WellFormed,
  /// Every point lies within its tolerance of its piece. A point beyond the end of its piece is
  /// measured to that end. Decided exactly.
  WithinTolerance,
  /// No point lies farther back along its piece than an earlier one by more than
  /// kNoiseStepBack times the sum of the two tolerances. A point within tolerance of both ends of
  /// an
  /// arc counts at the one where the points before it are.
  InOrder,
  /// Neighbours on one arc, its joints counted in, are at most the largest step apart, unless they
  /// are no farther apart than their tolerances.
  SmallSteps,
  /// Between neighbours, its joints counted in, an arc stays near the straight path. Measured in
  /// the middle between them, against the limit and the larger of the two tolerances. Every joint
  /// lies near the straight path between the points beside it, within the limit and the sum of
  /// both tolerances.
  NearPath,
  /// The circle and the angles of every arc agree with the points at which it starts and ends.
  Joined,
  /// A closed contour ends exactly where it begins.
  Closed,
  /// No arc has equal angles or comes back to where it starts.
  BelowFullTurn,
  /// Two pieces have no common point but the joint that they share, unless the path through the
  /// points crosses itself there. Let X be such a point. From X the straight path through the
  /// points of one piece is followed both ways, into the neighbouring pieces where need be, until
  /// it is farther from the other piece (or its neighbours) than the tolerance of its next point
  /// and the largest one there. The crossing is the path's own
  /// - when they come apart on opposite sides, or
  /// - when it is not known on which side they come apart, since the path ends before or passes the
  ///   tip of a fold whose ways out and back are within their tolerances of each other, and the
  ///   straight lines through the points of the two strands meet or touch at X, or
  /// - when the strands run into each other, as at a loop beside a joint, but the path has that
  ///   loop: the straight lines through the points meet on the way out and back, or touch at X, and
  ///   a point in between is farther from X than twice its tolerance, or
  /// - when both pieces are segments from one point of the path to the next: the segments from
  ///   point to point break no promise, whatever the points, so that a contour can always be given,
  ///   or
  /// - when an open path begins and ends there: X is within tolerance of its first and last point,
  ///   though not of all points.
  /// Lines touch at X where they are no farther apart there than 1/32 of the sum of their
  /// tolerances, so that a side that is scanned twice without noise does not count by its last
  /// bits.
  /// The crossing is not the path's own when they come apart on one side, or run into each other
  /// where all points of the loop are beside X. Pieces that fold back on each other without passing
  /// to the other side do not cross. Pieces that are nearer than rounding count as touching.
  NotCrossing,
};

/// By how many times the sum of their tolerances a point may lie back along its piece behind an
/// earlier one: noise in scans that are denser than their tolerance does that.
inline constexpr double kNoiseStepBack = 1.65;

inline constexpr std::size_t kNone = std::numeric_limits<std::size_t>::max();

/// A promise that does not hold. Of each promise a piece reports its worst place only.
struct Violation {
  Promise promise;
  std::size_t piece;               ///< from 0
  std::size_t otherPiece = kNone;  ///< the second one of a crossing
  std::size_t index = kNone;       ///< the measured point, where it is about one
  GeometryUtils::Point at;
  /// WithinTolerance: relative deviation. InOrder: the step back in excess of what is allowed.
  /// SmallSteps: the step in radians. NearPath: the distance from the straight path. Joined,
  /// Closed: the gap. BelowFullTurn: the sweep in radians. Others: 0.
  double amount = 0.0;
};

struct Report {
  std::vector<Violation> violations;  ///< empty when every promise is kept
  double largestRatio = 0.0;          ///< largest relative deviation of a point from its piece
  std::size_t largestIndex = 0;       ///< the point that has it
};

/// Measures a chain. Time O(n + k log k) for n points and k pieces where no more than O(k) pairs of
/// pieces come near each other; memory O(k).
Report Measure(Chain const& chain);

}  // namespace Vorn::Promises
