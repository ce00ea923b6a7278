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
  /// Enters the regions of segments, and empty ones for arcs, and takes note of the largest ends
  /// and coordinates. Segments with irregular ends go to the irregular pieces.
  void AddSegments(std::vector<Piece> const& pieces, Extents* extents);
  /// Takes note of the largest centre coordinate and radius of regular arcs.
  void MeasureArcs(std::vector<Piece> const& pieces);
  /// Enters the regions of arcs. Called when all sets are measured.
  void AddArcs(std::vector<Piece> const& pieces, Extents* extents) const;

  /// Whether the bounds on rounding hold for the arc: centre and radius in range and not far larger
  /// than the ends of all pieces, angles finite.
  bool IsRegular(Arc const& arc) const;
  /// The box around what the arc covers between its angles, widened by PaddingOf.
  Box BoxOfArc(Arc const& arc) const;
  /// How far a common point of the arc may lie off its circle.
  double PaddingOf(Arc const& arc) const;

  std::vector<Extents> extents_;
  bool hasArcs_ = false;
  double largestEnd_ = 0.0;         ///< of the coordinates of regular end points
  double largestCoordinate_ = 0.0;  ///< of regular pieces, centres included
  double largestRadius_ = 0.0;      ///< of regular pieces
};

}  // namespace Vorn::Contours
