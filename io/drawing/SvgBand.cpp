#include "io/drawing/SvgBand.h"

#include <algorithm>
#include <cmath>
#include <map>
#include <optional>

#include "io/drawing/Band.h"
#include "io/drawing/Decimation.h"
#include "io/drawing/Style.h"
#include "io/drawing/SvgElements.h"
#include "io/drawing/SvgPaths.h"

namespace Vorn::IO::Svg {

namespace {

/// Bands of a tolerance that differ by less than this many pixels are drawn alike.
constexpr double kBandStep = 0.5;
constexpr double kLeastBandSection = 0.5;
constexpr double kDiscCell = 0.5;

/// Path data of the band for each width on the page, in steps.
std::map<int, std::string> BandPaths(Scene const& scene) {
  View const& view = scene.view;
  std::map<int, std::string> paths;
  std::optional<int> drawn;
  std::string pen;
  for (BandSection const& section :
       BandSections(scene.drawing, scene.feet, kLeastBandSection / view.Scale())) {
    double const width = 2.0 * scene.magnify * section.tolerance * view.Scale();
    int const step = std::max(1, static_cast<int>(std::lround(width / kBandStep)));
    std::string& data = paths[step];
    Piece const& piece = scene.drawing.pieces[section.piece];
    GeometryUtils::Point const start =
        section.from == 0.0 ? piece.start : PlaceOn(piece, section.from);
    std::string const at = Px(view(start.x, start.y));
    if (drawn != step || at != pen) data += "M" + at;
    data += StretchData(piece, section.from, section.to, view);
    drawn = step;
    GeometryUtils::Point const end =
        section.to == piece.length ? piece.end : PlaceOn(piece, section.to);
    pen = Px(view(end.x, end.y));
  }
  return paths;
}

std::string BandAlongContour(Scene const& scene) {
  std::map<int, std::string> paths = BandPaths(scene);
  if (scene.drawing.IsToleranceUniform()) {
    // One path is closed where the contour is, and its width need not be rounded.
    paths = {{1, PathData(scene.drawing.pieces, scene.view)}};
    if (scene.drawing.IsClosed()) paths[1] += "Z";
  }
  double const uniform =
      2.0 * scene.magnify * scene.drawing.LargestTolerance() * scene.view.Scale();
  auto const strokes = [&](double extra, std::string const& color) {
    std::string svg =
        "<g class=\"band\" fill=\"none\" stroke=\"" + color + "\" stroke-linejoin=\"round\">\n";
    for (auto const& [step, data] : paths) {
      double const width = scene.drawing.IsToleranceUniform() ? uniform : kBandStep * step;
      svg += PathElement(data, "stroke-width=\"" + Px(width + extra) + "\"");
    }
    return svg + "</g>\n";
  };
  return strokes(1.2, kBandEdgeColor) + strokes(0.0, kBandColor);
}

std::string ToleranceDiscs(Scene const& scene) {
  std::vector<std::size_t> const kept = OnePerCell(scene.magnified, kDiscCell);
  auto const discs = [&](double extra, std::string const& color) {
    std::string svg = "<g class=\"band\" fill=\"" + color + "\">\n";
    for (std::size_t const i : kept) {
      double const radius = scene.drawing.points[i].w * scene.view.Scale();
      svg += CircleElement(scene.magnified[i], radius + extra, "");
    }
    return svg + "</g>\n";
  };
  return discs(0.6, kBandEdgeColor) + discs(0.0, kBandColor);
}

}  // namespace

std::string ToleranceBand(Scene const& scene) {
  if (!scene.IsBandVisible()) return "";
  return scene.HasContour() ? BandAlongContour(scene) : ToleranceDiscs(scene);
}

}  // namespace Vorn::IO::Svg
