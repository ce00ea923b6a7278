// Points of dense scans: one every so far, and means in windows along the path.
#include <algorithm>
#include <cmath>

#include "vorn/io/Spacing.h"
#include "vorn/io/Thinning.h"

namespace Vorn::IO {

namespace {

/// Sums over points, about the first of them so that far places lose no digits.
class Cloud {
 public:
  void Add(WPoint const& point) {
    if (count_ == 0) origin_ = point;
    double const x = point.x - origin_.x;
    double const y = point.y - origin_.y;
    ++count_;
    x_ += x;
    y_ += y;
    xx_ += x * x;
    xy_ += x * y;
    yy_ += y * y;
  }

  std::size_t Count() const { return count_; }

  WPoint Mean() const {
    auto const n = static_cast<double>(count_);
    return {origin_.x + x_ / n, origin_.y + y_ / n, origin_.w};
  }

  /// The mean square of the distances from the line of least squares: the smaller eigenvalue of the
  /// covariances.
  double SquareAcross() const {
    Moments const m = Central();
    double const half = (m.xx - m.yy) / 2.0;
    return std::max(0.0, (m.xx + m.yy) / 2.0 - std::hypot(half, m.xy));
  }

 private:
  struct Moments {
    double xx = 0.0;
    double xy = 0.0;
    double yy = 0.0;
  };

  Moments Central() const {
    auto const n = static_cast<double>(count_);
    return {xx_ / n - x_ / n * (x_ / n), xy_ / n - x_ / n * (y_ / n), yy_ / n - y_ / n * (y_ / n)};
  }

  WPoint origin_;
  std::size_t count_ = 0;
  double x_ = 0.0;
  double y_ = 0.0;
  double xx_ = 0.0;
  double xy_ = 0.0;
  double yy_ = 0.0;
};

/// Adds the windows up.
class Windows {
 public:
  void Close(Cloud const& cloud) {
    if (cloud.Count() == 0) return;
    double const square = cloud.SquareAcross();
    averages_.points.push_back(cloud.Mean());
    averages_.largestDeviation = std::max(averages_.largestDeviation, std::sqrt(square));
    averages_.fewest = count_ == 0 ? cloud.Count() : std::min(averages_.fewest, cloud.Count());
    averages_.most = std::max(averages_.most, cloud.Count());
    squares_ += square;
    ++count_;
  }

  void Keep(WPoint const& point) { averages_.points.push_back(point); }

  Averages Result() {
    if (count_ > 0) averages_.meanDeviation = std::sqrt(squares_ / static_cast<double>(count_));
    return averages_;
  }

 private:
  Averages averages_;
  double squares_ = 0.0;
  std::size_t count_ = 0;
};

}  // namespace

std::vector<std::size_t> KeepEvery(std::vector<WPoint> const& points, double spacing) {
  std::vector<std::size_t> kept = {0};
  double along = 0.0;
  for (std::size_t i = 1; i + 1 < points.size(); ++i) {
    along += Distance(points[i - 1], points[i]);
    if (along < spacing) continue;
    kept.push_back(i);
    along = 0.0;
  }
  if (points.size() > 1) kept.push_back(points.size() - 1);
  return kept;
}

Averages AverageAlong(std::vector<WPoint> const& points, double window) {
  Windows windows;
  windows.Keep(points.front());
  Cloud cloud;
  double along = 0.0;
  for (std::size_t i = 1; i + 1 < points.size(); ++i) {
    along += Distance(points[i - 1], points[i]);
    if (along >= window) {
      windows.Close(cloud);
      cloud = {};
      along = 0.0;
    }
    cloud.Add(points[i]);
  }
  windows.Close(cloud);
  windows.Keep(points.back());
  return windows.Result();
}

}  // namespace Vorn::IO
