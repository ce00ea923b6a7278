#include "cli/SvgContour.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "cli/Numbers.h"
#include "cli/SvgStyle.h"

namespace Vorn::Cli::Svg {

namespace {

using std::numbers::pi;

constexpr double kLeastGrid = 90.0;
constexpr double kContourWidth = 1.8;
constexpr double kLeastVisibleBand = 1.0;
constexpr double kTickText = 11.0;

/// Arcs are written in parts of at most this sweep, in radians: one part of more than half a turn
/// is ambiguous, and one of nearly a whole turn loses its centre to rounding.
constexpr double kLargestArcPart = 0.5 * pi;

/// An arc that bulges less than this many pixels is written as a line; its radius in pixels may
/// be beyond what viewers handle.
constexpr double kFlatArc = 0.02;

constexpr std::size_t kMostLabels = 40;
constexpr double kLabelDistance = 15.0;
constexpr double kLabelHeight = 13.0;
constexpr double kLetterWidth = 6.3;

std::string ArcData(Piece const& arc, View const& view) {
  double const radius = arc.radius * view.Scale();
  int const parts = std::max(1, static_cast<int>(std::ceil(arc.sweep / kLargestArcPart)));
  double const bulge = radius * (1.0 - std::cos(0.5 * arc.sweep / parts));
  std::string data;
  for (int i = 1; i <= parts; ++i) {
    GeometryUtils::Point const to = i == parts ? arc.end : PointOnArc(arc, arc.sweep * i / parts);
    std::string const target = Px(view(to.x, to.y));
    if (bulge < kFlatArc) {
      data += "L" + target;
    } else {
      // With y turned over by the view, counter-clockwise is SVG's negative sense.
      std::string const sense = arc.counterClockwise ? "0" : "1";
      data += "A" + Px(radius) + "," + Px(radius) + " 0 0 " + sense + " " + target;
    }
  }
  return data;
}

std::string PieceData(Piece const& piece, View const& view) {
  return piece.IsArc() ? ArcData(piece, view) : "L" + Px(view(piece.end.x, piece.end.y));
}

bool IsToleranceUniform(Report const& report) {
  return report.SmallestTolerance() == report.LargestTolerance();
}

std::string Grid(View const& view) {
  Rect const& frame = view.Frame();
  Box const box = view.Visible();
  double const leastStep = kLeastGrid / view.Scale();
  std::string const line = "stroke=\"" + kGridColor + "\"";
  std::string const size = "font-size=\"" + Px(kTickText) + "\" ";
  std::string svg;
  Ticks const columns = TicksBetween(box.xMin, box.xMax, leastStep);
  for (double const x : columns.values) {
    double const at = view(x, 0.0).x;
    svg += LineElement({at, frame.top}, {at, frame.Bottom()}, line);
    svg += Text({at, frame.Bottom() + 15.0}, size + "text-anchor=\"middle\"", columns.Label(x));
  }
  Ticks const rows = TicksBetween(box.yMin, box.yMax, leastStep);
  for (double const y : rows.values) {
    double const at = view(0.0, y).y;
    svg += LineElement({frame.left, at}, {frame.Right(), at}, line);
    svg += Text({frame.left - 6.0, at + 4.0}, size + "text-anchor=\"end\"", rows.Label(y));
  }
  return svg;
}

std::string UniformBand(Report const& report, View const& view) {
  std::string const data = PathData(report.pieces, view);
  double const width = 2.0 * report.SmallestTolerance() * view.Scale();
  auto stroke = [&](double strokeWidth, std::string const& color) {
    return "<path fill=\"none\" stroke=\"" + color + "\" stroke-width=\"" + Px(strokeWidth) +
           "\" stroke-linejoin=\"round\" stroke-linecap=\"round\" d=\"" + data + "\"/>\n";
  };
  return stroke(width + 1.0, kBandEdgeColor) + stroke(width, kBandColor);
}

std::string ToleranceDiscs(Report const& report, View const& view) {
  auto discs = [&](double extra, std::string const& color) {
    std::string svg = "<g fill=\"" + color + "\">\n";
    for (WPoint const& point : report.file.points) {
      svg += CircleElement(view(point.x, point.y), point.w * view.Scale() + extra, "");
    }
    return svg + "</g>\n";
  };
  return discs(0.5, kBandEdgeColor) + discs(0.0, kBandColor);
}

std::string Band(Report const& report, View const& view) {
  if (!IsBandVisible(report, view)) return "";
  return IsToleranceUniform(report) ? UniformBand(report, view) : ToleranceDiscs(report, view);
}

/// Dots that stay apart where there is room, leave a visible tolerance visible and never vanish.
double DotDiameter(std::vector<Pixel> const& dots, double toleranceDiameter) {
  std::vector<double> gaps;
  for (std::size_t i = 1; i < dots.size(); ++i) {
    gaps.push_back(std::hypot(dots[i].x - dots[i - 1].x, dots[i].y - dots[i - 1].y));
  }
  auto const middle = gaps.begin() + static_cast<std::ptrdiff_t>(gaps.size() / 2);
  std::nth_element(gaps.begin(), middle, gaps.end());
  return std::clamp(std::min(0.55 * *middle, std::max(0.4 * toleranceDiameter, 2.4)), 1.6, 5.0);
}

std::string MeasuredPoints(Report const& report, View const& view) {
  std::vector<Pixel> dots;
  for (WPoint const& point : report.file.points) dots.push_back(view(point.x, point.y));
  double const tolerance = 2.0 * report.LargestTolerance() * view.Scale();
  return Dots(dots, DotDiameter(dots, tolerance), kPointColor);
}

std::string PieceTitle(Report const& report, std::size_t i) {
  Piece const& piece = report.pieces[i];
  std::string title = std::to_string(i + 1) + ": ";
  if (piece.IsArc()) {
    title += "arc, radius " + FormatShort(piece.radius) + ", " +
             FormatShort(piece.sweep * 180.0 / pi) + " degrees";
  } else {
    title += "line, length " + FormatShort(piece.length);
  }
  if (report.ranges) title += ", " + Counted((*report.ranges)[i].count, "point");
  return title;
}

std::string Pieces(Report const& report, View const& view) {
  std::string svg = "<g fill=\"none\" stroke-width=\"" + Px(kContourWidth) +
                    "\" stroke-linecap=\"round\" stroke-linejoin=\"round\">\n";
  for (std::size_t i = 0; i < report.pieces.size(); ++i) {
    Piece const& piece = report.pieces[i];
    svg += "<path stroke=\"" + ColorOf(piece) + "\" d=\"" + PathData({piece}, view) + "\"><title>" +
           Escaped(PieceTitle(report, i)) + "</title></path>\n";
  }
  return svg + "</g>\n";
}

std::string Joints(Report const& report, View const& view) {
  double const radius = report.pieces.size() > 60 ? 2.4 : 3.6;
  std::string svg = "<g fill=\"white\" stroke=\"" + kTextColor + "\" stroke-width=\"1.2\">\n";
  for (Piece const& piece : report.pieces) {
    svg += CircleElement(view(piece.end.x, piece.end.y), radius, "");
  }
  GeometryUtils::Point const& start = report.pieces.front().start;
  svg += CircleElement(view(start.x, start.y), radius + 0.8, "fill=\"" + kStartColor + "\"");
  return svg + "</g>\n";
}

/// The point half way along the piece and the unit normal that points away from an arc's centre.
struct LabelAnchor {
  Pixel at;
  Pixel normal;
};

LabelAnchor AnchorOf(Piece const& piece, View const& view) {
  Pixel const start = view(piece.start.x, piece.start.y);
  Pixel const end = view(piece.end.x, piece.end.y);
  LabelAnchor anchor;
  if (piece.IsArc()) {
    GeometryUtils::Point const middle = PointOnArc(piece, 0.5 * piece.sweep);
    anchor.at = view(middle.x, middle.y);
    anchor.normal = {(middle.x - piece.center.x) / piece.radius,
                     -(middle.y - piece.center.y) / piece.radius};
    return anchor;
  }
  double const length = std::max(std::hypot(end.x - start.x, end.y - start.y), 1e-6);
  anchor.at = {0.5 * (start.x + end.x), 0.5 * (start.y + end.y)};
  anchor.normal = {(end.y - start.y) / length, -(end.x - start.x) / length};
  return anchor;
}

bool Overlap(Rect const& a, Rect const& b) {
  return a.left < b.Right() && b.left < a.Right() && a.top < b.Bottom() && b.top < a.Bottom();
}

bool Contains(Rect const& outer, Rect const& inner) {
  return inner.left >= outer.left && inner.Right() <= outer.Right() && inner.top >= outer.top &&
         inner.Bottom() <= outer.Bottom();
}

/// Finds room for the labels of the pieces, on the outer side of a piece if it is free.
class Labels {
 public:
  Labels(Report const& report, View const& view) : view_(view) {
    for (WPoint const& point : report.file.points) Take(view(point.x, point.y));
    for (Piece const& piece : report.pieces) TakePiece(piece);
  }

  std::string Add(Piece const& piece, std::string const& text) {
    LabelAnchor const anchor = AnchorOf(piece, view_);
    double const width = kLetterWidth * static_cast<double>(text.size());
    for (double const side : {1.0, -1.0}) {
      // A label beside a steep piece is kept off by half its width, above one by its height.
      double const reach = kLabelDistance + std::fabs(anchor.normal.x) * 0.5 * width;
      Pixel const middle{anchor.at.x + side * reach * anchor.normal.x,
                         anchor.at.y + side * reach * anchor.normal.y};
      Rect const rect{middle.x - 0.5 * width, middle.y - 0.5 * kLabelHeight, width, kLabelHeight};
      bool const isFree = Contains(view_.Frame(), rect) &&
                          std::none_of(taken_.begin(), taken_.end(),
                                       [&](Rect const& other) { return Overlap(rect, other); });
      if (!isFree) continue;
      taken_.push_back(rect);
      return Text({middle.x, middle.y + 4.0}, "fill=\"" + ColorOf(piece) + "\"", text);
    }
    return "";
  }

 private:
  /// What is drawn is taken ground.
  void Take(Pixel const& at) { taken_.push_back({at.x - 2.0, at.y - 2.0, 4.0, 4.0}); }

  void TakePiece(Piece const& piece) {
    constexpr double kStep = 4.0;
    constexpr double kMostSteps = 500.0;
    auto const steps =
        static_cast<int>(std::clamp(piece.length * view_.Scale() / kStep, 1.0, kMostSteps));
    for (int i = 0; i <= steps; ++i) {
      double const part = static_cast<double>(i) / steps;
      GeometryUtils::Point const at =
          piece.IsArc() ? PointOnArc(piece, part * piece.sweep)
                        : GeometryUtils::Point{std::lerp(piece.start.x, piece.end.x, part),
                                               std::lerp(piece.start.y, piece.end.y, part)};
      Take(view_(at.x, at.y));
    }
  }

  View const& view_;
  std::vector<Rect> taken_;
};

/// Four digits, or all ahead of the point as long as that reads better than an exponent.
std::string Measure(double value) {
  return value >= 1e4 && value < 1e7 ? FormatFixed(value, 0) : FormatShort(value, 4);
}

std::string PieceLabels(Report const& report, View const& view) {
  if (report.pieces.size() > kMostLabels) return "";
  Labels labels(report, view);
  std::string svg = "<g font-size=\"11\" text-anchor=\"middle\">\n";
  for (std::size_t i = 0; i < report.pieces.size(); ++i) {
    Piece const& piece = report.pieces[i];
    std::string const number = std::to_string(i + 1);
    svg += labels.Add(piece, number + (piece.IsArc() ? ": R " + Measure(piece.radius)
                                                     : ": " + Measure(piece.length)));
  }
  return svg + "</g>\n";
}

std::string WorstPoint(Report const& report, View const& view) {
  WPoint const& point = report.file.points[report.remeasured.worst];
  return CircleElement(view(point.x, point.y), 8.0,
                       "fill=\"none\" stroke=\"" + kWorstColor + "\" stroke-width=\"1.6\"");
}

std::string ScaleBar(Report const& report, View const& view) {
  Rect const& frame = view.Frame();
  double const length = NiceStep(kLeastGrid / view.Scale());
  double const width = length * view.Scale();
  Pixel const left{frame.Right() - 18.0 - width, frame.Bottom() - 16.0};
  Pixel const right{left.x + width, left.y};
  std::string const units = report.file.units.empty() ? "" : " " + report.file.units;
  std::string const stroke = "stroke=\"" + kTextColor + "\" stroke-width=\"1.6\"";
  Rect const plate{left.x - 10.0, left.y - 22.0, width + 20.0, 32.0};
  std::string svg = RectElement(plate, "fill=\"white\" fill-opacity=\"0.85\"");
  svg += LineElement(left, right, stroke);
  for (Pixel const& end : {left, right}) {
    svg += LineElement({end.x, end.y - 4.0}, {end.x, end.y + 4.0}, stroke);
  }
  return svg + Text({0.5 * (left.x + right.x), left.y - 7.0},
                    "font-size=\"11\" text-anchor=\"middle\"", FormatShort(length, 3) + units);
}

}  // namespace

bool IsBandVisible(Report const& report, View const& view) {
  return 2.0 * report.LargestTolerance() * view.Scale() >= kLeastVisibleBand;
}

std::string PathData(std::vector<Piece> const& pieces, View const& view) {
  GeometryUtils::Point const& start = pieces.front().start;
  std::string data = "M" + Px(view(start.x, start.y));
  for (Piece const& piece : pieces) data += PieceData(piece, view);
  return data;
}

std::string ContourPlot(Report const& report, View const& view) {
  Rect const& frame = view.Frame();
  return "<g id=\"contour\">\n" + RectElement(frame, "fill=\"white\"") + Grid(view) +
         "<clipPath id=\"frame\">" + RectElement(frame, "") + "</clipPath>\n" +
         "<g clip-path=\"url(#frame)\">\n" + Band(report, view) + MeasuredPoints(report, view) +
         Pieces(report, view) + Joints(report, view) + WorstPoint(report, view) +
         PieceLabels(report, view) + "</g>\n" +
         RectElement(frame, "fill=\"none\" stroke=\"" + kFrameColor + "\"") +
         ScaleBar(report, view) + "</g>\n";
}

}  // namespace Vorn::Cli::Svg
