// How a level of a cell sequence is made from the overlaps of the letters of the level before.

#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "geometry/cells/fast/CellLevel.h"
#include "geometry/cells/fast/LetterTable.h"

namespace Vorn::Cells {

/// Collects the words of a new level and numbers its letters in the order in which they first
/// occur.
class LevelBuilder {
 public:
  /// For the overlaps of a level's letters, each of which occurs as often as `counts` says. Both
  /// arguments must outlive this; `level` is emptied first.
  LevelBuilder(std::vector<std::size_t> const& counts, CellLevel* level)
      : counts_(counts), level_(*level), table_(counts.size()) {
    level_.clear();
    level_.words.ends.reserve(counts.size());
  }

  /// Adds a letter as it is to the word, some copies of it. No other letter has an equal triangle
  /// among its parts, or it stays a letter of its own.
  void Keep(BoxedTriangle const& boxed, std::size_t copies) {
    auto const letter = static_cast<Letter>(level_.triangles.size());
    level_.triangles.push_back(boxed);
    Append(letter, copies);
  }

  /// Adds a triangle to the word.
  void Add(Triangle const& part) { Append(LetterOf(part), 1); }

  /// Ends the word; the next one belongs to the next letter.
  void EndWord() {
    level_.words.ends.push_back(static_cast<std::uint32_t>(level_.words.letters.size()));
  }

 private:
  /// Adds copies of a letter to the word; a new letter is the next one.
  void Append(Letter letter, std::size_t copies) {
    bool const isNew = letter == level_.counts.size();
    if (isNew) level_.counts.push_back(0);
    for (std::size_t copy = 0; copy < copies; ++copy) level_.words.letters.push_back(letter);
    std::size_t const occurrences = copies * counts_[level_.words.ends.size()];
    level_.counts[letter] += occurrences;
    level_.size += occurrences;
  }

  /// The letter of a triangle, a new one if it has none.
  Letter LetterOf(Triangle const& triangle) {
    // Copies follow each other.
    if (!level_.words.letters.empty()) {
      Letter const previous = level_.words.letters.back();
      if (AreIdentical(level_.triangles[previous].triangle, triangle)) return previous;
    }
    return table_.FindOrAdd(triangle, &level_.triangles);
  }

  std::vector<std::size_t> const& counts_;
  CellLevel& level_;
  LetterTable table_;
};

}  // namespace Vorn::Cells
