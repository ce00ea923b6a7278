// Points that their neighbours do not bear out.
#include <Eigen/QR>
#include <algorithm>
#include <cmath>

#include "vorn/io/Spacing.h"
#include "vorn/io/Thinning.h"

namespace Vorn::IO {

namespace {

/// So many neighbours on one side tell where a point should be: one more than a parabola needs.
constexpr std::size_t kNeighbours = 4;
constexpr int kMostRows = 2 * static_cast<int>(kNeighbours);
constexpr int kTerms = 3;
constexpr std::size_t kFewest = 2 * kNeighbours + 1;

/// The standard deviation of a normal distribution is this multiple of the median of the sizes.
constexpr double kDeviationPerMedian = 1.4826022185056018;

using Rows = Eigen::Matrix<double, Eigen::Dynamic, kTerms, 0, kMostRows, kTerms>;
using Column = Eigen::Matrix<double, Eigen::Dynamic, 1, 0, kMostRows, 1>;

/// A stretch of neighbours, from `first` up to but not `last`.
struct Stretch {
  std::size_t first = 0;
  std::size_t last = 0;
};

/// How far the point is from the parabola of least squares through the others of the stretch. It is
/// laid along the chord of the stretch, with the point at its origin.
double FromParabola(std::vector<WPoint> const& points, std::size_t point, Stretch const& stretch) {
  WPoint const& begin = points[stretch.first];
  WPoint const& end = points[stretch.last - 1];
  double const chord = Distance(begin, end);
  if (!(chord > 0.0)) return Distance(begin, points[point]);
  double const alongX = (end.x - begin.x) / chord;
  double const alongY = (end.y - begin.y) / chord;
  bool const isInside = point >= stretch.first && point < stretch.last;
  auto const count = static_cast<Eigen::Index>(stretch.last - stretch.first - (isInside ? 1 : 0));
  Rows rows(count, kTerms);
  Column heights(count);
  Eigen::Index row = 0;
  for (std::size_t i = stretch.first; i < stretch.last; ++i) {
    if (i == point) continue;
    double const x = points[i].x - points[point].x;
    double const y = points[i].y - points[point].y;
    double const along = (x * alongX + y * alongY) / chord;
    rows.row(row) << 1.0, along, along * along;
    heights(row) = (y * alongX - x * alongY) / chord;
    ++row;
  }
  Eigen::Vector3d const terms = rows.colPivHouseholderQr().solve(heights);
  return std::fabs(terms(0)) / std::hypot(1.0, terms(1)) * chord;
}

/// The least of what the neighbours on both sides and on each alone say: at a corner, those of one
/// side know.
double FromNeighbours(std::vector<WPoint> const& points, std::size_t point) {
  std::size_t const begin = point - kNeighbours;
  std::size_t const end = point + 1 + kNeighbours;
  return std::min({FromParabola(points, point, {begin, point}),
                   FromParabola(points, point, {point + 1, end}),
                   FromParabola(points, point, {begin, end})});
}

double MedianOf(std::vector<double> values) {
  auto const middle = values.begin() + static_cast<std::ptrdiff_t>(values.size() / 2);
  std::nth_element(values.begin(), middle, values.end());
  return *middle;
}

}  // namespace

std::vector<Outlier> FindOutliers(std::vector<WPoint> const& points, double deviations) {
  if (points.size() < kFewest) return {};
  std::vector<double> distances;
  distances.reserve(points.size());
  for (std::size_t i = kNeighbours; i + kNeighbours < points.size(); ++i) {
    distances.push_back(FromNeighbours(points, i));
  }
  double const deviation = kDeviationPerMedian * MedianOf(distances);
  std::vector<Outlier> outliers;
  for (std::size_t i = 0; i < distances.size() && deviation > 0.0; ++i) {
    if (distances[i] > deviations * deviation) {
      outliers.push_back({i + kNeighbours, distances[i], distances[i] / deviation});
    }
  }
  return outliers;
}

}  // namespace Vorn::IO
