// The overlap of two triangles of which much is known beforehand. It stands for the plain
// Triangles::FindOverlap, with less left to find out.

#pragma once

#include "geometry/cells/fast/BoxedTriangle.h"
#include "geometry/triangles/CrossingPoints.h"
#include "geometry/triangles/Overlap.h"

namespace Vorn::Cells {

/// The bits of the three vertices of a triangle.
inline constexpr unsigned kAllVertices = 0x7;

/// What is known beforehand of two triangles.
struct Sight {
  /// Bit v: vertex v of the first triangle is inside the second one, otherwise outside.
  unsigned inside = 0;
  /// Bit v: vertex v of the second triangle is outside the first one, otherwise anywhere.
  unsigned outside = 0;
  /// The sides that may cross; the others do not.
  Triangles::SidePairs mayCross = 0;

  /// Whether every vertex of the second triangle is outside the first one.
  bool IsSecondOutside() const { return outside == kAllVertices; }

  /// Whether one side of the second triangle cuts off one or two vertices of the first, and there
  /// is nothing else to it.
  bool IsOneCut() const {
    Triangles::SidePairs const afterFirst = mayCross & (mayCross - 1);
    bool const hasTwoCrossings = afterFirst != 0 && (afterFirst & (afterFirst - 1)) == 0;
    return inside != 0 && hasTwoCrossings && IsSecondOutside();
  }
};

/// The common part of two triangles: the triangles of Triangles::FindOverlap in the same order.
/// What the sight tells must be true.
void FindSightedOverlap(BoxedTriangle const& first, Triangles::PreparedTriangle const& second,
                        Sight const& sight, Triangles::Overlap* overlap);

}  // namespace Vorn::Cells
