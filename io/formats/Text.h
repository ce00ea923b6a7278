#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "io/base/TextLines.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Pieces.h"

/// What the readers of contour files have in common.
namespace Vorn::IO {

/// The lines of a text, whatever the system they were written on; a byte order mark is skipped.
class Lines {
 public:
  /// Before the first line of the text.
  explicit Lines(std::string_view text);

  /// False at the end of the text.
  bool Next(std::string_view* line);

  /// Of the line that Next gave last, counted from 1.
  std::size_t Number() const { return number_; }

 private:
  TextLines lines_;
  std::size_t number_ = 0;
};

/// Ends the reading of a file with a message about all of it.
[[noreturn]] void RefuseFile(std::string const& path, std::string const& message);

/// The same about one line.
[[noreturn]] void RefuseLine(std::string const& path, std::size_t line, std::string const& message);

/// Ends the reading at an arc where points are wanted: "an arc from (0, 0) to (2, 0)". What would
/// help is a tolerance for its chords.
[[noreturn]] void RefuseArc(Piece const& arc, Place const& place);

/// What is said of such an arc.
std::string DescribeArc(Piece const& arc);

/// The coordinate that the text is. `what` names it: "start_x".
/// @throws Failure (FailureKind::File) naming file, line and text when it is none that can be used.
double RequireNumber(std::string_view text, std::string const& what, std::string const& path,
                     std::size_t line);

/// The fewest digits that read back as the same double, without an exponent and with a point, as
/// readers of older formats want it: "0.00001", "5.0".
std::string FormatPlain(double value);

/// With blanks in place of line breaks, so that a comment stays one.
std::string OneLine(std::string text);

/// Line and column of a place in the text of a file.
Place PlaceIn(std::string_view text, std::size_t offset, std::string const& path);

}  // namespace Vorn::IO
