#pragma once

#include <cstddef>

#include "geometry/fewest/promises/DrawnPiece.h"
#include "vorn/GeometryUtils.h"

/// The common points of two drawn pieces, ends included. The intersections of the library leave out
/// the ends of arcs, and with them what happens at joints.
namespace Vorn::Promises {

/// A common point and where it lies on the two pieces.
struct Meeting {
  GeometryUtils::Point at;
  double alongFirst = 0.0;
  double alongSecond = 0.0;
};

struct Meetings {
  static constexpr std::size_t kMost = 6;

  Meeting list[kMost];
  std::size_t count = 0;

  /// Appends one; there must be room.
  void Add(Meeting const& meeting) { list[count++] = meeting; }
};

/// Common points of two pieces without a common joint: isolated ones, and ends of one that lie on
/// the other, which every common stretch has. Pieces no farther apart than rounding count as
/// meeting.
Meetings FindMeetings(DrawnPiece const& first, DrawnPiece const& second);

/// Common points of two pieces of which the second starts where the first ends, but for that joint
/// and all meetings that enclose nothing with it: tangents, and pieces that fold back.
Meetings FindLoops(DrawnPiece const& first, DrawnPiece const& second);

}  // namespace Vorn::Promises
