#pragma once

#include <pybind11/pybind11.h>

/// How a single number comes in from Python. Every source of the module is compiled with this
/// header ahead of it, see CMakeLists.txt: all of them must convert doubles alike.
namespace Vorn::Python {

/// The value of a number, a masked element of numpy being none.
///
/// @return false where the object is no number
/// Throws a ValueError for a masked element, which would convert to not-a-number.
bool ReadDouble(pybind11::handle given, bool mayConvert, double* value);

}  // namespace Vorn::Python

namespace pybind11::detail {

/// Converts arguments and results; the names of its members are given.
template <>
struct type_caster<double> {
  PYBIND11_TYPE_CASTER(double, const_name("float"));

  bool load(handle given, bool mayConvert) {  // NOLINT(readability-identifier-naming)
    return Vorn::Python::ReadDouble(given, mayConvert, &value);
  }

  // NOLINTNEXTLINE(readability-identifier-naming)
  static handle cast(double number, return_value_policy, handle) {
    return PyFloat_FromDouble(number);
  }
};

}  // namespace pybind11::detail
