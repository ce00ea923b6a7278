#pragma once

#include <string>
#include <vector>

#include "io/drawing/Feet.h"
#include "io/drawing/Layout.h"

namespace Vorn::IO::Svg {

/// A drawing that has found its place on the page.
struct Scene {
  Drawing const& drawing;
  View view;
  double magnify = 1.0;
  std::vector<Foot> feet;        ///< of each point; empty if nothing is measured
  std::vector<Pixel> feetAt;     ///< the same on the page
  std::vector<Pixel> magnified;  ///< each point as drawn: moved away from its foot

  /// Whether there is a contour to draw.
  bool HasContour() const { return drawing.HasContour(); }
  /// Whether there are points and a contour, so that deviations are drawn.
  bool IsMeasured() const { return drawing.IsMeasured(); }
  /// Whether the tolerance is wide enough on the page to be seen at all.
  bool IsBandVisible() const;
  /// Whether there is a tolerance and the point lies beyond it.
  bool IsOutside(std::size_t point) const;
  /// Whether the point is measured from an arc.
  bool IsOnArc(std::size_t point) const;
  /// Whether a point is beyond its tolerance.
  bool AnyOutside() const;
};

/// Lays the contour out in the place and width given, as high as it needs within the limits.
Scene MakeScene(Drawing const& drawing, Rect const& least, double mostHeight);

}  // namespace Vorn::IO::Svg
