// What makes it safe to leave pairs out, u = 2^-53 being the rounding of one operation.
//
// Two segments whose boxes are apart are Disjoint by the first step of their intersection. If their
// boxes are not apart but the segments are, by a distance g, then at least one end point lies on
// the wrong side of the other segment's line, by g times the sine of the angle between that segment
// and the shortest connection. Unless both sines are below 1/sqrt(2) the cross products show it,
// for they are exact to 12 u times the largest coordinate per unit of length; and if both were, the
// boxes would be apart. So g above 40 u times the largest coordinate is enough. Slanted bounds are
// themselves computed, over at most 32 levels with some 30 u each, hence the larger margin.
//
// A common point of a circle and a segment or a circle, as it is computed, misses the circle: the
// square of its distance from the centre is wrong by at most 60 u D^2, with D above all lengths in
// the formulas, by which the point is off by at most 60 u D^2 / radius and 8 sqrt(u) D; and it is
// rounded by some 30 u D. A chord that counts as tangency adds at most four tangency thresholds
// squared. The point counts by its angle, so the region of an arc is the box of its angular range,
// padded. Underflow adds nothing that matters as long as differences of coordinates are zero or
// well above the square root of the smallest double, which holds when the coordinates are.

#include "geometry/contours/near/PieceExtents.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "math/NumericConstants.h"

namespace Vorn::Contours {

namespace {

using Point = GeometryUtils::Point;
using Arc = GeometryUtils::Arc;

constexpr double kEpsilon = std::numeric_limits<double>::epsilon();

/// Magnitudes whose fourth powers neither overflow nor vanish.
constexpr double kSmallestRegular = 1e-60;
constexpr double kLargestRegular = 1e60;

/// Arcs much larger than the contour would take all others' bounds along with them.
constexpr double kLargestToContour = 1024.0;

bool IsRegularMagnitude(double magnitude) {
  return kSmallestRegular <= magnitude && magnitude <= kLargestRegular;
}

bool IsRegularPoint(Point const& p) {
  return (p.x == 0.0 || IsRegularMagnitude(std::fabs(p.x))) &&
         (p.y == 0.0 || IsRegularMagnitude(std::fabs(p.y)));
}

double LargestOf(Point const& p) { return std::max(std::fabs(p.x), std::fabs(p.y)); }

Box BoxOfSegment(Point const& a, Point const& b) {
  return {std::min(a.x, b.x), std::max(a.x, b.x), std::min(a.y, b.y), std::max(a.y, b.y)};
}

/// Adds what a circle covers between two polar angles, as far as these are angles of atan2.
void IncludeSweep(Arc const& arc, double from, double to, Box* box) {
  double const pi = std::acos(-1.0);
  double const low = std::max(from, -pi);
  double const high = std::min(to, pi);
  if (low > high) return;
  double const quarter = 0.5 * pi;
  auto const covers = [&](double angle) { return low <= angle && angle <= high; };
  double const cosLow = std::cos(low);
  double const sinLow = std::sin(low);
  double const cosHigh = std::cos(high);
  double const sinHigh = std::sin(high);
  double const left = std::min(cosLow, cosHigh);
  double const right = covers(0.0) ? 1.0 : std::max(cosLow, cosHigh);
  double const bottom = covers(-quarter) ? -1.0 : std::min(sinLow, sinHigh);
  double const top = covers(quarter) ? 1.0 : std::max(sinLow, sinHigh);
  Point const& c = arc.center;
  double const r = arc.radius;
  box->Include({c.x + r * left, c.x + r * right, c.y + r * bottom, c.y + r * top});
}

}  // namespace

PieceExtents::PieceExtents(std::vector<std::vector<Shape> const*> const& sets) {
  for (std::vector<Shape> const* shapes : sets) {
    for (Shape const& shape : *shapes) {
      if (IsRegularPoint(shape.end)) largestEnd_ = std::max(largestEnd_, LargestOf(shape.end));
    }
  }
  for (std::vector<Shape> const* shapes : sets) {
    for (Shape const& shape : *shapes) {
      if (!IsRegular(shape)) continue;
      if (shape.arc != nullptr) {
        largestCoordinate_ = std::max(largestCoordinate_, LargestOf(shape.arc->center));
        largestRadius_ = std::max(largestRadius_, shape.arc->radius);
      } else {
        double const largest = std::max(LargestOf(shape.start), LargestOf(shape.end));
        largestCoordinate_ = std::max(largestCoordinate_, largest);
      }
    }
  }
}

bool PieceExtents::IsRegular(Shape const& shape) const {
  if (shape.arc == nullptr) return IsRegularPoint(shape.start) && IsRegularPoint(shape.end);
  Arc const& arc = *shape.arc;
  double const largest = kLargestToContour * largestEnd_;
  return IsRegularPoint(arc.center) && IsRegularMagnitude(arc.radius) && arc.radius <= largest &&
         LargestOf(arc.center) <= largest && std::isfinite(arc.startAngle) &&
         std::isfinite(arc.endAngle);
}

std::vector<Extent> PieceExtents::Of(std::vector<Shape> const& shapes,
                                     std::vector<std::size_t>* irregular) const {
  std::vector<Extent> extents;
  extents.reserve(shapes.size());
  for (Shape const& shape : shapes) {
    if (IsRegular(shape)) {
      extents.push_back(ExtentOf(shape));
    } else {
      irregular->push_back(extents.size());
      extents.push_back({});
    }
  }
  return extents;
}

double PieceExtents::SlantedMargin() const {
  return 2048.0 * kEpsilon * (largestCoordinate_ + largestRadius_);
}

Extent PieceExtents::ExtentOf(Shape const& shape) const {
  if (shape.arc != nullptr) return {BoxOfArc(*shape.arc), true, false};
  Point const& a = shape.start;
  Point const& b = shape.end;
  return {BoxOfSegment(a, b), (a.x <= b.x) == (a.y <= b.y), true};
}

Box PieceExtents::BoxOfArc(Arc const& arc) const {
  bool const isCounterClockwise = arc.direction > 0.0;
  double const low = isCounterClockwise ? arc.startAngle : arc.endAngle;
  double const high = isCounterClockwise ? arc.endAngle : arc.startAngle;
  Box box;
  if (high > low) {
    IncludeSweep(arc, low, high, &box);
  } else {
    constexpr double kBeyondAnyAngle = 4.0;
    IncludeSweep(arc, low, kBeyondAnyAngle, &box);
    IncludeSweep(arc, -kBeyondAnyAngle, high, &box);
  }
  if (box.IsEmpty()) return box;
  double const padding = PaddingOf(arc);
  return {box.xLow - padding, box.xHigh + padding, box.yLow - padding, box.yHigh + padding};
}

double PieceExtents::PaddingOf(Arc const& arc) const {
  double const lengths = 6.0 * largestCoordinate_ + 3.0 * largestRadius_;
  double const squareError =
      64.0 * kEpsilon * lengths * lengths + 8.0 * Numeric::kTangency * Numeric::kTangency;
  return std::min(squareError / arc.radius, std::sqrt(squareError)) + 64.0 * kEpsilon * lengths;
}

}  // namespace Vorn::Contours
