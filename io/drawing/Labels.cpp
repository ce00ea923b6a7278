#include "io/drawing/Labels.h"

#include <algorithm>
#include <cmath>

#include "io/drawing/Feet.h"
#include "io/drawing/Style.h"
#include "io/drawing/SvgElements.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO::Svg {

namespace {

constexpr double kLeastDistance = 9.0;
constexpr double kBeyondBand = 4.0;
constexpr double kFarther = 30.0;
constexpr double kDistanceStep = 5.0;
constexpr double kOwnPiece = 7.0;
constexpr double kLabelHeight = 13.0;
constexpr double kLetterWidth = 6.6;
constexpr double kTakenSize = 4.0;

Anchor AnchorOf(Piece const& piece, View const& view) {
  Pixel const start = view(piece.start.x, piece.start.y);
  Pixel const end = view(piece.end.x, piece.end.y);
  Anchor anchor;
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

Pixel AtDistance(Anchor const& anchor, double side, double distance) {
  return {anchor.at.x + side * distance * anchor.normal.x,
          anchor.at.y + side * distance * anchor.normal.y};
}

Rect Around(Pixel const& at) {
  return {at.x - 0.5 * kTakenSize, at.y - 0.5 * kTakenSize, kTakenSize, kTakenSize};
}

/// The place for a label whose nearer edge is `distance` from the anchor.
Rect RectBeside(Anchor const& anchor, double side, double distance, double width) {
  double const reach = distance + 0.5 * (std::fabs(anchor.normal.x) * width +
                                         std::fabs(anchor.normal.y) * kLabelHeight);
  Pixel const middle = AtDistance(anchor, side, reach);
  return {middle.x - 0.5 * width, middle.y - 0.5 * kLabelHeight, width, kLabelHeight};
}

/// Four digits, or all ahead of the point as long as that reads better than an exponent.
std::string Measure(double value) {
  return value >= 1e4 && value < 1e7 ? FormatFixed(value, 0) : FormatShort(value, 4);
}

}  // namespace

void Labels::Take(Pixel const& at) { taken_.push_back(Around(at)); }

void Labels::TakePiece(Piece const& piece) {
  constexpr double kMostSteps = 500.0;
  double const steps =
      std::clamp(std::ceil(piece.length * view_.Scale() / kTakenSize), 1.0, kMostSteps);
  for (int i = 0; i <= steps; ++i) {
    GeometryUtils::Point const at = PlaceOn(piece, piece.length * i / steps);
    Take(view_(at.x, at.y));
    pieces_.push_back(taken_.back());
  }
}

std::string Labels::Add(Piece const& piece, std::string const& text) {
  Anchor const anchor = AnchorOf(piece, view_);
  double const width = kLetterWidth * static_cast<double>(text.size());
  double const nearest = std::max(kLeastDistance, band_ + kBeyondBand);
  for (int step = 0; step * kDistanceStep <= kFarther; ++step) {
    double const distance = nearest + step * kDistanceStep;
    for (double const side : {1.0, -1.0}) {
      Rect const rect = RectBeside(anchor, side, distance, width);
      if (!IsFree(rect) || IsCutOff(anchor, side, distance)) continue;
      taken_.push_back(rect);
      return Text({rect.left + 0.5 * width, rect.top + 0.5 * kLabelHeight + 4.0},
                  "fill=\"" + TextColorOf(piece) + "\"", text);
    }
  }
  return "";
}

bool Labels::IsFree(Rect const& rect) const {
  return view_.Frame().Contains(rect) &&
         std::none_of(taken_.begin(), taken_.end(),
                      [&](Rect const& other) { return rect.Overlaps(other); });
}

bool Labels::IsCutOff(Anchor const& anchor, double side, double distance) const {
  for (int step = 0; kOwnPiece + step * kTakenSize < distance; ++step) {
    Rect const here = Around(AtDistance(anchor, side, kOwnPiece + step * kTakenSize));
    if (std::any_of(pieces_.begin(), pieces_.end(),
                    [&](Rect const& other) { return here.Overlaps(other); })) {
      return true;
    }
  }
  return false;
}

std::string LabelOf(Piece const& piece, std::size_t number) {
  return std::to_string(number) +
         (piece.IsArc() ? ": R " + Measure(piece.radius) : ": " + Measure(piece.length));
}

}  // namespace Vorn::IO::Svg
