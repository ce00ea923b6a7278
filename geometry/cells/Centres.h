// One representative point of a cell.

#pragma once

#include <cstddef>
#include <optional>
#include <span>

#include "geometry/cells/Bounds.h"
#include "geometry/triangles/TriangleCentre.h"
#include "math/NumericConstants.h"

namespace Vorn::Cells {

using Triangles::TriangleCentre;

/// Whether a triangle counts as without area in the centre of a cell.
inline bool IsDegenerate(TriangleCentre const& triangle) { return Numeric::IsZero(triangle.area); }

/// The sums that the centre of a cell comes from, each over its triangles in order.
struct CentreSums {
  /// Of the areas of proper triangles.
  double area = 0.0;
  /// Of the centres of proper triangles times their areas.
  Point weighted;
  /// Of the centres of degenerate triangles.
  Point degenerate;
  /// The number of degenerate triangles.
  std::size_t degenerateCount = 0;

  /// Adds a triangle.
  void Add(TriangleCentre const& triangle);

  /// Whether the proper triangles have an area to divide by; the others do not count then.
  bool HasArea() const { return area >= Numeric::kZero; }

  /// The centre: the mean of the triangle centres weighted by area. Deliberate: degenerate
  /// triangles count only where there are no others, which leaves chords and single points with a
  /// centre, the plain mean.
  Point Centre() const;
};

/// The area-weighted centre of a cell; nothing for an empty one. O(size of cell).
std::optional<Point> CentreOf(std::span<Triangle const> cell);

/// A cell as the triangles that it consists of, each copy by itself. CellSequence answers the same
/// questions with the same bits, sooner.
struct PlainCell {
  std::span<Triangle const> triangles;

  /// As CentreOf.
  std::optional<Point> Centre() const { return CentreOf(triangles); }

  /// As Cells::BoundingRect.
  std::optional<Rect> BoundingRect() const { return Cells::BoundingRect(triangles); }

  /// The centre of what a triangle and the cell have in common; nothing where that is empty.
  std::optional<Point> CentreOfOverlapWith(Triangle const& candidate) const;
};

}  // namespace Vorn::Cells
