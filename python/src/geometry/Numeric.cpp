#include <string>

#include "../Errors.h"
#include "../Numbers.h"
#include "Values.h"
#include "vorn/MathUtils.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

std::vector<double> VectorOf(Numbers const& numbers) {
  return {numbers.data(), numbers.data() + numbers.size()};
}

Numbers Solve(Numbers const& matrix, Numbers const& rhs) {
  bool const fits = matrix.ndim() == 2 && rhs.ndim() == 1 && matrix.shape(0) == rhs.size() &&
                    matrix.shape(1) == rhs.size();
  if (!fits) throw py::value_error("the matrix must be (n, n) and the right-hand side (n,)");
  std::vector<double> elements = VectorOf(matrix);
  std::vector<double> right = VectorOf(rhs);
  Numbers solution(rhs.size());
  RequireSuccess(MathUtils::LinearEquationSystemSolve(static_cast<int>(rhs.size()), elements.data(),
                                                      right.data(), solution.mutable_data()),
                 "linear_equation_system_solve");
  return solution;
}

std::pair<Triple, Triple> NormalizedVectors(Triple const& p1, Triple const& p2, Triple const& q1,
                                            Triple const& q2) {
  std::pair<Triple, Triple> out = {};
  RequireSuccess(MathUtils::CalcNormalized3DVectors(p1.data(), p2.data(), q1.data(), q2.data(),
                                                    out.first.data(), out.second.data()),
                 "calc_normalized_3d_vectors");
  return out;
}

Place LinesIntersection(double k1, double m1, double k2, double m2) {
  Place at;
  RequireSuccess(MathUtils::GetLinesIntersection(k1, m1, k2, m2, at.first, at.second),
                 "get_lines_intersection");
  return at;
}

void BindRounding(py::module_& module) {
  module.def(
      "get_outside_max",
      [](Numbers const& value) { return py::vectorize(&MathUtils::GetOutsideMax)(value); },
      py::arg("value"), R"(
The smallest whole number that is not below the value, for numbers or arrays; -2147483648 where that
does not fit 32 bits.

>>> int(get_outside_max(1.2))
2
)");
  module.def(
      "get_outside_min",
      [](Numbers const& value) { return py::vectorize(&MathUtils::GetOutsideMin)(value); },
      py::arg("value"), R"(
The largest whole number that is not above the value, for numbers or arrays; -2147483648 where that
does not fit 32 bits.

>>> int(get_outside_min(-1.2))
-2
)");
}

}  // namespace

void BindNumeric(py::module_& module) {
  BindRounding(module);
  module.def("linear_equation_system_solve", &Solve, py::arg("matrix"), py::arg("rhs"), R"(
Solves matrix (n, n) times solution = rhs (n,) by elimination with row pivoting.

Raises ContourError for a pivot column of zeros. A system that is singular only in its last pivot
has infinities or not-a-numbers in its solution.

>>> linear_equation_system_solve([[2, 0], [0, 4]], [2, 2])
array([1. , 0.5])
)");
  module.def("calc_normalized_3d_vectors", &NormalizedVectors, py::arg("p1"), py::arg("p2"),
             py::arg("q1"), py::arg("q2"), R"(
For both ends of the segment p1-p2 in space a point beside it, in the mean of the planes through q1
and q2. All are (x, y, z). Raises ContourError where an end has none.

>>> calc_normalized_3d_vectors((0, 0, 0), (1, 0, 0), (0, 1, 0), (1, 1, 0))
([0.0, 1.0, 0.0], [1.0, 1.0, 0.0])
)");
  module.def("get_lines_intersection", &LinesIntersection, py::arg("k1"), py::arg("m1"),
             py::arg("k2"), py::arg("m2"), R"(
Where the lines y = k1*x + m1 and y = k2*x + m2 cross. Raises ContourError for lines of one slope.
Batch form: lines_intersections.

>>> get_lines_intersection(1.0, 0.0, -1.0, 2.0)
(1.0, 1.0)
)");
}

}  // namespace Vorn::Python
