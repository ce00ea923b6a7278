#include "cli/SvgLayout.h"

#include <algorithm>
#include <cmath>

#include "cli/Numbers.h"

namespace Vorn::Cli::Svg {

namespace {

constexpr int kPixelDecimals = 2;

/// Share of the box left free around it.
constexpr double kMargin = 0.07;

/// How far a contour that misses the points may widen the drawing, as a share of their extent.
constexpr double kLargestOvershoot = 0.5;

/// More would be unreadable; also the way out when steps vanish against huge values.
constexpr int kMostTicks = 40;

constexpr int kArcSamples = 64;

int Exponent(double value) { return static_cast<int>(std::floor(std::log10(value))); }

/// An extent that can be divided by, also for points on one horizontal or vertical line.
double Positive(double extent) { return extent > 0.0 && std::isfinite(extent) ? extent : 0.0; }

}  // namespace

void Box::Include(double x, double y) {
  xMin = std::min(xMin, x);
  xMax = std::max(xMax, x);
  yMin = std::min(yMin, y);
  yMax = std::max(yMax, y);
}

double NiceStep(double least) {
  double const power = std::pow(10.0, std::floor(std::log10(least)));
  for (double const factor : {1.0, 2.0, 5.0}) {
    if (factor * power >= least) return factor * power;
  }
  return 10.0 * power;
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

Box BoxAround(Report const& report) {
  WPoint const& first = report.file.points.front();
  Box box{first.x, first.x, first.y, first.y};
  for (WPoint const& point : report.file.points) box.Include(point.x, point.y);

  double const reach = kLargestOvershoot * std::max(box.Width(), box.Height());
  Box const limit{box.xMin - reach, box.xMax + reach, box.yMin - reach, box.yMax + reach};
  auto include = [&](GeometryUtils::Point const& point) {
    if (!std::isfinite(point.x) || !std::isfinite(point.y)) return;
    box.Include(std::clamp(point.x, limit.xMin, limit.xMax),
                std::clamp(point.y, limit.yMin, limit.yMax));
  };
  for (Piece const& piece : report.pieces) {
    include(piece.start);
    include(piece.end);
    for (int i = 1; piece.IsArc() && i < kArcSamples; ++i) {
      include(PointOnArc(piece, piece.sweep * i / kArcSamples));
    }
  }
  return box;
}

std::string Px(double value) {
  if (!std::isfinite(value)) return "0";
  std::string text = FormatFixed(value, kPixelDecimals);
  text.erase(text.find_last_not_of('0') + 1);
  if (text.back() == '.') text.pop_back();
  return text;
}

std::string Px(Pixel const& pixel) { return Px(pixel.x) + "," + Px(pixel.y); }

std::string Escaped(std::string_view text) {
  std::string escaped;
  for (char const c : text) {
    switch (c) {
      case '&':
        escaped += "&amp;";
        break;
      case '<':
        escaped += "&lt;";
        break;
      case '>':
        escaped += "&gt;";
        break;
      case '"':
        escaped += "&quot;";
        break;
      default:
        if (c < 0 || c >= ' ') escaped += c;
    }
  }
  return escaped;
}

std::string Text(Pixel const& at, std::string const& attributes, std::string_view text) {
  return "<text x=\"" + Px(at.x) + "\" y=\"" + Px(at.y) + "\" " + attributes + ">" + Escaped(text) +
         "</text>\n";
}

std::string LineElement(Pixel const& from, Pixel const& to, std::string const& attributes) {
  return "<line x1=\"" + Px(from.x) + "\" y1=\"" + Px(from.y) + "\" x2=\"" + Px(to.x) + "\" y2=\"" +
         Px(to.y) + "\" " + attributes + "/>\n";
}

std::string CircleElement(Pixel const& center, double radius, std::string const& attributes) {
  return "<circle cx=\"" + Px(center.x) + "\" cy=\"" + Px(center.y) + "\" r=\"" + Px(radius) +
         "\" " + attributes + "/>\n";
}

std::string RectElement(Rect const& rect, std::string const& attributes) {
  return "<rect x=\"" + Px(rect.left) + "\" y=\"" + Px(rect.top) + "\" width=\"" + Px(rect.width) +
         "\" height=\"" + Px(rect.height) + "\" " + attributes + "/>\n";
}

std::string Dots(std::vector<Pixel> const& at, double diameter, std::string const& color) {
  if (at.empty()) return "";
  std::string path = "<path fill=\"none\" stroke=\"" + color + "\" stroke-width=\"" + Px(diameter) +
                     "\" stroke-linecap=\"round\" d=\"";
  // A stroke without length is drawn as its round cap.
  for (Pixel const& pixel : at) path += "M" + Px(pixel) + "h0";
  return path + "\"/>\n";
}

}  // namespace Vorn::Cli::Svg
