#include "geometry/fewest/Corner.h"

#include <algorithm>
#include <cmath>
#include <optional>

#include "geometry/fewest/JointRoom.h"

namespace Vorn::Fewest {

namespace {

/// Sine of the angle from which on two circles are said to cross.
constexpr double kLeastSine = 0.2;

/// Sine below which the crossing of two circles is not worth looking for.
constexpr double kFlatSine = 1e-3;

/// A gate leads away from the gap by at least this share of an offset, whatever its direction.
constexpr double kLeastSlope = 0.1;

/// Newton's method doubles the digits with each step.
constexpr int kMostSteps = 20;

double Cross(Place const& a, Place const& b) { return a.x * b.y - a.y * b.x; }

Place PlaceAt(Path const& path, std::int32_t point) { return {path.At(point).x, path.At(point).y}; }

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

/// The point near a split that lies farthest along a circle; nothing where the path runs on.
std::optional<std::int32_t> FindTip(Path const& path, std::int32_t split,
                                    PlacedCircle const& circle) {
  std::int32_t const stride = StrideFrom(path, split);
  std::int32_t const first = std::max(0, split - stride);
  std::int32_t const last = std::min(path.Count() - 1, split + stride);
  Place const start = PlaceAt(path, first);
  Place const gradient = GradientAt(circle, start);
  std::int32_t tip = first;
  double farthest = 0.0;
  for (std::int32_t i = first + 1; i <= last; ++i) {
    Place const p = PlaceAt(path, i);
    double const advance = gradient.y * (p.x - start.x) - gradient.x * (p.y - start.y);
    if (advance <= farthest) continue;
    farthest = advance;
    tip = i;
  }
  if (tip == first || tip == last) return {};
  return tip;
}

/// The gate at the tip of a fold of a dense scan. Points of sparse ones tell the way themselves.
bool FoldGate(Path const& path, std::int32_t split, PlacedCircle const& before,
              PlacedCircle const& behind, Gate* gate) {
  if (IsWideGap(path, split)) return false;
  std::optional<std::int32_t> const tip = FindTip(path, split, before);
  if (!tip) return false;
  Place const place = PlaceAt(path, *tip);
  *gate = BisectorGate(place, GradientAt(before, place), GradientAt(behind, place));
  gate->split = split;
  JointRoom const room = RoomForJoint(path, split);
  double const half = 2.0 * path.At(*tip).w;
  gate->least = -std::min(half, room.right);
  gate->greatest = std::min(half, room.left);
  return gate->isCusp;
}

}  // namespace

bool CornerGate(Path const& path, std::int32_t split, PlacedCircle const& before,
                PlacedCircle const& behind, Gate* gate) {
  Gate const middle = MiddleGate(path, split, before);
  double const sine = Cross(GradientAt(before, middle.origin), GradientAt(behind, middle.origin));
  if (!(std::fabs(sine) > kLeastSine)) return FoldGate(path, split, before, behind, gate);
  Place meeting;
  if (!FindMeeting(before, behind, middle.origin, &meeting)) return false;
  double const dx = meeting.x - middle.origin.x;
  double const dy = meeting.y - middle.origin.y;
  double const widest =
      DistanceBetween(path.At(split - 1), path.At(split)) * path.limits.jointRoom +
      4.0 * std::max(path.At(split - 1).w, path.At(split).w);
  if (!(dx * dx + dy * dy < widest * widest)) return false;
  JointRoom const room = RoomForJoint(path, split);
  double const height = dx * middle.across.x + dy * middle.across.y;
  if (!(height < room.left && -height < room.right)) return false;
  *gate = BisectorGate(meeting, GradientAt(before, meeting), GradientAt(behind, meeting));
  gate->split = split;
  // So much of an offset on the gate leads away from the gap.
  double const slope =
      std::max(kLeastSlope, gate->across.x * middle.across.x + gate->across.y * middle.across.y);
  gate->least = -std::min(widest, (room.right + height) / slope);
  gate->greatest = std::min(widest, (room.left - height) / slope);
  return true;
}

}  // namespace Vorn::Fewest
