// One level of a cell sequence.

#pragma once

#include <cstddef>
#include <vector>

#include "geometry/cells/fast/BoxedTriangle.h"
#include "geometry/cells/fast/RoundingBound.h"
#include "geometry/cells/fast/Words.h"

namespace Vorn::Cells {

/// What a cell was after one narrowing: its distinct triangles, and the words that put them in the
/// place of the letters of the level before.
struct CellLevel {
  Words words;
  /// The triangle that each letter stands for.
  std::vector<BoxedTriangle> triangles;
  /// Of all triangles that ever made up the cell. Parts of triangles are within both of them but
  /// for the rounding of crossing points, which kErrorBound leaves room for.
  Magnitude magnitude;
  /// How often each letter occurs in the sequence.
  std::vector<std::size_t> counts;
  /// The number of triangles, copies included.
  std::size_t size = 0;

  /// Becomes a level without triangles; the magnitude stays.
  void clear() {
    words.clear();
    triangles.clear();
    counts.clear();
    size = 0;
  }
};

}  // namespace Vorn::Cells
