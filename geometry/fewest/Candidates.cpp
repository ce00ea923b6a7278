#include "geometry/fewest/Candidates.h"

#include <algorithm>
#include <cmath>
#include <cstddef>

namespace Vorn::Fewest {

Columns::Worst Candidates::FindWorst(Programme const& programme, Circle const& circle) const {
  Columns::Worst worst;
  for (std::int32_t k = 0; k < count_; ++k) {
    std::int32_t const index = indices_[static_cast<std::size_t>(k)];
    if (programme.IsStale(index)) continue;
    double const value = std::fabs(Apply(programme.columns->At(index), circle));
    if (value > worst.value) worst = {index, value};
  }
  return worst;
}

Columns::Worst Candidates::FindWorstOfAll(Programme const& programme, Circle const& circle,
                                          double limit) {
  std::int64_t const size = programme.last - programme.first;
  auto const startOf = [&](std::int64_t part) {
    return programme.first + static_cast<std::int32_t>(part * size / kParts);
  };
  Columns::Worst worst;
  for (std::int32_t part = 0; part < kParts; ++part) {
    Columns::Worst const here =
        programme.columns->FindWorst(startOf(part), startOf(part + 1), circle);
    if (here.value > limit) Add(here.index);
    if (here.value > worst.value || worst.index < 0) worst = here;
  }
  return worst;
}

void Candidates::Add(std::int32_t index) {
  indices_[static_cast<std::size_t>(next_)] = index;
  count_ = std::max(count_, next_ + 1);
  next_ = (next_ + 1) % kMost;
}

}  // namespace Vorn::Fewest
