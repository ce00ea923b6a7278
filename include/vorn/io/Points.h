#pragma once

#include <cstddef>
#include <iosfwd>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "vorn/Types.h"
#include "vorn/io/Export.h"

namespace Vorn::IO {

/// How messages call the standard input.
inline constexpr char const* kStandardInputName = "standard input";

/// Where the reader takes each point's tolerance from.
struct ToleranceColumn {
  /// What is wanted of a column with tolerances.
  enum class Use {
    Ignore,     ///< every `w` stays 0
    IfPresent,  ///< column `w`, or the third one of a file without a header
    Required,   ///< the column called `name`, or with that number; without one the file is refused
  };
  Use use = Use::Ignore;   ///< what is wanted
  std::string name = "w";  ///< the column; only for Use::Required
};

/// Which columns hold the points, each as a name from the header or a number counted from 1. Empty
/// ones are for the reader to find.
struct ColumnChoice {
  std::string x;  ///< empty: column x, else the first
  std::string y;  ///< empty: column y, else the second
  std::string w;  ///< of the tolerance; empty: as ToleranceColumn says

  /// Whether columns were chosen at all.
  bool IsGiven() const { return !x.empty(); }
};

/// Reads `x,y` or `x,y,w`. Nothing when there are not two or three names, all different.
VORN_IO_EXPORT std::optional<ColumnChoice> ParseColumnChoice(std::string_view text);

/// The contents of one file of measured points.
struct VORN_IO_EXPORT PointFile {
  std::string path;                   ///< as it stands in messages
  std::vector<WPoint> points;         ///< `w` is 0 unless hasTolerances
  std::vector<std::size_t> lines;     ///< line of each point, counted from 1; empty: no table
  std::size_t outline = 0;            ///< which one of several in the file, from 1; 0: the only one
  bool hasTolerances = false;         ///< a column gave every point's `w`
  std::string toleranceColumn = "w";  ///< which one that was, as it was asked for
  std::optional<double> tolerance;    ///< of a comment `# tolerance T`
  std::string units;        ///< of a comment `# units mm`, else of the header; may be empty
  std::string columns;      ///< which ones hold the points, in words: "1 (x) and 2 (y)"
  bool hadHeights = false;  ///< not of a table: coordinates beside x and y were dropped
  std::string skipped;      ///< the footer of an instrument: "lines 502 to 504 behind the table"

  /// "point 4 (line 6)", points counted from 0 as the library does; without lines
  /// "point 4 at (1.5, 2)", of no file "point 4".
  std::string NameOf(std::size_t index) const;

  /// The line of the point; nothing of a file that is no table.
  std::optional<std::size_t> LineOf(std::size_t index) const;
};

/// What the path of one of several outlines has behind the name of the file: ", outline 2";
/// nothing for 0.
VORN_IO_EXPORT std::string OutlineSuffix(std::size_t outline);

/// Reads points written as `x,y` or `x,y,w`, one a line.
///
/// Fields are separated by a semicolon, a tab, a comma or blanks, by what the first line with
/// data holds; see FindSeparator. Fields may stand in double quotes. Numbers have a decimal point
/// or, where the separator is no comma, a decimal comma: one of the two throughout a file.
///
/// A first line without any number is a header, which tells the columns of the points as
/// FindPointColumns says, and their units; a line of units alone may follow. The preamble of an
/// instrument is skipped, see FindTable, and so is its footer: text from behind a point to the end
/// of the file that cannot be data gone wrong. Without a header there must be two or three columns,
/// unless the choice names columns by their numbers. Empty lines and comments are skipped: what
/// follows a `#`, and what follows a `//` at the beginning of a line or behind a blank. Line ends
/// may be of any system; a UTF-8 byte order mark is allowed.
///
/// @throws Failure (FailureKind::File) naming file, line, column and offending text when a number
/// is
///         not one or not finite, a tolerance is not positive, the columns do not fit, the file is
///         not text, or fewer than two points are there.
/// @throws Failure (FailureKind::BadArgument) when both arguments name a column for the tolerance.
VORN_IO_EXPORT PointFile ReadPoints(std::string const& path, std::istream& in,
                                    ToleranceColumn const& tolerance,
                                    ColumnChoice const& columns = {});

/// The same for text already in memory; `path` serves the messages.
VORN_IO_EXPORT PointFile ParsePoints(std::string_view text, std::string const& path,
                                     ToleranceColumn const& tolerance,
                                     ColumnChoice const& columns = {});

}  // namespace Vorn::IO
