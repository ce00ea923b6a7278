#include "io/drawing/Layout.h"

#include <algorithm>
#include <cmath>

#include "vorn/io/Numbers.h"

namespace Vorn::IO::Svg {

namespace {

/// Share of the box left free around it.
constexpr double kMargin = 0.07;

/// How far a contour that misses the points may widen the drawing, as a share of their extent.
constexpr double kLargestOvershoot = 0.5;

/// More would be unreadable; also the way out when steps vanish against huge values.
constexpr int kMostTicks = 40;

constexpr int kArcSamples = 64;

/// How far from the contour a tolerance is drawn that is as large as can be, and at most any
/// deviation, in pixels.
constexpr double kReadableTolerance = 14.0;
constexpr double kReadableDeviation = 70.0;

int Exponent(double value) { return static_cast<int>(std::floor(std::log10(value))); }

/// An extent that can be divided by, also for points on one horizontal or vertical line.
double Positive(double extent) { return extent > 0.0 && std::isfinite(extent) ? extent : 0.0; }

/// Places on a piece that tell its extent well enough: the ends, and some of an arc between.
std::vector<GeometryUtils::Point> Samples(Piece const& piece) {
  std::vector<GeometryUtils::Point> places = {piece.start, piece.end};
  for (int i = 1; piece.IsArc() && i < kArcSamples; ++i) {
    places.push_back(PointOnArc(piece, piece.sweep * i / kArcSamples));
  }
  return places;
}

Box BoxAround(std::vector<Piece> const& pieces) {
  GeometryUtils::Point const& first = pieces.front().start;
  Box box{first.x, first.x, first.y, first.y};
  for (Piece const& piece : pieces) {
    for (GeometryUtils::Point const& place : Samples(piece)) box.Include(place.x, place.y);
  }
  return box;
}

}  // namespace

void Box::Include(double x, double y) {
  xMin = std::min(xMin, x);
  xMax = std::max(xMax, x);
  yMin = std::min(yMin, y);
  yMax = std::max(yMax, y);
}

bool Rect::Contains(Rect const& inner) const {
  return inner.left >= left && inner.Right() <= Right() && inner.top >= top &&
         inner.Bottom() <= Bottom();
}

bool Rect::Overlaps(Rect const& other) const {
  return left < other.Right() && other.left < Right() && top < other.Bottom() &&
         other.top < Bottom();
}

double NiceStep(double least) {
  double const power = std::pow(10.0, std::floor(std::log10(least)));
  for (double const factor : {1.0, 2.0, 5.0}) {
    if (factor * power >= least) return factor * power;
  }
  return 10.0 * power;
}

double NiceFloor(double most) {
  double const power = std::pow(10.0, std::floor(std::log10(most)));
  for (double const factor : {5.0, 2.0}) {
    if (factor * power <= most) return factor * power;
  }
  return power;
}

Ticks TicksBetween(double low, double high, double leastStep) {
  Ticks ticks;
  ticks.step = NiceStep(leastStep);
  double const first = std::ceil(low / ticks.step);
  for (int i = 0; i < kMostTicks; ++i) {
    double const value = (first + i) * ticks.step;
    if (!(value <= high)) break;
    ticks.values.push_back(value);
  }
  return ticks;
}

std::string Ticks::Label(double value) const {
  double largest = step;
  for (double const tick : values) largest = std::max(largest, std::fabs(tick));
  int const digits = std::clamp(Exponent(largest) - Exponent(step) + 1, 1, 15);
  bool const isPlain = largest < 1e7 && step > 1e-5;
  if (!isPlain) return FormatShort(value, digits);
  return FormatFixed(value, std::max(0, -Exponent(step)));
}

View::View(Box const& box, double left, double top, double width, double leastHeight,
           double mostHeight)
    : xMiddle_(0.5 * box.xMin + 0.5 * box.xMax), yMiddle_(0.5 * box.yMin + 0.5 * box.yMax) {
  double const grow = 1.0 + 2.0 * kMargin;
  double const boxWidth = grow * Positive(box.Width());
  double const boxHeight = grow * Positive(box.Height());
  // Of the scales that fit each extent the smaller one; an extent of zero asks for none.
  scale_ = boxWidth > 0.0 ? width / boxWidth : 0.0;
  if (boxHeight > 0.0) {
    double const byHeight = mostHeight / boxHeight;
    scale_ = scale_ > 0.0 ? std::min(scale_, byHeight) : byHeight;
  }
  if (!(scale_ > 0.0) || !std::isfinite(scale_)) scale_ = 1.0;
  frame_ = {left, top, width, std::clamp(boxHeight * scale_, leastHeight, mostHeight)};
}

Pixel View::operator()(double x, double y) const {
  return {frame_.left + 0.5 * frame_.width + (x - xMiddle_) * scale_,
          frame_.top + 0.5 * frame_.height - (y - yMiddle_) * scale_};
}

Box View::Visible() const {
  double const halfWidth = 0.5 * frame_.width / scale_;
  double const halfHeight = 0.5 * frame_.height / scale_;
  return {xMiddle_ - halfWidth, xMiddle_ + halfWidth, yMiddle_ - halfHeight, yMiddle_ + halfHeight};
}

Box BoxAround(Drawing const& drawing, std::vector<GeometryUtils::Point> const& others) {
  if (drawing.points.empty()) return BoxAround(drawing.pieces);
  WPoint const& first = drawing.points.front();
  Box box{first.x, first.x, first.y, first.y};
  for (WPoint const& point : drawing.points) box.Include(point.x, point.y);

  double const reach = kLargestOvershoot * std::max(box.Width(), box.Height());
  Box const limit{box.xMin - reach, box.xMax + reach, box.yMin - reach, box.yMax + reach};
  auto include = [&](GeometryUtils::Point const& point) {
    if (!std::isfinite(point.x) || !std::isfinite(point.y)) return;
    box.Include(std::clamp(point.x, limit.xMin, limit.xMax),
                std::clamp(point.y, limit.yMin, limit.yMax));
  };
  for (Piece const& piece : drawing.pieces) {
    for (GeometryUtils::Point const& place : Samples(piece)) include(place);
  }
  for (GeometryUtils::Point const& point : others) include(point);
  return box;
}

double ReadableMagnification(Drawing const& drawing, double scale) {
  if (!drawing.IsMeasured()) return 1.0;
  double const deviation = drawing.deviations[drawing.Worst()].distance;
  double const tolerance = drawing.HasTolerances() ? drawing.LargestTolerance() : deviation;
  double const most =
      std::min(kReadableTolerance / (tolerance * scale), kReadableDeviation / (deviation * scale));
  return std::isfinite(most) && most > 1.0 ? NiceFloor(most) : 1.0;
}

}  // namespace Vorn::IO::Svg
