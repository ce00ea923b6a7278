#pragma once

#include <pybind11/pybind11.h>

#include <string>

#include "vorn/io/FitReport.h"

namespace Vorn::Python {

/// What a caller hands over for a fit.
struct FitCall {
  pybind11::object points;     ///< see PointsFrom
  pybind11::object tolerance;  ///< see PointsFrom
  pybind11::dict options;      ///< see FitChoiceFrom
  pybind11::object progress;   ///< a callable or None
  std::string units;           ///< of the points; may be empty
};

/// Fits with the interpreter lock given away. Throws what vorn.fit raises.
IO::FitReport FitOf(FitCall const& call);

/// What vorn.fit makes its contour of: the rows of the pieces, whether they are closed, the facts.
pybind11::tuple PartsOf(IO::FitReport const& report);

}  // namespace Vorn::Python
