#include "geometry/fitting/arc/ClosePoints.h"

#include <cstddef>

#include "geometry/elementary/Points.h"
#include "geometry/fitting/runs/Runs.h"

namespace Vorn::Fitting {

namespace {

class Exclusion {
 public:
  Exclusion(std::vector<WPoint> const& points, double tolerance)
      : run_(RunOverAll(points)), tolerance_(tolerance) {}

  std::optional<std::vector<std::int32_t>> Find() {
    bool const isLastTooClose = ExcludeFromFirst();
    if (isLastTooClose) MakeRoomForLast();
    if (static_cast<std::size_t>(run_.count) - excluded_.size() < kFewestArcPoints) {
      return std::nullopt;
    }
    return excluded_;
  }

 private:
  bool AreTooClose(std::int32_t kept, std::int32_t candidate) const {
    double const distance = Elementary::Distance(run_.PointAt(kept), run_.PointAt(candidate));
    return tolerance_ > distance / kSpacingShare;
  }

  std::int32_t Last() const { return run_.count - 1; }

  /// From the first point on, excludes every point but the last that is too close to the one kept
  /// before it. Whether the last point is too close as well.
  bool ExcludeFromFirst() {
    std::int32_t kept = 0;
    for (std::int32_t i = 1; i < Last(); ++i) {
      if (AreTooClose(kept, i)) {
        excluded_.push_back(i);
      } else {
        kept = i;
      }
    }
    return AreTooClose(kept, Last());
  }

  /// Excludes a point for the sake of the last one. The caller asks whether enough are left.
  void MakeRoomForLast() {
    if (!excluded_.empty()) {
      SettleLast();
    } else {
      excluded_.push_back(Last() - 1);
    }
  }

  /// Backwards over the gaps between runs of excluded points: a kept point stands below each. The
  /// second one met is where the last point is measured again; it or the last point goes.
  /// Deliberate: with fewer gaps nothing goes, and the last point stays too close to its neighbour.
  void SettleLast() {
    int gaps = 0;
    for (std::size_t pos = excluded_.size() - 1; pos > 0; --pos) {
      if (excluded_[pos] == excluded_[pos - 1] + 1) continue;
      if (++gaps < 2) continue;
      std::int32_t const keptBelow = excluded_[pos] - 1;
      if (AreTooClose(keptBelow, Last())) {
        excluded_.push_back(Last());
      } else {
        excluded_.insert(excluded_.begin() + static_cast<std::ptrdiff_t>(pos), keptBelow);
      }
      return;
    }
  }

  Run const run_;
  double const tolerance_;
  std::vector<std::int32_t> excluded_;
};

}  // namespace

std::optional<std::vector<std::int32_t>> FindClosePoints(std::vector<WPoint> const& points,
                                                         ToleranceEstimate const& estimate) {
  if (!(estimate.tolerance > estimate.greatestForAll)) return std::vector<std::int32_t>{};
  return Exclusion(points, estimate.tolerance).Find();
}

}  // namespace Vorn::Fitting
