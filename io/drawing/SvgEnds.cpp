#include "io/drawing/SvgEnds.h"

#include <algorithm>
#include <cmath>
#include <vector>

#include "io/drawing/Feet.h"
#include "io/drawing/Style.h"
#include "io/drawing/SvgElements.h"

namespace Vorn::IO::Svg {

namespace {

Pixel Between(Pixel const& from, Pixel const& to) { return {to.x - from.x, to.y - from.y}; }

/// The first of the pixels that is far enough from the start to show a direction, else the last.
Pixel Ahead(std::vector<Pixel> const& pixels, std::size_t start, double distance) {
  for (std::size_t i = start + 1; i < pixels.size(); ++i) {
    Pixel const step = Between(pixels[start], pixels[i]);
    if (std::hypot(step.x, step.y) >= distance) return pixels[i];
  }
  return pixels.back();
}

std::string StartAndEnd(Pixel const& start, Pixel const& direction, Pixel const& end,
                        bool isClosed) {
  std::string const outline = "stroke=\"" + kTextColor + "\" stroke-width=\"1\"";
  std::string svg;
  if (!isClosed) {
    svg += RectElement({end.x - 0.5 * kEndSize, end.y - 0.5 * kEndSize, kEndSize, kEndSize},
                       "class=\"end\" fill=\"white\" " + outline);
  }
  double const length = std::hypot(direction.x, direction.y);
  if (!(length > 0.0)) return svg;
  Pixel const tip{start.x + kStartSize * direction.x / length,
                  start.y + kStartSize * direction.y / length};
  return svg + ArrowHead(tip, direction, kStartSize,
                         "class=\"start\" fill=\"" + kStartColor + "\" " + outline);
}

}  // namespace

std::string ContourEnds(Scene const& scene) {
  Piece const& first = scene.drawing.pieces.front();
  Piece const& last = scene.drawing.pieces.back();
  double const nearby = std::min(first.length, kStartSize / scene.view.Scale());
  GeometryUtils::Point const ahead = PlaceOn(first, nearby);
  Pixel const start = scene.view(first.start.x, first.start.y);
  return StartAndEnd(start, Between(start, scene.view(ahead.x, ahead.y)),
                     scene.view(last.end.x, last.end.y), scene.drawing.IsClosed());
}

std::string DirectionArrows(Scene const& scene) {
  constexpr std::size_t kArrows = 16;
  constexpr double kArrowLength = 16.0;
  constexpr double kAside = 11.0;
  std::vector<Pixel> const& points = scene.magnified;
  std::string svg = "<g class=\"order\" stroke=\"" + kStartColor + "\" fill=\"" + kStartColor +
                    "\" stroke-width=\"1.1\">\n";
  std::vector<Pixel> drawn;
  std::size_t const step = std::max<std::size_t>(1, points.size() / kArrows);
  for (std::size_t i = step / 2; i + 1 < points.size(); i += step) {
    Pixel const along = Between(points[i], Ahead(points, i, kArrowLength));
    double const length = std::hypot(along.x, along.y);
    if (length < 0.5 * kArrowLength) continue;
    Pixel const unit{along.x / length, along.y / length};
    Pixel const tail{points[i].x - kAside * unit.y, points[i].y + kAside * unit.x};
    Pixel const tip{tail.x + kArrowLength * unit.x, tail.y + kArrowLength * unit.y};
    bool const isCrowded = std::any_of(drawn.begin(), drawn.end(), [&](Pixel const& other) {
      return std::hypot(other.x - tail.x, other.y - tail.y) < 3.0 * kArrowLength;
    });
    if (isCrowded) continue;
    drawn.push_back(tail);
    svg += LineElement(tail, tip, "") + ArrowHead(tip, unit, 6.0, "stroke=\"none\"");
  }
  return svg + "</g>\n";
}

std::string EndsOfPoints(Scene const& scene) {
  std::vector<Pixel> const& points = scene.magnified;
  return StartAndEnd(points.front(), Between(points.front(), Ahead(points, 0, kStartSize)),
                     points.back(), false);
}

std::string ArrowHead(Pixel const& tip, Pixel const& direction, double size,
                      std::string const& attributes) {
  double const length = std::hypot(direction.x, direction.y);
  Pixel const along{size * direction.x / length, size * direction.y / length};
  Pixel const aside{-0.5 * along.y, 0.5 * along.x};
  Pixel const back{tip.x - along.x, tip.y - along.y};
  return PathElement("M" + Px(tip) + "L" + Px(Pixel{back.x + aside.x, back.y + aside.y}) + "L" +
                         Px(Pixel{back.x - aside.x, back.y - aside.y}) + "Z",
                     "stroke-linejoin=\"round\" " + attributes);
}

}  // namespace Vorn::IO::Svg
