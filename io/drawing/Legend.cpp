#include "io/drawing/Legend.h"

#include "io/drawing/Style.h"
#include "io/drawing/SvgElements.h"
#include "io/drawing/SvgEnds.h"
#include "io/drawing/SvgPieces.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO::Svg {

namespace {

/// Entries side by side, each a mark and its words.
class Legend {
 public:
  explicit Legend(Pixel const& at) : at_(at) {}

  void AddStroke(std::string const& attributes, double width, std::string const& words) {
    svg_ += LineElement({at_.x, at_.y - 4.0}, {at_.x + 24.0, at_.y - 4.0},
                        "stroke-width=\"" + Px(width) + "\" " + attributes);
    AddWords(29.0, words);
  }

  void AddCircle(double radius, std::string const& attributes, std::string const& words) {
    svg_ += CircleElement({at_.x + 7.0, at_.y - 4.0}, radius, attributes);
    AddWords(18.0, words);
  }

  void AddShape(std::string const& data, std::string const& attributes, std::string const& words) {
    svg_ += "<g transform=\"translate(" + Px(Pixel{at_.x + 7.0, at_.y - 4.0}) + ")\">" +
            PathElement(data, attributes) + "</g>\n";
    AddWords(18.0, words);
  }

  std::string const& Svg() const { return svg_; }

 private:
  void AddWords(double indent, std::string const& words) {
    constexpr double kLetter = 6.1;
    constexpr double kGap = 15.0;
    svg_ += Text({at_.x + indent, at_.y}, "", words);
    at_.x += indent + kLetter * static_cast<double>(words.size()) + kGap;
  }

  Pixel at_;
  std::string svg_;
};

std::string Times(Scene const& scene) {
  return scene.magnify == 1.0 ? "" : " \xC3\x97" + FormatShort(scene.magnify);
}

bool AreLabelsSized(Scene const& scene) { return scene.drawing.pieces.size() <= kMostSizedLabels; }

std::string const kOutline = "stroke=\"" + kTextColor + "\" stroke-width=\"1\"";

void AddContourEntries(Scene const& scene, Legend* legend) {
  std::size_t const arcs = scene.drawing.ArcCount();
  if (arcs < scene.drawing.pieces.size()) {
    legend->AddStroke("stroke=\"" + kLineColor + "\"", 2.0,
                      AreLabelsSized(scene) ? "line: length" : "line");
  }
  if (arcs > 0) {
    legend->AddStroke("stroke=\"" + kArcColor + "\" " + kArcDashes, 2.0,
                      AreLabelsSized(scene) ? "arc: radius R" : "arc");
  }
  if (scene.drawing.pieces.size() > 1) {
    legend->AddCircle(3.4, "fill=\"white\" " + kOutline, "joint");
  }
}

void AddEnds(bool isClosed, Legend* legend) {
  legend->AddShape("M6,0L-5,5.5L-5-5.5Z", "fill=\"" + kStartColor + "\" " + kOutline,
                   isClosed ? "start and end" : "start");
  if (!isClosed) {
    legend->AddShape("M-3.5-3.5h7v7h-7z", "fill=\"white\" " + kOutline, "end");
  }
}

void AddPoints(Scene const& scene, Legend* legend) {
  if (scene.drawing.points.empty()) return;
  legend->AddCircle(2.0, "fill=\"" + kPointColor + "\"",
                    scene.HasContour() ? "point, deviation" + Times(scene) : "measured point");
  if (!scene.HasContour()) {
    legend->AddShape("M-7,0H1M7,0L1,3L1-3Z",
                     "fill=\"" + kStartColor + "\" stroke=\"" + kStartColor + "\"", "order");
  }
  if (scene.AnyOutside()) {
    legend->AddShape("M-3-3l6,6m0-6l-6,6",
                     "fill=\"none\" stroke=\"" + kOutsideColor + "\" stroke-width=\"1.1\"",
                     "outside tolerance");
  }
  if (scene.HasContour()) {
    legend->AddCircle(5.5, "fill=\"none\" stroke=\"" + kWorstColor + "\" stroke-width=\"1.7\"",
                      "largest deviation");
  }
}

void AddTolerance(Scene const& scene, Legend* legend) {
  if (!scene.drawing.HasTolerances()) return;
  legend->AddShape("M-7-5h14v10h-14z",
                   "fill=\"" + kBandColor + "\" stroke=\"" + kBandEdgeColor + "\"",
                   scene.IsBandVisible() ? "tolerance" + Times(scene)
                                         : "tolerance (on the contour: too thin to show)");
}

/// A round length, as long as it is on the page.
std::string ScaleBar(Scene const& scene, double y) {
  constexpr double kLeastBar = 60.0;
  double const length = NiceStep(kLeastBar / scene.view.Scale());
  Pixel const right{scene.view.Frame().Right(), y - 1.0};
  Pixel const left{right.x - length * scene.view.Scale(), right.y};
  std::string const& units = scene.drawing.units;
  std::string const stroke = "stroke=\"" + kTextColor + "\" stroke-width=\"1.4\"";
  return PathElement("M" + Px(Pixel{left.x, left.y - 4.0}) + "v8m0-4H" + Px(right.x) + "m0-4v8",
                     "fill=\"none\" " + stroke) +
         Text({0.5 * (left.x + right.x), y - 8.0}, "text-anchor=\"middle\"",
              FormatShort(length, 3) + (units.empty() ? "" : " " + units));
}

}  // namespace

std::string LegendRow(Scene const& scene, double y) {
  Legend legend({scene.view.Frame().left, y});
  if (scene.HasContour()) AddContourEntries(scene, &legend);
  AddEnds(scene.drawing.IsClosed(), &legend);
  AddPoints(scene, &legend);
  AddTolerance(scene, &legend);
  return "<g id=\"legend\" font-size=\"11\">\n" + legend.Svg() +
         ScaleBar(scene, scene.view.Frame().top - 7.0) + "</g>\n";
}

}  // namespace Vorn::IO::Svg
