#pragma once

#include <cstdint>
#include <vector>

#include "geometry/fewest/Circle.h"
#include "geometry/fewest/LocalFrame.h"
#include "geometry/fewest/Path.h"

/// How far points of dense scans lie back behind earlier ones, for long runs at once. Neighbours do
/// not tell: a scan that turns back does so by many steps that are each as short as noise.
namespace Vorn::Fewest {

/// Answers for runs of one path. What it finds of blocks of points is kept for the direction in
/// which it was asked, which is nearly the same for all pieces that cover a block.
class Backsteps {
 public:
  /// Reads the path in place; its points must not change.
  explicit Backsteps(Path const& path) : path_(path) {}

  /// Whether it is sure that no point of [first, end) lies farther back along a circle than `most`,
  /// a length, behind an earlier one. O(n / kBlock + kBlock) for n points, but for blocks that are
  /// new. The circle is in the local coordinates of a frame, `most` in those of the path.
  bool AreWithin(double most, Circle const& circle, LocalFrame const& frame, std::int32_t first,
                 std::int32_t end);

 private:
  static constexpr std::int32_t kBlock = 64;

  /// Consecutive points, the last of those before them counted in, seen in one direction.
  struct Block {
    Place direction;       ///< of length 1; 0 before the block is looked at
    double advance = 0.0;  ///< of the last point from the one before the block
    double aside = 0.0;    ///< the same to the left
    double back = 0.0;     ///< the farthest that a point lies behind an earlier one
    double above = 0.0;    ///< the farthest that a point lies ahead of the last one
    double below = 0.0;    ///< the farthest that a point lies behind the one before the block
    double width = 0.0;    ///< extent to the left and right
    double length = 0.0;   ///< extent along the direction

    /// An upper bound of one of the distances along, seen in a direction turned by an angle of this
    /// sine.
    double Turned(double along, double sine) const { return along + sine * width; }
  };

  /// Looks at the points [first, end). Where they begin a run no point before them counts.
  Block Scan(std::int32_t first, std::int32_t end, bool isBeginning, Place const& direction) const;
  /// A whole block, looked at anew where it was seen from a direction far from this one.
  Block const& OfBlock(std::int32_t block, Place const& direction);

  Path const& path_;
  std::vector<Block> blocks_;
};

}  // namespace Vorn::Fewest
