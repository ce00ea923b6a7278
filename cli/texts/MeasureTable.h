#pragma once

#include <string>
#include <vector>

#include "cli/base/Library.h"
#include "cli/texts/LengthFormat.h"
#include "vorn/io/PieceMeasures.h"

namespace Vorn::Cli {

/// A line for each piece with what its points say by themselves: radius or direction of least
/// squares with its standard deviation, form error, standard deviation of the points, and the angle
/// to the next piece. A heading tells how that differs from the fit.
/// @param measures one for each piece
std::string MeasureTable(std::vector<Piece> const& pieces,
                         std::vector<PieceMeasure> const& measures, LengthFormat const& length);

}  // namespace Vorn::Cli
