#include <algorithm>
#include <limits>
#include <string>

#include "../Numbers.h"
#include "Values.h"
#include "vorn/MathUtils.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

constexpr double kNone = std::numeric_limits<double>::quiet_NaN();

/// Rows of `width` numbers; a single row is one.
struct Rows {
  Rows(Numbers const& numbers, py::ssize_t width, char const* name)
      : data(numbers.data()), step(width) {
    py::ssize_t const last = numbers.ndim() > 0 ? numbers.shape(numbers.ndim() - 1) : 0;
    if (numbers.ndim() < 1 || numbers.ndim() > 2 || last != width) {
      throw py::value_error(std::string(name) + " must have rows of " + std::to_string(width) +
                            " numbers");
    }
    count = numbers.size() / width;
  }

  /// One row goes with any number of others.
  void SpreadTo(py::ssize_t wanted, char const* name) {
    if (count == wanted) return;
    if (count != 1) throw py::value_error(std::string(name) + ": the numbers of rows differ");
    step = 0;
  }

  double const* operator[](py::ssize_t i) const { return data + i * step; }

  double const* data;
  py::ssize_t count = 0;
  py::ssize_t step;
};

double DeviationOr(double const* line, double const* point, bool isSigned) {
  auto const deviation =
      isSigned
          ? &GeometryUtils::GetSignedDeviation
          : static_cast<decltype(&GeometryUtils::GetSignedDeviation)>(&GeometryUtils::GetDeviation);
  double answer = kNone;
  deviation(line[0], line[1], line[2], point[0], point[1], &answer);
  return answer;
}

Numbers LineDeviations(Numbers const& lines, Numbers const& points, bool isSigned) {
  Rows from(lines, 3, "lines");
  Rows at(points, 2, "points");
  py::ssize_t const count = from.count == 1 ? at.count : from.count;
  from.SpreadTo(count, "lines");
  at.SpreadTo(count, "points");
  Numbers answers(count);
  double* const out = answers.mutable_data();
  py::gil_scoped_release const unlocked;
  for (py::ssize_t i = 0; i < count; ++i) out[i] = DeviationOr(from[i], at[i], isSigned);
  return answers;
}

py::tuple SegmentsIntersections(Numbers const& first, Numbers const& second) {
  Rows a(first, 4, "first");
  Rows b(second, 4, "second");
  py::ssize_t const count = a.count == 1 ? b.count : a.count;
  a.SpreadTo(count, "first");
  b.SpreadTo(count, "second");
  py::array_t<std::int32_t> relations(count);
  Numbers places({count, py::ssize_t{2}});
  std::int32_t* const relation = relations.mutable_data();
  double* const place = places.mutable_data();
  {
    py::gil_scoped_release const unlocked;
    for (py::ssize_t i = 0; i < count; ++i) {
      double const* const s = a[i];
      double const* const t = b[i];
      place[2 * i] = place[2 * i + 1] = kNone;
      relation[i] = static_cast<std::int32_t>(GeometryUtils::GetLineSegmentsIntersection(
          s[0], s[1], s[2], s[3], t[0], t[1], t[2], t[3], place + 2 * i, place + 2 * i + 1));
    }
  }
  return py::make_tuple(relations, places);
}

Numbers LinesIntersections(Numbers const& lines) {
  Rows const rows(lines, 4, "lines");
  Numbers places({rows.count, py::ssize_t{2}});
  double* const out = places.mutable_data();
  py::gil_scoped_release const unlocked;
  for (py::ssize_t i = 0; i < rows.count; ++i) {
    double const* const row = rows[i];
    out[2 * i] = out[2 * i + 1] = kNone;
    MathUtils::GetLinesIntersection(row[0], row[1], row[2], row[3], out[2 * i], out[2 * i + 1]);
  }
  return places;
}

py::array_t<bool> AreValidToFit(Numbers const& points) {
  Rows const rows(points, 3, "points");
  py::array_t<bool> answers(std::max<py::ssize_t>(rows.count - 1, 0));
  bool* const out = answers.mutable_data();
  py::gil_scoped_release const unlocked;
  for (py::ssize_t i = 0; i + 1 < rows.count; ++i) {
    double const* const a = rows[i];
    double const* const b = rows[i + 1];
    out[i] = GeometryUtils::IsPointValidToFit({a[0], a[1], a[2]}, {b[0], b[1], b[2]});
  }
  return answers;
}

/// Closes the ring of vertices, as the flat polyline needs it.
double AreaOfRing(double const* vertices, py::ssize_t count, std::vector<double>* ring) {
  if (count < 1) return 0.0;
  ring->assign(vertices, vertices + 2 * count);
  ring->insert(ring->end(), vertices, vertices + 2);
  double area = kNone;
  GeometryUtils::GetArea(*ring, {static_cast<std::int32_t>(2 * count)}, &area);
  return area;
}

Numbers PolygonAreas(Numbers const& vertices, std::vector<py::ssize_t> const& counts) {
  Rows const rows(vertices, 2, "vertices");
  py::ssize_t total = 0;
  for (py::ssize_t const count : counts) {
    constexpr py::ssize_t kMost = std::numeric_limits<std::int32_t>::max() / 2;
    if (count < 0 || count > kMost) throw py::value_error("counts cannot be so large or below 0");
    total += count;
  }
  if (total != rows.count) throw py::value_error("counts must add up to the number of vertices");
  Numbers areas(static_cast<py::ssize_t>(counts.size()));
  double* out = areas.mutable_data();
  py::gil_scoped_release const unlocked;
  std::vector<double> ring;
  py::ssize_t first = 0;
  for (py::ssize_t const count : counts) {
    *out++ = AreaOfRing(rows[first], count, &ring);
    first += count;
  }
  return areas;
}

}  // namespace

void BindBatches(py::module_& module) {
  module.def("line_deviations", &LineDeviations, py::arg("lines"), py::arg("points"),
             py::arg("signed") = false, R"(
get_deviation, or get_signed_deviation, for lines (n, 3) of a, b, c and points (n, 2); one line goes
with any number of points and the other way round. Not-a-number where there is no line.

>>> line_deviations([0, 1, 0], [(0, 2), (5, -3)])
array([2., 3.])
)");
  module.def("line_segments_intersections", &SegmentsIntersections, py::arg("first"),
             py::arg("second"), R"(
get_line_segments_intersection for segments (n, 4); one goes with any number of others.

Answers the relations (n,) as the numbers of SegmentsRelPosition, and the places (n, 2), not-a-number
where there is none.

>>> line_segments_intersections([0, 0, 2, 2], [(0, 2, 2, 0), (5, 5, 6, 5)])[0]
array([ 2, -1], dtype=int32)
)");
  module.def("lines_intersections", &LinesIntersections, py::arg("lines"), R"(
get_lines_intersection for rows (n, 4) of k1, m1, k2, m2; places (n, 2), not-a-number for lines of one
slope.

>>> lines_intersections([(1, 0, -1, 2)])
array([[1., 1.]])
)");
  module.def("are_points_valid_to_fit", &AreValidToFit, py::arg("points"), R"(
is_point_valid_to_fit for all neighbours of points (n, 3); an answer (n - 1,).

>>> are_points_valid_to_fit([(0, 0, 0.1), (1, 0, 0.1), (1.1, 0, 0.1)])
array([ True, False])
)");
  module.def("polygon_areas", &PolygonAreas, py::arg("vertices"), py::arg("counts"), R"(
get_area for polygons whose vertices (n, 2) stand one behind the other; counts tell how many each has,
the first not repeated. Positive for polygons that run clockwise with the y axis pointing up.

>>> polygon_areas([(0, 0), (0, 1), (1, 0), (0, 0), (2, 0), (2, 2), (0, 2)], [3, 4])
array([ 0.5, -4. ])
)");
}

}  // namespace Vorn::Python
