#include "geometry/fewest/Corner.h"

#include <cmath>

namespace Vorn::Fewest {

namespace {

/// Sine of the angle from which on two circles are said to cross.
constexpr double kLeastSine = 0.2;

/// Sine below which the crossing of two circles is not worth looking for.
constexpr double kFlatSine = 1e-3;

/// Newton's method doubles the digits with each step.
constexpr int kMostSteps = 20;

double Cross(Place const& a, Place const& b) { return a.x * b.y - a.y * b.x; }

/// The crossing of two circles near a place, by Newton's method.
bool FindMeeting(PlacedCircle const& one, PlacedCircle const& other, Place start, Place* meeting) {
  for (int i = 0; i < kMostSteps; ++i) {
    double const f = ValueAt(one, start);
    double const g = ValueAt(other, start);
    Place const df = GradientAt(one, start);
    Place const dg = GradientAt(other, start);
    double const determinant = Cross(df, dg);
    if (!(std::fabs(determinant) > kFlatSine)) return false;
    double const dx = (f * dg.y - g * df.y) / determinant;
    double const dy = (df.x * g - dg.x * f) / determinant;
    start = {start.x - dx, start.y - dy};
    if (dx * dx + dy * dy == 0.0) break;
  }
  *meeting = start;
  return true;
}

}  // namespace

bool CornerGate(Path const& path, std::int32_t split, PlacedCircle const& before,
                PlacedCircle const& behind, Gate* gate) {
  Gate const middle = MiddleGate(path, split, before);
  double const sine = Cross(GradientAt(before, middle.origin), GradientAt(behind, middle.origin));
  if (!(std::fabs(sine) > kLeastSine)) return false;
  Place meeting;
  if (!FindMeeting(before, behind, middle.origin, &meeting)) return false;
  double const dx = meeting.x - middle.origin.x;
  double const dy = meeting.y - middle.origin.y;
  double const room = 2.0 * middle.greatest;
  if (!(dx * dx + dy * dy < room * room)) return false;
  *gate = BisectorGate(meeting, GradientAt(before, meeting), GradientAt(behind, meeting));
  gate->split = split;
  gate->least = -room;
  gate->greatest = room;
  return true;
}

}  // namespace Vorn::Fewest
