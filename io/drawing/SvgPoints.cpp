#include "io/drawing/SvgPoints.h"

#include <algorithm>
#include <cmath>

#include "io/drawing/Decimation.h"
#include "io/drawing/Style.h"
#include "io/drawing/SvgElements.h"

namespace Vorn::IO::Svg {

namespace {

constexpr double kWhiskerCell = 1.5;
constexpr double kLeastWhisker = 1.5;

/// Dots that stay apart where there is room and never vanish.
double DotDiameter(std::vector<Pixel> const& dots) {
  std::vector<double> gaps;
  for (std::size_t i = 1; i < dots.size(); ++i) {
    gaps.push_back(std::hypot(dots[i].x - dots[i - 1].x, dots[i].y - dots[i - 1].y));
  }
  if (gaps.empty()) return 4.0;
  auto const middle = gaps.begin() + static_cast<std::ptrdiff_t>(gaps.size() / 2);
  std::nth_element(gaps.begin(), middle, gaps.end());
  return std::clamp(0.7 * *middle, 2.0, 4.0);
}

}  // namespace

std::string Whiskers(Scene const& scene) {
  std::vector<std::size_t> order;
  auto const lengthOf = [&](std::size_t i) {
    Pixel const& foot = scene.feetAt[i];
    return std::hypot(scene.magnified[i].x - foot.x, scene.magnified[i].y - foot.y);
  };
  for (std::size_t i = 0; i < scene.feetAt.size(); ++i) {
    if (lengthOf(i) >= kLeastWhisker) order.push_back(i);
  }
  std::stable_sort(order.begin(), order.end(),
                   [&](std::size_t a, std::size_t b) { return lengthOf(a) > lengthOf(b); });
  std::string data;
  for (bool const isLeft : {true, false}) {
    std::vector<Pixel> feet;
    std::vector<std::size_t> points;
    for (std::size_t const i : order) {
      if (scene.drawing.deviations[i].isLeft != isLeft) continue;
      feet.push_back(scene.feetAt[i]);
      points.push_back(i);
    }
    for (std::size_t const kept : OnePerCell(feet, kWhiskerCell)) {
      data += "M" + Px(feet[kept]) + "L" + Px(scene.magnified[points[kept]]);
    }
  }
  return PathElement(data, "class=\"whiskers\" fill=\"none\" stroke=\"" + kWhiskerColor +
                               "\" stroke-width=\"0.5\"");
}

std::string MeasuredPoints(Scene const& scene) {
  std::vector<Pixel> onLines;
  std::vector<Pixel> onArcs;
  for (std::size_t i = 0; i < scene.magnified.size(); ++i) {
    if (scene.IsOutside(i)) continue;
    (scene.IsOnArc(i) ? onArcs : onLines).push_back(scene.magnified[i]);
  }
  double const diameter = DotDiameter(scene.magnified);
  return Dots(onLines, {"points", kPointColor, diameter}) +
         Dots(onArcs, {"points arcs", kPointColor, 0.86 * diameter, true});
}

std::string OutsidePoints(Scene const& scene) {
  std::vector<Pixel> outside;
  for (std::size_t i = 0; i < scene.magnified.size(); ++i) {
    if (scene.IsOutside(i)) outside.push_back(scene.magnified[i]);
  }
  std::string data;
  for (std::size_t const i : OnePerCell(outside, 1.0)) {
    data += "M" + Px(Pixel{outside[i].x - 3.0, outside[i].y - 3.0}) + "l6,6m0-6l-6,6";
  }
  return PathElement(data, "class=\"outside\" fill=\"none\" stroke=\"" + kOutsideColor +
                               "\" stroke-width=\"1.1\"");
}

std::string WorstPoint(Scene const& scene) {
  if (!scene.IsMeasured()) return "";
  return CircleElement(
      scene.magnified[scene.drawing.Worst()], kWorstRadius,
      "class=\"worst\" fill=\"none\" stroke=\"" + kWorstColor + "\" stroke-width=\"1.7\"");
}

}  // namespace Vorn::IO::Svg
