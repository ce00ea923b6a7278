// The point of a line cell whose line passes through given points.

#pragma once

#include <optional>

#include "geometry/cells/Bounds.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Cells {

/// The points that a line must pass through, when it is chosen from a line cell. The parameter
/// (u, v) of the cell's plane stands for the line v*x + y + u = 0.
struct FixedPoints {
  bool hasP1;
  Point p1;
  bool hasP2;
  Point p2;
  /// Whether the cell's parameters stand for x as a function of y: v*y + x + u = 0.
  bool swapped;

  /// Whether there is a point to pass through.
  bool IsAny() const { return hasP1 || hasP2; }

  /// What the fixed points leave of the cell's plane, as a triangle: a single point for two fixed
  /// points, a chord across the cell's bounding rectangle for one. Nothing for one point whose
  /// lines miss the rectangle, and for two points that no line of the form joins. There must be a
  /// point.
  std::optional<Triangle> FindCandidate(Rect const& rect) const;
};

/// The parameter of the line that is chosen from a cell: its centre, or the centre of the part of
/// the cell whose lines pass through the fixed points. Nothing for an empty cell, or when no line
/// of the cell passes through the points. `Cell` is PlainCell or CellSequence.
template <typename Cell>
std::optional<Point> CentreForLine(FixedPoints const& fixed, Cell const& cell) {
  if (!fixed.IsAny()) return cell.Centre();
  std::optional<Rect> const rect = cell.BoundingRect();
  if (!rect) return std::nullopt;
  std::optional<Triangle> const candidate = fixed.FindCandidate(*rect);
  if (!candidate) return std::nullopt;
  return cell.CentreOfOverlapWith(*candidate);
}

}  // namespace Vorn::Cells
