#include "io/formats/SvgPen.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "io/formats/Text.h"
#include "io/pieces/Shapes.h"

namespace Vorn::IO {

namespace {

constexpr double kTurn = 2.0 * std::numbers::pi;

/// The ellipse of an arc, in coordinates that are measured from its centre along its half axes:
/// there it is a circle of radius 1.
class UnitCircle {
 public:
  explicit UnitCircle(SvgArc const& arc)
      : first_{arc.rx * std::cos(arc.turn), arc.rx * std::sin(arc.turn)},
        second_{-arc.ry * std::sin(arc.turn), arc.ry * std::cos(arc.turn)} {}

  /// How far `way` goes along the half axes.
  XY Inward(XY const& way) const {
    return {(way.x * first_.x + way.y * first_.y) / Square(first_),
            (way.x * second_.x + way.y * second_.y) / Square(second_)};
  }

  XY Outward(XY const& way) const {
    return {way.x * first_.x + way.y * second_.x, way.x * first_.y + way.y * second_.y};
  }

  /// Half axes too short to reach both ends are made longer.
  void Grow(double factor) {
    first_ = {first_.x * factor, first_.y * factor};
    second_ = {second_.x * factor, second_.y * factor};
  }

  XY const& First() const { return first_; }
  XY const& Second() const { return second_; }

 private:
  static double Square(XY const& axis) { return axis.x * axis.x + axis.y * axis.y; }

  XY first_;
  XY second_;
};

/// The tangent of a quarter of the sweep of a circle's arc over the chord.
double BulgeOver(double chord, double radius, bool isLarge) {
  double const half = std::asin(std::min(1.0, chord / (2.0 * radius)));
  return std::tan((isLarge ? std::numbers::pi - half : half) / 2.0);
}

/// The ellipse through both ends, its centre where the flags ask for it.
EllipseArc EllipseThrough(XY const& from, XY const& to, SvgArc const& arc) {
  UnitCircle circle(arc);
  XY half = circle.Inward({(from.x - to.x) / 2.0, (from.y - to.y) / 2.0});
  double const length = std::hypot(half.x, half.y);
  if (length > 1.0) {
    circle.Grow(length);
    half = {half.x / length, half.y / length};
  }
  double const square = half.x * half.x + half.y * half.y;
  double const away = std::sqrt(std::max(0.0, 1.0 / square - 1.0));
  double const part = arc.isLarge == arc.isSweep ? -away : away;
  XY const center = {part * half.y, -part * half.x};
  XY const shift = circle.Outward(center);
  double const begin = std::atan2(half.y - center.y, half.x - center.x);
  double sweep = std::atan2(-half.y - center.y, -half.x - center.x) - begin;
  if (arc.isSweep && sweep < 0.0) sweep += kTurn;
  if (!arc.isSweep && sweep > 0.0) sweep -= kTurn;
  return {{(from.x + to.x) / 2.0 + shift.x, (from.y + to.y) / 2.0 + shift.y},
          circle.First(),
          circle.Second(),
          begin,
          begin + sweep};
}

}  // namespace

void SvgPen::MoveTo(XY const& to) { begin_ = at_ = to; }

void SvgPen::LineTo(XY const& to) {
  Add(MakeLine(map_(at_), map_(to)));
  at_ = to;
}

void SvgPen::Close() {
  if (!AreEqual(at_, begin_)) LineTo(begin_);
}

void SvgPen::CurveTo(std::vector<XY> const& controls) {
  BezierCurve curve = {{map_(at_)}};
  for (XY const& control : controls) curve.push_back({map_(control)});
  AddChords({curve});
  at_ = controls.back();
}

void SvgPen::ArcTo(SvgArc const& arc, XY const& to) {
  if (AreEqual(at_, to)) return;
  SvgArc sized = arc;
  sized.rx = std::fabs(arc.rx);
  sized.ry = std::fabs(arc.ry);
  if (sized.rx == 0.0 || sized.ry == 0.0) return LineTo(to);
  sized.rx == sized.ry&& map_.IsSimilarity() ? CircleTo(sized, to) : EllipseTo(sized, to);
  at_ = to;
}

void SvgPen::CircleTo(SvgArc const& arc, XY const& to) {
  double const bulge = BulgeOver(Distance(at_, to), arc.rx, arc.isLarge);
  bool const isCounterClockwise = arc.isSweep == (map_.Determinant() > 0.0);
  Piece const piece = MakeBulge(map_(at_), map_(to), isCounterClockwise ? bulge : -bulge);
  if (outcome_.arcs == ArcUse::Refuse) element_.Refuse(DescribeArc(piece), Remedy::FlattenCurves);
  Add(piece);
}

void SvgPen::EllipseTo(SvgArc const& arc, XY const& to) {
  EllipseArc const local = EllipseThrough(at_, to, arc);
  // A half axis whose square is zero, beside the way between the ends.
  if (!std::isfinite(local.to)) element_.Refuse("an arc has a half axis that is too short");
  EllipseArc const mapped = {map_(local.center), map_.OfDirection(local.first),
                             map_.OfDirection(local.second), local.from, local.to};
  std::vector<BezierCurve> curves = CurvesOf(mapped);
  // The ends are those that the file gives, to the last digit.
  curves.front().front().at = map_(at_);
  curves.back().back().at = map_(to);
  AddChords(curves);
}

void SvgPen::AddChords(std::vector<BezierCurve> const& curves) {
  std::vector<Piece> chords;
  if (auto const fault = AppendChords(curves, &outcome_.flattening, &chords)) {
    element_.Refuse(*fault, outcome_.flattening.Help());
  }
  for (Piece const& chord : chords) Add(chord);
}

void SvgPen::Add(Piece const& piece) {
  if (!IsUsable(piece.end.x) || !IsUsable(piece.end.y)) {
    element_.Refuse("a transformed coordinate is too large");
  }
  outcome_.pieces.push_back(piece);
}

}  // namespace Vorn::IO
