// Contours as chains of elements: building and editing at the end, single elements shifted and
// split, and the walk that skips elements of no length.

#include <cmath>
#include <cstddef>
#include <iterator>

#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

namespace {

using Arc = GeometryUtils::Arc;
using Elem = GeometryUtils::Elem;
using ElemType = GeometryUtils::ElemType;
using Point = GeometryUtils::Point;

bool IsKnownType(ElemType type) { return type == ElemType::Segment || type == ElemType::Arc; }

double PolarAngle(Point const& p, Point const& center) {
  return std::atan2(p.y - center.y, p.x - center.x);
}

/// Brings an angle that is at most one turn off back into the range of atan2.
double WrapOnce(double angle) {
  if (angle > Numeric::kTruncatedPi) return angle - Numeric::kTruncatedTwoPi;
  if (angle < -Numeric::kTruncatedPi) return angle + Numeric::kTruncatedTwoPi;
  return angle;
}

void SplitSegment(Elem const& whole, int parts, Point2D<double> const& start, Elem* pieces) {
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

bool GeometryUtils::AddSegm(std::vector<Elem>* contour, Point end) {
  // The fields of an arc are zero in a segment: nothing reads them, but a contour that is written
  // out or compared byte for byte should not depend on chance.
  Elem segment;
  segment.type = ElemType::Segment;
  segment.end = end;
  contour->push_back(segment);
  return true;
}

bool GeometryUtils::AddArc(std::vector<Elem>* contour, Point const& start, Point const& end,
                           Point const& center, double radius, bool clockwise) {
  Elem arc;
  arc.type = ElemType::Arc;
  arc.end = end;
  arc.center = center;
  arc.radius = radius;
  arc.direction = clockwise ? -1.0 : 1.0;
  arc.startAngle = PolarAngle(start, center);
  arc.endAngle = PolarAngle(end, center);
  contour->push_back(arc);
  return true;
}

bool GeometryUtils::RemoveElem(std::vector<Elem>* contour, Elem* removed) {
  if (contour->empty()) return false;
  *removed = contour->back();
  contour->pop_back();
  return true;
}

bool GeometryUtils::ReplaceElem(std::vector<Elem>* contour, Elem const& elem) {
  if (contour->empty() || !IsKnownType(elem.type)) return false;
  // elem may be the very element that is popped below.
  Elem const replacement = elem;
  Elem const replaced = contour->back();
  contour->pop_back();
  if (replacement.type == ElemType::Segment) return AddSegm(contour, replacement.end);

  Point start;
  if (!GetElemPoint(contour, &start)) {
    contour->push_back(replaced);
    return false;
  }
  return AddArc(contour, start, replacement.end, replacement.center, replacement.radius,
                replacement.direction < 0.0);
}

bool GeometryUtils::GetElemPoint(std::vector<Elem>* contour, Point* point) {
  if (contour->empty() || !IsKnownType(contour->back().type)) return false;
  *point = contour->back().end;
  return true;
}

ErrorCode GeometryUtils::GetElemPoint(std::vector<Elem>::const_iterator& it,
                                      Point2D<double>* point) {
  if (!IsKnownType(it->type)) return ErrorCode::Failed;
  *point = {it->end.x, it->end.y};
  return ErrorCode::Ok;
}

bool GeometryUtils::ShiftElem(Elem const& elem, Point2D<double> const& shift, Elem* shifted) {
  if (!IsKnownType(elem.type)) return false;
  Elem moved = elem;
  moved.end = {elem.end.x + shift.x, elem.end.y + shift.y};
  if (elem.type == ElemType::Arc) {
    moved.center = {elem.center.x + shift.x, elem.center.y + shift.y};
  }
  *shifted = moved;
  return true;
}

bool GeometryUtils::SplitElem(Elem const& elem, int parts, Point2D<double> const& start,
                              Elem* pieces) {
  if (parts < 2 || !IsKnownType(elem.type)) return false;
  Elem const whole = elem;
  if (whole.type == ElemType::Segment) {
    SplitSegment(whole, parts, start, pieces);
    return true;
  }
  // Deliberate: equal angles mean a full circle here, though such an arc has no length elsewhere.
  double const sweep =
      whole.startAngle != whole.endAngle ? GetArcAngleRad(whole) : Numeric::kTruncatedTwoPi;
  SplitArc(whole, parts, sweep, pieces);
  return true;
}

void GeometryUtils::DeleteFittingCurve(std::vector<Elem>* contour) { contour->clear(); }

ErrorCode GeometryUtils::CheckLength(std::vector<Elem>::const_iterator& prev,
                                     std::vector<Elem>::const_iterator& elem, bool* zeroLength) {
  if (!IsKnownType(prev->type) || !IsKnownType(elem->type)) return ErrorCode::Failed;
  *zeroLength = Numeric::IsZeroMagnitude(prev->end.x - elem->end.x) &&
                Numeric::IsZeroMagnitude(prev->end.y - elem->end.y);
  return ErrorCode::Ok;
}

ErrorCode GeometryUtils::GetNextIter(std::vector<Elem> const& contour,
                                     std::vector<Elem>::const_iterator& it,
                                     std::vector<Elem>::const_iterator* next) {
  if (it == contour.end()) return ErrorCode::Failed;
  for (auto candidate = std::next(it); candidate != contour.end(); ++candidate) {
    bool isZeroLength = false;
    ErrorCode const code = CheckLength(it, candidate, &isZeroLength);
    if (code != ErrorCode::Ok) return code;
    if (!isZeroLength) {
      *next = candidate;
      return ErrorCode::Ok;
    }
  }
  return ErrorCode::Failed;
}

}  // namespace Vorn
