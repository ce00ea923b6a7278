// The bounds that boxes give hold for the rounded distances too: a difference, a square and a sum
// of squares never fall when their parts grow, rounded or not.

#include "geometry/fitting/arc/PointSpread.h"

#include <algorithm>
#include <cmath>
#include <cstddef>

#include "geometry/elementary/Points.h"
#include "geometry/fitting/runs/Runs.h"
#include "math/Assert.h"

namespace Vorn::Fitting {

namespace {

double Distance2(WPoint const& a, WPoint const& b) {
  return Elementary::SquaredDistance(ToPoint(a), ToPoint(b));
}

/// How many neighbours share a box: with the cube root of n, pairs of boxes and pairs of points of
/// neighbouring boxes are both about n to the power of 4/3.
std::size_t GroupSize(std::size_t count) {
  return std::max<std::size_t>(16, static_cast<std::size_t>(std::cbrt(static_cast<double>(count))));
}

/// Neighbouring points and the box around them.
struct Group {
  Group(std::vector<WPoint> const& points, std::size_t from, std::size_t to)
      : begin(from), end(to) {
    xMin = xMax = points[begin].x;
    yMin = yMax = points[begin].y;
    for (std::size_t i = begin + 1; i < end; ++i) {
      xMin = std::min(xMin, points[i].x);
      xMax = std::max(xMax, points[i].x);
      yMin = std::min(yMin, points[i].y);
      yMax = std::max(yMax, points[i].y);
    }
  }

  /// No point of this group is further from one of the other.
  double MostDistance2(Group const& other) const {
    double const dx = std::max(xMax - other.xMin, other.xMax - xMin);
    double const dy = std::max(yMax - other.yMin, other.yMax - yMin);
    return dy * dy + dx * dx;
  }

  /// No point of this group is nearer to one of the other.
  double LeastDistance2(Group const& other) const {
    double const dx = std::max({xMin - other.xMax, other.xMin - xMax, 0.0});
    double const dy = std::max({yMin - other.yMax, other.yMin - yMax, 0.0});
    return dy * dy + dx * dx;
  }

  std::size_t begin;
  std::size_t end;
  double xMin, xMax, yMin, yMax;
};

class SpreadSearch {
 public:
  explicit SpreadSearch(std::vector<WPoint> const& points) : points_(points) {
    std::size_t const size = GroupSize(points.size());
    for (std::size_t i = 0; i < points.size(); i += size) {
      groups_.emplace_back(points, i, std::min(i + size, points.size()));
    }
  }

  PointSpread Find() {
    spread_.largest2 = spread_.smallest2 = Distance2(points_[0], points_[1]);
    FindFarGroups();
    // From group to itself, then to its neighbour and so on: the nearest pair is found early.
    for (std::size_t apart = 0; apart < groups_.size(); ++apart) {
      for (std::size_t g = 0; g + apart < groups_.size(); ++g) {
        Compare(groups_[g], groups_[g + apart]);
      }
    }
    FindFirstFarthest();
    return spread_;
  }

 private:
  /// One point of each group gives a distance that few pairs of groups can exceed.
  void FindFarGroups() {
    for (std::size_t g = 0; g < groups_.size(); ++g) {
      for (std::size_t h = g + 1; h < groups_.size(); ++h) {
        double const distance2 = Distance2(points_[groups_[g].begin], points_[groups_[h].begin]);
        spread_.largest2 = std::max(spread_.largest2, distance2);
      }
    }
  }

  void Compare(Group const& first, Group const& second) {
    bool const canBeFarther = first.MostDistance2(second) > spread_.largest2;
    bool const canBeNearer = first.LeastDistance2(second) < spread_.smallest2;
    if (!canBeFarther && !canBeNearer) return;
    for (std::size_t i = first.begin; i < first.end; ++i) {
      for (std::size_t j = std::max(second.begin, i + 1); j < second.end; ++j) {
        double const distance2 = Distance2(points_[i], points_[j]);
        spread_.largest2 = std::max(spread_.largest2, distance2);
        spread_.smallest2 = std::min(spread_.smallest2, distance2);
      }
    }
  }

  void FindFirstFarthest() {
    for (std::size_t g = 0; g < groups_.size(); ++g) {
      Group const& first = groups_[g];
      std::vector<Group const*> const candidates = GroupsThatReach(g);
      for (std::size_t i = first.begin; i < first.end; ++i) {
        if (FindFarthestFrom(i, candidates)) return;
      }
    }
  }

  /// Makes the farthest pair that of one point and the first behind it that is as far away. False
  /// when there is none in the groups.
  bool FindFarthestFrom(std::size_t i, std::vector<Group const*> const& groups) {
    for (Group const* group : groups) {
      for (std::size_t j = std::max(group->begin, i + 1); j < group->end; ++j) {
        if (Distance2(points_[i], points_[j]) != spread_.largest2) continue;
        spread_.i = static_cast<std::int32_t>(i);
        spread_.j = static_cast<std::int32_t>(j);
        return true;
      }
    }
    return false;
  }

  /// The groups from this one on that may hold the other end of a farthest pair.
  std::vector<Group const*> GroupsThatReach(std::size_t first) const {
    std::vector<Group const*> reaching;
    for (std::size_t g = first; g < groups_.size(); ++g) {
      bool const reaches = groups_[first].MostDistance2(groups_[g]) >= spread_.largest2;
      if (reaches) reaching.push_back(&groups_[g]);
    }
    return reaching;
  }

  std::vector<WPoint> const& points_;
  std::vector<Group> groups_;
  PointSpread spread_;
};

/// Pair by pair: a distance that is not a number is neither larger nor smaller than any other, and
/// boxes cannot tell.
PointSpread FindSpreadOfAnything(std::vector<WPoint> const& points) {
  PointSpread spread;
  spread.largest2 = spread.smallest2 = Distance2(points[0], points[1]);
  Run const run = RunOverAll(points);
  for (std::int32_t i = 0; i < run.count; ++i) {
    for (std::int32_t j = i + 1; j < run.count; ++j) {
      double const distance2 = Distance2(run[i], run[j]);
      if (distance2 > spread.largest2) {
        spread.largest2 = distance2;
        spread.i = i;
        spread.j = j;
      }
      if (distance2 < spread.smallest2) spread.smallest2 = distance2;
    }
  }
  return spread;
}

bool IsFinite(WPoint const& p) { return std::isfinite(p.x) && std::isfinite(p.y); }

}  // namespace

PointSpread FindSpread(std::vector<WPoint> const& points) {
  VORN_ASSERT(points.size() >= 2);
  bool const areFinite = std::all_of(points.begin(), points.end(), IsFinite);
  return areFinite ? SpreadSearch(points).Find() : FindSpreadOfAnything(points);
}

}  // namespace Vorn::Fitting
