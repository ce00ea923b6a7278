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

/// Where there is no room beside the piece, a label stands as far away as this, in pixels.
constexpr double kNearestLeader = 24.0;
constexpr double kLongestLeader = 180.0;
constexpr double kLeaderStep = 8.0;

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

Pixel Turned(Pixel const& direction, double angle) {
  return {direction.x * std::cos(angle) - direction.y * std::sin(angle),
          direction.x * std::sin(angle) + direction.y * std::cos(angle)};
}

double WidthOf(std::string const& text) { return kLetterWidth * static_cast<double>(text.size()); }

/// Four digits, or all ahead of the point as long as that reads better than an exponent.
std::string Measure(double value) {
  return value >= 1e4 && value < 1e7 ? FormatFixed(value, 0) : FormatShort(value, 4);
}

}  // namespace

void Labels::Take(Pixel const& at) { taken_.push_back(Around(at)); }

void Labels::TakeRing(Pixel const& at, double radius) {
  taken_.push_back({at.x - radius, at.y - radius, 2.0 * radius, 2.0 * radius});
}

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

std::string Labels::Write(Piece const& piece, Rect const& rect, std::string const& text) {
  taken_.push_back(rect);
  labels_.push_back(rect);
  return Text({rect.left + 0.5 * rect.width, rect.top + 0.5 * kLabelHeight + 4.0},
              "fill=\"" + TextColorOf(piece) + "\"", text);
}

std::string Labels::AddBeside(Piece const& piece, std::string const& text) {
  Anchor const anchor = AnchorOf(piece, view_);
  double const nearest = std::max(kLeastDistance, band_ + kBeyondBand);
  for (int step = 0; step * kDistanceStep <= kFarther; ++step) {
    double const distance = nearest + step * kDistanceStep;
    for (double const side : {1.0, -1.0}) {
      Rect const rect = RectBeside(anchor, side, distance, WidthOf(text));
      if (IsFree(rect) && !IsCutOff(anchor, side, distance)) return Write(piece, rect, text);
    }
  }
  return "";
}

std::string Labels::AddAnywhere(Piece const& piece, std::string const& text) {
  std::string const beside = AddBeside(piece, text);
  return beside.empty() ? AddWithLeader(piece, AnchorOf(piece, view_), text) : beside;
}

std::string Labels::AddWithLeader(Piece const& piece, Anchor const& anchor,
                                  std::string const& text) {
  for (int step = 0; kNearestLeader + step * kLeaderStep <= kLongestLeader; ++step) {
    double const distance = kNearestLeader + step * kLeaderStep;
    for (double const turn : {0.0, 0.5, -0.5, 1.0, -1.0}) {
      for (double const side : {1.0, -1.0}) {
        Anchor const turned = {anchor.at, Turned(anchor.normal, turn)};
        Rect const rect = RectBeside(turned, side, distance, WidthOf(text));
        Pixel const from = AtDistance(turned, side, kOwnPiece);
        Pixel const to = AtDistance(turned, side, distance - 1.0);
        if (!IsFree(rect) || !IsLeaderFree(from, to)) continue;
        std::string const line = LineElement(
            anchor.at, to,
            "class=\"leader\" stroke-width=\"0.7\" stroke=\"" + TextColorOf(piece) + "\"");
        return line + Write(piece, rect, text);
      }
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

bool Labels::IsLeaderFree(Pixel const& from, Pixel const& to) const {
  double const length = std::hypot(to.x - from.x, to.y - from.y);
  int const steps = static_cast<int>(std::ceil(length / kTakenSize));
  for (int i = 0; i <= steps; ++i) {
    double const part = static_cast<double>(i) / std::max(1, steps);
    Rect const here = Around({std::lerp(from.x, to.x, part), std::lerp(from.y, to.y, part)});
    auto const isHere = [&](Rect const& other) { return here.Overlaps(other); };
    if (std::any_of(pieces_.begin(), pieces_.end(), isHere) ||
        std::any_of(labels_.begin(), labels_.end(), isHere)) {
      return false;
    }
  }
  return true;
}

std::string LabelOf(Piece const& piece, std::size_t number) {
  return std::to_string(number) +
         (piece.IsArc() ? ": R " + Measure(piece.radius) : ": " + Measure(piece.length));
}

}  // namespace Vorn::IO::Svg
