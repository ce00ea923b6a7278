// Words that replace letters: how a cell of many equal triangles is held.

#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace Vorn::Cells {

/// Stands for one distinct triangle of a level.
using Letter = std::uint32_t;

/// The words that replace the letters of one level by letters of the next.
struct Words {
  /// Where each word ends in `letters`; it begins where the one before ends.
  std::vector<std::uint32_t> ends;
  std::vector<Letter> letters;

  /// The word that replaces a letter, which must have one.
  std::span<Letter const> Of(Letter letter) const {
    std::uint32_t const begin = letter == 0 ? 0 : ends[letter - 1];
    return {letters.data() + begin, letters.data() + ends[letter]};
  }

  /// Becomes words for no letter.
  void clear() {
    ends.clear();
    letters.clear();
  }
};

/// The words from the first level to the last one. Those of the first level hold one word, the
/// sequence that a cell began with.
struct WordChain {
  /// Adds a level whose words expand to so many letters. The words must outlive the chain.
  void Append(Words const& words, std::size_t expandedLetters) {
    levels.push_back(&words);
    length += expandedLetters;
    widest = std::max(widest, expandedLetters);
  }

  std::vector<Words const*> levels;
  /// The number of letters in the expansions of all levels, and of the level that has most.
  std::size_t length = 0;
  std::size_t widest = 1;
};

}  // namespace Vorn::Cells
