#pragma once

#include <cstddef>
#include <string_view>

namespace Vorn::IO {

/// The table that a footer may follow.
struct TableFacts {
  char separator = ',';
  std::size_t columns = 0;  ///< how many fields each line has
  std::size_t points = 0;   ///< how many lines of data were read
};

/// Whether a text is nothing but what instruments write behind their tables, "End of report",
/// "Mean: 0.02", "Points;500", rules and empty lines between, up to its end. Anything that may be
/// data gone wrong is none: what begins like a number or with a word for a missing value, and a
/// line of as many fields as the table unless they are different words between blanks or tell the
/// number of the points.
bool IsFooter(std::string_view text, TableFacts const& table);

}  // namespace Vorn::IO
