/// @file
/// The contour of the fewest lines and arcs that the tolerances of measured points allow.

#pragma once

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>
#include <vector>

#include "vorn/GeometryUtils.h"
#include "vorn/Types.h"

namespace Vorn {

/// 60 degrees in radians.
inline constexpr double kSixtyDegrees = 1.0471975511965976;

/// Whether one place stands for all points: that of the point of least tolerance lies within the
/// tolerance of every other. FewestPieces::Fit then has no fit.
///
/// @param[in] points in any order
/// @return whether they coincide so; true for no points at all. O(n).
inline bool DoPointsCoincide(std::vector<WPoint> const& points) {
  auto const tightest = std::min_element(
      points.begin(), points.end(), [](WPoint const& p, WPoint const& q) { return p.w < q.w; });
  return std::all_of(points.begin(), points.end(), [&](WPoint const& p) {
    return std::hypot(p.x - tightest->x, p.y - tightest->y) <= p.w;
  });
}

/// Turns measured points into as few segments and arcs as their tolerances allow, and says below
/// which number no chain of segments and arcs can go. A service of its own beside
/// GeometryUtils::CreateFittingCurve: points may lie as close together as they like, may coincide
/// and may step backwards within their noise, and the number of pieces does not depend on how the
/// part lies in the plane.
///
/// What every answer holds (measured before it is given)
/// - Every point lies within its tolerance of the piece that covers it, ends of the piece included.
/// - Each piece starts exactly where the one before ends; a closed contour ends exactly where it
///   begins.
/// - The points come in order along their piece: none lies farther behind an earlier one than 1.65
///   times the sum of their tolerances, as noise in dense scans makes them.
/// - No piece crosses itself or another one where the straight path through the points does not by
///   more than the tolerances. Only segments from one point to the next may cross by less, as the
///   path itself does. Where the path passes itself by less than 1/32 of the sum of two tolerances
///   it counts as touching itself: a side may be scanned out and back.
/// - No arc is a full turn: a full circle comes as two arcs.
///
/// Points far apart against their tolerances, by more than eight times the sum of two, as drawings
/// and tool paths have them
/// - A joint between two of them lies no farther from the straight way from one to the other than
/// an
///   arc of the largest step bulges, 0.134 of the way at 60 degrees, and twice the tolerance; or,
///   where the path runs on straight by two points or more on either side, than the place where
///   these lines meet.
/// - An arc that covers one or two of them turns by no more than 8 degrees from one to the next. So
///   a square of four points is four segments.
///
/// Of contours of as many pieces the one of segments alone is taken where there is one.
///
/// Where it falls short
/// - An open scan of one circle t times around takes the arcs that keep every one of them below 353
///   degrees: 3 for twice around, of which the bound, 1, takes no account. Paths that cross
///   themselves at nearly every point may take many more pieces than the bound, in the worst case
///   one for each point: no piece may cross another anywhere but where the points do.
/// - Where largestRadius is below radii of the part, short pieces stand for its arcs; all of them
///   may be segments though some arcs would save a few. The bound takes no account of
///   largestRadius. Limits nearer to each other than a part in 10^5 leave arcs no room for
///   rounding.
/// - Tolerances below 2^-1040 have too few digits left; such points may come as short segments.
///
/// There is no state and there are no threads: the same input gives the same bits on every call.
/// Calls from several threads at once are safe.
class VORN_EXPORT FewestPieces {
 public:
  /// There are no objects of this class.
  FewestPieces() = delete;

  /// How hard the search looks for a chain of fewer pieces. The promises are the same for all, and
  /// a harder look never gives more pieces.
  enum class Effort : std::int32_t {
    /// The quickest: time O(n log n) on noisy profiles and arcs.
    Quick = 0,
    /// Also looks where Quick may lose pieces: where a piece reaches clearly less far than a piece
    /// without joints would, and where noise comes near the tolerance.
    Wide = 1,
    /// Looks everywhere. Many times as long as Quick.
    Full = 2,
  };

  /// What is asked for. Lengths are in the unit of the points, angles in radians.
  struct Options {
    /// How hard the search looks.
    Effort effort = Effort::Quick;
    /// Whether the deviations are brought down as far as the number of pieces allows; corners of
    /// segments then come where their regression lines meet, exactly so for exact points. Without
    /// it pieces run wherever their points allow.
    bool centre = true;
    /// Whether the contour runs back from the last point to the first. The last point may repeat
    /// the first; the contour may start at any place on the path.
    bool closed = false;
    /// Whether arcs are left out.
    bool segmentsOnly = false;
    /// Greatest angle, as seen from the centre of an arc, between neighbouring points that the arc
    /// covers, and between its ends and the points next to them; above 0, at most pi. Points closer
    /// together than their tolerances count as one. 60 degrees by default: an arc then bulges at
    /// most 0.134 of the distance of two neighbours beyond the straight path between them.
    double largestStep = kSixtyDegrees;
    /// Least radius of an arc; 0 or more.
    double smallestRadius = 0.0;
    /// Greatest radius of an arc: what is flatter comes as a segment. Above 0 and not below
    /// smallestRadius.
    double largestRadius = std::numeric_limits<double>::infinity();
    /// How far a piece, and the joint of two, may leave the straight path between neighbouring
    /// points, in addition to their tolerances; 0 or more. Infinite by default: no limit.
    double farthestBetweenPoints = std::numeric_limits<double>::infinity();
  };

  /// The points that one piece covers, as positions in the input. In a closed contour the piece
  /// across the end of the input has first > last: it covers first to the end of the input and the
  /// beginning to last.
  struct Range {
    /// The first point.
    std::int32_t first = 0;
    /// The last point.
    std::int32_t last = 0;
  };

  /// What comes out.
  struct Result {
    /// The contour, in the form that all members of GeometryUtils understand: a first element that
    /// holds the start point, then one element for each piece.
    std::vector<GeometryUtils::Elem> contour;
    /// For each piece the points that it covers, in the order of the contour. Each point is covered
    /// by one piece.
    std::vector<Range> ranges;
    /// Largest distance of a point from its piece in units of its tolerance; at most 1.
    double largestDeviation = 0.0;
    /// The first point with that distance.
    std::int32_t largestDeviationIndex = -1;
    /// No chain of segments and arcs that passes within the tolerances has fewer pieces than this,
    /// wherever its joints are and in whatever order it meets the points. Proven, not estimated,
    /// and never too high: what one piece covers in exact numbers counts as covered. So does, where
    /// rounding decides, a run that would need tolerances wider by less than 1e-8 of them and 2e-14
    /// of its extent. Arcs of a radius below the tolerance of a point that they cover are left out
    /// of account. Of a closed contour each piece covers neighbours on the way around, wherever the
    /// contour starts; it has two pieces at least, since none of them alone ends where it begins.
    std::int32_t fewestPossible = 0;
    /// Whether the contour has exactly that many pieces.
    bool isFewest = false;
  };

  /// Finds the chain.
  ///
  /// Two points give one segment. More are covered as the options ask; where a promise cannot be
  /// kept with the fewest pieces, one more is taken.
  ///
  /// @code
  /// Vorn::FewestPieces::Result result;
  /// Vorn::ErrorCode const code =
  ///     Vorn::FewestPieces::Fit(points, Vorn::FewestPieces::Options(), &result, nullptr, 100);
  /// @endcode
  ///
  /// @param[in]  points         measured points in the order of the path, each with its tolerance
  /// @param[in]  options        what is asked for
  /// @param[out] result         replaced as a whole on success, untouched otherwise. Null answers
  ///             Failed.
  /// @param[in]  executionState told of the progress, in per cent, never falling, from 1 to
  ///             maxPercent; null for no reporting. What it throws passes through to the caller:
  ///             result is untouched and nothing is lost.
  /// @param[in]  maxPercent     the percentage to report when all is done
  /// @return Ok; NoFit when all points coincide within their tolerances, see DoPointsCoincide, and
  ///         where the numbers have too few digits left for any answer; Failed for a null result,
  ///         fewer than two points, a coordinate that is not finite, a tolerance that is not above
  ///         0 or not finite, more points than an std::int32_t counts, or an option outside its
  ///         range
  /// @throws std::bad_alloc when memory runs out; result is untouched
  /// @note Time O(n log n) on noisy profiles and arcs with effort Quick, memory O(n). The answer
  ///       depends neither on where the part lies nor on how it is turned, apart from the rounding
  ///       of the coordinates.
  static ErrorCode Fit(std::vector<WPoint> const& points, Options const& options, Result* result,
                       ExecutionState* executionState, std::int32_t maxPercent);
};

static_assert(sizeof(FewestPieces::Options) == 40);
static_assert(sizeof(FewestPieces::Range) == 8);

}  // namespace Vorn
