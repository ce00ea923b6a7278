// A chord that is overlapped with triangles one after another. It stands for the plain
// Triangles::FindOverlap and gives the same triangles.

#pragma once

#include "geometry/cells/fast/BoxedTriangle.h"
#include "geometry/cells/fast/RoundingBound.h"
#include "geometry/triangles/Overlap.h"
#include "geometry/triangles/PreparedTriangle.h"

namespace Vorn::Cells {

/// A chord, that is a triangle (P1, P2, P2), that is overlapped with others one after another. Most
/// of them lie wholly on one side of it.
class ChordCutter {
 public:
  /// `magnitude` is that of the triangles to come. Takes any triangle, but is fast for chords only.
  ChordCutter(Triangle const& chord, Magnitude const& magnitude);

  /// As FindOverlap of the chord with the other triangle.
  void FindOverlapWith(BoxedTriangle const& other, Triangles::Overlap* overlap) const;

 private:
  /// Whether a triangle lies on one side of the chord, farther from it than rounding can move it.
  bool IsClearlyApartFrom(BoxedTriangle const& other) const;

  Triangles::PreparedTriangle prepared_;
  /// An offset above this is clear; infinite when none is.
  double clear_ = 0.0;
};

}  // namespace Vorn::Cells
