#include "geometry/fewest/Programme.h"

#include <algorithm>

namespace Vorn::Fewest {

namespace {

Row UnitRow(int k) {
  return {k == 0 ? 1.0 : 0.0, k == 1 ? 1.0 : 0.0, k == 2 ? 1.0 : 0.0, k == 3 ? 1.0 : 0.0};
}

bool IsBox(std::int32_t id) { return id <= Basis::kBox + 3; }

std::size_t ConditionOf(std::int32_t id) { return static_cast<std::size_t>(-1 - id); }

}  // namespace

bool Basis::Holds(std::int32_t id) const {
  return std::find(ids.begin(), ids.end(), id) != ids.end();
}

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
  return IsBox(id) ? UnitRow(id - Basis::kBox) : conditions[ConditionOf(id)].row;
}

Condition::Kind Programme::KindOf(std::int32_t id) const {
  return id >= 0 || IsBox(id) ? Condition::Kind::Slab : conditions[ConditionOf(id)].kind;
}

double Programme::LimitOf(std::int32_t id) const {
  if (id >= 0) return 1.0;
  return IsBox(id) ? box : conditions[ConditionOf(id)].limit;
}

bool Programme::IsStale(std::int32_t id) const {
  if (id >= 0) return id < first || id >= last;
  return !IsBox(id) && -1 - id >= conditionCount;
}

}  // namespace Vorn::Fewest
