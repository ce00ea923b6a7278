#pragma once

#include <array>
#include <cstddef>
#include <cstdint>

#include "geometry/fewest/Columns.h"

/// Linear programmes in the four coefficients of a circle: the rows that it has to obey.
namespace Vorn::Fewest {

/// The four rows that hold a corner of the polytope. An id of 0 or more is the position of a point,
/// -1 - k condition k, kBox + k the box around coefficient k.
struct Basis {
  static constexpr std::int32_t kBox = -1000;
  std::array<std::int32_t, 4> ids{kBox, kBox + 1, kBox + 2, kBox + 3};

  /// Whether an id is that of a side of the box.
  static bool IsBox(std::int32_t id) { return id <= kBox + 3; }
  /// Whether a row is one of the four.
  bool Holds(std::int32_t id) const {
    return ids[0] == id || ids[1] == id || ids[2] == id || ids[3] == id;
  }
  /// The id of a box row that is none of the four.
  std::int32_t FreeBox() const;
};

/// A condition besides the tolerance rows.
struct Condition {
  Row row;
  /// Slab: |row| <= limit. HalfSpace: row <= limit. Equality: row = limit, always kept.
  enum class Kind : std::int8_t { Slab, HalfSpace, Equality } kind = Kind::Slab;
  double limit = 0.0;
};

/// The rows that a circle has to obey: those of the points [first, last) and some more.
struct Programme {
  static constexpr int kMostConditions = 24;
  /// Local coordinates are of the order of 1, so this box holds every circle down to a radius of
  /// 1e-6; the smaller, the better the rounding.
  static constexpr double kWidestBox = 1048576.0;

  Columns const* columns = nullptr;
  std::int32_t first = 0;
  std::int32_t last = 0;
  int conditionCount = 0;
  /// Bounds every coefficient, so that the programme has an end where the points leave it without.
  double box = kWidestBox;
  std::array<Condition, kMostConditions> conditions;

  /// Adds a condition; one too many is left out and answers false.
  bool Add(Condition const& condition);

  /// The row, the kind and the limit of a row that a basis may hold.
  Row RowOf(std::int32_t id) const {
    if (id >= 0) return columns->At(id);
    return Basis::IsBox(id) ? BoxRow(id) : ConditionOf(id).row;
  }
  /// Of points and the box: a slab.
  Condition::Kind KindOf(std::int32_t id) const {
    return id >= 0 || Basis::IsBox(id) ? Condition::Kind::Slab : ConditionOf(id).kind;
  }
  /// Of points: 1.
  double LimitOf(std::int32_t id) const {
    if (id >= 0) return 1.0;
    return Basis::IsBox(id) ? box : ConditionOf(id).limit;
  }
  /// Whether there is no row of that id any more.
  bool IsStale(std::int32_t id) const {
    if (id >= 0) return id < first || id >= last;
    return !Basis::IsBox(id) && -1 - id >= conditionCount;
  }
  /// The row of a side of the box.
  static Row BoxRow(std::int32_t id);
  /// The condition of an id that is neither that of a point nor of the box.
  Condition const& ConditionOf(std::int32_t id) const {
    return conditions[static_cast<std::size_t>(-1 - id)];
  }
};

}  // namespace Vorn::Fewest
