#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace Vorn::IO {

/// Watches over a text that is read block by block, so that a line without an end is refused while
/// little of it was read.
class LongLines {
 public:
  /// For the file of this path.
  explicit LongLines(std::string path) : path_(std::move(path)) {}

  /// Looks at what has come since the last call; `text` is all that was read so far.
  /// @throws Failure (FailureKind::File) naming file and line when the last line is longer than any
  ///         of a table, or, in a format that may stand in one line, than what can be read of it.
  void Look(std::string_view text);

 private:
  /// Lets longer lines pass where the format has them; refuses the last line where it has not.
  void Judge(std::string_view text);

  std::string path_;
  std::size_t lineBegin_ = 0;  ///< of a line behind which every line is short, as far as is known
  std::size_t longest_ = 0;    ///< of the lines that pass, in bytes; 0 before the first look
};

}  // namespace Vorn::IO
