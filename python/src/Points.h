#pragma once

#include <pybind11/numpy.h>

#include <vector>

#include "vorn/Types.h"

namespace Vorn::Python {

/// The points of a caller and what they bring along.
struct PointsInput {
  std::vector<WPoint> points;
  bool hasTolerances = false;  ///< every `w` was given
};

/// Copies the points once, whatever array they come in: (n, 2) or (n, 3) of any numbers and
/// strides, anything that numpy.asarray takes, or a frame with the columns x, y and perhaps w.
/// `tolerance` is None, a number or one for each point, and goes before what the points bring.
PointsInput PointsFrom(pybind11::object const& points, pybind11::object const& tolerance);

/// The points as an array: (n, 3), or (n, 2) for points without tolerances.
pybind11::array_t<double> ArrayOf(PointsInput const& input);

/// Throws a ContourError naming the first point that has a coordinate that is not finite or a
/// tolerance that is not above 0 and finite.
void RequireUsable(std::vector<WPoint> const& points, bool haveTolerances);

/// The same.
void RequireUsable(PointsInput const& input);

}  // namespace Vorn::Python
