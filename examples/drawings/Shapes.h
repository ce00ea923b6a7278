#pragma once

#include <cmath>
#include <vector>

#include "Svg.h"
#include "vorn/GeometryUtils.h"

/// What the drawings of the documentation have in common: styles, points with their tolerances and
/// contours.
namespace Drawing::Shapes {

using Vorn::GeometryUtils;
using Vorn::WPoint;

inline constexpr char kDisc[] = R"(fill="#7a8794" fill-opacity="0.22" stroke="#7a8794")";
inline constexpr char kPoint[] = R"(fill="#222222")";
inline constexpr char kSegment[] = R"(fill="none" stroke="#1f6fb4" stroke-width="2.5")";
inline constexpr char kArc[] = R"(fill="none" stroke="#d9730d" stroke-width="2.5")";
inline constexpr char kJoint[] = R"(fill="#ffffff" stroke="#222222" stroke-width="1.5")";
inline constexpr char kStop[] = R"(fill="#d62728" fill-opacity="0.10" stroke="#d62728")";
inline constexpr char kChosen[] = R"(fill="none" stroke="#1d7a38" stroke-width="2.5")";
inline constexpr char kNote[] = R"(fill="#444444" font-size="13")";
inline constexpr char kCentred[] = R"(fill="#444444" font-size="13" text-anchor="middle")";

inline Xy Position(WPoint const& p) { return {p.x, p.y}; }
inline Xy Position(GeometryUtils::Point const& p) { return {p.x, p.y}; }

/// Points along an arc, close enough for a drawing.
inline std::vector<Xy> ArcPoints(Xy centre, double radius, double from, double sweep) {
  constexpr int kSteps = 120;
  std::vector<Xy> points;
  for (int i = 0; i <= kSteps; ++i) {
    double const angle = from + sweep * i / kSteps;
    points.push_back({centre.x + radius * std::cos(angle), centre.y + radius * std::sin(angle)});
  }
  return points;
}

/// Each point as a dot in the disc of its tolerance.
inline void DrawPoints(Panel const& panel, std::vector<WPoint> const& points, double dot) {
  for (WPoint const& p : points) panel.Disc(Position(p), p.w, kDisc);
  for (WPoint const& p : points) panel.Dot(Position(p), dot, kPoint);
}

/// Segments, arcs and the joints between them.
inline void DrawContour(Panel const& panel, std::vector<GeometryUtils::Elem> const& contour) {
  for (std::size_t i = 1; i < contour.size(); ++i) {
    GeometryUtils::Elem const& elem = contour[i];
    if (elem.type == GeometryUtils::ElemType::Segment) {
      panel.Lines({Position(contour[i - 1].end), Position(elem.end)}, false, kSegment);
    } else {
      double const sweep = GeometryUtils::GetArcAngleRad(elem) * (elem.direction > 0.0 ? 1 : -1);
      panel.Lines(ArcPoints(Position(elem.center), elem.radius, elem.startAngle, sweep), false,
                  kArc);
    }
  }
  for (GeometryUtils::Elem const& elem : contour) panel.Dot(Position(elem.end), 4.0, kJoint);
}

}  // namespace Drawing::Shapes
