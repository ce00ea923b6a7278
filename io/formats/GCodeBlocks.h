#pragma once

#include <array>
#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Vorn::IO {

/// A letter with its number.
struct GCodeWord {
  char letter = ' ';
  double value = 0.0;
  std::string_view text;
};

/// One block: the words of a line, by letter. Only G and M may be repeated.
struct GCodeBlock {
  std::vector<GCodeWord> codes;
  std::array<std::optional<double>, 26> values;

  /// The value of the word with this letter; nothing where the block has none.
  std::optional<double> const& operator[](char letter) const {
    return values[static_cast<std::size_t>(letter - 'A')];
  }
  /// The same to be written.
  std::optional<double>& operator[](char letter) {
    return values[static_cast<std::size_t>(letter - 'A')];
  }
};

/// Takes a line apart, without its comments. The words keep views into `line`.
/// @throws Failure (FailureKind::File) naming file, line and word.
GCodeBlock ReadGCodeBlock(std::string_view line, std::size_t number, std::string const& path);

}  // namespace Vorn::IO
