#include "benchmarks/TimeBudget.h"

#include <algorithm>
#include <cmath>
#include <iterator>

namespace Vorn::Benchmarks {

bool TimeBudget::Allows(std::int64_t size) const {
  auto const after = taken_.lower_bound(size);
  if (after == taken_.begin()) return true;
  auto const [lastSize, lastSeconds] = *std::prev(after);
  double exponent = 1.0;
  if (std::prev(after) != taken_.begin()) {
    auto const [earlierSize, earlierSeconds] = *std::prev(after, 2);
    double const sizeRatio = static_cast<double>(lastSize) / static_cast<double>(earlierSize);
    exponent = std::max(1.0, std::log(lastSeconds / earlierSeconds) / std::log(sizeRatio));
  }
  double const growth = static_cast<double>(size) / static_cast<double>(lastSize);
  return lastSeconds * std::pow(growth, exponent) <= seconds_;
}

void TimeBudget::Note(std::int64_t size, double seconds) {
  auto const [entry, isNew] = taken_.try_emplace(size, seconds);
  if (!isNew) entry->second = std::min(entry->second, seconds);
}

}  // namespace Vorn::Benchmarks
