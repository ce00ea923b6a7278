// Makes the drawings of docs/method.md from what the library itself answers.
//
// usage: draw_method DIRECTORY

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

#include "Shapes.h"
#include "Svg.h"
#include "vorn/GeometryUtils.h"

using Drawing::Canvas;
using Drawing::Panel;
using Drawing::Xy;
using namespace Drawing::Shapes;
using Vorn::ErrorCode;
using Vorn::GeometryUtils;
using Vorn::WPoint;

namespace {

using Elem = GeometryUtils::Elem;
using Polygon = std::vector<Xy>;

constexpr char kCell[] = R"(fill="#7a8794" fill-opacity="0.10" stroke="#8a95a1")";
constexpr char kCommon[] = R"(fill="#2a9d4a" fill-opacity="0.45" stroke="#1d7a38")";

constexpr std::array<char const*, 6> kHues = {"#1f6fb4", "#d9730d", "#8e44ad",
                                              "#b8860b", "#0f8b8d", "#c2185b"};

std::string Stroke(std::size_t hue, char const* more = "") {
  return std::string(R"(fill="none" stroke=")") + kHues[hue % kHues.size()] + "\" " + more;
}

std::string Fill(std::size_t hue) {
  return std::string("fill=\"") + kHues[hue % kHues.size()] + "\"";
}

Xy Middle(Polygon const& polygon) {
  Xy sum;
  for (Xy const& p : polygon) sum = {sum.x + p.x, sum.y + p.y};
  auto const count = static_cast<double>(polygon.size());
  return {sum.x / count, sum.y / count};
}

double Area(Polygon const& polygon) {
  double sum = 0.0;
  for (std::size_t i = 0; i < polygon.size(); ++i) {
    Xy const& p = polygon[i];
    Xy const& q = polygon[(i + 1) % polygon.size()];
    sum += p.x * q.y - q.x * p.y;
  }
  return 0.5 * sum;
}

// The part of a polygon to the left of the line from p to q.
Polygon CutByLine(Polygon const& polygon, Xy p, Xy q) {
  auto const side = [&](Xy r) { return (q.x - p.x) * (r.y - p.y) - (q.y - p.y) * (r.x - p.x); };
  Polygon kept;
  for (std::size_t i = 0; i < polygon.size(); ++i) {
    Xy const a = polygon[i];
    Xy const b = polygon[(i + 1) % polygon.size()];
    double const sa = side(a);
    double const sb = side(b);
    if (sa >= 0.0) kept.push_back(a);
    if ((sa > 0.0 && sb < 0.0) || (sa < 0.0 && sb > 0.0)) {
      double const t = sa / (sa - sb);
      kept.push_back({a.x + t * (b.x - a.x), a.y + t * (b.y - a.y)});
    }
  }
  return kept;
}

Polygon CommonPart(Polygon common, Polygon cutter) {
  if (Area(cutter) < 0.0) std::reverse(cutter.begin(), cutter.end());
  for (std::size_t i = 0; i < cutter.size() && !common.empty(); ++i) {
    common = CutByLine(common, cutter[i], cutter[(i + 1) % cutter.size()]);
  }
  return common;
}

struct Fit {
  ErrorCode code = ErrorCode::Failed;
  std::vector<Elem> contour;
  double deviation = 0.0;
  std::int32_t index = -1;
};

Fit FitPoints(std::vector<WPoint> const& points, GeometryUtils::FittingStrategy strategy) {
  Fit fit;
  fit.code = GeometryUtils::CreateFittingCurve(points, strategy, &fit.contour, &fit.deviation,
                                               &fit.index, nullptr, 100);
  return fit;
}

std::vector<WPoint> EdgeAndFillet() {
  constexpr std::array<double, 17> kError = {0.15, -0.2, 0.1,  0.22,  -0.12, -0.2,
                                             0.18, 0.05, -0.2, -0.15, 0.2,   -0.05,
                                             0.18, -0.2, 0.1,  0.2,   -0.1};
  std::vector<WPoint> points;
  for (std::size_t i = 0; i < kError.size(); ++i) {
    double const s = 1.25 * static_cast<double>(i);
    double const edge = 9.0;
    double const radius = 7.0;
    double const turn = std::max(0.0, (s - edge) / radius);
    double const r = radius - kError[i];
    points.push_back(s < edge
                         ? WPoint{s, kError[i], 0.35}
                         : WPoint{edge + r * std::sin(turn), radius - r * std::cos(turn), 0.35});
  }
  return points;
}

bool DrawToleranceBands(std::string const& path) {
  std::vector<WPoint> const points = EdgeAndFillet();
  Fit const fit = FitPoints(points, GeometryUtils::FittingStrategy::Mixed);
  if (fit.code != ErrorCode::Ok) return false;

  Canvas canvas(760, 400);
  Panel const panel(canvas, {20.0, 40.0}, {740.0, 380.0}, {-1.5, -1.4}, {17.85, 7.74});
  panel.Frame("Every point within its own tolerance");
  DrawPoints(panel, points, 3.0);
  DrawContour(panel, fit.contour);
  panel.Label(Position(points[2]), {0.0, -24.0}, "measured point and its tolerance", kCentred);
  panel.Label(Position(fit.contour[1].end), {0.0, 40.0}, "joint", kCentred);
  panel.Label({3.0, -1.0}, {0.0, 0.0}, "segment", R"(fill="#1f6fb4" text-anchor="middle")");
  panel.Label({15.0, 1.6}, {0.0, 0.0}, "arc", "fill=\"#d9730d\"");
  return canvas.Write(path);
}

// The line that a point (u, v) of the parameter plane stands for, from x0 to x1.
Polygon LineOf(Xy parameters, double x0, double x1) {
  auto const y = [&](double x) { return -parameters.y * x - parameters.x; };
  return {{x0, y(x0)}, {x1, y(x1)}};
}

Polygon LineCell(WPoint const& a, WPoint const& b) {
  bool formFixed = true;
  bool xOfY = false;
  Vorn::Point2D<double> corners[4];
  if (GeometryUtils::GetLinePolygon(a, b, &formFixed, &xOfY, corners) != ErrorCode::Ok) return {};
  Polygon cell;
  for (Vorn::Point2D<double> const& corner : corners) cell.push_back({corner.x, corner.y});
  return cell;
}

bool DrawLineCell(std::string const& path) {
  WPoint const a = {-2.5, -0.4, 0.7};
  WPoint const b = {2.5, 0.6, 0.9};
  Polygon const cell = LineCell(a, b);
  double rect[8];
  if (cell.empty() || !GeometryUtils::GetPermissibleRect(a, b, rect)) return false;

  Canvas canvas(820, 400);
  Panel const plane(canvas, {20.0, 40.0}, {450.0, 380.0}, {-4.3, -3.2}, {4.3, 3.6});
  Panel const cells(canvas, {480.0, 40.0}, {800.0, 380.0}, {-1.05, -0.8}, {0.85, 0.4});
  plane.Frame("Points and extreme lines");
  cells.Frame("Line cell: u across, v up");
  DrawPoints(plane, {a, b}, 3.0);
  cells.Lines(cell, true, kCommon);
  plane.BeginClip();
  for (std::size_t i = 0; i < cell.size(); ++i) {
    plane.Lines(LineOf(cell[i], -5.0, 5.0), false, Stroke(i, "stroke-width=\"1.5\""));
  }
  plane.Lines(LineOf(Middle(cell), -5.0, 5.0), false, kChosen);
  plane.EndClip();
  for (std::size_t i = 0; i < 8; i += 2) plane.Dot({rect[i], rect[i + 1]}, 4.0, kJoint);
  for (std::size_t i = 0; i < cell.size(); ++i) cells.Dot(cell[i], 5.0, Fill(i));
  cells.Dot(Middle(cell), 5.0, "fill=\"#1d7a38\"");
  cells.Label(Middle(cell), {9.0, 5.0}, "one line", kNote);
  plane.Label({-4.2, -3.05}, {2.0, 0.0}, "a point (u, v) is the line v x + y + u = 0", kNote);
  return canvas.Write(path);
}

bool DrawLineRun(std::string const& path) {
  constexpr double kTolerance = 0.22;
  std::vector<WPoint> const points = {
      {-3.0, -0.10, kTolerance}, {-2.0, 0.12, kTolerance}, {-1.0, 0.05, kTolerance},
      {0.0, 0.33, kTolerance},   {1.0, 0.34, kTolerance},  {2.0, 0.62, kTolerance},
      {3.0, 1.35, kTolerance},
  };
  Canvas canvas(820, 400);
  Panel const plane(canvas, {20.0, 40.0}, {450.0, 380.0}, {-3.7, -2.05}, {3.7, 3.8});
  Panel const cells(canvas, {480.0, 40.0}, {800.0, 380.0}, {-1.0, -1.3}, {1.7, 0.55});
  plane.Frame("The run stops before point 7");
  cells.Frame("Cells of its pairs of points");
  DrawPoints(plane, points, 3.0);

  cells.BeginClip();
  Polygon common = LineCell(points[0], points[1]);
  for (std::size_t i = 0; i + 2 < points.size(); ++i) {
    Polygon const cell = LineCell(points[i], points[i + 1]);
    cells.Lines(cell, true, kCell);
    common = CommonPart(common, cell);
  }
  Polygon const last = LineCell(points[5], points[6]);
  bool const stops = !common.empty() && CommonPart(common, last).empty();
  cells.Lines(last, true, kStop);
  cells.Lines(common, true, kCommon);
  cells.Dot(Middle(common), 4.0, "fill=\"#1d7a38\"");
  cells.EndClip();

  plane.Lines(LineOf(Middle(common), -3.0, 2.0), false, kChosen);
  for (std::size_t i = 0; i < points.size(); ++i) {
    plane.Label(Position(points[i]), {0.0, -22.0}, std::to_string(i + 1), kCentred);
  }
  plane.Label({-3.5, -1.9}, {0.0, -34.0}, "green: a line of the common part of the cells", kNote);
  plane.Label({-3.5, -1.9}, {0.0, -16.0}, "red: the cell of points 6 and 7 misses it,", kNote);
  plane.Label({-3.5, -1.9}, {0.0, 2.0}, "so the next run starts at point 6", kNote);
  return stops && canvas.Write(path);
}

Polygon CentreCell(WPoint const& a, WPoint const& b, WPoint const& c) {
  int count = 0;
  Vorn::Point2D<double> corners[6];
  if (GeometryUtils::GetCirclePolygon(a, b, c, false, false, 0, &count, corners) != ErrorCode::Ok) {
    return {};
  }
  Polygon cell;
  for (int i = 0; i < count; ++i) cell.push_back({corners[i].x, corners[i].y});
  return cell;
}

WPoint OnCircle(double radius, double degrees, double w) {
  double const angle = degrees * std::acos(-1.0) / 180.0;
  return {radius * std::cos(angle), radius * std::sin(angle), w};
}

// The extreme circles, each through a choice of inner and outer points around the circumcentre,
// here the origin. The order is that of the corners of the cell.
constexpr std::array<std::array<int, 3>, 6> kChoices = {
    {{-1, -1, 1}, {-1, 1, 1}, {-1, 1, -1}, {1, 1, -1}, {1, -1, -1}, {1, -1, 1}}};

bool DrawCircleCell(std::string const& path) {
  constexpr double kRadius = 6.0;
  constexpr double kTolerance = 0.45;
  constexpr std::array<double, 3> kDegrees = {25.0, 85.0, 155.0};
  std::vector<WPoint> points;
  for (double degrees : kDegrees) points.push_back(OnCircle(kRadius, degrees, kTolerance));
  Polygon const cell = CentreCell(points[0], points[1], points[2]);
  if (cell.size() != kChoices.size()) return false;

  Canvas canvas(820, 430);
  Panel const plane(canvas, {20.0, 40.0}, {500.0, 410.0}, {-8.0, -2.9}, {8.0, 9.4333});
  Panel const zoom(canvas, {530.0, 40.0}, {800.0, 410.0}, {-1.7, -2.33}, {1.7, 2.33});
  plane.Frame("Points and extreme circles");
  zoom.Frame("Centre cell, enlarged");
  DrawPoints(plane, points, 3.0);
  plane.Lines(cell, true, kCommon);
  zoom.Lines(cell, true, kCommon);
  plane.BeginClip();
  for (std::size_t i = 0; i < cell.size(); ++i) {
    WPoint const through = OnCircle(kRadius + kChoices[i][0] * kTolerance, kDegrees[0], 0.0);
    double const radius = std::hypot(through.x - cell[i].x, through.y - cell[i].y);
    plane.Lines(ArcPoints(cell[i], radius, 0.1, 2.95), false, Stroke(i));
  }
  plane.EndClip();
  for (std::size_t i = 0; i < cell.size(); ++i) zoom.Dot(cell[i], 5.0, Fill(i));
  for (double degrees : kDegrees) {
    plane.Dot(Position(OnCircle(kRadius - kTolerance, degrees, 0.0)), 3.5, kJoint);
    plane.Dot(Position(OnCircle(kRadius + kTolerance, degrees, 0.0)), 3.5, kJoint);
  }
  plane.Label({0.0, -2.5}, {0.0, 0.0}, "each corner is the centre of the circle of its colour",
              kCentred);
  return canvas.Write(path);
}

// Triples of samples spread over a run as the arc fitter spreads them: each with its mirror image.
std::vector<std::array<std::size_t, 3>> Triples(int size) {
  std::vector<std::array<std::size_t, 3>> triples;
  for (int step = 1; step <= (size - 1) / 2; ++step) {
    bool const early = step < size / 3;
    int const i0 = early ? step : 0;
    int const i1 = early ? (step - 1 + size) / 2 : step;
    auto const add = [&](int a, int b, int c) {
      triples.push_back(
          {static_cast<std::size_t>(a), static_cast<std::size_t>(b), static_cast<std::size_t>(c)});
    };
    add(i0, i1, size - 1);
    add(0, size - 1 - i1, size - 1 - i0);
  }
  return triples;
}

bool DrawArcRun(std::string const& path) {
  constexpr double kRadius = 6.0;
  constexpr double kTolerance = 0.18;
  constexpr std::array<double, 9> kError = {0.07, -0.09, 0.04, 0.09, -0.07, 0.06, -0.09, 0.07, 1.4};
  std::vector<WPoint> points;
  for (std::size_t i = 0; i < kError.size(); ++i) {
    double const degrees = 150.0 - 14.0 * static_cast<double>(i);
    points.push_back(OnCircle(kRadius + kError[i], degrees, kTolerance));
  }
  std::vector<WPoint> const run(points.begin(), points.end() - 1);

  Canvas canvas(820, 430);
  Panel const plane(canvas, {20.0, 40.0}, {500.0, 410.0}, {-7.2, -2.1}, {7.2, 9.0});
  Panel const cells(canvas, {530.0, 40.0}, {800.0, 410.0}, {-0.9, -2.1}, {1.7, 1.463});
  plane.Frame("The arc stops before point 9");
  cells.Frame("Centre cells, enlarged");
  DrawPoints(plane, points, 2.5);

  cells.BeginClip();
  Polygon common;
  for (auto const& triple : Triples(static_cast<int>(run.size()))) {
    Polygon const cell = CentreCell(run[triple[0]], run[triple[1]], run[triple[2]]);
    cells.Lines(cell, true, kCell);
    common = common.empty() ? cell : CommonPart(common, cell);
  }
  Polygon const last = CentreCell(points[1], points[4], points[8]);
  bool const stops = common.size() > 2 && CommonPart(common, last).empty();
  cells.Lines(last, true, kStop);
  cells.Lines(common, true, kCommon);
  cells.EndClip();

  Fit const fit = FitPoints(run, GeometryUtils::FittingStrategy::Mixed);
  if (fit.code != ErrorCode::Ok || fit.contour.size() != 2) return false;
  DrawContour(plane, fit.contour);
  plane.Lines(common, true, kCommon);
  for (std::size_t i = 0; i < points.size(); ++i) {
    WPoint const at = OnCircle(kRadius + 1.0, 150.0 - 14.0 * static_cast<double>(i), 0.0);
    double const lift = i + 1 == points.size() ? 18.0 : 4.0;
    plane.Label(Position(at), {i + 1 == points.size() ? 14.0 : 0.0, lift}, std::to_string(i + 1),
                kCentred);
  }
  plane.Label({1.0, -2.0}, {-8.0, -46.0}, "grey: cells of triples from 1 to 8", kNote);
  plane.Label({1.0, -2.0}, {-8.0, -28.0}, "green: their common part", kNote);
  plane.Label({1.0, -2.0}, {-8.0, -10.0}, "red: the cell of 2, 5 and 9", kNote);
  return stops && canvas.Write(path);
}

// Noise from -0.5 to 0.5 that is the same everywhere.
class Noise {
 public:
  double Next() {
    state_ = state_ * 1664525U + 1013904223U;
    return static_cast<double>(state_ >> 8U) / 16777216.0 - 0.5;
  }

 private:
  std::uint32_t state_ = 12345;
};

// A straight face, a hollow, a straight face, a crown and a straight face.
std::vector<WPoint> Profile() {
  struct Stretch {
    int points;
    double curvature;
  };
  constexpr std::array<Stretch, 5> kStretches = {
      {{16, 0.0}, {10, 0.2}, {10, 0.0}, {14, -0.25}, {8, 0.0}}};
  constexpr double kStep = 0.02;
  constexpr int kStepsPerPoint = 25;
  Noise noise;
  std::vector<WPoint> points;
  Xy at;
  double heading = -0.2;
  for (Stretch const& stretch : kStretches) {
    for (int i = 0; i < stretch.points * kStepsPerPoint; ++i) {
      if (i % kStepsPerPoint == 0) {
        double const error = 0.008 * noise.Next();
        points.push_back(
            {at.x - error * std::sin(heading), at.y + error * std::cos(heading), 0.01});
      }
      heading += kStep * stretch.curvature;
      at = {at.x + kStep * std::cos(heading), at.y + kStep * std::sin(heading)};
    }
  }
  return points;
}

// One bow.
std::vector<WPoint> Bow() {
  Noise noise;
  std::vector<WPoint> points;
  for (int i = 0; i <= 40; ++i) {
    WPoint const p = OnCircle(22.0 + 0.4 * noise.Next(), 120.0 - 1.5 * i, 0.1);
    points.push_back({12.4 + p.x, p.y - 20.0, p.w});
  }
  return points;
}

std::string Summary(Fit const& fit, char const* unit) {
  std::size_t const pieces = fit.contour.size() - 1;
  return std::to_string(pieces) + (pieces == 1 ? " piece" : " pieces") + ", largest deviation " +
         Drawing::Number(fit.deviation) + " " + unit;
}

bool DrawStrategies(std::string const& path) {
  struct Row {
    GeometryUtils::FittingStrategy strategy;
    std::vector<WPoint> points;
    char const* name;
    char const* unit;
  };
  std::array<Row, 3> const rows = {
      {{GeometryUtils::FittingStrategy::Mixed, Profile(), "Mixed", "of the tolerance"},
       {GeometryUtils::FittingStrategy::MixedCells, Profile(), "MixedCells", "of the tolerance"},
       {GeometryUtils::FittingStrategy::SingleArc, Bow(), "SingleArc", "(a plain distance)"}}};
  Canvas canvas(820, 770);
  double top = 40.0;
  for (Row const& row : rows) {
    Fit const fit = FitPoints(row.points, row.strategy);
    if (fit.code != ErrorCode::Ok) return false;
    Panel const panel(canvas, {20.0, top}, {800.0, top + 210.0}, {-1.5, -2.6}, {26.36, 4.9});
    panel.Frame(std::string(row.name) + ": " + Summary(fit, row.unit));
    DrawContour(panel, fit.contour);
    for (WPoint const& p : row.points) panel.Dot(Position(p), 1.6, kPoint);
    top += 250.0;
  }
  return canvas.Write(path);
}

}  // namespace

int main(int argc, char** argv) {
  if (argc != 2) {
    std::fprintf(stderr, "usage: draw_method DIRECTORY\n");
    return 2;
  }
  struct Picture {
    char const* name;
    bool (*draw)(std::string const& path);
  };
  constexpr std::array<Picture, 6> kPictures = {{{"tolerance-bands", DrawToleranceBands},
                                                 {"line-cell", DrawLineCell},
                                                 {"line-run", DrawLineRun},
                                                 {"circle-cell", DrawCircleCell},
                                                 {"arc-run", DrawArcRun},
                                                 {"strategies", DrawStrategies}}};
  for (Picture const& picture : kPictures) {
    if (!picture.draw(std::string(argv[1]) + "/" + picture.name + ".svg")) {
      std::fprintf(stderr, "draw_method: %s failed\n", picture.name);
      return 1;
    }
  }
  return 0;
}
