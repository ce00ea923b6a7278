#pragma once

#include <cstddef>
#include <cstdint>
#include <limits>
#include <vector>

#include "geometry/fewest/promises/Coverage.h"
#include "geometry/fewest/promises/Meetings.h"

/// Whether the path through the points crosses itself where two pieces do; the rule stands at
/// Promise::NotCrossing.
namespace Vorn::Promises {

/// A place on the straight path through the points.
struct Approach {
  GeometryUtils::Point at{};
  /// The smaller one of the two points beside it. Without points it is below everything.
  double tolerance = -std::numeric_limits<double>::infinity();
};

class OwnPath {
 public:
  /// Of the points of a coverage, which must outlive it. O(n).
  explicit OwnPath(Coverage const& coverage);

  /// Is this meeting of two pieces the path's own? The number of points looked at, over all calls,
  /// is limited to a multiple of the number of all points; beyond it the answer is no.
  bool Crosses(std::size_t first, std::size_t second, Meeting const& meeting);

 private:
  enum class Side { Left, Right, Unknown, Joined };

  /// A strand of the path that is followed, in terms of running numbers that may go below zero and
  /// above the size on closed contours, and the piece of the other strand it is compared with.
  struct Strand {
    std::int64_t number;
    std::int64_t step;  ///< +1 or -1
    std::size_t piece;  ///< that covers the point
    std::size_t other;
    DrawnPiece drawnOther;
  };

  /// The points of a strand up to where it comes apart from the other, and the sides there.
  struct Passage {
    std::int64_t beyond;  ///< the first point behind the meeting
    std::int64_t first;
    std::int64_t last;
    Side before;
    Side after;

    /// Whether a strand runs into the other one, or the budget is used up.
    bool IsJoined() const { return before == Side::Joined || after == Side::Joined; }
    /// Whether the strand leaves the other one on the side from which it came.
    bool StaysOnOneSide() const {
      return before == after && (before == Side::Left || before == Side::Right);
    }
  };

  /// Consecutive points by running number, both ends included.
  struct Run {
    std::int64_t first;
    std::int64_t last;

    /// The number of edges; below 1 there are none.
    std::int64_t Size() const { return last - first; }
  };

  /// Whether the first and the last point of an open path, but not all of its points, lie within
  /// their tolerances of p.
  bool IsWhereThePathCloses(GeometryUtils::Point const& p) const;
  /// Whether a piece is an edge of the path: the segment from one point to the next one.
  bool IsEdge(std::size_t piece) const;
  /// Whether the path goes out from a meeting and comes back, leaves the place in between, and
  /// meets itself on the way.
  bool HasLoop(Passage const& out, Passage const& back, GeometryUtils::Point const& at);
  /// Follows the strand of a piece both ways from a length along it, where it is at a place, beside
  /// that of the other piece.
  Passage Follow(std::size_t piece, double along, std::size_t other,
                 GeometryUtils::Point const& at);
  /// Steps along from a place until the strands are apart, meet or end; the strand is left at the
  /// last point.
  Side FollowOneWay(Strand* strand, GeometryUtils::Point from);
  /// Whether a place of a strand is farther from the other one than both tolerances.
  bool IsApart(Strand const& strand, Place const& place, double w) const;
  /// On which side the strands come apart on the straight way from a place to the next point p,
  /// which may lie far beyond: the place on it is taken that is still apart when the way to it is
  /// halved time and again.
  Side SideWhereApart(Strand const& strand, GeometryUtils::Point const& from,
                      WPoint const& p) const;
  /// Goes on to the next point and its piece; false at the end of the path, and on a closed contour
  /// after one round.
  bool StepOn(Strand* strand) const;
  /// Goes over to the neighbour of the other piece when p is beyond an end and nearer to that.
  /// False when this leads to the piece that covers p itself: the strands run into each other.
  bool MoveToNearest(Strand* strand, GeometryUtils::Point const& p, Place* place) const;
  /// On which side of the other strand p lies; unknown beyond the end of the contour. Outside a
  /// corner, where p is beyond the ends of both pieces, the sum of both deviations has the right
  /// sign. Beyond the tip of a fold, where it may not, p lies on the side away from the way back;
  /// unknown when that is within tolerances of the way out.
  Side SideOf(Strand const& strand, GeometryUtils::Point const& p, Place const& place) const;
  /// The running number of the first point of a piece that lies beyond a length along it, by
  /// bisection: points are in order but for their noise, which the search around the place takes
  /// in.
  std::int64_t FirstNumberBeyond(std::size_t piece, double along) const;
  /// Whether the straight lines through two runs of points meet, other than in a point at which one
  /// ends and the other goes on. The longer run is halved until few edges are left or the runs have
  /// no room in common.
  bool DoMeet(Run const& mine, Run const& other);
  /// The same, looked for near a point of each run first.
  bool DoMeetNear(Run const& mine, std::int64_t near, Run const& other, std::int64_t otherNear);
  /// Where the edge of a run before a point of it passes nearest to a place; without a tolerance
  /// where the run has no such edge.
  Approach EdgeBeside(GeometryUtils::Point const& at, Run const& run, std::int64_t beyond) const;
  /// The point of a running number, which may go below zero and above the size.
  WPoint const& PointOf(std::int64_t number) const;

  Coverage const& coverage_;
  std::vector<double> widest_;  ///< the largest tolerance of each piece
  std::int64_t budget_;
};

}  // namespace Vorn::Promises
