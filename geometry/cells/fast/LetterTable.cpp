#include "geometry/cells/fast/LetterTable.h"

#include <bit>
#include <utility>

namespace Vorn::Cells {

namespace {

/// Room for two parts of every letter while half of the slots stay free, so that the table seldom
/// has to be enlarged. With 2 some fits by cells took 3 to 9 per cent longer.
constexpr std::size_t kSlotsPerLetter = 4;

/// The slots are doubled when one in so many is taken.
constexpr std::size_t kSlotsPerTaken = 2;

/// Odd numbers of 64 bits without a pattern, one for each coordinate. Any others would do.
constexpr std::uint64_t kFactors[] = {0x9E3779B97F4A7C15, 0xC2B2AE3D27D4EB4F, 0x165667B19E3779F9,
                                      0xD6E8FEB86659FD93, 0xA0761D6478BD642F, 0xE7037ED1A0B428DB};

/// The upper half of a 64-bit hash, whose bits depend on most of the factors' bits.
constexpr int kUpperHalf = 32;

/// Multiplies and folds the words of a triangle, each by itself so that no product waits for the
/// one before.
std::uint32_t HashOf(Triangle const& triangle) {
  auto const word = [](double coordinate, std::uint64_t factor) {
    return std::bit_cast<std::uint64_t>(coordinate) * factor;
  };
  Point const* const pts = triangle.pts;
  std::uint64_t const hash = (word(pts[0].x, kFactors[0]) ^ word(pts[0].y, kFactors[1])) +
                             (word(pts[1].x, kFactors[2]) ^ word(pts[1].y, kFactors[3])) +
                             (word(pts[2].x, kFactors[4]) ^ word(pts[2].y, kFactors[5]));
  return static_cast<std::uint32_t>(hash >> kUpperHalf);
}

}  // namespace

LetterTable::LetterTable(std::size_t expectedLetters)
    : slots_(std::bit_ceil(kSlotsPerLetter * expectedLetters)) {}

Letter LetterTable::FindOrAdd(Triangle const& triangle, std::vector<BoxedTriangle>* triangles) {
  if (taken_ * kSlotsPerTaken >= slots_.size()) Enlarge();
  std::uint32_t const hash = HashOf(triangle);
  Slot& slot = SlotOf(triangle, hash, *triangles);
  if (slot.letter == kFree) {
    slot = {static_cast<Letter>(triangles->size()), hash};
    triangles->emplace_back(triangle);
    ++taken_;
  }
  return slot.letter;
}

LetterTable::Slot& LetterTable::SlotOf(Triangle const& triangle, std::uint32_t hash,
                                       std::vector<BoxedTriangle> const& triangles) {
  std::size_t const mask = slots_.size() - 1;
  std::size_t at = hash & mask;
  while (
      slots_[at].letter != kFree &&
      !(slots_[at].hash == hash && AreIdentical(triangles[slots_[at].letter].triangle, triangle))) {
    at = (at + 1) & mask;
  }
  return slots_[at];
}

void LetterTable::Enlarge() {
  std::vector<Slot> const old = std::move(slots_);
  slots_.assign(old.size() * 2, {});
  std::size_t const mask = slots_.size() - 1;
  for (Slot const& slot : old) {
    if (slot.letter == kFree) continue;
    std::size_t at = slot.hash & mask;
    while (slots_[at].letter != kFree) at = (at + 1) & mask;
    slots_[at] = slot;
  }
}

}  // namespace Vorn::Cells
