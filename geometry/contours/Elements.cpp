#include "geometry/contours/Elements.h"

#include <cmath>

#include "geometry/elementary/Angles.h"

namespace Vorn::Contours {

namespace {

/// Brings an angle that is at most one turn off back into the range of atan2.
double WrapOnce(double angle) {
  if (angle > Numeric::kTruncatedPi) return angle - Numeric::kTruncatedTwoPi;
  if (angle < -Numeric::kTruncatedPi) return angle + Numeric::kTruncatedTwoPi;
  return angle;
}

void SplitSegment(Elem const& whole, int parts, Point const& start, Elem* pieces) {
  double const stepX = (whole.end.x - start.x) / parts;
  double const stepY = (whole.end.y - start.y) / parts;
  for (int i = 0; i + 1 < parts; ++i) {
    pieces[i] = whole;
    pieces[i].end = {start.x + (i + 1) * stepX, start.y + (i + 1) * stepY};
  }
  pieces[parts - 1] = whole;
}

void SplitArc(Elem const& whole, int parts, double sweep, Elem* pieces) {
  double const step = sweep / parts;
  double cutAngle = whole.startAngle;
  for (int k = 1; k < parts; ++k) {
    Elem& piece = pieces[k - 1];
    piece = whole;
    piece.startAngle = cutAngle;
    cutAngle =
        WrapOnce(whole.direction > 0.0 ? whole.startAngle + k * step : whole.startAngle - k * step);
    piece.endAngle = cutAngle;
    piece.end = {whole.center.x + whole.radius * std::cos(cutAngle),
                 whole.center.y + whole.radius * std::sin(cutAngle)};
  }
  pieces[parts - 1] = whole;
  pieces[parts - 1].startAngle = cutAngle;
}

}  // namespace

Elem ArcElement(ArcPiece const& piece) {
  Elem arc;
  arc.type = ElemType::Arc;
  arc.end = piece.end;
  arc.center = piece.centre;
  arc.radius = piece.radius;
  arc.direction = piece.isClockwise ? -1.0 : 1.0;
  arc.startAngle = Elementary::AngleAbout(piece.centre, piece.start);
  arc.endAngle = Elementary::AngleAbout(piece.centre, piece.end);
  return arc;
}

Elem Moved(Elem const& elem, Point const& shift) {
  Elem moved = elem;
  moved.end = {elem.end.x + shift.x, elem.end.y + shift.y};
  if (!IsSegment(elem)) moved.center = {elem.center.x + shift.x, elem.center.y + shift.y};
  return moved;
}

void Split(Elem const& elem, int parts, Point const& start, Elem* pieces) {
  // The pieces may overwrite the element.
  Elem const whole = elem;
  if (IsSegment(whole)) {
    SplitSegment(whole, parts, start, pieces);
    return;
  }
  // Deliberate: equal angles mean a full circle here, though such an arc has no length elsewhere.
  bool const isFullCircle = !(whole.startAngle != whole.endAngle);
  SplitArc(whole, parts, isFullCircle ? Numeric::kTruncatedTwoPi : Elementary::ArcSweep(whole),
           pieces);
}

}  // namespace Vorn::Contours
