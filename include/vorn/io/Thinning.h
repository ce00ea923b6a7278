#pragma once

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "vorn/Types.h"
#include "vorn/io/Export.h"
#include "vorn/io/Points.h"
#include "vorn/io/Tolerances.h"

namespace Vorn::IO {

/// Whether two points are too close to each other to be neighbours.
using TooClose = std::function<bool(WPoint const&, WPoint const&)>;

/// The rule for points whose tolerances are assigned; see AreTooClose.
VORN_IO_EXPORT TooClose RuleOfTolerances();

/// The rule for points that get their tolerances from the spacing that is left: only those are too
/// close that leave no tolerance above zero.
VORN_IO_EXPORT TooClose RuleOfSpacing(double cap);

/// The indices of the points to keep so that no two neighbours are too close: the first point, then
/// always the next one far enough from the one kept before. The last point is kept as well, in
/// place of those just before it that are too close to it. Fewer than two indices when even the
/// first and the last point cannot be neighbours. O(n).
VORN_IO_EXPORT std::vector<std::size_t> KeepSpaced(std::vector<WPoint> const& points,
                                                   TooClose const& tooClose);

/// Of a closed contour: takes those away at the end that are too close to the first point.
VORN_IO_EXPORT void DropCloseToFirst(std::vector<WPoint> const& points, TooClose const& tooClose,
                                     std::vector<std::size_t>* kept);

/// The indices of the first point, of the next one that is at least `spacing` along the path behind
/// the one kept before, and so on, and of the last point. Needs a point. O(n).
VORN_IO_EXPORT std::vector<std::size_t> KeepEvery(std::vector<WPoint> const& points,
                                                  double spacing);

/// Points that stand for several.
struct Averages {
  std::vector<WPoint> points;     ///< the means; `w` is that of the first point of each window
  double largestDeviation = 0.0;  ///< the largest standard deviation across the path of a window
  double meanDeviation = 0.0;     ///< the root of the mean of their squares
  std::size_t fewest = 0;         ///< points in the smallest window
  std::size_t most = 0;           ///< points in the largest one
};

/// The mean of the points in each window of `window` along the path. The first and the last point
/// of an open path stay as they are, with no window; so the path gets no shorter. Across the path
/// means from the line of least squares through the points of the window. Needs two points. O(n).
VORN_IO_EXPORT Averages AverageAlong(std::vector<WPoint> const& points, double window);

/// A point that its neighbours do not bear out.
struct Outlier {
  std::size_t point = 0;    ///< its index
  double distance = 0.0;    ///< from where its neighbours have it
  double deviations = 0.0;  ///< the same in standard deviations of all such distances
};

/// The points further than `deviations` standard deviations from where their neighbours have them:
/// from the parabola of least squares through four points before, four behind, or all eight, by
/// which it is nearest; so corners are no outliers. The standard deviation follows from the median
/// of all distances, so that outliers do not hide each other. Nothing for less than nine points,
/// and where most points lie so exactly that they do not deviate at all. O(n).
VORN_IO_EXPORT std::vector<Outlier> FindOutliers(std::vector<WPoint> const& points,
                                                 double deviations);

/// The indices from 0 to count - 1 that are not in the ascending list.
VORN_IO_EXPORT std::vector<std::size_t> Others(std::vector<std::size_t> const& kept,
                                               std::size_t count);

/// The text without the lines of these numbers, counted from 1 and ascending; every other byte
/// stays as it was.
VORN_IO_EXPORT std::string WithoutLines(std::string_view text,
                                        std::vector<std::size_t> const& lines);

}  // namespace Vorn::IO
