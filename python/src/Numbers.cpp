#include "Numbers.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

/// What arrays of this kind hold, in words; empty for numbers.
std::string StrangeContent(char kind) {
  switch (kind) {
    case 'U':
    case 'S':
      return "texts";
    case 'c':
      return "complex numbers";
    case 'M':
    case 'm':
      return "dates or times";
    case 'V':
      return "records";
    default:
      return "";
  }
}

bool IsComplex(py::handle value) {
  return PyComplex_Check(value.ptr()) != 0 ||
         py::isinstance(value, py::module_::import("numpy").attr("complexfloating"));
}

[[noreturn]] void RefuseValue(py::handle value, py::ssize_t position, std::string const& name) {
  throw py::type_error(name + ": value " + std::to_string(position) + " is " +
                       std::string(py::repr(value)) + " of type " +
                       std::string(py::str(py::type::of(value).attr("__name__"))) +
                       ", which is not a number");
}

/// Texts have no conversion of their own to a float, so "1" is refused as well.
double NumberFrom(py::handle value, py::ssize_t position, std::string const& name) {
  if (IsComplex(value)) RefuseValue(value, position, name);
  double const number = PyFloat_AsDouble(value.ptr());
  if (number == -1.0 && PyErr_Occurred() != nullptr) {
    PyErr_Clear();
    RefuseValue(value, position, name);
  }
  return number;
}

py::array FromObjects(py::array const& objects, std::string const& name) {
  py::array_t<double> numbers(
      std::vector<py::ssize_t>(objects.shape(), objects.shape() + objects.ndim()));
  double* out = numbers.mutable_data();
  py::ssize_t position = 0;
  for (py::handle const value : objects.attr("flat")) *out++ = NumberFrom(value, position++, name);
  return numbers;
}

}  // namespace

void RefuseMasked(py::object const& given, std::string const& name) {
  if (py::module_::import("numpy").attr("ma").attr("is_masked")(given).cast<bool>()) {
    throw py::value_error(name + ": some values are masked; leave them out");
  }
}

py::array NumbersFrom(py::object const& given, std::string const& name) {
  RefuseMasked(given, name);
  py::array const array = py::module_::import("numpy").attr("asarray")(given);
  if (array.dtype().kind() == 'O') return FromObjects(array, name);
  std::string const strange = StrangeContent(array.dtype().kind());
  if (strange.empty()) return array;
  throw py::type_error(name + " are " + strange + " (" + std::string(py::str(array.dtype())) +
                       "), not numbers");
}

}  // namespace Vorn::Python
