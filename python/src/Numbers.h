#pragma once

#include <pybind11/numpy.h>

#include <string>

namespace Vorn::Python {

/// Throws a ValueError where a value is masked: it has no value, which an array of the same numbers
/// would not tell.
void RefuseMasked(pybind11::object const& given, std::string const& name);

/// An array of bool, integers or floats, of any shape and strides, of what a caller gave: anything
/// that numpy.asarray takes. Objects are taken where each of them is a number; their array is one
/// of doubles then. Every function that takes numbers takes them through here.
///
/// @param name of the argument, in the plural, for messages
/// Throws a TypeError that tells what was given for texts, complex numbers, dates, records and
/// objects that are no numbers, and a ValueError where a value is masked.
pybind11::array NumbersFrom(pybind11::object const& given, std::string const& name);

/// The same as doubles without gaps between them, copied only where they are something else: an
/// argument of this type takes what NumbersFrom does, and a result of it is an array.
struct Numbers : pybind11::array_t<double, pybind11::array::c_style | pybind11::array::forcecast> {
  using Base = pybind11::array_t<double, pybind11::array::c_style | pybind11::array::forcecast>;
  using Base::Base;
};

}  // namespace Vorn::Python

namespace pybind11::detail {

/// Converts arguments and results; the names of its members are given.
template <>
struct type_caster<Vorn::Python::Numbers> {
  PYBIND11_TYPE_CASTER(Vorn::Python::Numbers, const_name("numpy.ndarray[numpy.float64]"));

  bool load(handle given, bool) {  // NOLINT(readability-identifier-naming)
    value = Vorn::Python::NumbersFrom(reinterpret_borrow<object>(given), "the numbers");
    return true;
  }

  // NOLINTNEXTLINE(readability-identifier-naming)
  static handle cast(Vorn::Python::Numbers const& numbers, return_value_policy, handle) {
    return numbers.inc_ref();
  }
};

}  // namespace pybind11::detail
