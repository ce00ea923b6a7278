#include "geometry/fewest/Programme.h"

namespace Vorn::Fewest {

namespace {

Row UnitRow(int k) {
  return {k == 0 ? 1.0 : 0.0, k == 1 ? 1.0 : 0.0, k == 2 ? 1.0 : 0.0, k == 3 ? 1.0 : 0.0};
}

}  // namespace

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

Row Programme::RowOf(std::int32_t id) const {
  if (id >= 0) return columns->At(id);
  return Basis::IsBox(id) ? UnitRow(id - Basis::kBox) : ConditionOf(id).row;
}

}  // namespace Vorn::Fewest
