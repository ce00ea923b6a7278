#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "geometry/fewest/promises/Coverage.h"
#include "geometry/fewest/promises/Meetings.h"

/// Whether the path through the points crosses itself where two pieces do; the rule stands at
/// Promise::NotCrossing.
namespace Vorn::Promises {

class OwnPath {
 public:
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
    std::int64_t first;
    std::int64_t last;
    Side before;
    Side after;

    bool IsJoined() const { return before == Side::Joined || after == Side::Joined; }
    bool StaysOnOneSide() const {
      return before == after && (before == Side::Left || before == Side::Right);
    }
  };

  bool IsWhereThePathCloses(GeometryUtils::Point const& p) const;
  Passage Follow(std::size_t piece, double along, std::size_t other);
  Side FollowOneWay(Strand* strand);
  bool StepOn(Strand* strand) const;
  bool MoveToNearest(Strand* strand, GeometryUtils::Point const& p, Place* place) const;
  Side SideOf(Strand const& strand, GeometryUtils::Point const& p, Place const& place) const;
  std::int64_t FirstNumberBeyond(std::size_t piece, double along) const;
  bool DoMeet(std::int64_t first, std::int64_t last, std::int64_t otherFirst,
              std::int64_t otherLast);
  WPoint const& PointOf(std::int64_t number) const;

  Coverage const& coverage_;
  std::vector<double> widest_;  ///< the largest tolerance of each piece
  std::int64_t budget_;
};

}  // namespace Vorn::Promises
