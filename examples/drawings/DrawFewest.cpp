// Makes the drawings of docs/method.md that show how the fewest pieces are found.
//
// usage: draw_fewest DIRECTORY

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <limits>
#include <string>
#include <vector>

#include "Shapes.h"
#include "Svg.h"
#include "vorn/FewestPieces.h"

using Drawing::Canvas;
using Drawing::Panel;
using Drawing::Xy;
using namespace Drawing::Shapes;
using Vorn::ErrorCode;
using Vorn::FewestPieces;

namespace {

constexpr char kFaint[] = R"(fill="none" stroke="#1f6fb4" stroke-opacity="0.35")";
constexpr char kGate[] =
    R"(fill="none" stroke="#8a95a1" stroke-width="1.5" stroke-dasharray="5 4")";
constexpr char kReach[] = R"(fill="none" stroke="#2a9d4a" stroke-width="7" stroke-opacity="0.8")";
constexpr char kNarrow[] = R"(fill="none" stroke="#d9730d" stroke-width="5")";

struct Circle {
  Xy centre;
  double radius = 0.0;
};

/// The place at an angle and a distance from the origin.
Xy Polar(double radius, double degrees) {
  double const angle = degrees * std::acos(-1.0) / 180.0;
  return {radius * std::cos(angle), radius * std::sin(angle)};
}

Circle Through(Xy a, Xy b, Xy c) {
  Xy const u = {b.x - a.x, b.y - a.y};
  Xy const v = {c.x - a.x, c.y - a.y};
  double const twice = 2.0 * (u.x * v.y - u.y * v.x);
  double const u2 = u.x * u.x + u.y * u.y;
  double const v2 = v.x * v.x + v.y * v.y;
  Xy const arm = {(v.y * u2 - u.y * v2) / twice, (u.x * v2 - v.x * u2) / twice};
  return {{a.x + arm.x, a.y + arm.y}, std::hypot(arm.x, arm.y)};
}

/// Points near an arc about the origin, from left to right.
struct Bow {
  double radius;
  double firstDegrees;
  double stepDegrees;
  double tolerance;

  Xy At(double index, double offset) const {
    return Polar(radius + offset, firstDegrees + index * stepDegrees);
  }
  WPoint Point(double index, double offset) const {
    Xy const at = At(index, offset);
    return {at.x, at.y, tolerance};
  }
};

bool Covers(Circle const& circle, std::vector<WPoint> const& points, std::size_t first,
            std::size_t last) {
  for (std::size_t i = first; i <= last; ++i) {
    double const distance =
        std::hypot(points[i].x - circle.centre.x, points[i].y - circle.centre.y);
    if (std::fabs(distance - circle.radius) > points[i].w) return false;
  }
  return true;
}

/// Circles that pass the points first to last, found by trying offsets of the first, the middle
/// and the last of them.
std::vector<Circle> CirclesOver(Bow const& bow, std::vector<double> const& offsets,
                                std::vector<WPoint> const& points, std::size_t first,
                                std::size_t last) {
  constexpr int kSteps = 12;
  std::size_t const middle = (first + last) / 2;
  auto const moved = [&](std::size_t i, int step) {
    return bow.At(static_cast<double>(i), offsets[i] + bow.tolerance * step / kSteps);
  };
  std::vector<Circle> circles;
  for (int a = -kSteps; a <= kSteps; ++a) {
    for (int b = -kSteps; b <= kSteps; ++b) {
      for (int c = -kSteps; c <= kSteps; ++c) {
        Circle const circle = Through(moved(first, a), moved(middle, b), moved(last, c));
        if (Covers(circle, points, first, last)) circles.push_back(circle);
      }
    }
  }
  return circles;
}

/// The part of an arc that lies above the points.
void DrawCircle(Panel const& panel, Circle const& circle, char const* style) {
  panel.Lines(ArcPoints(circle.centre, circle.radius, 0.5, 2.2), false, style);
}

std::vector<WPoint> PointsOf(Bow const& bow, std::vector<double> const& offsets) {
  std::vector<WPoint> points;
  for (std::size_t i = 0; i < offsets.size(); ++i) {
    points.push_back(bow.Point(static_cast<double>(i), offsets[i]));
  }
  return points;
}

/// A stretch of offsets along a gate.
struct Interval {
  double low = std::numeric_limits<double>::infinity();
  double high = -std::numeric_limits<double>::infinity();

  bool Holds(double offset) const { return low <= offset && offset <= high; }
  void Add(double offset) {
    low = std::min(low, offset);
    high = std::max(high, offset);
  }
};

/// Where a circle crosses the ray from the origin at this place of the bow: the offset from its
/// radius. The circles are much the same as that of the bow, so there is one crossing near it.
double CrossingAt(Bow const& bow, double index, Circle const& circle) {
  Xy const ray = Polar(1.0, bow.firstDegrees + index * bow.stepDegrees);
  double const along = ray.x * circle.centre.x + ray.y * circle.centre.y;
  double const aside = ray.x * circle.centre.y - ray.y * circle.centre.x;
  return along + std::sqrt(circle.radius * circle.radius - aside * aside) - bow.radius;
}

bool DrawRun(std::string const& path) {
  Bow const bow = {7.0, 150.0, -12.0, 0.3};
  std::vector<double> const offsets = {0.1, -0.15, 0.2, -0.1, 0.15, -0.2, 0.05, -0.1, -1.3};
  std::vector<WPoint> const points = PointsOf(bow, offsets);
  std::vector<Circle> const circles = CirclesOver(bow, offsets, points, 0, 7);
  if (circles.size() < 20) return false;
  bool const isLongest = std::none_of(circles.begin(), circles.end(), [&](Circle const& circle) {
    return Covers(circle, points, 0, 8);
  });

  Canvas canvas(820, 430);
  Panel const panel(canvas, {20.0, 40.0}, {800.0, 410.0}, {-7.6, 2.0}, {7.6, 9.21});
  panel.Frame("Circles that pass points 1 to 8; none of them passes point 9");
  DrawPoints(panel, points, 3.0);
  panel.BeginClip();
  std::size_t const every = circles.size() / 20;
  for (std::size_t i = 0; i < circles.size(); i += every) DrawCircle(panel, circles[i], kFaint);
  panel.EndClip();
  for (std::size_t i = 0; i < points.size(); ++i) {
    panel.Label(bow.At(static_cast<double>(i), 0.95), {0.0, 4.0}, std::to_string(i + 1), kCentred);
  }
  return isLongest && canvas.Write(path);
}

void DrawGate(Panel const& panel, Bow const& bow, double index) {
  panel.Lines({bow.At(index, -0.9), bow.At(index, 0.9)}, false, kGate);
}

void DrawInterval(Panel const& panel, Bow const& bow, double index, Interval const& interval,
                  char const* style) {
  panel.Lines({bow.At(index, interval.low), bow.At(index, interval.high)}, false, style);
}

bool DrawGates(std::string const& path) {
  Bow const bow = {7.0, 155.0, -10.0, 0.3};
  std::vector<double> const offsets = {-0.1, 0.1, 0.15, 0.25, 0.3,  0.35, -0.15,
                                       0.15, 0.2, 0.15, 0.0,  -0.2, -0.5};
  std::vector<WPoint> const points = PointsOf(bow, offsets);
  constexpr double kFirstGate = 5.5;
  constexpr double kSecondGate = 11.5;
  std::vector<Circle> const before = CirclesOver(bow, offsets, points, 0, 5);
  std::vector<Circle> const after = CirclesOver(bow, offsets, points, 6, 11);
  Interval reached;
  for (Circle const& circle : before) reached.Add(CrossingAt(bow, kFirstGate, circle));
  Interval alone;
  Interval joined;
  std::vector<Circle> linked;
  for (Circle const& circle : after) {
    double const offset = CrossingAt(bow, kSecondGate, circle);
    alone.Add(offset);
    if (!reached.Holds(CrossingAt(bow, kFirstGate, circle))) continue;
    joined.Add(offset);
    linked.push_back(circle);
  }
  if (before.empty() || linked.empty() || !(joined.high < alone.high || joined.low > alone.low)) {
    return false;
  }

  Canvas canvas(820, 470);
  Panel const panel(canvas, {20.0, 40.0}, {800.0, 450.0}, {-7.6, 1.6}, {7.6, 9.59});
  panel.Frame("Two gates and the intervals that one piece and two pieces reach");
  DrawPoints(panel, points, 3.0);
  panel.BeginClip();
  for (double const gate : {kFirstGate, kSecondGate}) DrawGate(panel, bow, gate);
  DrawInterval(panel, bow, kFirstGate, reached, kReach);
  DrawInterval(panel, bow, kSecondGate, alone, kReach);
  DrawInterval(panel, bow, kSecondGate, joined, kNarrow);
  panel.EndClip();
  panel.Label(bow.At(kFirstGate, 1.1), {0.0, 0.0}, "first gate", kCentred);
  panel.Label(bow.At(kSecondGate, 1.3), {0.0, 0.0}, "second gate", kCentred);
  panel.Label({-4.5, 2.2}, {0.0, -18.0}, "green: what one piece reaches by itself", kNote);
  panel.Label({-4.5, 2.2}, {0.0, 0.0},
              "orange: what a second piece reaches that begins in the interval of the first gate",
              kNote);
  return canvas.Write(path);
}

/// A straight face, a fillet and a straight face with noise of half the tolerance.
std::vector<WPoint> FaceFilletFace() {
  constexpr std::array<double, 13> kError = {0.12,  -0.15, 0.1,   0.15, -0.12, -0.14, 0.15,
                                             -0.02, -0.13, -0.15, 0.14, -0.05, 0.13};
  constexpr double kFace = 10.0;
  constexpr double kRadius = 5.0;
  double const quarter = 0.5 * std::acos(-1.0) * kRadius;
  std::vector<WPoint> points;
  for (int i = 0; i * 0.7 < 2.0 * kFace + quarter; ++i) {
    double const s = 0.7 * i;
    double const turn = std::clamp((s - kFace) / kRadius, 0.0, quarter / kRadius);
    double const before = std::min(s, kFace);
    double const after = std::max(0.0, s - kFace - quarter);
    double const r = kRadius - kError[static_cast<std::size_t>(i) % kError.size()];
    points.push_back({before + r * std::sin(turn), kRadius - r * std::cos(turn) + after, 0.3});
  }
  return points;
}

std::string Counts(FewestPieces::Result const& result) {
  std::size_t arcs = 0;
  for (GeometryUtils::Elem const& elem : result.contour) {
    if (elem.type == GeometryUtils::ElemType::Arc) ++arcs;
  }
  return std::to_string(result.ranges.size() - arcs) + " segments, " + std::to_string(arcs) +
         (arcs == 1 ? " arc" : " arcs") + ", largest " + Drawing::Number(result.largestDeviation) +
         " w";
}

bool DrawCentring(std::string const& path) {
  std::vector<WPoint> const points = FaceFilletFace();
  Canvas canvas(820, 470);
  double left = 20.0;
  for (bool const centre : {false, true}) {
    FewestPieces::Options options;
    options.centre = centre;
    FewestPieces::Result result;
    if (FewestPieces::Fit(points, options, &result, nullptr, 100) != ErrorCode::Ok) return false;
    Panel const panel(canvas, {left, 60.0}, {left + 380.0, 450.0}, {-1.0, -1.3}, {16.4, 16.56});
    panel.Frame((centre ? "Centred: " : "As found: ") + Counts(result));
    DrawPoints(panel, points, 2.0);
    DrawContour(panel, result.contour);
    left += 400.0;
  }
  return canvas.Write(path);
}

}  // namespace

int main(int argc, char** argv) {
  if (argc != 2) {
    std::fprintf(stderr, "usage: draw_fewest DIRECTORY\n");
    return 2;
  }
  struct Picture {
    char const* name;
    bool (*draw)(std::string const& path);
  };
  constexpr std::array<Picture, 3> kPictures = {
      {{"fewest-run", DrawRun}, {"fewest-gates", DrawGates}, {"fewest-centring", DrawCentring}}};
  for (Picture const& picture : kPictures) {
    if (!picture.draw(std::string(argv[1]) + "/" + picture.name + ".svg")) {
      std::fprintf(stderr, "draw_fewest: %s failed\n", picture.name);
      return 1;
    }
  }
  return 0;
}
