#pragma once

#include <cmath>
#include <cstdint>
#include <span>

#include "geometry/triangles/TriangleOverlap.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Cells {

/// How large the coordinates of a set of triangles are, for bounds of rounding errors.
struct Magnitude {
  double x = 0.0;
  double y = 0.0;
  /// Zero, or not a number as soon as a coordinate is not finite.
  double doubt = 0.0;

  void Include(GeometryUtils::Triangle const& triangle) {
    for (GeometryUtils::Point const& p : triangle.pts) {
      double const absX = std::fabs(p.x);
      double const absY = std::fabs(p.y);
      x = absX > x ? absX : x;
      y = absY > y ? absY : y;
      doubt += 0.0 * (p.x + p.y);
    }
  }

  void Include(std::span<GeometryUtils::Triangle const> triangles) {
    for (GeometryUtils::Triangle const& triangle : triangles) Include(triangle);
  }
};

/// A triangle that others are overlapped with one after another.
///
/// Most of them lie wholly within or beyond it. On which side of a line a point lies is the sign of
/// a cross product; where it is far larger than any rounding error, every formula for it has the
/// same sign, and the answers of the exact steps of an overlap are known without taking them. What
/// is not that clear is left to those steps.
class Cutter {
 public:
  /// `magnitude` is that of the triangles to come.
  Cutter(GeometryUtils::Triangle const& triangle, Magnitude const& magnitude);

  /// What is left of a triangle that is cut.
  enum class Rest {
    Whole,  ///< all of it: the overlap is kCopiesOfContained copies of it
    Parts,  ///< what is told by the overlap, which may be nothing
  };

  /// As FindOverlap of the other triangle with this one. The overlap is written for `Parts` only.
  Rest Cut(BoxedTriangle const& other, Overlap* overlap) const;

 private:
  enum class Place {
    Within,    ///< nothing of the other triangle is cut off
    Apart,     ///< there is no overlap
    Crossing,  ///< sides may cross; what is known stands in the sight
    Unclear,   ///< nothing is known
  };

  /// Where the other triangle lies.
  Place PlaceOf(BoxedTriangle const& other, Sight* sight) const;
  bool HasSideAlong(unsigned flat, GeometryUtils::Triangle const& other) const;
  unsigned VerticesOutside(BoxedTriangle const& other) const;

  /// Two doubles that are worked on at once. Lanes never meet in a sum, so the results are those of
  /// plain doubles.
  using Pair [[gnu::vector_size(16)]] = double;

  /// Two sides, directed so that the inside of the triangle has positive offsets.
  struct LinePair {
    Pair x, y, dx, dy;

    /// Twice the areas of the triangles that the sides form with a point.
    Pair OffsetsOf(GeometryUtils::Point const& p) const { return (p.x - x) * dy - (p.y - y) * dx; }
  };

  Shape shape_;
  /// Sides 0 and 1, then 2 and 0 again.
  LinePair lines_[2];
  /// Vertices in the same way.
  struct PointPair {
    Pair x, y;
  } vertices_[2];
  /// Twice the area.
  double area2_ = 0.0;
  /// An offset above this is clear; infinite when none is.
  double clear_ = 0.0;
  /// Offsets of two points that differ by more than this belong to a line that is not parallel.
  double skew_ = 0.0;
};

/// A chord, that is a triangle (P1, P2, P2), that is overlapped with others one after another. Most
/// of them lie wholly on one side of it.
class ChordCutter {
 public:
  /// `magnitude` is that of the triangles to come. Takes any triangle, but is fast for chords only.
  ChordCutter(GeometryUtils::Triangle const& chord, Magnitude const& magnitude);

  /// As FindOverlap of the chord with the other triangle.
  void FindOverlapWith(BoxedTriangle const& other, Overlap* overlap) const;

 private:
  bool IsClearlyApartFrom(BoxedTriangle const& other) const;

  Shape shape_;
  /// An offset above this is clear; infinite when none is.
  double clear_ = 0.0;
};

}  // namespace Vorn::Cells
