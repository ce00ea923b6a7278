#include "io/pieces/Flattening.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace Vorn::IO {

namespace {

/// A curve that halving has not brought near to its chords by then is none that coordinates can
/// tell from a point.
constexpr int kMostHalvings = 48;

XY Between(XY const& a, XY const& b, double part) {
  return {a.x + part * (b.x - a.x), a.y + part * (b.y - a.y)};
}

/// Halfway in homogeneous coordinates: each point counts by its weight.
ControlPoint Halfway(ControlPoint const& a, ControlPoint const& b) {
  double const part = b.weight / (a.weight + b.weight);
  return {Between(a.at, b.at, part), (a.weight + b.weight) / 2.0};
}

/// The first half takes the place of the curve, the second half is returned.
BezierCurve SplitOff(BezierCurve* curve) {
  BezierCurve level = *curve;
  BezierCurve second(curve->size());
  for (std::size_t i = 0; i < curve->size(); ++i) {
    (*curve)[i] = level.front();
    second[curve->size() - 1 - i] = level.back();
    for (std::size_t k = 0; k + 1 < level.size(); ++k) level[k] = Halfway(level[k], level[k + 1]);
    level.pop_back();
  }
  return second;
}

double DistanceFromChord(XY const& point, XY const& start, XY const& end) {
  return DistanceTo(MakeLine(start, end), point.x, point.y);
}

bool IsNearChord(BezierCurve const& curve, double tolerance) {
  return std::all_of(curve.begin(), curve.end(), [&](ControlPoint const& control) {
    return DistanceFromChord(control.at, curve.front().at, curve.back().at) <= tolerance;
  });
}

/// A part of a curve, and how often the curve was halved for it.
struct Part {
  BezierCurve curve;
  int halvings = 0;
};

}  // namespace

bool AppendChords(BezierCurve const& curve, double tolerance, std::size_t mostChords,
                  std::vector<XY>* points) {
  if (!(tolerance > 0.0)) return false;
  std::size_t const most = points->size() + mostChords;
  std::vector<Part> rest = {{curve, 0}};
  while (!rest.empty()) {
    Part part = std::move(rest.back());
    rest.pop_back();
    if (part.halvings < kMostHalvings && !IsNearChord(part.curve, tolerance)) {
      ++part.halvings;
      BezierCurve second = SplitOff(&part.curve);
      rest.push_back({std::move(second), part.halvings});
      rest.push_back(std::move(part));
      continue;
    }
    if (points->size() >= most) return false;
    points->push_back(part.curve.back().at);
  }
  return true;
}

bool AppendChords(Piece const& arc, double tolerance, std::size_t mostChords,
                  std::vector<XY>* points) {
  // A chord that turns by a is radius * (1 - cos(a / 2)) = 2 * radius * sin(a / 4)^2 from its arc,
  // and by a third of a turn, shapes become another.
  constexpr double kWidestChord = 2.0 * std::numbers::pi / 3.0;
  if (!(tolerance > 0.0)) return false;
  double const sine = std::sqrt(std::min(1.0, tolerance / (2.0 * arc.radius)));
  double const widest = std::min(kWidestChord, 4.0 * std::asin(sine));
  double const needed = std::max(1.0, std::ceil(arc.sweep / widest));
  if (!(needed <= static_cast<double>(mostChords))) return false;
  auto const count = static_cast<std::size_t>(needed);
  for (std::size_t i = 1; i < count; ++i) {
    double const part = static_cast<double>(i) / static_cast<double>(count);
    points->push_back(PointOnArc(arc, arc.sweep * part));
  }
  points->push_back(arc.end);
  return true;
}

XY PointOf(EllipseArc const& arc, double t) {
  double const cosine = std::cos(t);
  double const sine = std::sin(t);
  return {arc.center.x + arc.first.x * cosine + arc.second.x * sine,
          arc.center.y + arc.first.y * cosine + arc.second.y * sine};
}

std::vector<BezierCurve> CurvesOf(EllipseArc const& arc) {
  constexpr double kQuarterTurn = std::numbers::pi / 2.0;
  double const turn = arc.to - arc.from;
  int const count = std::max(1, static_cast<int>(std::ceil(std::fabs(turn) / kQuarterTurn)));
  std::vector<BezierCurve> curves;
  for (int i = 0; i < count; ++i) {
    double const from = arc.from + turn * i / count;
    double const to = arc.from + turn * (i + 1) / count;
    // The tangents at both ends meet halfway, 1 / cos of half the turn away from the centre.
    double const weight = std::cos((to - from) / 2.0);
    XY const halfway = PointOf(arc, (from + to) / 2.0);
    XY const middle = Between(arc.center, halfway, 1.0 / weight);
    curves.push_back({{PointOf(arc, from), 1.0}, {middle, weight}, {PointOf(arc, to), 1.0}});
  }
  return curves;
}

std::optional<std::string> AppendChords(std::vector<BezierCurve> const& curves,
                                        Flattening* flattening, std::vector<Piece>* pieces) {
  if (!flattening->tolerance) {
    return "a curve that is no arc of a circle";
  }
  for (BezierCurve const& curve : curves) {
    std::vector<XY> points = {curve.front().at};
    if (!AppendChords(curve, *flattening->tolerance, flattening->chordsLeft, &points)) {
      return "curves flattened so finely have more than " + std::to_string(kMostChords) + " chords";
    }
    flattening->chordsLeft -= points.size() - 1;
    for (std::size_t i = 1; i < points.size(); ++i) {
      pieces->push_back(MakeLine(points[i - 1], points[i]));
    }
  }
  return {};
}

}  // namespace Vorn::IO
