#pragma once

#include <string>

#include "io/fit/FitReport.h"

namespace Vorn::IO {

/// The version of the layout below; it grows when a field changes its meaning or goes away.
inline constexpr int kJsonSchemaVersion = 1;

/// The report as a JSON document, ending with a line end. Doubles are written with as many digits
/// as it takes to read back the same bits. Angles are radians; points are counted from 0; what is
/// not known is null.
std::string ToJson(Report const& report);

}  // namespace Vorn::IO
