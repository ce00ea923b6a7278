#pragma once

#include <string>
#include <vector>

#include "vorn/io/Drawing.h"

/// Where things go on the page: pixels, scales and ticks. Everything is laid out in pixels before
/// it is written, so strokes and letters look the same whatever the size of the contour.
namespace Vorn::IO::Svg {

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

  /// The right side.
  double Right() const { return left + width; }
  /// The lower side; y grows downwards.
  double Bottom() const { return top + height; }
  /// Whether the other one lies inside, borders included.
  bool Contains(Rect const& inner) const;
  /// Whether both have some area in common.
  bool Overlaps(Rect const& other) const;
};

/// A box in the plane of the contour, y up.
struct Box {
  double xMin = 0.0;
  double xMax = 0.0;
  double yMin = 0.0;
  double yMax = 0.0;

  /// From left to right, in units of the contour.
  double Width() const { return xMax - xMin; }
  /// From bottom to top.
  double Height() const { return yMax - yMin; }
  /// Grows so that the point is inside.
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

/// The same, not above `most`.
double NiceFloor(double most);

/// Ticks in [low, high] no closer than `leastStep`.
Ticks TicksBetween(double low, double high, double leastStep);

/// Maps the contour's plane into a frame of the page: one scale for both axes, y turned upside
/// down, the box in the middle.
class View {
 public:
  /// The frame has the given place and width; its height follows from the box, within limits.
  View(Box const& box, double left, double top, double width, double leastHeight,
       double mostHeight);

  /// Where a point of the plane is on the page.
  Pixel operator()(double x, double y) const;
  /// Pixels to a unit of the contour.
  double Scale() const { return scale_; }
  /// The part of the page that is drawn into.
  Rect const& Frame() const { return frame_; }
  /// The part of the plane that the frame shows.
  Box Visible() const;

 private:
  Rect frame_;
  double scale_ = 1.0;
  double xMiddle_ = 0.0;
  double yMiddle_ = 0.0;
};

/// A box around points and, as far as they stay near them, the contour and other places; without
/// points around the contour.
Box BoxAround(Drawing const& drawing, std::vector<GeometryUtils::Point> const& others = {});

/// A round number that draws the largest tolerance some millimetres wide where a unit is `scale`
/// pixels long, and never less than 1. Deviations far beyond the tolerance ask for less, and
/// without tolerances the largest deviation counts.
double ReadableMagnification(Drawing const& drawing, double scale);

}  // namespace Vorn::IO::Svg
