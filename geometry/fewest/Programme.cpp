#include "geometry/fewest/Programme.h"

namespace Vorn::Fewest {

std::int32_t Basis::FreeBox() const {
  std::int32_t id = kBox;
  while (Holds(id)) ++id;
  return id;
}

bool Programme::Add(Condition const& condition) {
  if (conditionCount == kMostConditions) return false;
  conditions[static_cast<std::size_t>(conditionCount++)] = condition;
  return true;
}

Row Programme::BoxRow(std::int32_t id) {
  std::int32_t const k = id - Basis::kBox;
  return {k == 0 ? 1.0 : 0.0, k == 1 ? 1.0 : 0.0, k == 2 ? 1.0 : 0.0, k == 3 ? 1.0 : 0.0};
}

}  // namespace Vorn::Fewest
