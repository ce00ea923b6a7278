#pragma once

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>
#include <vector>

#include "support/RandomGeometry.h"
#include "vorn/GeometryUtils.h"

/// Seeded profiles as a measuring machine would deliver them: lines and arcs with noise.
namespace Vorn::Testing {

/// Halves tolerances until every neighbour pair is far enough apart to be fitted.
inline void MakeSpacingValid(std::vector<WPoint>* points) {
  for (std::size_t i = 0; i + 1 < points->size(); ++i) {
    WPoint& a = (*points)[i];
    WPoint& b = (*points)[i + 1];
    if (a.x == b.x && a.y == b.y) continue;
    while (!GeometryUtils::IsPointValidToFit(a, b)) {
      a.w *= 0.5;
      b.w *= 0.5;
    }
  }
}

/// Points along lines and arcs that meet smoothly or in a corner. Spacing, tolerances (one for all
/// or one for each point) and the noise, as a share of the tolerance, are drawn at random.
inline std::vector<WPoint> MakeProfile(RandomGeometry* random, std::int32_t count) {
  constexpr double kNoiseShares[] = {0.0, 0.1, 0.3, 0.3, 0.9, 0.9, 1.6, 1.6};
  double const spacing = random->Uniform(0.2, 5.0);
  double const tolerance = spacing * random->Uniform(0.01, 0.3);
  bool const isToleranceVaried = random->Flip();
  double const noise = tolerance * kNoiseShares[random->Integer(0, 7)];

  std::vector<WPoint> points;
  double x = random->Uniform(-50.0, 50.0);
  double y = random->Uniform(-50.0, 50.0);
  double heading = random->Uniform(-3.0, 3.0);
  while (static_cast<std::int32_t>(points.size()) < count) {
    bool const isArc = random->Flip();
    std::int32_t const length = random->Integer(2, 16);
    double const curvature =
        isArc ? (random->Flip() ? 1.0 : -1.0) / (spacing * random->Uniform(3.0, 60.0)) : 0.0;
    if (random->Integer(0, 2) == 0) heading += random->Uniform(-1.2, 1.2);
    for (std::int32_t i = 0; i < length; ++i) {
      double const w = isToleranceVaried ? tolerance * random->Uniform(0.2, 1.0) : tolerance;
      double const across = noise * random->Uniform(-1.0, 1.0);
      points.push_back({x - across * std::sin(heading), y + across * std::cos(heading), w});
      heading += 0.5 * curvature * spacing;
      x += spacing * std::cos(heading);
      y += spacing * std::sin(heading);
      heading += 0.5 * curvature * spacing;
    }
  }
  points.resize(static_cast<std::size_t>(count));
  MakeSpacingValid(&points);
  return points;
}

/// Points of one arc, ends included; a whole turn or more is allowed.
inline std::vector<WPoint> MakeArcPoints(GeometryUtils::Point const& center, double radius,
                                         double startAngle, double sweep, std::int32_t count,
                                         double tolerance) {
  std::vector<WPoint> points;
  for (std::int32_t i = 0; i < count; ++i) {
    double const angle = startAngle + sweep * i / (count - 1);
    points.push_back(
        {center.x + radius * std::cos(angle), center.y + radius * std::sin(angle), tolerance});
  }
  return points;
}

inline std::vector<WPoint> MakeLinePoints(GeometryUtils::Point const& start, double dx, double dy,
                                          std::int32_t count, double tolerance) {
  std::vector<WPoint> points;
  for (std::int32_t i = 0; i < count; ++i) {
    points.push_back({start.x + dx * i, start.y + dy * i, tolerance});
  }
  return points;
}

/// One arc with noise and tolerances of very different size: where a tight triple comes first, each
/// later cell swallows the current one whole, which triples its triangles, so the fitters have to
/// thin.
inline std::vector<WPoint> MakeArcWithFewTightPoints(RandomGeometry* random, std::int32_t count) {
  double const radius = random->Uniform(5.0, 40.0);
  double const sweep = (random->Flip() ? 1.0 : -1.0) * random->Uniform(0.8, 4.5);
  std::vector<WPoint> points =
      MakeArcPoints(random->PointIn(-20.0, 20.0), radius, random->Uniform(-3.0, 3.0), sweep, count,
                    0.25 * radius * std::fabs(sweep) / (count - 1));
  for (WPoint& p : points) {
    if (random->Integer(0, 3) == 0) p.w *= 1e-3;
    p.x += p.w * random->Uniform(-0.4, 0.4);
    p.y += p.w * random->Uniform(-0.4, 0.4);
  }
  MakeSpacingValid(&points);
  return points;
}

/// A straight run that starts with two tight points: every later pair cell holds the current cell
/// whole, which triples its triangles.
inline std::vector<WPoint> MakeLineWithTightStart(RandomGeometry* random, std::int32_t count) {
  double const slope = random->Uniform(-3.0, 3.0);
  std::vector<WPoint> points =
      MakeLinePoints(random->PointIn(-20.0, 20.0), 1.0, slope, count, 0.25);
  points[0].w = points[1].w = 1e-5;
  for (std::size_t i = 2; i < points.size(); ++i) {
    points[i].y += random->Uniform(-0.24, 0.24);
  }
  return points;
}

/// What measuring errors, bad files and bad callers do to a profile.
inline void AddHazard(RandomGeometry* random, std::vector<WPoint>* points) {
  auto const last = static_cast<std::int32_t>(points->size()) - 1;
  auto const at = static_cast<std::size_t>(random->Integer(0, last));
  WPoint& p = (*points)[at];
  WPoint const& other = (*points)[static_cast<std::size_t>(random->Integer(0, last))];
  switch (random->Integer(0, 8)) {
    case 0:  // The same point twice.
      points->insert(points->begin() + static_cast<std::ptrdiff_t>(at), WPoint{p});
      break;
    case 1:  // A jump to elsewhere on the profile.
      p.x = other.x;
      p.y = other.y;
      break;
    case 2:  // The way back over the same points.
      std::reverse(points->begin() + static_cast<std::ptrdiff_t>(at), points->end());
      break;
    case 3:
      p.w = 0.0;
      break;
    case 4:  // A tolerance that is zero by every test.
      p.w = std::numeric_limits<double>::denorm_min();
      break;
    case 5:
      p.w = -p.w;
      break;
    case 6:  // An outlier.
      p.x += random->Wide(0, 30);
      break;
    case 7:  // Far from the origin, where few bits are left for the shape.
      for (WPoint& q : *points) q.x += 1e9;
      break;
    default:  // Huge, though squares do not overflow yet.
      for (WPoint& q : *points) q = {q.x * 0x1p200, q.y * 0x1p200, q.w * 0x1p200};
      break;
  }
}

}  // namespace Vorn::Testing
