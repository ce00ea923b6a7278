#include "io/formats/DxfCurves.h"

#include <algorithm>
#include <cmath>
#include <numbers>
#include <utility>

#include "io/pieces/Shapes.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO::Dxf {

namespace {

constexpr double kTurn = 2.0 * std::numbers::pi;

/// Programs write splines of degree 3, rarely 5.
constexpr double kHighestDegree = 25.0;

std::vector<Piece> Chords(Entity const& entity, std::vector<BezierCurve> const& curves,
                          Flattening* flattening) {
  std::vector<Piece> chords;
  if (auto const fault = AppendChords(curves, flattening, &chords)) {
    entity.Refuse(*fault, flattening->Help());
  }
  return chords;
}

void RequireFlat(Entity const& entity, double z) {
  if (z != 0.0) entity.Refuse("is not in the plane of x and y");
}

EllipseArc EllipseOf(Entity const& entity) {
  XY const first = {entity.Number(11), entity.Number(21)};
  double const ratio = entity.Number(40);
  RequireFlat(entity, entity.NumberOr(31, 0.0));
  if (entity.NumberOr(210, 0.0) != 0.0 || entity.NumberOr(220, 0.0) != 0.0) {
    entity.Refuse("is not in the plane of x and y");
  }
  if (!(ratio > 0.0) || AreEqual(first, {0.0, 0.0})) entity.Refuse("has an axis without length");
  // On the back of the plane the second axis points the other way.
  double const side = entity.NumberOr(230, 1.0) < 0.0 ? -ratio : ratio;
  double const from = entity.NumberOr(41, 0.0);
  double const turn = std::remainder(entity.NumberOr(42, kTurn) - from, kTurn);
  // Whole turns leave a rounding of either sign.
  constexpr double kRounding = 1e-9;
  double const sweep = turn > kRounding ? turn : turn + kTurn;
  return {{entity.Number(10), entity.Number(20)},
          first,
          {-side * first.y, side * first.x},
          from,
          from + sweep};
}

/// The knots, the control points and the degree of a spline.
struct Spline {
  std::size_t degree = 0;
  std::vector<double> knots;
  std::vector<ControlPoint> controls;
};

/// In some files the weights come ahead of the points they belong to.
void TakeGroups(Entity const& entity, Spline* spline) {
  std::vector<double> weights;
  std::vector<ControlPoint>& controls = spline->controls;
  for (Group const& group : entity.Groups()) {
    if (group.code == 40) spline->knots.push_back(entity.NumberOf(group));
    if (group.code == 41) weights.push_back(entity.NumberOf(group));
    if (group.code == 10) controls.push_back({{entity.NumberOf(group), 0.0}});
    if (group.code == 20 && !controls.empty()) controls.back().at.y = entity.NumberOf(group);
    if (group.code == 30) RequireFlat(entity, entity.NumberOf(group));
  }
  if (weights.empty()) return;
  if (weights.size() != controls.size()) {
    entity.Refuse("has " + Counted(controls.size(), "control point") + " and " +
                  Counted(weights.size(), "weight"));
  }
  for (std::size_t i = 0; i < controls.size(); ++i) controls[i].weight = weights[i];
}

std::size_t DegreeOf(Entity const& entity) {
  double const degree = entity.Number(71);
  if (degree != std::floor(degree) || degree < 1.0 || degree > kHighestDegree) {
    entity.Refuse("degree " + FormatExact(degree) + " is not from 1 to " +
                  FormatExact(kHighestDegree));
  }
  return static_cast<std::size_t>(degree);
}

Spline ReadSpline(Entity const& entity) {
  Spline spline;
  spline.degree = DegreeOf(entity);
  TakeGroups(entity, &spline);
  if (spline.controls.empty()) entity.Refuse("has no control points, only fit points or none");
  bool const areEnough = spline.controls.size() > spline.degree &&
                         spline.knots.size() == spline.controls.size() + spline.degree + 1;
  if (!areEnough) {
    entity.Refuse("of degree " + std::to_string(spline.degree) + " has " +
                  Counted(spline.controls.size(), "control point") + " and " +
                  Counted(spline.knots.size(), "knot"));
  }
  if (!std::is_sorted(spline.knots.begin(), spline.knots.end())) {
    entity.Refuse("has knots that do not grow");
  }
  for (ControlPoint const& control : spline.controls) {
    if (!(control.weight > 0.0)) entity.Refuse("has a weight that is not above 0");
  }
  return spline;
}

/// Between two points, in homogeneous coordinates.
ControlPoint Mixed(ControlPoint const& a, ControlPoint const& b, double part) {
  double const weight = (1.0 - part) * a.weight + part * b.weight;
  double const share = part * b.weight / weight;
  return {{a.at.x + share * (b.at.x - a.at.x), a.at.y + share * (b.at.y - a.at.y)}, weight};
}

/// The polar form of the spline in the span that begins with the knot `span`: at `degree` values
/// of which the first `low` are the begin of the span and the rest its end. That is a control point
/// of the span as a Bezier curve.
ControlPoint PolarForm(Spline const& spline, std::size_t span, std::size_t low) {
  std::size_t const degree = spline.degree;
  std::vector<double> const& knots = spline.knots;
  auto const first = spline.controls.begin() + static_cast<std::ptrdiff_t>(span - degree);
  BezierCurve level(first, first + static_cast<std::ptrdiff_t>(degree) + 1);
  for (std::size_t round = 1; round <= degree; ++round) {
    double const at = round <= low ? knots[span] : knots[span + 1];
    for (std::size_t k = degree; k >= round; --k) {
      double const begin = knots[k + span - degree];
      double const end = knots[k + 1 + span - round];
      level[k] = Mixed(level[k - 1], level[k], (at - begin) / (end - begin));
    }
  }
  return level.back();
}

std::vector<BezierCurve> CurvesOf(Spline const& spline) {
  std::vector<BezierCurve> curves;
  for (std::size_t span = spline.degree; span < spline.controls.size(); ++span) {
    if (!(spline.knots[span] < spline.knots[span + 1])) continue;
    BezierCurve curve;
    for (std::size_t i = 0; i <= spline.degree; ++i) {
      curve.push_back(PolarForm(spline, span, spline.degree - i));
    }
    if (!curves.empty()) curve.front() = curves.back().back();
    curves.push_back(std::move(curve));
  }
  return curves;
}

}  // namespace

std::vector<Piece> EllipsePieces(Entity const& entity, Flattening* flattening) {
  EllipseArc const arc = EllipseOf(entity);
  std::vector<BezierCurve> curves = CurvesOf(arc);
  constexpr double kRounding = 1e-9;
  bool const isWhole = arc.to - arc.from >= kTurn - kRounding;
  if (isWhole) curves.back().back().at = curves.front().front().at;
  return Chords(entity, curves, flattening);
}

std::vector<Piece> SplinePieces(Entity const& entity, Flattening* flattening) {
  std::vector<BezierCurve> const curves = CurvesOf(ReadSpline(entity));
  if (curves.empty()) entity.Refuse("has knots that do not grow");
  return Chords(entity, curves, flattening);
}

}  // namespace Vorn::IO::Dxf
