// Cells of admissible lines.
//
// A line that passes within the tolerances of two measured points lies between the four tangents of
// their tolerance circles. In the plane of line parameters those tangents are the corners of a
// convex quadrilateral, the line cell of the pair.

#pragma once

#include <array>
#include <cstddef>
#include <optional>

#include "geometry/triangles/Triangle.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Cells {

using Elementary::Point;
using Triangles::Triangle;

/// The lines that bound a line cell, and the corners that stand for them.
inline constexpr std::size_t kLineCellCorners = 4;

/// The four points P0, P1, P2, P3 where the two crossing common tangents touch the tolerance
/// circles of two points: P0 and P1 on the circle of the second point, P2 and P3 on that of the
/// first; P0-P2 and P1-P3 are the tangents.
using TangentPoints = std::array<Point, kLineCellCorners>;

/// The tangent points of two measured points; nothing when their circles overlap. Deliberate: when
/// the sum of the tolerances is tiny or negative, the points themselves, first point first.
std::optional<TangentPoints> FindTangentPoints(WPoint const& a, WPoint const& b);

/// The form in which the parameters (u, v) of a line are written, v*x + y + u = 0 or, exchanged,
/// v*y + x + u = 0. All cells of a run must have one form.
struct LineForm {
  /// Whether the form is chosen; as long as it is not, the next cell chooses it.
  bool isChosen = false;
  /// Whether x is a function of y.
  bool xOfY = false;
};

/// The corners of a line cell in boundary order.
using LineCellCorners = std::array<Point, kLineCellCorners>;

/// The triangles of a line cell.
using LineCell = std::array<Triangle, kLineCellCorners - 2>;

/// Whether lines can be written with denominators of one sign: false when one is tiny in magnitude,
/// otherwise whether the angles atan2(num, den) of the lines 0 and 3 lie on one side of a right
/// angle. Deliberate: only these two, the outermost of a cell's bunch, are compared. False for
/// fewer than four lines.
bool HaveOneSign(double const* den, double const* num, int n);

/// The corners of the cell of the lines that tangent points span. Chooses the form if that is still
/// open; one chosen here is changed once before giving up. InvalidLineCell when the lines cannot be
/// written in the form, which then still is the one tried last.
ErrorCode FindCorners(TangentPoints const& tangentPoints, LineForm* form, LineCellCorners* corners);

/// The triangles of a cell.
LineCell Divide(LineCellCorners const& corners);

/// The line cell of two measured points. Failed, form unchanged, when their tolerance circles
/// overlap; otherwise the code of FindCorners.
ErrorCode FindLineCell(WPoint const& a, WPoint const& b, LineForm* form, LineCell* cell);

}  // namespace Vorn::Cells
