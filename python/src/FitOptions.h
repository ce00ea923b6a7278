#pragma once

#include <pybind11/pybind11.h>

#include "vorn/io/FitContour.h"

namespace Vorn::Python {

/// Reads the keywords strategy, closed, start, tolerance_per_point and those of the fewest pieces;
/// see Taken.
IO::FitChoice FitChoiceFrom(pybind11::dict const& keywords);

/// What the keyword `closed` says: a truth value, "auto", "yes" or "no".
IO::ClosedChoice ClosedFrom(pybind11::handle given);

}  // namespace Vorn::Python
