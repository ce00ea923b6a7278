#include "geometry/fewest/Columns.h"

#include <cmath>

namespace Vorn::Fewest {

namespace {

using Lanes [[gnu::vector_size(16)]] = double;
using Bits [[gnu::vector_size(16)]] = std::int64_t;

/// Rows looked at together before the largest is compared with the largest so far, and as many of
/// the rest. A comparison for each row would cost most of the time: its outcome is hard to foresee.
constexpr std::int32_t kBlock = 16;
constexpr std::int32_t kSmallBlock = 4;

Lanes Load(double const* p) { return Lanes{p[0], p[1]}; }

Lanes Magnitude(Lanes v) {
  constexpr std::int64_t kAllButSign = 0x7fffffffffffffff;
  return reinterpret_cast<Lanes>(reinterpret_cast<Bits>(v) & Bits{kAllButSign, kAllButSign});
}

Lanes Larger(Lanes v, Lanes u) { return v > u ? v : u; }

/// The coefficients of the rows, an array for each.
struct Coefficients {
  double const* a;
  double const* bx;
  double const* by;
  double const* d;
};

/// |row applied to a circle|, for one row, for two side by side or for a block of them. Every way
/// adds the same products in the same order, so that all of them give the same bits.
class Residuals {
 public:
  /// Reads the rows in place; they have to outlive this.
  Residuals(Coefficients const& rows, Circle const& circle)
      : rows_(rows),
        circle_(circle),
        a_{circle.a, circle.a},
        bx_{circle.bx, circle.bx},
        by_{circle.by, circle.by},
        d_{circle.d, circle.d} {}

  /// That of row i.
  double At(std::int32_t i) const {
    return std::fabs(
        ((circle_.a * rows_.a[i] + circle_.bx * rows_.bx[i]) + circle_.by * rows_.by[i]) +
        circle_.d * rows_.d[i]);
  }

  /// The largest of the kBlock rows from i on.
  double LargestOfBlock(std::int32_t i) const {
    Lanes even{0.0, 0.0};
    Lanes odd{0.0, 0.0};
    for (std::int32_t k = 0; k < kBlock; k += 4) {
      even = Larger(PairAt(i + k), even);
      odd = Larger(PairAt(i + k + 2), odd);
    }
    even = Larger(odd, even);
    return even[0] > even[1] ? even[0] : even[1];
  }

  /// The largest of the kSmallBlock rows from i on.
  double LargestOfSmallBlock(std::int32_t i) const {
    Lanes const largest = Larger(PairAt(i + 2), PairAt(i));
    return largest[0] > largest[1] ? largest[0] : largest[1];
  }

  /// The first row of a block from i on that is not below its largest; the last row of the block
  /// where none is.
  std::int32_t FirstInBlock(std::int32_t i, std::int32_t size, double largest) const {
    std::int32_t const last = i + size - 1;
    while (At(i) < largest && i < last) ++i;
    return i;
  }

 private:
  /// Those of rows i and i + 1.
  Lanes PairAt(std::int32_t i) const {
    return Magnitude(
        ((a_ * Load(rows_.a + i) + bx_ * Load(rows_.bx + i)) + by_ * Load(rows_.by + i)) +
        d_ * Load(rows_.d + i));
  }

  Coefficients rows_;
  Circle circle_;
  Lanes a_;
  Lanes bx_;
  Lanes by_;
  Lanes d_;
};

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

Columns::Worst Columns::FindWorst(std::int32_t first, std::int32_t last,
                                  Circle const& circle) const {
  Residuals const residuals({a_.data(), bx_.data(), by_.data(), d_.data()}, circle);
  Worst worst;
  std::int32_t blockOfWorst = 1;
  auto const offer = [&](std::int32_t i, std::int32_t size, double largest) {
    if (!(largest > worst.value || worst.index < 0)) return;
    worst = {i, largest};
    blockOfWorst = size;
  };
  std::int32_t i = first;
  for (; i + kBlock <= last; i += kBlock) offer(i, kBlock, residuals.LargestOfBlock(i));
  for (; i + kSmallBlock <= last; i += kSmallBlock) {
    offer(i, kSmallBlock, residuals.LargestOfSmallBlock(i));
  }
  for (; i < last; ++i) offer(i, 1, residuals.At(i));
  if (worst.index < 0) return worst;
  worst.index = residuals.FirstInBlock(worst.index, blockOfWorst, worst.value);
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
