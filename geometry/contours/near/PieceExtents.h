#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "geometry/contours/near/BoxTree.h"
#include "vorn/GeometryUtils.h"

/// The regions of the pieces of a contour, such that pieces with regions apart have no common point
/// in the eyes of the intersection routines, whatever these lose by rounding.
namespace Vorn::Contours {

/// A segment from start to end, or an arc, which may lie elsewhere than its start and end say.
struct Shape {
  GeometryUtils::Point start;
  GeometryUtils::Point end;
  GeometryUtils::Arc const* arc = nullptr;  ///< null for a segment
};

class PieceExtents {
 public:
  /// The sets of pieces that are to be compared, with each other or within themselves.
  explicit PieceExtents(std::vector<std::vector<Shape> const*> const& sets);

  /// The regions of shapes. Of irregular pieces no region can be told, so that they may meet any
  /// other piece: they hold a not-a-number, or values so large, so small or so different that
  /// bounds on rounding fail. Their regions are empty and their numbers appended to irregular.
  std::vector<Extent> Of(std::vector<Shape> const& shapes,
                         std::vector<std::size_t>* irregular) const;

  /// By how much slanted bounds must be apart.
  double SlantedMargin() const;

 private:
  bool IsRegular(Shape const& shape) const;
  Extent ExtentOf(Shape const& shape) const;
  Box BoxOfArc(GeometryUtils::Arc const& arc) const;
  double PaddingOf(GeometryUtils::Arc const& arc) const;

  double largestEnd_ = 0.0;         ///< of the coordinates of end points
  double largestCoordinate_ = 0.0;  ///< of regular pieces, centres included
  double largestRadius_ = 0.0;      ///< of regular pieces
};

/// Calls test(i, k) for pairs i < k of shapes until it answers true, and returns whether it did.
/// All pairs are tested but for those that have no common point.
template <typename Test>
bool AnyPair(std::vector<Shape> const& shapes, Test const& test) {
  PieceExtents const extents({&shapes});
  std::vector<std::size_t> irregular;
  BoxTree tree(extents.Of(shapes, &irregular), extents.SlantedMargin());
  for (std::size_t const odd : irregular) {
    for (std::size_t i = 0; i < odd; ++i) {
      if (test(i, odd)) return true;
    }
    for (std::size_t k = odd + 1; k < shapes.size(); ++k) {
      if (test(odd, k)) return true;
    }
  }
  return tree.AnyPair(test);
}

/// The same for all pairs of one of the first and one of the second shapes.
template <typename Test>
bool AnyPair(std::vector<Shape> const& first, std::vector<Shape> const& second, Test const& test) {
  PieceExtents const extents({&first, &second});
  std::vector<std::size_t> irregularFirst;
  std::vector<std::size_t> irregularSecond;
  BoxTree tree(extents.Of(first, &irregularFirst), extents.SlantedMargin());
  BoxTree otherTree(extents.Of(second, &irregularSecond), extents.SlantedMargin());
  for (std::size_t const odd : irregularFirst) {
    for (std::size_t k = 0; k < second.size(); ++k) {
      if (test(odd, k)) return true;
    }
  }
  for (std::size_t const odd : irregularSecond) {
    for (std::size_t i = 0; i < first.size(); ++i) {
      if (test(i, odd)) return true;
    }
  }
  return tree.AnyPair(otherTree, test);
}

}  // namespace Vorn::Contours
