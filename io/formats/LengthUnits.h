#pragma once

#include <optional>
#include <string>

namespace Vorn::IO {

inline constexpr double kMillimetresPerInch = 25.4;

/// Whether the words say so, in the spellings that files use.
bool IsInch(std::string const& units);
/// Whether the name means millimetres.
bool IsMillimetre(std::string const& units);

}  // namespace Vorn::IO
