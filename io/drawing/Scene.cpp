#include "io/drawing/Scene.h"

#include <utility>

#include "vorn/io/FitReport.h"

namespace Vorn::IO::Svg {

namespace {

constexpr double kLeastVisibleBand = 1.0;

View ViewOf(Box const& box, Rect const& least, double mostHeight) {
  return {box, least.left, least.top, least.width, least.height, mostHeight};
}

std::vector<GeometryUtils::Point> MagnifiedPoints(Drawing const& drawing,
                                                  std::vector<Foot> const& feet, double times) {
  std::vector<GeometryUtils::Point> magnified;
  magnified.reserve(drawing.points.size());
  for (std::size_t i = 0; i < drawing.points.size(); ++i) {
    WPoint const& point = drawing.points[i];
    magnified.push_back(feet.empty() ? GeometryUtils::Point{point.x, point.y}
                                     : Magnified(point, feet[i], times));
  }
  return magnified;
}

}  // namespace

bool Scene::IsBandVisible() const {
  return drawing.HasTolerances() &&
         2.0 * magnify * drawing.LargestTolerance() * view.Scale() >= kLeastVisibleBand;
}

bool Scene::IsOutside(std::size_t point) const {
  return HasContour() && drawing.points[point].w > 0.0 &&
         !(drawing.deviations[point].relative <= kLargestRelative);
}

bool Scene::IsOnArc(std::size_t point) const {
  return HasContour() && drawing.pieces[drawing.deviations[point].piece].IsArc();
}

bool Scene::AnyOutside() const {
  for (std::size_t i = 0; i < drawing.points.size(); ++i) {
    if (IsOutside(i)) return true;
  }
  return false;
}

Scene MakeScene(Drawing const& drawing, Rect const& least, double mostHeight) {
  // The magnification follows from the scale, and what it moves outward asks for room in turn.
  View const first = ViewOf(BoxAround(drawing), least, mostHeight);
  double const magnify =
      drawing.IsMeasured() ? drawing.magnify.value_or(ReadableMagnification(drawing, first.Scale()))
                           : 1.0;
  std::vector<Foot> feet = FeetOf(drawing);
  std::vector<GeometryUtils::Point> const points = MagnifiedPoints(drawing, feet, magnify);
  Scene scene{drawing, ViewOf(BoxAround(drawing, points), least, mostHeight),
              magnify, std::move(feet),
              {},      {}};
  for (Foot const& foot : scene.feet) scene.feetAt.push_back(scene.view(foot.at.x, foot.at.y));
  for (GeometryUtils::Point const& point : points) {
    scene.magnified.push_back(scene.view(point.x, point.y));
  }
  return scene;
}

}  // namespace Vorn::IO::Svg
