#pragma once

#include "vorn/GeometryUtils.h"

namespace Vorn::Cells {

/// The part of the line a*x + b*y + c = 0 inside the circle around a bounding rectangle, as a
/// degenerate triangle: (P1, P2, P2), or (P1, P1, P1) where the line only touches. False where it
/// misses the circle.
bool ChordAcross(double const* rect, double a, double b, double c, GeometryUtils::Triangle* chord);

/// The points that a line must pass through, when it is chosen from a line cell.
struct FixedPoints {
  bool hasP1;
  GeometryUtils::Point p1;
  bool hasP2;
  GeometryUtils::Point p2;
  /// Whether the cell's parameters stand for x as a function of y.
  bool swapped;

  bool IsAny() const { return hasP1 || hasP2; }

  /// What the fixed points leave of a cell's plane, as a triangle: a single point for two fixed
  /// points, a chord across the cell's bounding rectangle for one. False when there is nothing.
  bool FindCandidate(double const* rect, GeometryUtils::Triangle* candidate) const;
};

}  // namespace Vorn::Cells
