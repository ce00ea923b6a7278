#include "geometry/fewest/Backsteps.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <limits>

namespace Vorn::Fewest {

namespace {

/// A block is looked at anew where the direction has turned by an angle of more than this sine:
/// then what its width adds to a step back could make up a good part of what noise may.
constexpr double kLargestSine = 0.02;

/// Blocks that turn by more than this angle in radians are left to a look at their points.
constexpr double kMostTurn = 0.25;

double Dot(Place const& a, Place const& b) { return a.x * b.x + a.y * b.y; }
double Cross(Place const& a, Place const& b) { return a.x * b.y - a.y * b.x; }

}  // namespace

Backsteps::Block Backsteps::Scan(std::int32_t first, std::int32_t end, bool isBeginning,
                                 Place const& direction) const {
  Block block;
  block.direction = direction;
  WPoint const& origin = path_.At(isBeginning ? first : first - 1);
  double highest = 0.0;
  double lowest = 0.0;
  double left = 0.0;
  double right = 0.0;
  for (std::int32_t i = first; i < end; ++i) {
    WPoint const& p = path_.At(i);
    Place const step{p.x - origin.x, p.y - origin.y};
    block.advance = Dot(direction, step);
    block.aside = Cross(direction, step);
    highest = std::max(highest, block.advance);
    lowest = std::min(lowest, block.advance);
    left = std::max(left, block.aside);
    right = std::min(right, block.aside);
    block.back = std::max(block.back, highest - block.advance);
  }
  block.above = highest - block.advance;
  block.below = -lowest;
  block.width = left - right;
  block.length = highest - lowest;
  return block;
}

Backsteps::Block const& Backsteps::OfBlock(std::int32_t block, Place const& direction) {
  if (blocks_.empty()) blocks_.resize(static_cast<std::size_t>(path_.Count() / kBlock) + 1);
  Block& known = blocks_[static_cast<std::size_t>(block)];
  bool const isNear = Dot(known.direction, direction) > 0.0 &&
                      std::fabs(Cross(known.direction, direction)) <= kLargestSine;
  if (!isNear) known = Scan(block * kBlock, (block + 1) * kBlock, false, direction);
  return known;
}

bool Backsteps::AreWithin(double most, Circle const& circle, LocalFrame const& frame,
                          std::int32_t first, std::int32_t end) {
  double const curvature = 2.0 * std::fabs(circle.a) * frame.scale;
  double advance = 0.0;
  double farthest = -std::numeric_limits<double>::infinity();
  for (std::int32_t i = first; i < end;) {
    std::int32_t const next = std::min(end, (i / kBlock + 1) * kBlock);
    WPoint const& middle = path_.At(i + (next - i) / 2);
    Place const normal = GradientAt(circle, frame.ToLocal(Place{middle.x, middle.y}));
    double const size = std::sqrt(Dot(normal, normal));
    if (!(size > 0.0)) return false;
    Place const direction{normal.y / size, -normal.x / size};
    bool const isWhole = i > first && next - i == kBlock;
    Block const block =
        isWhole ? OfBlock(i / kBlock, direction) : Scan(i, next, i == first, direction);
    double const turn = curvature * block.length;
    if (turn > kMostTurn) return false;
    double const turned = Cross(block.direction, direction);
    double const sine = std::fabs(turned) + turn;
    double const back = std::max(block.Turned(block.back, sine),
                                 farthest - (advance - block.Turned(block.below, sine)));
    if (back > most) return false;
    advance += block.advance + turned * block.aside;
    farthest = std::max(farthest, advance + block.Turned(block.above, sine));
    i = next;
  }
  return true;
}

}  // namespace Vorn::Fewest
