#pragma once

#include <string>

#include "cli/base/Library.h"
#include "cli/texts/LengthFormat.h"
#include "vorn/io/FitReport.h"

namespace Vorn::Cli {

/// A line for each piece with what its points say by themselves: radius or direction of least
/// squares with its standard deviation, form error, standard deviation of the points, and the angle
/// to the next piece. A heading tells how that differs from the fit.
std::string MeasureTable(FitReport const& report, LengthFormat const& length);

}  // namespace Vorn::Cli
