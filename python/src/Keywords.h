#pragma once

#include <pybind11/pybind11.h>

#include <cmath>
#include <functional>
#include <map>
#include <string>

namespace Vorn::Python {

/// For each keyword of a function, what puts its value into the options.
template <typename Options>
using Takers = std::map<std::string, std::function<void(pybind11::handle, Options*)>>;

/// The value that a word stands for.
template <typename Value>
Value Chosen(std::map<std::string, Value> const& words, char const* name, pybind11::handle given) {
  std::string const word = pybind11::str(given);
  auto const found = words.find(word);
  if (found != words.end()) return found->second;
  std::string known;
  for (auto const& entry : words) known += (known.empty() ? "" : ", ") + entry.first;
  throw pybind11::value_error(std::string(name) + " is '" + word + "'; it must be one of " + known);
}

/// A number that must be finite and above 0.
inline double AboveZero(pybind11::handle given, char const* name) {
  auto const value = given.cast<double>();
  if (value > 0.0 && std::isfinite(value)) return value;
  throw pybind11::value_error(std::string(name) + " must be a number above 0, not " +
                              std::string(pybind11::repr(given)));
}

/// Takes one value; None leaves the usual one.
template <typename Options>
void Take(Takers<Options> const& takers, std::string const& name, pybind11::handle given,
          Options* options) {
  auto const taker = takers.find(name);
  if (taker == takers.end()) {
    throw pybind11::type_error("got an unexpected keyword argument '" + name + "'");
  }
  if (given.is_none()) return;
  try {
    taker->second(given, options);
  } catch (pybind11::cast_error const&) {
    throw pybind11::type_error(name + " cannot be " + std::string(pybind11::repr(given)));
  }
}

/// The options that the keywords ask for. Throws a TypeError for an unknown keyword or a value of
/// the wrong type, and a ValueError for an unknown word.
template <typename Options>
Options Taken(Takers<Options> const& takers, pybind11::dict const& keywords) {
  Options options;
  for (auto const& [name, given] : keywords) Take(takers, pybind11::str(name), given, &options);
  return options;
}

}  // namespace Vorn::Python
