// The common part of two triangles, and of a triangle with a cell.

#pragma once

#include <cstddef>
#include <span>
#include <vector>

#include "geometry/triangles/InlineVector.h"
#include "geometry/triangles/PreparedTriangle.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Triangles {

using OverlappingStatus = GeometryUtils::OverlappingStatus;

/// How many times a contained triangle makes up the overlap. Deliberate: the copies weigh in the
/// centre of a cell and in its size.
inline constexpr int kCopiesOfContained = 3;

/// How many triangles an overlap can have: a walk takes at most four points on each of three sides,
/// and twelve points make ten triangles.
inline constexpr std::size_t kMostParts = 10;

/// What two triangles have in common.
struct Overlap {
  /// Overlap exactly when there are parts.
  OverlappingStatus status = OverlappingStatus::NoOverlap;
  InlineVector<Triangle, kMostParts> parts;

  /// Becomes an overlap without parts.
  void Reset(OverlappingStatus newStatus) {
    status = newStatus;
    parts.clear();
  }
};

/// The common part of two triangles. OverlapFailed when a vertex has no defined status or the
/// vertices say that one triangle is partly in the other although no sides cross.
void FindOverlap(PreparedTriangle const& first, PreparedTriangle const& second, Overlap* overlap);

/// Appends the triangles of the common parts of a triangle and each triangle of a cell, in order;
/// pairs that could not be resolved count as without a common part. `result` must not hold the
/// cell. O(size of cell).
void AppendOverlaps(Triangle const& first, std::span<Triangle const> cell,
                    std::vector<Triangle>* result);

}  // namespace Vorn::Triangles
