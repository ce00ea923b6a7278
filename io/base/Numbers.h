#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace Vorn::IO {

/// What stands between the whole part of a number and its fraction.
enum class DecimalMark { Point, Comma };

/// The number that the whole text is, in any locale: `1`, `+1.5e3`, `-.0005993`, `2.`; with a
/// decimal comma `1,5E+03`, but not `2,`, where the comma may as well be a separator. Nothing when
/// it is not one. `nan`, `inf` and numbers too large for a double are read as such, so that the
/// caller can say what is wrong with them.
std::optional<double> ParseNumber(std::string_view text, DecimalMark mark = DecimalMark::Point);

/// At most `digits` significant digits, without trailing zeros.
std::string FormatShort(double value, int digits = 6);

/// Always `decimals` digits after the point; zero never carries a minus sign.
std::string FormatFixed(double value, int decimals);

/// The fewest digits that read back as the same double.
std::string FormatExact(double value);

/// Without blanks at both ends.
std::string_view Trimmed(std::string_view text);

std::string LowerCase(std::string_view text);

/// Text from a file as it may stand in a message: quoted, cut when long, control characters
/// replaced.
std::string Quoted(std::string_view text);

/// One word on a command line, in single quotes where a shell needs them.
std::string ShellQuoted(std::string const& text);

/// "1 line", "2 lines".
std::string Counted(std::size_t count, std::string const& noun);

}  // namespace Vorn::IO
