#include "geometry/fitting/line/LineCut.h"

#include "geometry/elementary/ImplicitLine.h"
#include "geometry/intersections/Lines.h"

namespace Vorn::Fitting {

Cells::FixedPoints PointsOfLine(Ends const& ends, bool xOfY) {
  return {ends.fixedStart.has_value(), ends.fixedStart.value_or(Point{}), ends.fixedEnd.has_value(),
          ends.fixedEnd.value_or(Point{}), xOfY};
}

std::optional<Elementary::Segment> CutLine(Point const& parameters, Cells::FixedPoints const& fixed,
                                           Elementary::Segment const& near) {
  Elementary::ImplicitLine const line{fixed.swapped ? 1.0 : parameters.y,
                                      fixed.swapped ? parameters.y : 1.0, parameters.x};
  std::optional<Point> const start =
      fixed.hasP1 ? fixed.p1 : Intersections::FootOn(line, near.start);
  std::optional<Point> const end = fixed.hasP2 ? fixed.p2 : Intersections::FootOn(line, near.end);
  if (!start || !end) return std::nullopt;
  return Elementary::Segment{*start, *end};
}

}  // namespace Vorn::Fitting
