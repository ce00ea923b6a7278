#include "cli/analysis/Corners.h"

#include <cmath>
#include <numbers>

#include "cli/Spacing.h"

namespace Vorn::Cli {

namespace {

/// The turn between two chords of 25 times the noise has a standard deviation of sqrt(6) / 25
/// radians, 5.6 degrees: kLeastCorner is more than five of them away.
constexpr double kReachPerNoise = 25.0;

std::vector<double> PlacesAlong(std::vector<WPoint> const& points) {
  std::vector<double> places(points.size());
  for (std::size_t i = 1; i < points.size(); ++i) {
    places[i] = places[i - 1] + Distance(points[i - 1], points[i]);
  }
  return places;
}

Corner CornerAt(std::vector<WPoint> const& points, std::size_t before, std::size_t at,
                std::size_t after) {
  double const inX = points[at].x - points[before].x;
  double const inY = points[at].y - points[before].y;
  double const outX = points[after].x - points[at].x;
  double const outY = points[after].y - points[at].y;
  double const turn = std::atan2(inX * outY - inY * outX, inX * outX + inY * outY);
  return {at, std::fabs(turn) * 180.0 / std::numbers::pi, turn > 0.0};
}

/// Collects corners and keeps the sharpest of those that are one and the same.
class Collector {
 public:
  Collector(std::vector<double> const& places, double reach) : places_(places), reach_(reach) {}

  void Add(Corner const& corner) {
    bool const isNew = corners_.empty() || places_[corner.point] - places_[latest_] > reach_;
    latest_ = corner.point;
    if (isNew) {
      corners_.push_back(corner);
    } else if (corner.degrees > corners_.back().degrees) {
      corners_.back() = corner;
    }
  }

  std::vector<Corner> Take() { return std::move(corners_); }

 private:
  std::vector<double> const& places_;
  double reach_;
  std::size_t latest_ = 0;
  std::vector<Corner> corners_;
};

}  // namespace

std::vector<Corner> FindCorners(std::vector<WPoint> const& points, double reach) {
  std::vector<double> const places = PlacesAlong(points);
  auto const isFar = [&](std::size_t from, std::size_t to) {
    double const distance = places[to] - places[from];
    return distance >= reach && distance > 0.0;
  };
  Collector corners(places, reach);
  std::size_t before = 0;
  std::size_t after = 0;
  for (std::size_t at = 0; at < points.size(); ++at) {
    while (before + 1 < at && isFar(before + 1, at)) ++before;
    while (after < points.size() && !isFar(at, after)) ++after;
    if (after == points.size()) break;
    if (!isFar(before, at)) continue;
    // Of points in one place the first stands for all.
    if (places[at] == places[at - 1]) continue;
    Corner const corner = CornerAt(points, before, at, after);
    if (corner.degrees >= kLeastCorner) corners.Add(corner);
  }
  return corners.Take();
}

double ReachForNoise(double noise) { return kReachPerNoise * noise; }

}  // namespace Vorn::Cli
