#include "io/fit/LocalFrame.h"

#include <algorithm>
#include <cmath>
#include <utility>

#include "io/pieces/Frame.h"

namespace Vorn::IO {

namespace {

void Shift(XY const& by, XY* point) {
  point->x += by.x;
  point->y += by.y;
}

}  // namespace

XY LocalOrigin(std::vector<WPoint> const& points) {
  Extent extent = {{HUGE_VAL, HUGE_VAL}, {-HUGE_VAL, -HUGE_VAL}};
  for (WPoint const& point : points) {
    if (!std::isfinite(point.x) || !std::isfinite(point.y)) return {0.0, 0.0};
    extent.low = {std::min(extent.low.x, point.x), std::min(extent.low.y, point.y)};
    extent.high = {std::max(extent.high.x, point.x), std::max(extent.high.y, point.y)};
  }
  return OriginFor(extent);
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
