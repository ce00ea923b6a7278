// How a level of a cell sequence is made from the overlaps of the letters of the level before.

#pragma once

#include <cstddef>
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
  LevelBuilder(std::vector<std::size_t> const& counts, CellLevel* level);

  /// Adds a letter as it is to the word, some copies of it. No other letter has an equal triangle
  /// among its parts, or it stays a letter of its own.
  void Keep(BoxedTriangle const& boxed, std::size_t copies);

  /// Adds a triangle to the word.
  void Add(Triangle const& part) { Append(LetterOf(part), 1); }

  /// Ends the word; the next one belongs to the next letter.
  void EndWord();

 private:
  void Append(Letter letter, std::size_t copies);
  Letter LetterOf(Triangle const& triangle);

  std::vector<std::size_t> const& counts_;
  CellLevel& level_;
  LetterTable table_;
};

}  // namespace Vorn::Cells
