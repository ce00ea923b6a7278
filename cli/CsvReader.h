#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "vorn/Types.h"

namespace Vorn::Cli {

/// Where the reader takes each point's tolerance from.
struct ToleranceColumn {
  enum class Use {
    Ignore,     ///< every `w` stays 0
    IfPresent,  ///< column `w`, or the third one of a file without a header
    Required,   ///< the column called `name`; without one the file is refused
  };
  Use use = Use::Ignore;
  std::string name = "w";
};

/// The contents of one file of measured points.
struct PointFile {
  std::string path;
  std::vector<WPoint> points;       ///< `w` is 0 unless hasTolerances
  std::vector<std::size_t> lines;   ///< line of each point, counted from 1
  bool hasTolerances = false;       ///< a column gave every point's `w`
  std::optional<double> tolerance;  ///< of a comment `# tolerance T`
  std::string units;                ///< of a comment `# units mm`; may be empty

  /// "point 4 (line 6)", points counted from 0 as the library does.
  std::string NameOf(std::size_t index) const;
};

/// Reads points written as `x,y` or `x,y,w`, one a line.
///
/// Fields are separated by a semicolon, a tab, a comma or blanks, by what the first line with
/// data holds, in this order of preference. A first line without any number is a header; columns
/// called x and y are found by it, else the first two columns are taken. Without a header there
/// must be two or three columns. Empty lines and what follows a `#` are skipped; line ends may be
/// of any system; a UTF-8 byte order mark is allowed.
///
/// @throws Failure (ExitCode::File) naming file, line and offending text when a number is not one
///         or not finite, a tolerance is not positive, the columns do not fit, or fewer than two
///         points are there.
PointFile ReadPoints(std::string const& path, ToleranceColumn const& column);

/// The same for text already in memory; `path` serves the messages.
PointFile ParsePoints(std::string_view text, std::string const& path,
                      ToleranceColumn const& column);

}  // namespace Vorn::Cli
