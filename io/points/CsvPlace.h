#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "vorn/io/Failure.h"

namespace Vorn::IO {

/// Where a reader of points is in its file, and how it refuses what it finds there.
class CsvPlace {
 public:
  /// Before the first line of the file with this name.
  explicit CsvPlace(std::string const& path);

  /// Goes on to the next line. The text must live as long as messages may quote it.
  void Enter(std::string_view lineText) {
    ++line_;
    lineText_ = lineText;
  }

  /// The name of the file as messages call it.
  std::string const& Path() const { return path_; }

  /// The number of the current line, counted from 1; 0 before the first one.
  std::size_t Line() const { return line_; }

  /// Says something of the whole file.
  [[noreturn]] void Refuse(std::string const& message) const;

  /// Says something of the current line and names no column.
  [[noreturn]] void RefuseLine(std::string const& message) const;

  /// Says something of a part of the current line.
  [[noreturn]] void RefuseAt(std::string_view field, std::string const& message,
                             Remedy help = Remedy::None) const;

 private:
  std::string path_;
  std::size_t line_ = 0;
  std::string_view lineText_;
};

}  // namespace Vorn::IO
