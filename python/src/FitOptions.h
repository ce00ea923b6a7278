#pragma once

#include <pybind11/pybind11.h>

#include "vorn/io/FitContour.h"

namespace Vorn::Python {

/// Reads the keywords strategy, closed, start and those of the fewest pieces; see Taken.
IO::FitChoice FitChoiceFrom(pybind11::dict const& keywords);

}  // namespace Vorn::Python
