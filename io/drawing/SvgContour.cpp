#include "io/drawing/SvgContour.h"

#include <algorithm>
#include <cmath>
#include <map>
#include <numbers>

#include "io/drawing/Band.h"
#include "io/drawing/Decimation.h"
#include "io/drawing/Labels.h"
#include "io/drawing/Style.h"
#include "io/drawing/SvgElements.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO::Svg {

namespace {

using std::numbers::pi;

constexpr double kLeastGrid = 90.0;
constexpr double kTickText = 11.0;

/// Arcs are written in parts of at most this sweep, in radians: one part of more than half a turn
/// is ambiguous, and one of nearly a whole turn loses its centre to rounding.
constexpr double kLargestArcPart = 0.5 * pi;

/// An arc that bulges less than this many pixels is written as a line; its radius in pixels may
/// be beyond what viewers handle.
constexpr double kFlatArc = 0.02;

/// More pieces are drawn as one path of each kind.
constexpr std::size_t kMostSinglePieces = 2000;
constexpr std::size_t kMostLabels = 40;

/// Bands of a tolerance that differ by less than this many pixels are drawn alike.
constexpr double kBandStep = 0.5;
constexpr double kLeastBandSection = 0.5;
constexpr double kWhiskerCell = 1.5;
constexpr double kDiscCell = 0.5;
constexpr double kLeastWhisker = 1.5;

std::string ArcData(Piece const& arc, double from, double to, View const& view) {
  double const radius = arc.radius * view.Scale();
  double const sweep = (to - from) * arc.sweep;
  int const parts = std::max(1, static_cast<int>(std::ceil(sweep / kLargestArcPart - 1e-9)));
  double const bulge = radius * (1.0 - std::cos(0.5 * sweep / parts));
  std::string data;
  for (int i = 1; i <= parts; ++i) {
    bool const isEnd = i == parts && to == 1.0;
    GeometryUtils::Point const target =
        isEnd ? arc.end : PointOnArc(arc, from * arc.sweep + sweep * i / parts);
    std::string const at = Px(view(target.x, target.y));
    if (bulge < kFlatArc) {
      data += "L" + at;
    } else {
      // With y turned over by the view, counter-clockwise is SVG's negative sense.
      char const* const sense = arc.counterClockwise ? "0" : "1";
      data += "A" + Px(radius) + "," + Px(radius) + " 0 0 " + sense + " " + at;
    }
  }
  return data;
}

std::string PieceData(Piece const& piece, View const& view) {
  return StretchData(piece, 0.0, piece.length, view);
}

std::string Grid(View const& view) {
  Rect const& frame = view.Frame();
  Box const box = view.Visible();
  double const leastStep = kLeastGrid / view.Scale();
  std::string const line = "stroke=\"" + kGridColor + "\" stroke-width=\"0.7\"";
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

std::string Band(Scene const& scene) {
  if (!scene.IsBandVisible()) return "";
  return scene.HasContour() ? BandAlongContour(scene) : ToleranceDiscs(scene);
}

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

/// Thin lines from the contour to the magnified points, on each side of a place the longest.
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

std::string PieceTitle(Drawing const& drawing, std::size_t i) {
  Piece const& piece = drawing.pieces[i];
  std::string title = std::to_string(i + 1) + ": ";
  if (piece.IsArc()) {
    title += "arc, radius " + FormatShort(piece.radius) + ", " +
             FormatShort(piece.sweep * 180.0 / pi) + " degrees";
  } else {
    title += "line, length " + FormatShort(piece.length);
  }
  return title;
}

std::string StrokeOf(Piece const& piece) {
  return "stroke=\"" + ColorOf(piece) + "\"" + (piece.IsArc() ? " " + kArcDashes : "");
}

std::string SinglePieces(Scene const& scene) {
  std::string svg;
  for (std::size_t i = 0; i < scene.drawing.pieces.size(); ++i) {
    Piece const& piece = scene.drawing.pieces[i];
    svg += "<path " + StrokeOf(piece) + " d=\"" + PathData({piece}, scene.view) + "\"><title>" +
           Escaped(PieceTitle(scene.drawing, i)) + "</title></path>\n";
  }
  return svg;
}

std::string MergedPieces(Scene const& scene) {
  std::vector<Piece> lines;
  std::vector<Piece> arcs;
  for (Piece const& piece : scene.drawing.pieces) (piece.IsArc() ? arcs : lines).push_back(piece);
  std::string svg;
  for (std::vector<Piece> const& pieces : {lines, arcs}) {
    if (!pieces.empty()) {
      svg += PathElement(PathData(pieces, scene.view), StrokeOf(pieces.front()));
    }
  }
  return svg;
}

std::string Pieces(Scene const& scene) {
  bool const areFew = scene.drawing.pieces.size() <= kMostSinglePieces;
  return "<g class=\"pieces\" fill=\"none\" stroke-width=\"" + Px(kContourWidth) +
         "\" stroke-linejoin=\"round\">\n" + (areFew ? SinglePieces(scene) : MergedPieces(scene)) +
         "</g>\n";
}

std::string Joints(Scene const& scene) {
  std::vector<Piece> const& pieces = scene.drawing.pieces;
  double const radius = pieces.size() > 60 ? 2.2 : 3.4;
  std::vector<Pixel> joints;
  for (std::size_t i = 1; i < pieces.size(); ++i) {
    joints.push_back(scene.view(pieces[i].start.x, pieces[i].start.y));
  }
  std::string svg =
      "<g class=\"joints\" fill=\"white\" stroke=\"" + kTextColor + "\" stroke-width=\"1\">\n";
  for (std::size_t const i : OnePerCell(joints, 1.0)) svg += CircleElement(joints[i], radius, "");
  return svg + "</g>\n";
}

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

std::string ContourEnds(Scene const& scene) {
  Piece const& first = scene.drawing.pieces.front();
  Piece const& last = scene.drawing.pieces.back();
  double const nearby = std::min(first.length, kStartSize / scene.view.Scale());
  GeometryUtils::Point const ahead = PlaceOn(first, nearby);
  Pixel const start = scene.view(first.start.x, first.start.y);
  return StartAndEnd(start, Between(start, scene.view(ahead.x, ahead.y)),
                     scene.view(last.end.x, last.end.y), scene.drawing.IsClosed());
}

/// Small arrows to the right of the points' sense of travel: nothing joins the points themselves.
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

std::string PointsAlone(Scene const& scene) {
  std::vector<Pixel> const& points = scene.magnified;
  return DirectionArrows(scene) + MeasuredPoints(scene) +
         StartAndEnd(points.front(), Between(points.front(), Ahead(points, 0, kStartSize)),
                     points.back(), false);
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

std::string PieceLabels(Scene const& scene) {
  if (scene.drawing.pieces.size() > kMostLabels) return "";
  double const band = scene.IsBandVisible()
                          ? scene.magnify * scene.drawing.LargestTolerance() * scene.view.Scale()
                          : 0.0;
  Labels labels(scene.view, band);
  for (std::size_t const i : OnePerCell(scene.magnified, 2.0)) labels.Take(scene.magnified[i]);
  for (Piece const& piece : scene.drawing.pieces) labels.TakePiece(piece);
  std::string svg = "<g font-size=\"11\" text-anchor=\"middle\" class=\"halo\">\n";
  for (std::size_t i = 0; i < scene.drawing.pieces.size(); ++i) {
    Piece const& piece = scene.drawing.pieces[i];
    svg += labels.Add(piece, LabelOf(piece, i + 1));
  }
  return svg + "</g>\n";
}

std::string WorstPoint(Scene const& scene) {
  if (!scene.IsMeasured()) return "";
  return CircleElement(
      scene.magnified[scene.drawing.Worst()], 7.0,
      "class=\"worst\" fill=\"none\" stroke=\"" + kWorstColor + "\" stroke-width=\"1.7\"");
}

std::string FittedContour(Scene const& scene) {
  // So many points would hide the contour.
  bool const areMany = scene.drawing.points.size() > kMostExactDots;
  std::string const pieces = Pieces(scene);
  std::string const points = Whiskers(scene) + MeasuredPoints(scene);
  return (areMany ? points + pieces : pieces + points) + Joints(scene) + ContourEnds(scene) +
         OutsidePoints(scene) + WorstPoint(scene) + PieceLabels(scene);
}

}  // namespace

std::string StretchData(Piece const& piece, double from, double to, View const& view) {
  if (piece.IsArc() && piece.length > 0.0) {
    return ArcData(piece, from / piece.length, to / piece.length, view);
  }
  GeometryUtils::Point const end = to == piece.length ? piece.end : PlaceOn(piece, to);
  return "L" + Px(view(end.x, end.y));
}

std::string PathData(std::vector<Piece> const& pieces, View const& view) {
  std::string data;
  std::string pen;
  for (Piece const& piece : pieces) {
    // Pieces of a file need not meet: a gap is not drawn over.
    std::string const start = Px(view(piece.start.x, piece.start.y));
    if (start != pen) data += "M" + start;
    data += PieceData(piece, view);
    pen = Px(view(piece.end.x, piece.end.y));
  }
  return data;
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

std::string ContourPlot(Scene const& scene) {
  Rect const& frame = scene.view.Frame();
  return "<g id=\"contour\">\n" + Grid(scene.view) + "<clipPath id=\"frame\">" +
         RectElement(frame, "") + "</clipPath>\n<g clip-path=\"url(#frame)\">\n" + Band(scene) +
         (scene.HasContour() ? FittedContour(scene) : PointsAlone(scene)) + "</g>\n" +
         RectElement(frame, "fill=\"none\" stroke=\"" + kFrameColor + "\" stroke-width=\"0.9\"") +
         "</g>\n";
}

}  // namespace Vorn::IO::Svg
