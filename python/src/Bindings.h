#pragma once

#include <pybind11/pybind11.h>

/// Each adds the functions of one idea to the module.
namespace Vorn::Python {

void BindFit(pybind11::module_& module);
void BindPoints(pybind11::module_& module);
void BindContours(pybind11::module_& module);
void BindFormats(pybind11::module_& module);
void BindDrawings(pybind11::module_& module);
void BindThinning(pybind11::module_& module);
void BindOutlines(pybind11::module_& module);
void BindReports(pybind11::module_& module);

}  // namespace Vorn::Python
