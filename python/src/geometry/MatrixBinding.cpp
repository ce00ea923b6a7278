#include <pybind11/operators.h>

#include <algorithm>
#include <cstring>

#include "../Errors.h"
#include "../Numbers.h"
#include "Values.h"
#include "vorn/Matrix.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

constexpr py::ssize_t kOrder = 3;
constexpr py::ssize_t kElements = 9;

Matrix FromArray(Numbers const& elements) {
  if (elements.size() != kElements) throw py::value_error("a matrix has nine elements");
  Mtrx values = {};
  std::copy_n(elements.data(), kElements, values.m);
  return {values};
}

/// A matrix is its nine doubles, which no member gives out.
Numbers ToArray(Matrix const& matrix) {
  static_assert(sizeof(Matrix) == kElements * sizeof(double));
  Numbers array({kOrder, kOrder});
  std::memcpy(array.mutable_data(), static_cast<void const*>(&matrix), sizeof matrix);
  return array;
}

SpatVector VectorOf(Numbers const& numbers) {
  SpatVector vector;
  if (numbers.size() != kOrder && numbers.size() != vector.QuantityOfDataElements()) {
    throw py::value_error("a vector has three numbers, or five");
  }
  std::copy_n(numbers.data(), numbers.size(), vector.v);
  return vector;
}

/// As many numbers as came in.
Numbers Result(SpatVector const& vector, Numbers const& like) {
  Numbers array(like.size());
  std::copy_n(vector.v, like.size(), array.mutable_data());
  return array;
}

Numbers TimesColumn(Matrix& matrix, Numbers const& numbers) {
  SpatVector vector = VectorOf(numbers);
  return Result(matrix.MxV(vector), numbers);
}

Numbers TimesRow(Matrix& matrix, Numbers const& numbers) {
  SpatVector vector = VectorOf(numbers);
  return Result(matrix.VxM(vector), numbers);
}

Triple AnglesMxMyMz(Matrix& matrix) {
  Triple angles = {};
  matrix.GetAnglesFromMxMyMz(&angles[0], &angles[1], &angles[2]);
  return angles;
}

Triple AnglesMzMyMx(Matrix& matrix) {
  Triple angles = {};
  matrix.GetAnglesFromMzMyMx(&angles[0], &angles[1], &angles[2]);
  return angles;
}

/// A failure answers no array.
Numbers Reorth(int dimension, Numbers const& elements, int terms) {
  if (elements.size() != kElements) throw py::value_error("a matrix has nine elements");
  Numbers result({kOrder, kOrder});
  std::copy_n(elements.data(), kElements, result.mutable_data());
  RequireSuccess(Matrix::Reorth(dimension, result.mutable_data(), terms), "reorth_elements");
  return result;
}

void BindReorth(py::module_& module) {
  module.def("reorth_elements", &Reorth, py::arg("dimension"), py::arg("elements"),
             py::arg("terms"), R"(
The nine elements of a matrix pulled back to a rotation, as an array (3, 3). Raises ContourError for
another dimension than 3.

>>> reorth_elements(3, [[1, 0, 0], [0, 1, 0], [0, 0, 1]], 4)[0]
array([1., 0., 0.])
)");
}

/// The rotations that a matrix is made from, and their angles.
void BindRotations(py::class_<Matrix>* matrix) {
  (*matrix)
      .def("init_i", &Matrix::InitI, R"(
Makes it the identity.

>>> turn = Matrix()
>>> turn.init_mx_my_mz(0.1, 0.2, 0.3)
>>> turn.init_i()
>>> turn.det()
1.0
)")
      .def("init_mx_my_mz", &Matrix::InitMxMyMz, py::arg("ax"), py::arg("ay"), py::arg("az"),
           R"(
Makes it the product of the rotations about x, y and z by angles in radians.

>>> turn = Matrix()
>>> turn.init_mx_my_mz(0.1, 0.2, 0.3)
>>> [round(angle, 6) for angle in turn.get_angles_from_mx_my_mz()]
[0.1, 0.2, 0.3]
)")
      .def("init_mz_my_mx", &Matrix::InitMzMyMx, py::arg("ax"), py::arg("ay"), py::arg("az"),
           R"(
Makes it the product of the rotations about z, y and x by angles in radians.

>>> turn = Matrix()
>>> turn.init_mz_my_mx(0.1, 0.2, 0.3)
>>> [round(angle, 6) for angle in turn.get_angles_from_mz_my_mx()]
[0.1, 0.2, 0.3]
)")
      .def("get_angles_from_mx_my_mz", &AnglesMxMyMz, R"(
The angles [ax, ay, az] of init_mx_my_mz, radians.

>>> turn = Matrix()
>>> turn.init_mx_my_mz(0.1, 0.2, 0.3)
>>> [round(angle, 6) for angle in turn.get_angles_from_mx_my_mz()]
[0.1, 0.2, 0.3]
)")
      .def("get_angles_from_mz_my_mx", &AnglesMzMyMx, R"(
The angles [ax, ay, az] of init_mz_my_mx, radians.

>>> [abs(angle) for angle in Matrix().get_angles_from_mz_my_mx()]
[0.0, 0.0, 0.0]
)");
}

void BindProducts(py::class_<Matrix>* matrix) {
  (*matrix)
      .def("mxv", &TimesColumn, py::arg("vector"),
           R"(
The matrix times a column of three numbers, as an array (3,). Of a column of five the last two come
back as they are. Raises ValueError for another number of them.

>>> Matrix([1, 2, 0, 0, 1, 0, 0, 0, 1]).mxv([1, 1, 1])
array([3., 1., 1.])
)")
      .def("vxm", &TimesRow, py::arg("vector"), R"(
A row of three numbers, or of five as for mxv, times the matrix, as an array.

>>> Matrix([1, 2, 0, 0, 1, 0, 0, 0, 1]).vxm([1, 1, 1])
array([1., 3., 1.])
)")
      .def(
          "__mul__", [](Matrix& a, Matrix const& b) { return a * b; }, py::is_operator(),
          "The product of two matrices.")
      .def(
          "__matmul__", [](Matrix& a, Matrix const& b) { return a * b; }, py::is_operator(),
          "The product of two matrices.");
}

void BindContent(py::class_<Matrix>* matrix) {
  (*matrix)
      .def("quantity_of_data_elements", &Matrix::QuantityOfDataElements, R"(
How many elements it has.

>>> Matrix().quantity_of_data_elements()
9
)")
      .def("reorth", py::overload_cast<int>(&Matrix::Reorth), py::arg("terms"),
           R"(
Pulls it back to a rotation by so many terms of a series; answers whether that went well.

>>> drifted = Matrix([1.001, 0, 0, 0, 1.001, 0, 0, 0, 1.001])
>>> drifted.reorth(8)
True
>>> round(drifted.det(), 9)
1.0
)")
      .def("transpose", &Matrix::Transpose, R"(
Exchanges rows and columns.

>>> upper = Matrix([1, 2, 0, 0, 1, 0, 0, 0, 1])
>>> upper.transpose()
>>> upper.to_array()[1]
array([2., 1., 0.])
)")
      .def("to_array", &ToArray, R"(
The elements as an array (3, 3).

>>> Matrix().to_array()[0]
array([1., 0., 0.])
)");
}

}  // namespace

void BindMatrix(py::module_& module) {
  BindReorth(module);
  py::class_<Matrix> matrix(module, "Matrix", R"(
A 3x3 rotation matrix; angles are radians, and the elementary rotations turn the frame, not the
point.

>>> import math
>>> turn = Matrix()
>>> turn.init_mx_my_mz(0.0, 0.0, math.pi / 2)
>>> [round(float(v), 12) for v in turn.mxv([1, 0, 0])]
[0.0, -1.0, 0.0]
)");
  matrix
      .def(py::init<>(), R"(
The identity.

>>> Matrix().det()
1.0
)")
      .def(py::init(&FromArray), py::arg("elements"), R"(
Takes nine elements, row by row, or an array (3, 3). Raises ValueError for another number of them.

>>> Matrix([[2, 0, 0], [0, 3, 0], [0, 0, 4]]).det()
24.0
)")
      .def("det", &Matrix::Det, R"(
The determinant.

>>> Matrix([2, 0, 0, 0, 3, 0, 0, 0, 4]).det()
24.0
)")
      .def(py::pickle(&ToArray, &FromArray));
  BindRotations(&matrix);
  BindProducts(&matrix);
  BindContent(&matrix);
}

}  // namespace Vorn::Python
