#pragma once

#include <set>
#include <string>
#include <vector>

/// How the texts of the program are set out.
namespace Vorn::Cli {

/// The cells of one line of a table.
using Row = std::vector<std::string>;

/// The rows one below the other, two blanks between columns as wide as their widest cell. Columns
/// whose cell in the first row is one of `words` are set to the left, all others to the right.
/// No line ends with a blank. Needs at least one row; no row is longer than the first.
std::string Aligned(std::vector<Row> const& rows, std::set<std::string> const& words = {});

/// A line of a summary: the name, padded to the width of the longest one, and the text. Without a
/// name the line goes on with the one above.
std::string Fact(std::string name, std::string const& text);

}  // namespace Vorn::Cli
