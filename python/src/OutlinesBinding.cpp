#include <pybind11/pybind11.h>
#include <pybind11/stl.h>

#include <algorithm>
#include <optional>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

#include "Bindings.h"
#include "Errors.h"
#include "PieceRow.h"
#include "vorn/io/ContourArea.h"
#include "vorn/io/Departure.h"
#include "vorn/io/Intersections.h"
#include "vorn/io/Outlines.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

/// Rows, whether closed, and units.
using Parts = std::tuple<PieceRows, bool, std::string>;

IO::ContourFile FromParts(Parts const& parts) {
  auto const& [rows, isClosed, units] = parts;
  return ContourFrom(rows, isClosed, units);
}

Parts PartsOf(IO::ContourFile const& contour) {
  return {RowsOf(contour.pieces), contour.isClosed, contour.units};
}

std::vector<Parts> PartsOf(std::vector<IO::ContourFile> const& contours) {
  std::vector<Parts> parts;
  parts.reserve(contours.size());
  for (IO::ContourFile const& contour : contours) parts.push_back(PartsOf(contour));
  return parts;
}

std::vector<std::tuple<std::size_t, std::size_t, double>> Gaps(Parts const& parts) {
  std::vector<std::tuple<std::size_t, std::size_t, double>> gaps;
  for (IO::Gap const& gap : IO::FindGaps(FromParts(parts))) {
    gaps.emplace_back(gap.before, gap.after, gap.size);
  }
  return gaps;
}

double Departure(PieceRows const& a, PieceRows const& b) {
  if (a.size() == 0 || b.size() == 0) {
    Raise({ErrorCode::Failed, "the contour has no pieces", {}});
  }
  std::vector<IO::Piece> const first = PiecesFrom(a);
  std::vector<IO::Piece> const second = PiecesFrom(b);
  py::gil_scoped_release const unlocked;
  return IO::DepartureOf(first, second);
}

py::object PlaceOrNone(std::optional<IO::XY> const& place) {
  if (!place) return py::none();
  return py::make_tuple(place->x, place->y);
}

/// The places that two contours, or the parts of one, have in common.
class Meetings {
 public:
  Meetings(Parts const& a, std::optional<Parts> const& b) : a_(FromParts(a)) {
    if (b) b_ = FromParts(*b);
    py::gil_scoped_release const unlocked;
    found_ = b_ ? IO::IntersectionsOf(a_, *b_) : IO::SelfIntersectionsOf(a_);
  }

  /// In the order of the fields of Intersection in Python.
  py::list Places() const {
    py::list places;
    for (IO::Intersection const& one : found_) {
      places.append(py::make_tuple(IO::NameOf(one.kind), PlaceOrNone(one.at),
                                   PlaceOrNone(one.until), one.a.piece, one.a.position, one.b.piece,
                                   one.b.position));
    }
    return places;
  }

  std::string ToJson() const { return IO::ToJson(found_, a_, b_ ? &*b_ : nullptr); }
  std::string ToCsv() const { return IO::ToCsv(found_, a_, b_ ? &*b_ : nullptr); }

 private:
  IO::ContourFile a_;
  std::optional<IO::ContourFile> b_;
  std::vector<IO::Intersection> found_;
};

/// What closed contours enclose.
class Areas {
 public:
  explicit Areas(std::vector<Parts> const& parts) {
    std::vector<IO::ContourFile> outlines;
    for (Parts const& one : parts) {
      outlines.push_back(FromParts(one));
      bool const isClosed = !outlines.back().pieces.empty() && IO::IsClosed(outlines.back());
      if (!isClosed) {
        Raise({ErrorCode::Failed,
               "contour " + std::to_string(outlines.size() - 1) + " is open and has no area",
               {}});
      }
    }
    py::gil_scoped_release const unlocked;
    measured_ = IO::MeasureOutlines(std::move(outlines));
  }

  /// In the order of the fields of OutlineArea in Python.
  py::list Measures() const {
    py::list measures;
    for (IO::ContourArea const& one : measured_) {
      measures.append(py::make_tuple(one.signedArea, one.perimeter, PlaceOrNone(one.centroid),
                                     one.depth, one.IsHole(), one.crossesItself, one.gaps.size()));
    }
    return measures;
  }

  double Net() const { return IO::NetArea(measured_); }
  std::string ToJson() const { return IO::ToJson(measured_); }

 private:
  std::vector<IO::ContourArea> measured_;
};

}  // namespace

void BindOutlines(py::module_& module) {
  module.def(
      "outlines", [](Parts const& parts) { return PartsOf(IO::OutlinesOf(FromParts(parts))); },
      "The contours that pieces make when they are chained by their ends.");
  module.def(
      "runs", [](Parts const& parts) { return PartsOf(IO::RunsOf(FromParts(parts))); },
      "The contour cut at its gaps.");
  module.def("gaps", &Gaps, "Where pieces do not meet: both pieces and how far.");
  module.def("departure", &Departure, "How far one contour leaves the other.");
  py::class_<Meetings>(module, "Meetings", "Places that contours have in common.")
      .def(py::init<Parts const&, std::optional<Parts> const&>())
      .def("places", &Meetings::Places)
      .def("to_json", &Meetings::ToJson)
      .def("to_csv", &Meetings::ToCsv);
  py::class_<Areas>(module, "Areas", "What closed contours enclose.")
      .def(py::init<std::vector<Parts> const&>())
      .def("measures", &Areas::Measures)
      .def("net", &Areas::Net)
      .def("to_json", &Areas::ToJson);
}

}  // namespace Vorn::Python
