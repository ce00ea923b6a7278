#pragma once

#include <optional>
#include <vector>

#include "vorn/io/Export.h"
#include "vorn/io/Pieces.h"

namespace Vorn::IO {

/// How points lie about the line or circle that fits them best. Distances are orthogonal.
struct Scatter {
  /// From the outermost point on one side to the outermost on the other.
  double formError = 0.0;
  /// The root of the sum of the squared distances over the number of points less the number of
  /// parameters (line 2, circle 3). Nothing when there are no more points than parameters.
  std::optional<double> standardDeviation;
};

/// The line with the least sum of squared orthogonal distances from some points.
struct LeastSquaresLine {
  XY at;                   ///< the mean of the points, which the line runs through
  double direction = 0.0;  ///< polar angle in (-pi/2, pi/2], radians
  Scatter scatter;         ///< of the points about the line
  /// Standard deviation of the direction in radians, if the distances are independent.
  std::optional<double> directionDeviation;
};

/// The circle with the least sum of squared orthogonal distances from some points.
struct LeastSquaresCircle {
  XY center;            ///< of the circle
  double radius = 0.0;  ///< above 0
  Scatter scatter;      ///< of the points about the circle
  /// Standard deviation of the radius, if the distances are independent. On a flat arc it is much
  /// larger than that of the points.
  std::optional<double> radiusDeviation;
};

/// The line through at least two different points, in closed form: its direction is that of the
/// largest variance.
///
/// Coordinates are taken from the mean of the points and in units of their extent, so the answer is
/// as good far from the origin as near it.
///
/// @return nothing without two different points, and when a coordinate or a distance of two points
///         is not finite. Where no direction has a larger variance than another it is 0.
/// @note Property: moved, turned and scaled points give the moved, turned and scaled line, up to
///       rounding. O(n).
VORN_IO_EXPORT std::optional<LeastSquaresLine> FitLine(std::vector<XY> const& points);

/// The circle that is nearest to at least three different points, by orthogonal distances and not
/// by the algebraic ones that make short arcs too small.
///
/// Begins with Taubin's algebraic fit and goes on by damped Gauss-Newton steps in the curvature,
/// the direction of the normal and the offset at the place of the circle nearest to the mean of the
/// points (Chernov and Lesort, "Least squares fitting of circles", Journal of Mathematical Imaging
/// and Vision 23, 2005). These stay of the size of the points where centre and radius of a flat arc
/// go to infinity. For points within `e` of an arc of height `h` the radius is as well determined
/// as they allow: up to about `e / h` of itself.
///
/// @return nothing with less than three different points, when a coordinate or a distance of two
///         points is not finite, and when the best circle is straight to within the rounding of the
///         points.
/// @note Property: moved, turned and scaled points give the moved, turned and scaled circle, up to
///       rounding. O(n) for each of some ten steps.
VORN_IO_EXPORT std::optional<LeastSquaresCircle> FitCircle(std::vector<XY> const& points);

}  // namespace Vorn::IO
