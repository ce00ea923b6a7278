#include "geometry/fewest/Columns.h"

#include <cmath>

namespace Vorn::Fewest {

namespace {

using Lanes [[gnu::vector_size(16)]] = double;
using Bits [[gnu::vector_size(16)]] = std::int64_t;

/// Rows looked at together before the largest is compared with the largest so far.
constexpr std::int32_t kBlock = 16;

Lanes Load(double const* p) { return Lanes{p[0], p[1]}; }

Lanes Magnitude(Lanes v) {
  constexpr std::int64_t kAllButSign = 0x7fffffffffffffff;
  return reinterpret_cast<Lanes>(reinterpret_cast<Bits>(v) & Bits{kAllButSign, kAllButSign});
}

Lanes Larger(Lanes v, Lanes u) { return v > u ? v : u; }

}  // namespace

void Columns::Clear() {
  a_.clear();
  bx_.clear();
  by_.clear();
  d_.clear();
}

void Columns::Append(Sample const& s) {
  double const weight = 1.0 / s.w;
  a_.push_back((s.x * s.x + s.y * s.y) * weight - s.w);
  bx_.push_back(s.x * weight);
  by_.push_back(s.y * weight);
  d_.push_back(weight);
}

Row Columns::At(std::int32_t i) const {
  auto const k = static_cast<std::size_t>(i);
  return {a_[k], bx_[k], by_[k], d_[k]};
}

Columns::Worst Columns::FindWorst(std::int32_t first, std::int32_t last,
                                  Circle const& circle) const {
  double const* const a = a_.data();
  double const* const bx = bx_.data();
  double const* const by = by_.data();
  double const* const d = d_.data();
  auto const valueAt = [&](std::int32_t i) {
    return std::fabs(((circle.a * a[i] + circle.bx * bx[i]) + circle.by * by[i]) + circle.d * d[i]);
  };
  Lanes const ca{circle.a, circle.a};
  Lanes const cx{circle.bx, circle.bx};
  Lanes const cy{circle.by, circle.by};
  Lanes const cd{circle.d, circle.d};
  auto const pairAt = [&](std::int32_t i) {
    return Magnitude(((ca * Load(a + i) + cx * Load(bx + i)) + cy * Load(by + i)) +
                     cd * Load(d + i));
  };

  Worst worst;
  std::int32_t worstBlock = -1;
  std::int32_t i = first;
  for (; i + kBlock <= last; i += kBlock) {
    Lanes even{0.0, 0.0};
    Lanes odd{0.0, 0.0};
    for (std::int32_t k = 0; k < kBlock; k += 4) {
      even = Larger(pairAt(i + k), even);
      odd = Larger(pairAt(i + k + 2), odd);
    }
    even = Larger(odd, even);
    double const largest = even[0] > even[1] ? even[0] : even[1];
    if (largest > worst.value || worst.index < 0) {
      worst.value = largest;
      worst.index = worstBlock = i;
    }
  }
  for (; i < last; ++i) {
    double const value = valueAt(i);
    if (value > worst.value || worst.index < 0) {
      worst = {i, value};
      worstBlock = -1;
    }
  }
  if (worstBlock >= 0) {
    while (valueAt(worst.index) < worst.value && worst.index < worstBlock + kBlock - 1) {
      ++worst.index;
    }
  }
  return worst;
}

std::int32_t Columns::FindFirstAbove(std::int32_t first, std::int32_t last, Circle const& circle,
                                     double limit) const {
  for (std::int32_t i = first; i < last; ++i) {
    if (std::fabs(Apply(At(i), circle)) > limit) return i;
  }
  return last;
}

}  // namespace Vorn::Fewest
