#include "cli/Svg.h"

#include <filesystem>

#include "cli/Numbers.h"
#include "cli/SvgContour.h"
#include "cli/SvgDeviation.h"
#include "cli/SvgLayout.h"
#include "cli/SvgStyle.h"

namespace Vorn::Cli {

namespace {

using namespace Svg;

constexpr double kPageWidth = 1200.0;
constexpr double kLeft = 84.0;
constexpr double kRight = 24.0;
constexpr double kContourTop = 78.0;
constexpr double kLeastContourHeight = 240.0;
constexpr double kMostContourHeight = 680.0;
constexpr double kLegendDrop = 42.0;
constexpr double kDeviationDrop = 66.0;
constexpr double kDeviationHeight = 170.0;
constexpr double kBottom = 44.0;

constexpr char const* kStyle =
    "<style>text { font-family: 'DejaVu Sans', Verdana, Arial, sans-serif; } "
    ".halo { paint-order: stroke; stroke: white; stroke-width: 3px; stroke-linejoin: round; "
    "}</style>\n";

std::string Title(Report const& report) {
  std::string const name = std::filesystem::path(report.file.path).filename().string();
  std::string const units = report.file.units.empty() ? "" : " " + report.file.units;
  std::string tolerance = FormatShort(report.SmallestTolerance());
  if (report.SmallestTolerance() != report.LargestTolerance()) {
    tolerance += " to " + FormatShort(report.LargestTolerance());
  }
  std::string const facts = Counted(report.file.points.size(), "point") + ", " +
                            Counted(report.LineCount(), "line") + " and " +
                            Counted(report.ArcCount(), "arc") + ", tolerance " + tolerance + units +
                            ", strategy " + NameOf(report.strategy);
  PointDeviation const& worst = report.remeasured.Worst();
  std::string const verdict = Describe(report.verdict) + ": largest deviation " +
                              FormatShort(worst.relative, 4) + " of the tolerance (" +
                              FormatShort(worst.distance, 4) + units + ")";
  std::string const color = report.verdict == Verdict::WithinTolerance ? kStartColor : kWorstColor;
  return Text({kLeft, 30.0}, "font-size=\"18\" font-weight=\"bold\"", name) +
         Text({kLeft, 50.0}, "font-size=\"12.5\"", facts) +
         Text({kLeft, 68.0}, "font-size=\"12.5\" fill=\"" + color + "\"", verdict);
}

/// Entries side by side, each a mark and its words.
class Legend {
 public:
  explicit Legend(double y) : at_{kLeft, y} {}

  void AddStroke(std::string const& color, double width, std::string const& words) {
    svg_ += LineElement({at_.x, at_.y - 4.0}, {at_.x + 26.0, at_.y - 4.0},
                        "stroke=\"" + color + "\" stroke-width=\"" + Px(width) + "\"");
    AddWords(32.0, words);
  }

  void AddMark(double radius, std::string const& attributes, std::string const& words) {
    svg_ += CircleElement({at_.x + 7.0, at_.y - 4.0}, radius, attributes);
    AddWords(19.0, words);
  }

  std::string const& Svg() const { return svg_; }

 private:
  void AddWords(double indent, std::string const& words) {
    constexpr double kLetter = 6.6;
    constexpr double kGap = 22.0;
    svg_ += Text({at_.x + indent, at_.y}, "font-size=\"11.5\"", words);
    at_.x += indent + kLetter * static_cast<double>(words.size()) + kGap;
  }

  Pixel at_;
  std::string svg_;
};

std::string LegendRow(Report const& report, View const& view) {
  Legend legend(view.Frame().Bottom() + kLegendDrop);
  std::string const outline = "stroke=\"" + kTextColor + "\" stroke-width=\"1.2\"";
  legend.AddStroke(kLineColor, 2.4, "line: length");
  legend.AddStroke(kArcColor, 2.4, "arc: radius R");
  legend.AddMark(3.6, "fill=\"white\" " + outline, "joint");
  legend.AddMark(4.2, "fill=\"" + kStartColor + "\" " + outline, "start");
  legend.AddMark(2.2, "fill=\"" + kPointColor + "\"", "measured point");
  legend.AddMark(6.0, "fill=\"none\" stroke=\"" + kWorstColor + "\" stroke-width=\"1.6\"",
                 "largest deviation");
  legend.AddStroke(kBandColor, 9.0,
                   IsBandVisible(report, view) ? "tolerance, true to scale"
                                               : "tolerance (above: too thin to show)");
  return legend.Svg();
}

}  // namespace

std::string ToSvg(Report const& report) {
  View const view(BoxAround(report), kLeft, kContourTop, kPageWidth - kLeft - kRight,
                  kLeastContourHeight, kMostContourHeight);
  Rect const deviation{kLeft, view.Frame().Bottom() + kDeviationDrop, view.Frame().width,
                       kDeviationHeight};
  std::string const width = Px(kPageWidth);
  std::string const height = Px(deviation.Bottom() + kBottom);
  return "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
         "<svg xmlns=\"http://www.w3.org/2000/svg\" width=\"" +
         width + "\" height=\"" + height + "\" viewBox=\"0 0 " + width + " " + height + "\">\n" +
         kStyle + "<rect width=\"100%\" height=\"100%\" fill=\"#f8f9fa\"/>\n<g fill=\"" +
         kTextColor + "\">\n" + Title(report) + ContourPlot(report, view) +
         LegendRow(report, view) + DeviationPlot(report, deviation) + "</g>\n</svg>\n";
}

}  // namespace Vorn::Cli
