#pragma once

#include "support/ReferenceOverlap.h"

/// The plain second implementation of line cells, circle cells and their centres.
namespace Vorn::Testing::Reference {

/// Slightly below the double nearest to a right angle, as the library has it.
inline constexpr double kRightAngle = 1.570796326794895;

inline bool Rect(WPoint const& a, WPoint const& b, std::array<Point, 4>* rect) {
  double const w = a.w + b.w;
  if (w <= kSmallestNormal) {
    *rect = {Point{a.x, a.y}, Point{a.x, a.y}, Point{b.x, b.y}, Point{b.x, b.y}};
    return true;
  }
  double const dx = b.x - a.x;
  double const dy = b.y - a.y;
  double const l2 = dx * dx + dy * dy;
  double const w2 = w * w;
  if (w2 > l2) return false;
  double const t = std::sqrt(l2 / w2 - 1.0);
  double const kb = b.w * w / l2;
  double const ka = a.w * w / l2;
  (*rect)[0] = {b.x - (t * dy + dx) * kb, b.y + (t * dx - dy) * kb};
  (*rect)[1] = {b.x + (t * dy - dx) * kb, b.y - (t * dx + dy) * kb};
  (*rect)[2] = {a.x + (dx + t * dy) * ka, a.y - (t * dx - dy) * ka};
  (*rect)[3] = {a.x + (dx - t * dy) * ka, a.y + (dy + t * dx) * ka};
  return true;
}

inline bool RectOfEqual(double x1, double y1, double x2, double y2, double r,
                        std::array<Point, 4>* rect) {
  if (r * r <= kSmallestNormal) {
    *rect = {Point{x1, y1}, Point{x1, y1}, Point{x2, y2}, Point{x2, y2}};
    return true;
  }
  double const dx = x2 - x1;
  double const dy = y2 - y1;
  double const l2 = dx * dx + dy * dy;
  double const big = 4.0 * (r * r);
  if (big > l2) return false;
  double const k = big / l2;
  double const t = std::sqrt(l2 / big - 1.0);
  double const hx = dx / 2.0;
  double const hy = dy / 2.0;
  Point p0;
  Point p1;
  if (std::fabs(dx) >= std::fabs(dy)) {
    p0.y = y2 - k * hy + k * hx * t;
    p1.y = y2 - k * hy - k * hx * t;
    p0.x = x2 - ((p0.y - y2) * hy + r * r) / hx;
    p1.x = x2 - ((p1.y - y2) * hy + r * r) / hx;
  } else {
    p0.x = x2 - k * hx - k * hy * t;
    p1.x = x2 - k * hx + k * hy * t;
    p0.y = y2 - ((p0.x - x2) * hx + r * r) / hy;
    p1.y = y2 - ((p1.x - x2) * hx + r * r) / hy;
  }
  *rect = {p0, p1, Point{x1 + x2 - p0.x, y1 + y2 - p0.y}, Point{x1 + x2 - p1.x, y1 + y2 - p1.y}};
  return true;
}

inline bool ValidBunch(std::array<double, 4> const& den, std::array<double, 4> const& num) {
  std::array<double, 4> angle{};
  for (int i = 0; i < 4; ++i) {
    if (std::fabs(den[i]) <= kSmallestNormal) return false;
    angle[i] = std::fabs(std::atan2(num[i], den[i]));
  }
  bool const bothBelow = angle[0] < kRightAngle && angle[3] < kRightAngle;
  bool const bothAbove = angle[0] > kRightAngle && angle[3] > kRightAngle;
  return bothBelow || bothAbove;
}

/// The cell polygon of a permissible rectangle in the line-parameter plane.
inline ErrorCode LinePolygonOf(std::array<Point, 4> const& rect, bool* formFixed, bool* xOfY,
                               std::array<Point, 4>* polygon) {
  int const from[4] = {0, 1, 1, 0};
  int const to[4] = {2, 2, 3, 3};
  std::array<double, 4> a{};
  std::array<double, 4> b{};
  std::array<double, 4> d{};
  for (int i = 0; i < 4; ++i) {
    Point const& u = rect[from[i]];
    Point const& v = rect[to[i]];
    a[i] = v.y - u.y;
    b[i] = u.x - v.x;
    d[i] = v.x * u.y - u.x * v.y;
  }
  int attempts = 1;
  if (!*formFixed) {
    *formFixed = true;
    *xOfY = std::fabs(a[3]) > std::fabs(b[3]);
    attempts = 2;
  }
  for (int attempt = 0; attempt < attempts; ++attempt) {
    if (attempt == 1) *xOfY = !*xOfY;
    auto const& den = *xOfY ? a : b;
    auto const& num = *xOfY ? b : a;
    if (!ValidBunch(den, num)) continue;
    int const order[4] = {1, 2, 3, 0};
    for (int i = 0; i < 4; ++i) {
      int const line = order[i];
      (*polygon)[i] = {d[line] / den[line], num[line] / den[line]};
    }
    return ErrorCode::Ok;
  }
  return ErrorCode::InvalidLineCell;
}

inline ErrorCode LinePolygon(WPoint const& a, WPoint const& b, bool* formFixed, bool* xOfY,
                             std::array<Point, 4>* polygon) {
  std::array<Point, 4> rect;
  if (!Rect(a, b, &rect)) return ErrorCode::Failed;
  return LinePolygonOf(rect, formFixed, xOfY, polygon);
}

inline Cell FanOf(std::vector<Point> const& polygon) {
  Cell cell;
  Divide(polygon, 0, static_cast<int>(polygon.size()), &cell);
  return cell;
}

inline ErrorCode LineCell(WPoint const& a, WPoint const& b, bool* formFixed, bool* xOfY,
                          Cell* cell) {
  std::array<Point, 4> polygon;
  ErrorCode const code = LinePolygon(a, b, formFixed, xOfY, &polygon);
  if (code != ErrorCode::Ok) return code;
  Cell local;
  if (!Divide({polygon.begin(), polygon.end()}, 0, 4, &local)) return ErrorCode::Failed;
  *cell = local;
  return ErrorCode::Ok;
}

inline ErrorCode LineCellOfEqual(double x1, double y1, double x2, double y2, double r,
                                 bool* formFixed, bool* xOfY, Cell* cell) {
  std::array<Point, 4> rect;
  std::array<Point, 4> polygon;
  if (!RectOfEqual(x1, y1, x2, y2, r, &rect)) return ErrorCode::Failed;
  ErrorCode const code = LinePolygonOf(rect, formFixed, xOfY, &polygon);
  if (code != ErrorCode::Ok) return code;
  Cell local;
  if (!Divide({polygon.begin(), polygon.end()}, 0, 4, &local)) return ErrorCode::Failed;
  *cell = local;
  return ErrorCode::Ok;
}

/// The centre, by the padded system of four unknowns in which the last two are forced to zero.
inline bool PaddedCircumcentre(Point const& p0, Point const& p1, Point const& p2, Point* center) {
  double const ax = 2.0 * (p0.x - p1.x);
  double const ay = 2.0 * (p0.y - p1.y);
  double const bx = 2.0 * (p1.x - p2.x);
  double const by = 2.0 * (p1.y - p2.y);
  std::array<double, 4> solution{};
  bool const solved =
      Solve<4>({{{ax, ay, ax, ay}, {bx, by, bx, by}, {0, 0, 1, 0}, {0, 0, 0, 1}}},
               {(p1.y + p0.y) * (p0.y - p1.y) + (p1.x + p0.x) * (p0.x - p1.x),
                (p2.y + p1.y) * (p1.y - p2.y) + (p2.x + p1.x) * (p1.x - p2.x), 0.0, 0.0},
               &solution);
  if (solved) *center = {solution[0], solution[1]};
  return solved;
}

inline ErrorCode CirclePolygon(WPoint const& first, WPoint const& middle, WPoint const& last,
                               bool firstFixed, bool lastFixed, int orientation,
                               std::vector<Point>* vertices) {
  Point center;
  Point const points[3] = {{first.x, first.y}, {middle.x, middle.y}, {last.x, last.y}};
  double const w[3] = {first.w, middle.w, last.w};
  if (!PaddedCircumcentre(points[0], points[1], points[2], &center)) return ErrorCode::Failed;
  double const radius = Distance(points[0], center);
  if (!(radius > kSmallestNormal)) return ErrorCode::Failed;

  std::vector<Point> candidates;
  for (int i = 0; i < 3; ++i) {
    double const dx = points[i].x - center.x;
    double const dy = points[i].y - center.y;
    candidates.push_back(
        {center.x + dx * (radius - w[i]) / radius, center.y + dy * (radius - w[i]) / radius});
    candidates.push_back(
        {center.x + dx * (radius + w[i]) / radius, center.y + dy * (radius + w[i]) / radius});
  }
  candidates.push_back(points[0]);
  candidates.push_back(points[2]);

  using Row = std::array<int, 3>;
  std::vector<Row> rows{{0, 2, 5}, {0, 3, 5}, {0, 3, 4}, {1, 3, 4}, {1, 2, 4}, {1, 2, 5}};
  if (firstFixed) rows = {{6, 2, 5}, {6, 3, 5}, {6, 3, 4}, {6, 2, 4}};
  if (lastFixed) rows = {{0, 2, 7}, {0, 3, 7}, {1, 3, 7}, {1, 2, 7}};
  if (firstFixed && lastFixed) rows = {{6, 2, 7}, {6, 3, 7}, {6, 3, 7}};

  bool const free = !firstFixed && !lastFixed;
  std::vector<Point> kept;
  int reference = 0;
  for (std::size_t k = 0; k < rows.size(); ++k) {
    Triangle const t{{candidates[rows[k][0]], candidates[rows[k][1]], candidates[rows[k][2]]}};
    Point rowCenter;
    double rowRadius = 0.0;
    if (!CircleThrough(t.pts[0], t.pts[1], t.pts[2], &rowCenter, &rowRadius)) {
      return ErrorCode::Failed;
    }
    int const sign = SignOf(Area(t));
    if (free && orientation != 0) {
      if (sign == orientation) kept.push_back(rowCenter);
      continue;
    }
    if (k == 0) reference = sign;
    if (sign != reference) return ErrorCode::OrientationMismatch;
    kept.push_back(rowCenter);
  }
  if (free && kept.size() < 3) return ErrorCode::OrientationMismatch;
  *vertices = kept;
  return ErrorCode::Ok;
}

struct Box {
  double minX = 0.0;
  double minY = 0.0;
  double maxX = 0.0;
  double maxY = 0.0;
};

inline bool BoxOf(Cell const& cell, Box* box) {
  if (cell.empty()) return false;
  Point const& first = cell[0].pts[0];
  *box = {first.x, first.y, first.x, first.y};
  for (auto const& triangle : cell) {
    for (auto const& p : triangle.pts) {
      if (p.x < box->minX) box->minX = p.x;
      if (p.y < box->minY) box->minY = p.y;
      if (p.x > box->maxX) box->maxX = p.x;
      if (p.y > box->maxY) box->maxY = p.y;
    }
  }
  return true;
}

inline bool ChordOf(Cell const& cell, Line const& line, Triangle* chord) {
  Box box;
  if (!BoxOf(cell, &box)) return false;
  Point const center{(box.minX + box.maxX) * 0.5, (box.minY + box.maxY) * 0.5};
  double const radius = Distance({box.minX, box.minY}, center);
  auto const points = CrossCircle(line, center, radius);
  if (points.empty()) return false;
  *chord = {{points.front(), points.back(), points.back()}};
  return true;
}

inline bool CellCenter(Cell const& cell, Point* center) {
  if (cell.empty()) return false;
  double total = 0.0;
  int degenerate = 0;
  Point weighted{};
  Point plain{};
  for (auto const& triangle : cell) {
    double const area = std::fabs(Area(triangle));
    Point const c = Center(triangle);
    if (area <= kSmallestNormal) {
      plain = {plain.x + c.x, plain.y + c.y};
      ++degenerate;
    } else {
      total += area;
      weighted = {weighted.x + c.x * area, weighted.y + c.y * area};
    }
  }
  if (total >= kSmallestNormal) {
    *center = {weighted.x / total, weighted.y / total};
  } else if (degenerate > 0) {
    *center = {plain.x / degenerate, plain.y / degenerate};
  } else {
    *center = weighted;
  }
  return true;
}

inline bool CellCenterForCircle(Point const& p1, Point const& p2, Cell const& cell, Point* center) {
  Line chordLine;
  if (!LineThrough(p1.x, p1.y, p2.x, p2.y, &chordLine)) return false;
  Line const bisector = NormalAt(chordLine, Midpoint(p1, p2));
  Triangle chord;
  if (!ChordOf(cell, bisector, &chord)) return false;
  Cell overlap;
  if (Overlap(chord, cell, &overlap) != OverlappingStatus::Overlap) return false;
  return CellCenter(overlap, center);
}

inline bool CellCenterForLine(bool hasP1, Point p1, bool hasP2, Point p2, bool swapped,
                              Cell const& cell, Point* center) {
  if (!hasP1 && !hasP2) return CellCenter(cell, center);
  if (swapped) {
    std::swap(p1.x, p1.y);
    std::swap(p2.x, p2.y);
  }
  Triangle candidate;
  if (hasP1 && hasP2) {
    std::array<double, 2> uv{};
    if (!Solve<2>({{{1.0, p1.x}, {1.0, p2.x}}}, {-p1.y, -p2.y}, &uv)) return false;
    Point const p{uv[0], uv[1]};
    candidate = {{p, p, p}};
  } else {
    Point const p = hasP1 ? p1 : p2;
    if (!ChordOf(cell, {1.0, p.x, p.y}, &candidate)) return false;
  }
  Cell overlap;
  Overlap(candidate, cell, &overlap);
  if (overlap.empty()) return false;
  return CellCenter(overlap, center);
}

}  // namespace Vorn::Testing::Reference
