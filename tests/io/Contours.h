#pragma once

#include <cmath>
#include <vector>

#include "io/fit/MakeReport.h"
#include "vorn/GeometryUtils.h"

/// Contours made by hand, for tests of what the program does with them.
namespace Vorn::IO::Contours {

using Elem = GeometryUtils::Elem;

inline Elem Segment(double x, double y) {
  Elem elem;
  elem.type = GeometryUtils::ElemType::Segment;
  elem.end = {x, y};
  return elem;
}

/// An arc about (cx, cy) that begins and ends at the given polar angles.
inline Elem Arc(double cx, double cy, double radius, double from, double to, double direction) {
  Elem elem;
  elem.type = GeometryUtils::ElemType::Arc;
  elem.center = {cx, cy};
  elem.radius = radius;
  elem.direction = direction;
  elem.startAngle = from;
  elem.endAngle = to;
  elem.end = {cx + radius * std::cos(to), cy + radius * std::sin(to)};
  return elem;
}

/// From (0, 0) straight to (4, 0), then a clockwise three-quarter circle of radius 1 about (4, -1)
/// to (3, -1).
inline std::vector<Elem> LineAndArc() {
  constexpr double kHalfPi = 1.5707963267948966;
  return {Segment(0.0, 0.0), Segment(4.0, 0.0), Arc(4.0, -1.0, 1.0, kHalfPi, 2.0 * kHalfPi, -1.0)};
}

/// Along the x axis to 10, then a quarter turn to the left about (10, 5).
inline std::vector<Piece> LineAndQuarter() {
  constexpr double kHalfPi = 1.5707963267948966;
  return PiecesOf({Segment(0, 0), Segment(10, 0), Arc(10, 5, 5, -kHalfPi, 0.0, 1.0)});
}

inline PointFile FileWith(std::vector<WPoint> points) {
  PointFile file;
  file.path = "part.csv";
  for (std::size_t i = 0; i < points.size(); ++i) file.lines.push_back(i + 2);
  file.points = std::move(points);
  return file;
}

/// Points of LineAndArc, the second 0.01 off it and the fourth 0.015, with a tolerance of 0.02.
inline FitReport LineAndArcReport() {
  double const w = 0.02;
  double const r = std::sqrt(0.5);
  FitAnswer fit;
  fit.code = ErrorCode::Ok;
  fit.contour = LineAndArc();
  fit.deviation = 0.5;
  fit.deviationIndex = 1;
  fit.seconds = 0.25;
  PointFile file = FileWith({{0, 0, w},
                             {2, 0.01, w},
                             {4, 0, w},
                             {5.015, -1, w},
                             {4 + r, -1 - r, w},
                             {4, -2, w},
                             {3, -1, w}});
  return MakeReport({std::move(file), "given for all points", {}}, Strategy::Mixed, std::move(fit));
}

}  // namespace Vorn::IO::Contours
