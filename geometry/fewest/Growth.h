#pragma once

#include <cstdint>
#include <span>

#include "geometry/fewest/Columns.h"
#include "geometry/fewest/Limits.h"
#include "geometry/fewest/LocalFrame.h"
#include "geometry/fewest/Polytope.h"
#include "geometry/fewest/RunTest.h"
#include "geometry/fewest/Simplex.h"
#include "vorn/Types.h"

/// The longest run that one circle covers, without regard to its neighbours.
namespace Vorn::Fewest {

/// Finds longest runs; keeps its memory from one to the next.
class FreeRun {
 public:
  /// Reads the points in place; they have to outlive it.
  FreeRun(std::span<WPoint const> points, Limits const& limits)
      : points_(points), limits_(limits) {}

  /// The end (one past the last point) of the longest run from a point on that one circle covers.
  /// `expected` is a guess of its length, which only changes the time.
  std::int32_t FindEnd(std::int32_t start, std::int32_t expected);

  /// The circle that covers the run found last, in the coordinates of the points. Runs of three
  /// points or fewer are covered without one.
  PlacedCircle Covering() const { return frame_.FromLocal(circle_); }

 private:
  /// Moves the local coordinates to a start and empties the programme but for the limits of radii.
  void Begin(std::int32_t start, std::int32_t expected);
  /// Makes the programme that of the points up to `end`.
  void Extend(std::int32_t end);
  /// Whether one circle covers the points up to `end`; keeps that circle and its basis if so.
  bool Try(std::int32_t end);
  /// The circle may hold for more points than it was asked for: the end of those below `bad`, at
  /// least `good`.
  std::int32_t ExtendCovered(std::int32_t good, std::int32_t bad);

  std::span<WPoint const> points_;
  Limits limits_;
  LocalFrame frame_;
  Columns columns_;
  Programme programme_;
  Basis basis_;
  Polytope polytope_;
  Circle circle_;
  std::int32_t start_ = 0;
  double slack_ = 0.0;
};

/// Relative violation of a row that rounding may cause on a run of the given extent in units of its
/// least tolerance: the inverse of a basis loses about extent / tolerance units in the last place.
inline double SlackFor(double extentOverTolerance) {
  // Far below what the tolerance of a measured point tells apart.
  constexpr double kLeastSlack = 1e-10;
  // Some 18 units in the last place of 1.
  constexpr double kSlackPerExtent = 4e-15;
  return kLeastSlack + kSlackPerExtent * extentOverTolerance;
}

}  // namespace Vorn::Fewest
