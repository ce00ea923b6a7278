// A triangle that others are overlapped with one after another. It stands for the plain
// Triangles::FindOverlap and gives the same triangles, mostly from the signs of nine offsets.

#pragma once

#include "geometry/cells/fast/BoxedTriangle.h"
#include "geometry/cells/fast/Pair.h"
#include "geometry/cells/fast/RoundingBound.h"
#include "geometry/cells/fast/SightedOverlap.h"
#include "geometry/triangles/Overlap.h"
#include "geometry/triangles/PreparedTriangle.h"

namespace Vorn::Cells {

/// A triangle that others are overlapped with one after another.
///
/// Most of them lie wholly within or beyond it. On which side of a line a point lies is the sign of
/// a cross product; where it is far larger than any rounding error, every formula for it has the
/// same sign, and the answers of the exact steps of an overlap are known without taking them. What
/// is not that clear is left to those steps.
class Cutter {
 public:
  /// `magnitude` is that of the triangles to come.
  Cutter(Triangle const& triangle, Magnitude const& magnitude);

  /// What is left of a triangle that is cut.
  enum class Rest {
    Whole,  ///< all of it: the overlap is kCopiesOfContained copies of it
    Parts,  ///< what is told by the overlap, which may be nothing
  };

  /// As FindOverlap of the other triangle with this one. The overlap is written for `Parts` only.
  Rest Cut(BoxedTriangle const& other, Triangles::Overlap* overlap) const;

 private:
  enum class Place {
    Within,    ///< nothing of the other triangle is cut off
    Apart,     ///< there is no overlap
    Crossing,  ///< sides may cross; what is known stands in the sight
    Unclear,   ///< nothing is known
  };

  /// Where the other triangle lies.
  Place PlaceOf(BoxedTriangle const& other, Sight* sight) const;

  /// Whether one of the sides with a bit in `flat` counts as parallel to the line of that bit, and
  /// is near the side on it.
  bool HasSideAlong(unsigned flat, Triangle const& other) const;

  /// The vertices of this triangle that surely are neither in nor on the other one.
  unsigned VerticesOutside(BoxedTriangle const& other) const;

  struct Offsets;

  /// Two sides: the vertices they start at and their directions, turned so that the inside of the
  /// triangle has positive offsets.
  struct LinePair {
    Pair x, y, dx, dy;

    /// Twice the areas of the triangles that the sides form with a point.
    Pair OffsetsOf(Point const& p) const { return (p.x - x) * dy - (p.y - y) * dx; }
  };

  Triangles::PreparedTriangle prepared_;
  /// Sides 0 and 1, then 2 and 0 again.
  LinePair lines_[2];
  /// Twice the area.
  double area2_ = 0.0;
  /// An offset above this is clear; infinite when none is.
  double clear_ = 0.0;
  /// Offsets of two points that differ by more than this belong to a line that is not parallel.
  double skew_ = 0.0;
};

}  // namespace Vorn::Cells
