#pragma once

#include <pybind11/pybind11.h>
#include <pybind11/stl.h>

#include <array>
#include <utility>
#include <vector>

#include "vorn/GeometryUtils.h"

/// How the records of the core pass between C++ and Python: places as pairs, measured points as
/// triples, contours as lists of Elem.
namespace Vorn::Python {

using Place = std::pair<double, double>;
using Triple = std::array<double, 3>;
using Elem = GeometryUtils::Elem;
using Elems = std::vector<Elem>;

inline GeometryUtils::Point PointOf(Place const& place) { return {place.first, place.second}; }
inline Place PlaceOf(GeometryUtils::Point const& point) { return {point.x, point.y}; }
inline WPoint WPointOf(Triple const& triple) { return {triple[0], triple[1], triple[2]}; }

/// Each adds the functions of one idea to vorn.geometry.
void BindElementary(pybind11::module_& module);
void BindElements(pybind11::module_& module);
void BindChains(pybind11::module_& module);
void BindPolylines(pybind11::module_& module);
void BindCells(pybind11::module_& module);
void BindCurves(pybind11::module_& module);
void BindNumeric(pybind11::module_& module);
void BindMatrix(pybind11::module_& module);
void BindBatches(pybind11::module_& module);

}  // namespace Vorn::Python
