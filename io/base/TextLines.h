#pragma once

#include <cstddef>
#include <string_view>

namespace Vorn::IO {

/// No table of points has longer lines: a million columns fit. Taking a longer one apart would take
/// many times its memory.
inline constexpr std::size_t kLongestTableLine = std::size_t{16} << 20;

/// What is said of a longer one.
inline constexpr char const* kLineTooLong =
    "the line is longer than 16 MiB: no table and no tool path has such lines";

/// Walks over the lines of a text; a line ends with LF, CR LF or CR.
class TextLines {
 public:
  /// Before the first line of the text.
  explicit TextLines(std::string_view text) : text_(text), nextLineFeed_(text.find('\n')) {}

  /// Whether every line was taken.
  bool AtEnd() const { return position_ >= text_.size(); }

  /// The next line without its end. Must not be called at the end.
  std::string_view Take();

  /// Where the line after the one just taken begins.
  std::size_t Position() const { return position_; }

 private:
  std::string_view text_;
  std::size_t position_ = 0;
  /// Kept between calls: a text that has carriage returns alone is not searched over and over.
  std::size_t nextLineFeed_;
};

}  // namespace Vorn::IO
