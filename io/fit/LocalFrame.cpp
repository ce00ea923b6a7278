#include "io/fit/LocalFrame.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace Vorn::IO {

namespace {

/// The offset is a multiple of a power of ten at least this many times the size of the points.
constexpr double kSizesToStep = 32.0;

double StepFor(double size) {
  constexpr double kBase = 10.0;
  double step = 1.0;
  while (step < kSizesToStep * size) step *= kBase;
  return step;
}

struct Range {
  double low = HUGE_VAL;
  double high = -HUGE_VAL;

  void Add(double value) {
    low = std::min(low, value);
    high = std::max(high, value);
  }
  double Size() const { return high - low; }
};

/// Whether value - offset is exact for every value of the range. It is where both are within a
/// factor of two: then the difference is a multiple of the last place of either and not larger than
/// the smaller of the two.
bool IsExact(Range const& range, double offset) {
  double const nearest = std::min(std::fabs(range.low), std::fabs(range.high));
  double const furthest = std::max(std::fabs(range.low), std::fabs(range.high));
  bool const isOneSided = (range.low > 0.0) == (range.high > 0.0);
  double const size = std::fabs(offset);
  return isOneSided && 0.5 * size <= nearest && furthest <= 2.0 * size;
}

double OffsetOf(Range const& range, double step) {
  double const offset = std::round((range.low + range.Size() / 2.0) / step) * step;
  return std::isfinite(offset) && IsExact(range, offset) ? offset : 0.0;
}

void Shift(XY const& by, XY* point) {
  point->x += by.x;
  point->y += by.y;
}

}  // namespace

XY LocalOrigin(std::vector<WPoint> const& points) {
  Range x;
  Range y;
  for (WPoint const& point : points) {
    if (!std::isfinite(point.x) || !std::isfinite(point.y)) return {0.0, 0.0};
    x.Add(point.x);
    y.Add(point.y);
  }
  double const size = std::max(x.Size(), y.Size());
  if (!(size > 0.0) || !std::isfinite(kSizesToStep * size)) return {0.0, 0.0};
  double const step = StepFor(size);
  return {OffsetOf(x, step), OffsetOf(y, step)};
}

std::vector<WPoint> TakenOff(std::vector<WPoint> points, XY const& origin) {
  for (WPoint& point : points) {
    point.x -= origin.x;
    point.y -= origin.y;
  }
  return points;
}

void PutBack(XY const& origin, FitReport* report) {
  if (origin.x == 0.0 && origin.y == 0.0) return;
  report->file.points = TakenOff(std::move(report->file.points), {-origin.x, -origin.y});
  for (GeometryUtils::Elem& element : report->fit.contour) {
    Shift(origin, &element.end);
    if (element.type == GeometryUtils::ElemType::Arc) Shift(origin, &element.center);
  }
  for (Piece& piece : report->pieces) {
    Shift(origin, &piece.start);
    Shift(origin, &piece.end);
    if (piece.IsArc()) Shift(origin, &piece.center);
  }
}

}  // namespace Vorn::IO
