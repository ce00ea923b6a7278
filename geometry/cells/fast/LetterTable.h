// The table that tells whether a triangle has a letter already: open addressing with linear probes.

#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <vector>

#include "geometry/cells/fast/BoxedTriangle.h"
#include "geometry/cells/fast/Words.h"

namespace Vorn::Cells {

/// Whether all bits of two triangles are equal: a zero and a negative zero are not. Only such
/// triangles share a letter.
inline bool AreIdentical(Triangle const& a, Triangle const& b) {
  // Bits are meant, and a triangle is six doubles without padding.
  static_assert(sizeof(Triangle) == 6 * sizeof(double));
  // NOLINTNEXTLINE(bugprone-suspicious-memory-comparison)
  return std::memcmp(&a, &b, sizeof(Triangle)) == 0;
}

/// Finds letters by triangle. The triangles themselves stand in a vector that the caller keeps,
/// each at the position that is its letter.
class LetterTable {
 public:
  /// An empty table with room for about so many letters.
  explicit LetterTable(std::size_t expectedLetters);

  /// The letter of a triangle. One that has none gets the next letter and is appended to
  /// `triangles`, which must hold what was appended so far and may hold more. O(1) on the average.
  Letter FindOrAdd(Triangle const& triangle, std::vector<BoxedTriangle>* triangles);

 private:
  static constexpr Letter kFree = UINT32_MAX;

  /// A letter and the hash of its triangle.
  struct Slot {
    Letter letter = kFree;
    std::uint32_t hash = 0;
  };

  /// Where the triangle stands in the table, or where it belongs.
  Slot& SlotOf(Triangle const& triangle, std::uint32_t hash,
               std::vector<BoxedTriangle> const& triangles);

  /// Doubles the number of slots.
  void Enlarge();

  /// A power of two of slots, at most half of them taken.
  std::vector<Slot> slots_;
  std::size_t taken_ = 0;
};

}  // namespace Vorn::Cells
