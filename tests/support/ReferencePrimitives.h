#pragma once

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <vector>

#include "vorn/GeometryUtils.h"

/// A second, deliberately plain and slow implementation of the geometry under the tolerance cells.
/// It shares no code with the library and exists only to be compared with it bit for bit: every
/// product, sum and comparison stands in the order in which the library has to take it.
namespace Vorn::Testing::Reference {

using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;

inline constexpr double kSmallestNormal = std::numeric_limits<double>::min();
inline constexpr double kEpsilon = std::numeric_limits<double>::epsilon();

inline int SignOf(double value) {
  if (value == 0.0) return 0;
  return value < 0.0 ? -1 : 1;
}

inline double SquaredDistance(Point const& p, Point const& q) {
  double const dy = p.y - q.y;
  double const dx = p.x - q.x;
  return dy * dy + dx * dx;
}

inline double Distance(Point const& p, Point const& q) { return std::sqrt(SquaredDistance(p, q)); }

struct Line {
  double a = 0.0;
  double b = 0.0;
  double c = 0.0;
};

inline bool LineThrough(double x1, double y1, double x2, double y2, Line* line) {
  if (std::fabs(x1 - x2) <= kSmallestNormal && std::fabs(y1 - y2) <= kSmallestNormal) return false;
  *line = {y1 - y2, x2 - x1, x1 * y2 - y1 * x2};
  return true;
}

inline Line NormalAt(Line const& line, Point const& p) {
  return {line.b, -line.a, line.a * p.y - line.b * p.x};
}

inline bool MeetingPoint(Line const& l, Line const& m, Point* point) {
  double const det = l.a * m.b - l.b * m.a;
  if (std::fabs(det) < kSmallestNormal) return false;
  *point = {(l.b * m.c - l.c * m.b) / det, (l.c * m.a - l.a * m.c) / det};
  return true;
}

inline bool Between(double low, double value, double high) { return low <= value && value <= high; }

inline bool InBoxOf(Point const& p, Point const& corner, Point const& opposite) {
  return Between(std::min(corner.x, opposite.x), p.x, std::max(corner.x, opposite.x)) &&
         Between(std::min(corner.y, opposite.y), p.y, std::max(corner.y, opposite.y));
}

inline bool ApartOnAxis(double v1, double v2, double v3, double v4) {
  double const low = std::min(v1, v2);
  double const high = std::max(v1, v2);
  if (v3 > v4) return v4 > high || low > v3;
  return v3 > high || low > v4;
}

inline SegmentsRelPosition MeetSegments(Point const& p1, Point const& p2, Point const& p3,
                                        Point const& p4, Point* meeting) {
  using enum SegmentsRelPosition;
  double const dx1 = p2.x - p1.x;
  double const dy1 = p2.y - p1.y;
  double const dx2 = p3.x - p4.x;
  double const dy2 = p3.y - p4.y;
  if (ApartOnAxis(p1.x, p2.x, p3.x, p4.x)) return Disjoint;
  if (ApartOnAxis(p1.y, p2.y, p3.y, p4.y)) return Disjoint;
  double const det = dy1 * dx2 - dy2 * dx1;

  if (std::fabs(det) > kSmallestNormal) {
    double const s = (p1.x - p3.x) * dy2 - (p1.y - p3.y) * dx2;
    double const u = (p1.y - p3.y) * dx1 - (p1.x - p3.x) * dy1;
    bool hit = false;
    if (det > 0.0) hit = Between(0.0, s, det) && Between(0.0, u, det);
    if (det < 0.0) hit = Between(det, s, 0.0) && Between(det, u, 0.0);
    if (!hit) return Disjoint;
    *meeting = {p1.x + s * dx1 / det, p1.y + s * dy1 / det};
    return Intersecting;
  }

  if (std::fabs(dx1) <= kSmallestNormal && std::fabs(dy1) <= kSmallestNormal) {
    if ((p1.x - p3.x) * (p4.y - p3.y) == (p1.y - p3.y) * (p4.x - p3.x) && InBoxOf(p1, p3, p4)) {
      *meeting = p1;
      return Intersecting;
    }
  }
  if (std::fabs(dx2) <= kSmallestNormal && std::fabs(dy2) <= kSmallestNormal) {
    if ((p3.x - p1.x) * dy1 == (p3.y - p1.y) * dx1 && InBoxOf(p3, p1, p2)) {
      *meeting = p3;
      return Intersecting;
    }
  }

  Line l1;
  Line l2;
  bool const ok2 = LineThrough(p3.x, p3.y, p4.x, p4.y, &l2);
  bool const ok1 = LineThrough(p1.x, p1.y, p2.x, p2.y, &l1);
  if (ok1 && ok2) {
    if (std::fabs(l1.c - l2.c) > kSmallestNormal) return Parallel;
    double const xmin1 = std::min(p1.x, p2.x), xmax1 = std::max(p1.x, p2.x);
    double const ymin1 = std::min(p1.y, p2.y), ymax1 = std::max(p1.y, p2.y);
    double const xmin2 = std::min(p3.x, p4.x), xmax2 = std::max(p3.x, p4.x);
    double const ymin2 = std::min(p3.y, p4.y), ymax2 = std::max(p3.y, p4.y);
    if (xmin1 > xmax2 || ymin1 > ymax2 || xmin2 > xmax1 || ymin2 > ymax1) return Disjoint;
    double const xlo = std::max(xmin1, xmin2), xhi = std::min(xmax1, xmax2);
    double const ylo = std::max(ymin1, ymin2), yhi = std::min(ymax1, ymax2);
    bool const shared = xlo <= xhi && ylo <= yhi;
    if (!shared) return Disjoint;
    *meeting = {(xlo + xhi) / 2.0, (ylo + yhi) / 2.0};
    return Collinear;
  }
  if (ok1) {
    if (std::fabs(l1.a * p3.x + l1.b * p3.y + l1.c) > kSmallestNormal) return Disjoint;
    *meeting = p3;
    return Intersecting;
  }
  if (ok2) {
    if (std::fabs(l2.a * p1.x + l2.b * p1.y + l2.c) > kSmallestNormal) return Disjoint;
    *meeting = p1;
    return Intersecting;
  }
  if (std::fabs(p1.x - p3.x) > kSmallestNormal || std::fabs(p1.y - p3.y) > kSmallestNormal) {
    return Disjoint;
  }
  *meeting = p1;
  return Intersecting;
}

/// The points where a line crosses a circle, in the order in which the library reports them.
inline std::vector<Point> CrossCircle(Line const& line, Point const& center, double r) {
  double const norm = std::sqrt(line.a * line.a + line.b * line.b);
  if (norm <= kSmallestNormal) return {};
  double const distance = std::fabs(line.a * center.x + line.b * center.y + line.c) / norm;
  if (!(distance <= r)) return {};
  Point foot;
  if (!MeetingPoint(line, NormalAt(line, center), &foot)) return {};

  Point start;
  Point end;
  if (std::fabs(line.a) > std::fabs(line.b)) {
    start.y = foot.y + 2.0 * r;
    end.y = foot.y - 2.0 * r;
    start.x = -(line.b / line.a) * start.y - line.c / line.a;
    end.x = -(line.b / line.a) * end.y - line.c / line.a;
  } else {
    start.x = foot.x + 2.0 * r;
    end.x = foot.x - 2.0 * r;
    start.y = -(line.a / line.b) * start.x - line.c / line.b;
    end.y = -(line.a / line.b) * end.x - line.c / line.b;
  }

  double const dx = end.x - start.x;
  double const dy = end.y - start.y;
  double const fx = start.x - center.x;
  double const fy = start.y - center.y;
  double const qa = dx * dx + dy * dy;
  double const qb = 2.0 * (dx * fx + dy * fy);
  double const qc = fx * fx + fy * fy - r * r;
  double const disc = qb * qb - 4.0 * qa * qc;
  if (!(disc >= 0.0)) return {};
  std::vector<Point> points;
  double const t1 = (std::sqrt(disc) - qb) / (2.0 * qa);
  if (Between(0.0, t1, 1.0)) points.push_back({start.x + t1 * dx, start.y + t1 * dy});
  if (disc > kEpsilon) {
    double const t2 = (-qb - std::sqrt(disc)) / (2.0 * qa);
    if (Between(0.0, t2, 1.0)) points.push_back({start.x + t2 * dx, start.y + t2 * dy});
  }
  return points;
}

/// Gaussian elimination with row pivoting; false only for an exactly zero pivot column before the
/// last one.
template <int N>
bool Solve(std::array<std::array<double, N>, N> a, std::array<double, N> b,
           std::array<double, N>* x) {
  for (int k = 0; k + 1 < N; ++k) {
    int pivot = k;
    for (int row = k + 1; row < N; ++row) {
      if (std::fabs(a[row][k]) > std::fabs(a[pivot][k])) pivot = row;
    }
    if (std::fabs(a[pivot][k]) == 0.0) return false;
    if (pivot != k) {
      for (int col = k; col < N; ++col) std::swap(a[k][col], a[pivot][col]);
      std::swap(b[k], b[pivot]);
    }
    for (int row = k + 1; row < N; ++row) {
      double const f = a[row][k] / a[k][k];
      for (int col = k + 1; col < N; ++col) a[row][col] -= f * a[k][col];
      b[row] -= f * b[k];
    }
  }
  for (int i = N - 1; i >= 0; --i) {
    double sum = 0.0;
    for (int j = i + 1; j < N; ++j) sum += a[i][j] * (*x)[j];
    (*x)[i] = (b[i] - sum) / a[i][i];
  }
  return true;
}

inline bool CircleThrough(Point const& a, Point const& b, Point const& c, Point* center,
                          double* radius) {
  std::array<double, 2> solution{};
  bool const solved =
      Solve<2>({{{2.0 * (a.x - b.x), 2.0 * (a.y - b.y)}, {2.0 * (a.x - c.x), 2.0 * (a.y - c.y)}}},
               {(b.x + a.x) * (a.x - b.x) + (b.y + a.y) * (a.y - b.y),
                (c.x + a.x) * (a.x - c.x) + (c.y + a.y) * (a.y - c.y)},
               &solution);
  if (!solved) return false;
  *center = {solution[0], solution[1]};
  *radius = (Distance(a, *center) + Distance(b, *center) + Distance(c, *center)) / 3.0;
  return true;
}

}  // namespace Vorn::Testing::Reference
