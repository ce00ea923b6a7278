// The records that stand for a segment and for a circle between inner functions. An arc is a
// GeometryUtils::Arc, of which inner functions read everything but the end.

#pragma once

#include "geometry/elementary/Points.h"

namespace Vorn::Elementary {

/// The straight way from one point to another; a point when both are equal.
struct Segment {
  Point start;
  Point end;
};

/// A full circle.
struct Circle {
  Point centre;
  /// Not below zero, unless a function says what a negative one means.
  double radius = 0.0;
};

}  // namespace Vorn::Elementary
