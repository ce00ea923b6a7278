#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace Vorn::IO {

/// Where the table of a text begins, lines counted from 0.
struct TableStart {
  std::size_t first = 0;     ///< its header or else its first line with numbers
  bool hasUnitLine = false;  ///< a line of units alone follows the header
};

/// Finds the table behind the preamble of an instrument: two lines of nothing but numbers, as many
/// in each, and the header ahead of them; texts may stand in the same fields of both where the
/// header names the axes. Ahead of a header that does so anything but points is a preamble, else
/// only what begins with text: a line that looks like data gone wrong leaves the start at 0, so
/// that the reader complains about it. Empty lines, rules and comments count for nothing.
TableStart FindTable(std::string_view text);

/// Whether the line is a rule between others, "-----" or "===;===": three strokes and no more than
/// such signs and separators.
bool IsRule(std::string_view line);

/// The unit that a line of a preamble states, "Units: mm" or "Einheit;mm"; empty when it does not.
std::string UnitInPreamble(std::string_view line);

/// Where the comment of a line begins: at a #, or at a // that begins the line or follows a blank.
/// Within other text a // is none: it stands in addresses.
std::size_t FindComment(std::string_view line);

/// Whether the field is meant as data: also what begins like a number without being one, such as
/// 3mm, must not pass for the name of a column.
bool LooksLikeNumber(std::string_view field);

}  // namespace Vorn::IO
