// The regions of the pieces of a contour, such that pieces with regions apart have no common point
// by the intersection functions, whatever these lose by rounding.

#pragma once

#include <cstddef>
#include <vector>

#include "geometry/contours/near/Box.h"
#include "geometry/elementary/Points.h"
#include "geometry/elementary/Shapes.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Contours {

using Elementary::Point;
using Arc = GeometryUtils::Arc;

/// A segment from start to end, or an arc, which may lie elsewhere than its start and end say.
struct Piece {
  Point start;
  Point end;
  Arc const* arc = nullptr;  ///< null for a segment

  /// Whether it is a segment.
  bool IsSegment() const { return arc == nullptr; }

  /// The segment, if it is one.
  Elementary::Segment AsSegment() const { return {start, end}; }
};

/// The regions of a set of pieces.
struct Extents {
  /// By the numbers of the pieces; empty for irregular ones.
  std::vector<Extent> all;

  /// The numbers of pieces that may meet any other one, because no region can be told: they hold a
  /// not-a-number, or values so large, so small or so different that bounds on rounding fail.
  std::vector<std::size_t> irregular;
};

/// Finds the regions of the pieces of one or more sets that are to be compared with each other or
/// within themselves. How large they are depends on the largest coordinates and radii of all sets.
class PieceExtents {
 public:
  /// Looks at the sets, which must stay. O(n).
  explicit PieceExtents(std::vector<std::vector<Piece> const*> const& sets);

  /// The regions of one of the sets; moved out, so asked for once.
  Extents Take(std::size_t set);

  /// By how much slanted bounds must be apart for pieces to have no common point.
  double SlantedMargin() const;

 private:
  void AddSegments(std::vector<Piece> const& pieces, Extents* extents);
  void MeasureArcs(std::vector<Piece> const& pieces);
  void AddArcs(std::vector<Piece> const& pieces, Extents* extents) const;

  bool IsRegular(Arc const& arc) const;
  Box BoxOfArc(Arc const& arc) const;
  double PaddingOf(Arc const& arc) const;

  std::vector<Extents> extents_;
  bool hasArcs_ = false;
  double largestEnd_ = 0.0;         ///< of the coordinates of regular end points
  double largestCoordinate_ = 0.0;  ///< of regular pieces, centres included
  double largestRadius_ = 0.0;      ///< of regular pieces
};

}  // namespace Vorn::Contours
