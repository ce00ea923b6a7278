#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "vorn/io/Export.h"

namespace Vorn::IO {

/// What stands between the whole part of a number and its fraction.
enum class DecimalMark { Point, Comma };

/// The number that the whole text is, in any locale: "1", "+1.5e3", "-.0005993", "2."; with a
/// decimal comma "1,5E+03", but not "2,", where the comma may as well be a separator. Nothing when
/// it is not one. "nan", "inf" and numbers too large for a double are read as such, so that the
/// caller can say what is wrong with them.
VORN_IO_EXPORT std::optional<double> ParseNumber(std::string_view text,
                                                 DecimalMark mark = DecimalMark::Point);

/// At most `digits` significant digits, without trailing zeros; one at least, and no more than the
/// 1074 that a double can have.
VORN_IO_EXPORT std::string FormatShort(double value, int digits = 6);

/// Always `decimals` digits after the point, 0 to 1074; zero never carries a minus sign.
VORN_IO_EXPORT std::string FormatFixed(double value, int decimals);

/// A multiple of a tolerance, for people: four significant digits, and as many more as it takes not
/// to read as 1 when it is less or more.
VORN_IO_EXPORT std::string FormatRelative(double value);

/// The fewest digits that read back as the same double.
VORN_IO_EXPORT std::string FormatExact(double value);

}  // namespace Vorn::IO
