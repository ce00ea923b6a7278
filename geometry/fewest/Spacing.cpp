#include "geometry/fewest/Spacing.h"

#include <algorithm>
#include <cstddef>

#include "math/Assert.h"

namespace Vorn::Fewest {

namespace {

RunSpacing Joined(RunSpacing const& one, RunSpacing const& other) {
  return {std::max(one.widest2, other.widest2), std::min(one.leastTolerance, other.leastTolerance),
          std::min(one.lowX, other.lowX),       std::max(one.highX, other.highX),
          std::min(one.lowY, other.lowY),       std::max(one.highY, other.highY)};
}

}  // namespace

RunSpacing Spacing::Scan(std::int32_t first, std::int32_t end, bool isBeginning) const {
  WPoint const* last = &path_.At(isBeginning ? first : first - 1);
  WPoint const& p = path_.At(first);
  RunSpacing spacing{0.0, p.w, p.x, p.x, p.y, p.y};
  for (std::int32_t i = first; i < end; ++i) {
    WPoint const& next = path_.At(i);
    double const dx = next.x - last->x;
    double const dy = next.y - last->y;
    spacing = Joined(spacing, {dx * dx + dy * dy, next.w, next.x, next.x, next.y, next.y});
    last = &next;
  }
  return spacing;
}

RunSpacing const& Spacing::OfBlock(std::int32_t block) {
  if (blocks_.empty()) blocks_.resize(static_cast<std::size_t>(path_.Count() / kBlock) + 1);
  RunSpacing& spacing = blocks_[static_cast<std::size_t>(block)];
  bool const isNew = spacing.leastTolerance == 0.0;
  if (isNew) spacing = Scan(block * kBlock, (block + 1) * kBlock, block == 0);
  return spacing;
}

RunSpacing Spacing::Of(std::int32_t first, std::int32_t end) {
  VORN_ASSERT(first < end);
  std::int32_t const firstBlock = first / kBlock + 1;
  std::int32_t const endBlock = end / kBlock;
  if (firstBlock >= endBlock) return Scan(first, end, true);
  RunSpacing spacing = Scan(first, firstBlock * kBlock, true);
  for (std::int32_t block = firstBlock; block < endBlock; ++block) {
    spacing = Joined(spacing, OfBlock(block));
  }
  std::int32_t const rest = endBlock * kBlock;
  return rest < end ? Joined(spacing, Scan(rest, end, false)) : spacing;
}

double Spacing::WidestGap2(std::int32_t first, std::int32_t end) {
  if (end - first > 2 * kBlock) return Of(first, end).widest2;
  double widest = 0.0;
  for (std::int32_t i = first + 1; i < end; ++i) {
    WPoint const& p = path_.At(i - 1);
    WPoint const& q = path_.At(i);
    double const dx = q.x - p.x;
    double const dy = q.y - p.y;
    double const gap = dx * dx + dy * dy;
    widest = gap > widest ? gap : widest;
  }
  return widest;
}

}  // namespace Vorn::Fewest
