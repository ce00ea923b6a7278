// Notation: P0 .. P3 the tangent points, L1 .. L4 the lines P0P2, P1P2, P1P3, P0P3, each as
// A*x + B*y + D = 0.
#include "geometry/cells/LineCells.h"

#include <cmath>

#include "geometry/triangles/Ears.h"
#include "math/NumericConstants.h"

namespace Vorn::Cells {

namespace {

constexpr int kLines = kLineCellCorners;

/// The four lines through tangent points, coefficient by coefficient.
struct Bunch {
  explicit Bunch(TangentPoints const& points) {
    constexpr std::size_t kFrom[kLines] = {0, 1, 1, 0};
    constexpr std::size_t kTo[kLines] = {2, 2, 3, 3};
    for (int i = 0; i < kLines; ++i) {
      Point const& u = points[kFrom[i]];
      Point const& v = points[kTo[i]];
      a[i] = v.y - u.y;
      b[i] = u.x - v.x;
      d[i] = v.x * u.y - u.x * v.y;
    }
  }

  /// Whether the lines can be written in a form.
  bool IsValidFor(bool xOfY) const {
    return xOfY ? HaveOneSign(a, b, kLines) : HaveOneSign(b, a, kLines);
  }

  double a[kLines];
  double b[kLines];
  double d[kLines];
};

/// The corners of the cell in cyclic order: the parameter points of L2, L3, L4, L1.
LineCellCorners CornersOf(Bunch const& bunch, bool xOfY) {
  constexpr int kOrder[kLines] = {1, 2, 3, 0};
  LineCellCorners corners;
  for (std::size_t k = 0; k < corners.size(); ++k) {
    int const i = kOrder[k];
    corners[k] = xOfY ? Point{bunch.d[i] / bunch.a[i], bunch.b[i] / bunch.a[i]}
                      : Point{bunch.d[i] / bunch.b[i], bunch.a[i] / bunch.b[i]};
  }
  return corners;
}

}  // namespace

std::optional<TangentPoints> FindTangentPoints(WPoint const& a, WPoint const& b) {
  double const sum = a.w + b.w;
  if (Numeric::IsZero(sum)) {
    // Deliberate: here the first point comes first, the reverse of the general case.
    return TangentPoints{Point{a.x, a.y}, {a.x, a.y}, {b.x, b.y}, {b.x, b.y}};
  }
  double const dx = b.x - a.x;
  double const dy = b.y - a.y;
  double const length2 = dx * dx + dy * dy;
  double const sum2 = sum * sum;
  if (sum2 > length2) return std::nullopt;

  double const t = std::sqrt(length2 / sum2 - 1.0);
  double const kb = b.w * sum / length2;
  double const ka = a.w * sum / length2;
  return TangentPoints{Point{b.x - (t * dy + dx) * kb, b.y + (t * dx - dy) * kb},
                       {b.x + (t * dy - dx) * kb, b.y - (t * dx + dy) * kb},
                       {a.x + (dx + t * dy) * ka, a.y - (t * dx - dy) * ka},
                       {a.x + (dx - t * dy) * ka, a.y + (dy + t * dx) * ka}};
}

bool HaveOneSign(double const* den, double const* num, int n) {
  if (n < kLines) return false;
  for (int i = 0; i < n; ++i) {
    if (Numeric::IsZeroMagnitude(den[i])) return false;
  }
  double const firstAngle = std::fabs(std::atan2(num[0], den[0]));
  double const lastAngle = std::fabs(std::atan2(num[kLines - 1], den[kLines - 1]));
  constexpr double kRightAngle = Numeric::kTruncatedHalfPi;
  return (firstAngle < kRightAngle && lastAngle < kRightAngle) ||
         (firstAngle > kRightAngle && lastAngle > kRightAngle);
}

ErrorCode FindCorners(TangentPoints const& tangentPoints, LineForm* form,
                      LineCellCorners* corners) {
  Bunch const bunch(tangentPoints);
  bool const isChosenHere = !form->isChosen;
  if (isChosenHere) {
    form->isChosen = true;
    form->xOfY = std::fabs(bunch.a[kLines - 1]) > std::fabs(bunch.b[kLines - 1]);
  }
  if (!bunch.IsValidFor(form->xOfY)) {
    // A form that came from outside is never changed: all cells of a run must lie in one plane.
    if (!isChosenHere) return ErrorCode::InvalidLineCell;
    form->xOfY = !form->xOfY;
    if (!bunch.IsValidFor(form->xOfY)) return ErrorCode::InvalidLineCell;
  }
  *corners = CornersOf(bunch, form->xOfY);
  return ErrorCode::Ok;
}

LineCell Divide(LineCellCorners const& corners) {
  LineCellCorners ring = corners;
  LineCell cell;
  std::size_t size = 0;
  Triangles::CutEars(ring.data(), kLines, [&](Triangle const& ear) { cell[size++] = ear; });
  return cell;
}

ErrorCode FindLineCell(WPoint const& a, WPoint const& b, LineForm* form, LineCell* cell) {
  std::optional<TangentPoints> const tangentPoints = FindTangentPoints(a, b);
  if (!tangentPoints) return ErrorCode::Failed;
  LineCellCorners corners;
  ErrorCode const code = FindCorners(*tangentPoints, form, &corners);
  if (code == ErrorCode::Ok) *cell = Divide(corners);
  return code;
}

}  // namespace Vorn::Cells
