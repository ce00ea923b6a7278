#include <pybind11/numpy.h>
#include <pybind11/stl.h>

#include <algorithm>
#include <cmath>
#include <vector>

#include "Bindings.h"
#include "Errors.h"
#include "PieceRow.h"
#include "Points.h"
#include "vorn/io/ContourArea.h"
#include "vorn/io/Deviations.h"
#include "vorn/io/Intersections.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

using Distances = py::array_t<double>;
using Places = py::array_t<double>;

/// The piece nearest to each point.
struct Measured {
  std::vector<IO::Piece> pieces;
  std::vector<WPoint> points;
  std::vector<IO::PointDeviation> deviations;
};

Measured Measure(PieceRows const& rows, py::object const& points) {
  Measured measured;
  measured.pieces = PiecesFrom(rows);
  measured.points = PointsFrom(points, py::none()).points;
  if (measured.pieces.empty()) Raise({ErrorCode::Failed, "the contour has no pieces", {}});
  RequireUsable(measured.points, false);
  if (measured.points.empty()) return measured;
  py::gil_scoped_release const unlocked;
  measured.deviations = IO::Remeasure(measured.points, measured.pieces).points;
  return measured;
}

template <typename Value, typename ValueOf>
py::array_t<Value> ArrayOf(std::vector<IO::PointDeviation> const& deviations, ValueOf&& valueOf) {
  py::array_t<Value> array(static_cast<py::ssize_t>(deviations.size()));
  std::transform(deviations.begin(), deviations.end(), array.mutable_data(), valueOf);
  return array;
}

Distances DistancesOf(Measured const& measured) {
  return ArrayOf<double>(measured.deviations, [](auto const& d) { return d.distance; });
}

/// Positive to the left of the sense of travel.
Distances SignedDistances(PieceRows const& rows, py::object const& points) {
  return ArrayOf<double>(Measure(rows, points).deviations,
                         [](auto const& d) { return d.isLeft ? d.distance : 0.0 - d.distance; });
}

Distances PlainDistances(PieceRows const& rows, py::object const& points) {
  return DistancesOf(Measure(rows, points));
}

Places FeetOf(Measured const& measured) {
  Places feet({static_cast<py::ssize_t>(measured.deviations.size()), py::ssize_t{2}});
  double* out = feet.mutable_data();
  for (std::size_t i = 0; i < measured.deviations.size(); ++i) {
    WPoint const& point = measured.points[i];
    IO::XY const at =
        IO::FootOn(measured.pieces[measured.deviations[i].piece], point.x, point.y).at;
    *out++ = at.x;
    *out++ = at.y;
  }
  return feet;
}

py::tuple Nearest(PieceRows const& rows, py::object const& points) {
  Measured const measured = Measure(rows, points);
  auto const pieces = ArrayOf<std::int64_t>(
      measured.deviations, [](auto const& d) { return static_cast<std::int64_t>(d.piece); });
  return py::make_tuple(FeetOf(measured), pieces, DistancesOf(measured));
}

/// How many equal chords keep within `chord` of the piece.
std::size_t ChordsOf(IO::Piece const& piece, double chord) {
  if (!piece.IsArc()) return 1;
  // A chord over the angle a leaves its arc by radius * (1 - cos(a / 2)).
  double const cosine = std::max(1.0 - chord / piece.radius, -1.0);
  double const most = std::min(2.0 * std::acos(cosine), std::acos(-1.0) / 2.0);
  double const wanted = std::ceil(piece.sweep / most);
  constexpr double kMostChords = 1e7;
  if (!(wanted <= kMostChords)) {
    Raise({ErrorCode::Failed, "chord is too small for the radius of an arc", {}});
  }
  return std::max<std::size_t>(static_cast<std::size_t>(wanted), 1);
}

void AddSamples(IO::Piece const& piece, double chord, std::vector<IO::XY>* samples) {
  std::size_t const chords = ChordsOf(piece, chord);
  for (std::size_t i = 1; i < chords; ++i) {
    double const part = static_cast<double>(i) / static_cast<double>(chords);
    samples->push_back(IO::PointOnArc(piece, part * piece.sweep));
  }
  samples->push_back(piece.end);
}

Places Sample(PieceRows const& rows, double chord) {
  if (!(chord > 0.0)) throw py::value_error("chord must be above 0");
  std::vector<IO::XY> samples;
  for (IO::Piece const& piece : PiecesFrom(rows)) {
    bool const continues =
        !samples.empty() && samples.back().x == piece.start.x && samples.back().y == piece.start.y;
    if (!continues) samples.push_back(piece.start);
    AddSamples(piece, chord, &samples);
  }
  Places places({static_cast<py::ssize_t>(samples.size()), py::ssize_t{2}});
  double* out = places.mutable_data();
  for (IO::XY const& sample : samples) {
    *out++ = sample.x;
    *out++ = sample.y;
  }
  return places;
}

std::optional<double> Area(PieceRows const& rows, bool isClosed) {
  IO::ContourFile const contour = ContourFrom(rows, isClosed, "");
  if (contour.pieces.empty() || !IO::IsClosed(contour)) return {};
  return IO::SignedAreaOf(contour);
}

py::tuple Bounds(PieceRows const& rows) {
  if (rows.size() == 0) Raise({ErrorCode::Failed, "the contour has no pieces", {}});
  IO::Extent const extent = IO::ExtentOf(PiecesFrom(rows));
  return py::make_tuple(extent.low.x, extent.low.y, extent.high.x, extent.high.y);
}

bool MeetsItself(PieceRows const& rows, bool isClosed) {
  IO::ContourFile const contour = ContourFrom(rows, isClosed, "");
  py::gil_scoped_release const unlocked;
  return !IO::SelfIntersectionsOf(contour).empty();
}

bool ReturnsToStart(PieceRows const& rows) {
  return rows.size() > 0 && IO::ReturnsToStart(PiecesFrom(rows));
}

PieceRows ReversedRows(PieceRows const& rows) {
  std::vector<IO::Piece> pieces = PiecesFrom(rows);
  std::reverse(pieces.begin(), pieces.end());
  for (IO::Piece& piece : pieces) piece = IO::Reversed(piece);
  return RowsOf(pieces);
}

GeometryUtils::Elem ElementOf(IO::Piece const& piece) {
  GeometryUtils::Elem element;
  element.type = piece.IsArc() ? GeometryUtils::ElemType::Arc : GeometryUtils::ElemType::Segment;
  element.end = piece.end;
  element.center = piece.center;
  element.radius = piece.radius;
  element.direction = piece.counterClockwise ? 1.0 : -1.0;
  element.startAngle = piece.startAngle;
  element.endAngle = piece.endAngle;
  return element;
}

/// The rows of one piece cut into parts of equal length.
PieceRows Split(PieceRows const& rows, int parts) {
  if (parts < 2) throw py::value_error("parts must be 2 or more");
  IO::Piece const piece = PiecesFrom(rows).front();
  std::vector<GeometryUtils::Elem> elements(static_cast<std::size_t>(parts) + 1);
  elements.front().end = piece.start;
  RequireSuccess(GeometryUtils::SplitElem(ElementOf(piece), parts, {piece.start.x, piece.start.y},
                                          &elements[1]),
                 "split");
  return RowsOf(IO::PiecesOf(elements));
}

using Place = std::pair<double, double>;

IO::XY PlaceFrom(Place const& place) {
  if (!std::isfinite(place.first) || !std::isfinite(place.second)) {
    Raise({ErrorCode::Failed, "x or y of a place is not finite", {}});
  }
  return {place.first, place.second};
}

PieceRows Line(Place const& start, Place const& end) {
  return RowsOf({IO::MakeLine(PlaceFrom(start), PlaceFrom(end))});
}

PieceRows Arc(Place const& start, Place const& end, Place const& center, bool ccw) {
  IO::XY const from = PlaceFrom(start);
  IO::XY const about = PlaceFrom(center);
  double const radius = IO::Distance(from, about);
  if (!(radius > 0.0) || !std::isfinite(radius)) {
    Raise({ErrorCode::InvalidArcRadius, "the radius of an arc is not a number above 0", {}});
  }
  return RowsOf({IO::MakeArc(from, PlaceFrom(end), about, radius, ccw)});
}

}  // namespace

void BindContours(py::module_& module) {
  module.def("distances", &PlainDistances, "The distance of each point from the contour.");
  module.def("signed_distances", &SignedDistances, "The same, positive to the left.");
  module.def("nearest", &Nearest, "Feet, pieces and distances of the points.");
  module.def("sample", &Sample, "The ends of chords that leave the contour by at most `chord`.");
  module.def("area", &Area, "Positive counter-clockwise; None for an open contour.");
  module.def("bounds", &Bounds, "Least x and y, largest x and y.");
  module.def("meets_itself", &MeetsItself, "Whether the contour crosses or touches itself.");
  module.def("returns_to_start", &ReturnsToStart, "Whether the last piece ends at the start.");
  module.def(
      "no_rows", [] { return RowsOf({}); }, "No pieces.");
  module.def("reversed_rows", &ReversedRows, "The contour run through from its end.");
  module.def("split", &Split, "One piece cut into parts of equal length.");
  module.def("line", &Line, "The row of a line.");
  module.def("arc", &Arc, "The row of an arc.");
}

}  // namespace Vorn::Python
