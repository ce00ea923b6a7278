#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "cli/Report.h"

/// The plumbing of the drawing: pixels, scales, ticks and text. Everything is laid out in pixels
/// before it is written, so strokes and letters look the same whatever the size of the contour.
namespace Vorn::Cli::Svg {

/// Where something is on the page, y down as SVG has it.
struct Pixel {
  double x = 0.0;
  double y = 0.0;
};

struct Rect {
  double left = 0.0;
  double top = 0.0;
  double width = 0.0;
  double height = 0.0;

  double Right() const { return left + width; }
  double Bottom() const { return top + height; }
};

/// A box in the plane of the contour, y up.
struct Box {
  double xMin = 0.0;
  double xMax = 0.0;
  double yMin = 0.0;
  double yMax = 0.0;

  double Width() const { return xMax - xMin; }
  double Height() const { return yMax - yMin; }
  void Include(double x, double y);
};

/// Round numbers between two values.
struct Ticks {
  double step = 1.0;
  std::vector<double> values;

  /// With as many digits as tell neighbouring ticks apart.
  std::string Label(double value) const;
};

/// 1, 2 or 5 times a power of ten, not below `least`.
double NiceStep(double least);

/// Ticks in [low, high] no closer than `leastStep`.
Ticks TicksBetween(double low, double high, double leastStep);

/// Maps the contour's plane into a frame of the page: one scale for both axes, y turned upside
/// down, the box in the middle.
class View {
 public:
  /// The frame has the given place and width; its height follows from the box, within limits.
  View(Box const& box, double left, double top, double width, double leastHeight,
       double mostHeight);

  Pixel operator()(double x, double y) const;
  double Scale() const { return scale_; }
  Rect const& Frame() const { return frame_; }
  Box Visible() const;

 private:
  Rect frame_;
  double scale_ = 1.0;
  double xMiddle_ = 0.0;
  double yMiddle_ = 0.0;
};

/// A box around the points and, as far as it stays near them, the contour.
Box BoxAround(Report const& report);

/// A coordinate or a length on the page.
std::string Px(double value);

/// "12.5,30".
std::string Px(Pixel const& pixel);

/// Safe inside an element or an attribute; control characters are left out.
std::string Escaped(std::string_view text);

/// One text element; `attributes` are written as they are.
std::string Text(Pixel const& at, std::string const& attributes, std::string_view text);

std::string LineElement(Pixel const& from, Pixel const& to, std::string const& attributes);

std::string CircleElement(Pixel const& center, double radius, std::string const& attributes);

std::string RectElement(Rect const& rect, std::string const& attributes);

/// Round dots of one size as a single element, which keeps thousands of them small.
std::string Dots(std::vector<Pixel> const& at, double diameter, std::string const& color);

}  // namespace Vorn::Cli::Svg
