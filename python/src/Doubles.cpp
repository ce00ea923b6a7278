#include "Doubles.h"

#include "Numbers.h"

namespace py = pybind11;

namespace Vorn::Python {

bool ReadDouble(py::handle given, bool mayConvert, double* value) {
  if (!given) return false;
  if (PyFloat_Check(given.ptr()) != 0) {
    *value = PyFloat_AS_DOUBLE(given.ptr());
    return true;
  }
  if (!mayConvert || PyNumber_Check(given.ptr()) == 0) return false;
  if (PyLong_Check(given.ptr()) == 0) {
    RefuseMasked(py::reinterpret_borrow<py::object>(given), "the numbers");
  }
  *value = PyFloat_AsDouble(given.ptr());
  if (PyErr_Occurred() == nullptr) return true;
  PyErr_Clear();
  return false;
}

}  // namespace Vorn::Python
