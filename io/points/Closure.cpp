#include "vorn/io/Closure.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "vorn/io/Spacing.h"

namespace Vorn::IO {

namespace {

using std::numbers::pi;

constexpr std::size_t kLeastPoints = 8;
constexpr std::size_t kLeastClosed = 3;
constexpr std::size_t kStepsLookedAt = 5;
constexpr double kLargestGapInSteps = 1.5;
constexpr double kSharpestTurn = 135.0 / 180.0 * pi;

constexpr double kStretchInTolerances = 20.0;
constexpr double kLargestShareOfLength = 1.0 / 20.0;
constexpr double kLeastSeamTurn = 20.0 / 180.0 * pi;

/// Between the directions a to b and c to d; 0 when one of them has no length.
double TurnBetween(WPoint const& a, WPoint const& b, WPoint const& c, WPoint const& d) {
  double const x1 = b.x - a.x;
  double const y1 = b.y - a.y;
  double const x2 = d.x - c.x;
  double const y2 = d.y - c.y;
  return std::fabs(std::atan2(x1 * y2 - y1 * x2, x1 * x2 + y1 * y2));
}

double LongestStepAtEnds(std::vector<WPoint> const& points) {
  double longest = 0.0;
  std::size_t const last = points.size() - 1;
  for (std::size_t i = 0; i < kStepsLookedAt; ++i) {
    longest = std::max({longest, Distance(points[i], points[i + 1]),
                        Distance(points[last - i], points[last - i - 1])});
  }
  return longest;
}

/// Why points whose last is not the first again are open; nothing when they look closed.
std::optional<std::string> WhyOpen(std::vector<WPoint> const& points, double gap) {
  if (points.size() < kLeastPoints) return "the last point is not the first";
  if (gap > kLargestGapInSteps * LongestStepAtEnds(points)) {
    return "the ends are further apart than the points next to them";
  }
  std::size_t const last = points.size() - 1;
  double const turn =
      TurnBetween(points[last - kStepsLookedAt], points[last], points[0], points[kStepsLookedAt]);
  if (turn > kSharpestTurn) return "the contour would turn back between its ends";
  return {};
}

Closure Judge(std::vector<WPoint> const& points, Closure closure) {
  if (closure.repeatsFirst) {
    closure.isClosed = points.size() > kLeastClosed;
    closure.reason = "the last point is the first";
    return closure;
  }
  std::optional<std::string> const whyOpen = WhyOpen(points, closure.gap);
  closure.isClosed = !whyOpen;
  closure.reason = whyOpen.value_or("the ends are as near as neighbours");
  return closure;
}

std::size_t DistinctCount(std::vector<WPoint> const& points, Closure const& closure) {
  return points.size() - (closure.repeatsFirst ? 1 : 0);
}

/// A closed walk over the points, by its length from the first one.
class Walk {
 public:
  Walk(std::vector<WPoint> const& points, std::size_t count) : points_(points), count_(count) {
    for (std::size_t i = 0; i < 2 * count; ++i) {
      lengths_.push_back(lengths_.back() + Distance(At(i), At(i + 1)));
    }
  }

  double Length() const { return lengths_[count_]; }

  /// How much the walk turns at each point, compared over `stretch` before and after it.
  std::vector<double> Turns(double stretch) const {
    std::vector<double> turns(count_);
    std::size_t before = 0;
    std::size_t after = 0;
    for (std::size_t i = count_; i < 2 * count_; ++i) {
      // The nearest points at least a stretch away. Both move on only, so this takes one round.
      while (before + 1 < i && lengths_[i] - lengths_[before + 1] >= stretch) ++before;
      after = std::max(after, i + 1);
      while (after < 2 * count_ && lengths_[after] - lengths_[i] < stretch) ++after;
      turns[i - count_] = TurnBetween(At(before), At(i), At(i), At(after));
    }
    return turns;
  }

 private:
  WPoint const& At(std::size_t i) const { return points_[i % count_]; }

  std::vector<WPoint> const& points_;
  std::size_t count_;
  std::vector<double> lengths_ = {0.0};  ///< two rounds, so that every point has both sides
};

double MedianTolerance(std::vector<WPoint> const& points) {
  std::vector<double> tolerances;
  tolerances.reserve(points.size());
  for (WPoint const& point : points) tolerances.push_back(point.w);
  auto const middle = tolerances.begin() + static_cast<std::ptrdiff_t>(tolerances.size() / 2);
  std::nth_element(tolerances.begin(), middle, tolerances.end());
  return *middle;
}

}  // namespace

Closure FindClosure(std::vector<WPoint> const& points, ClosedChoice choice) {
  if (points.empty()) return {false, false, 0.0, "there are no points"};
  WPoint const& first = points.front();
  WPoint const& last = points.back();
  Closure closure;
  closure.gap = Distance(last, first);
  closure.repeatsFirst = first.x == last.x && first.y == last.y;
  if (choice == ClosedChoice::Auto) return Judge(points, closure);
  closure.isClosed = choice == ClosedChoice::Yes;
  closure.reason = "as asked for";
  return closure;
}

Circuit MakeCircuit(std::vector<WPoint> const& points, Closure const& closure, std::size_t seam) {
  std::size_t const count = DistinctCount(points, closure);
  Circuit circuit;
  for (std::size_t i = 0; i <= count; ++i) {
    std::size_t const index = (seam + i) % count;
    circuit.points.push_back(points[index]);
    circuit.origin.push_back(index);
  }
  return circuit;
}

std::optional<std::size_t> SharpestCorner(std::vector<WPoint> const& points,
                                          Closure const& closure) {
  Walk const walk(points, DistinctCount(points, closure));
  double const stretch = std::min(kStretchInTolerances * MedianTolerance(points),
                                  kLargestShareOfLength * walk.Length());
  std::vector<double> const turns = walk.Turns(stretch);
  auto const sharpest = std::max_element(turns.begin(), turns.end());
  if (*sharpest <= kLeastSeamTurn) return {};
  return static_cast<std::size_t>(sharpest - turns.begin());
}

}  // namespace Vorn::IO
