#include "geometry/fewest/JointRoom.h"

#include <algorithm>
#include <cmath>
#include <optional>

namespace Vorn::Fewest {

namespace {

/// In gaps wider than this many times the sum of the tolerances directions are known to 1/8.
constexpr double kWideGap = 8.0;

/// Cosine of the sharpest turn of a corner between two points, 150 degrees: a path that turns by
/// more has another side there, and the lines meet far out.
constexpr double kSharpestCosine = -0.8660254037844387;

/// Cosine of the largest turn, 30 degrees, of a path that runs on.
constexpr double kRunningOn = 0.8660254037844387;

/// Points beside a gap that are looked at for one far enough away.
constexpr std::int32_t kMostClosePoints = 64;

/// The way from one point to another.
struct Way {
  double x = 0.0;
  double y = 0.0;
};

Way Between(WPoint const& from, WPoint const& to) { return {to.x - from.x, to.y - from.y}; }

double Cross(Way const& a, Way const& b) { return a.x * b.y - a.y * b.x; }

double Dot(Way const& a, Way const& b) { return a.x * b.x + a.y * b.y; }

double Length(Way const& way) { return std::sqrt(Dot(way, way)); }

/// How high above a gap, in gaps and positive to the left, the lines through the ways before and
/// behind it meet on the way ahead; 0 where they do not, or where the corner would be too sharp. At
/// most sin(75)^2 / sin(150) = 1.87.
double HeightOfCorner(Way const& before, Way const& gap, Way const& behind) {
  double const turn = Cross(before, behind);
  double const turnIn = Cross(before, gap);
  double const turnOut = Cross(gap, behind);
  // The path turns to one side at both points, so the lines meet ahead of one and behind the other.
  bool const meet = turnIn * turnOut > 0.0 && turnIn * turn > 0.0;
  double const lengths = Length(before) * Length(behind);
  if (!meet || Dot(before, behind) < kSharpestCosine * lengths) return 0.0;
  double const gap2 = gap.x * gap.x + gap.y * gap.y;
  // By the law of sines; a turn to the left leaves the corner on the right.
  return -turnIn * turnOut / (turn * gap2);
}

/// The sagitta of an arc of the greatest step in chords, tan(step / 4) / 2.
double BulgeOf(Limits const& limits) {
  double const sine = limits.sineOfHalfStep;
  return 0.5 * sine / (1.0 + std::sqrt(std::max(0.0, 1.0 - sine * sine)));
}

bool AreFarApart(WPoint const& p, WPoint const& q) {
  return DistanceBetween(p, q) > kWideGap * (p.w + q.w);
}

/// The point at a position up to two beyond the ends; null where there is none.
WPoint const* PointAt(Path const& path, std::int32_t i) {
  if (i < 0) return path.before.At(-1 - i);
  if (i >= path.Count()) return path.behind.At(i - path.Count());
  return &path.At(i);
}

/// The way along the path between a point and another one.
struct FoundWay {
  Way way;
  std::int32_t other = 0;  ///< the position of the other point
};

/// The way between a point and the nearest one on the side of `step`, -1 or 1, that lies far from
/// it: no way at the end of the path, nothing where all points near it are close.
std::optional<FoundWay> FindWay(Path const& path, std::int32_t point, std::int32_t step) {
  WPoint const& from = *PointAt(path, point);
  for (std::int32_t k = 1; k <= kMostClosePoints; ++k) {
    std::int32_t const at = point + k * step;
    WPoint const* const other = PointAt(path, at);
    if (other == nullptr) return FoundWay{};
    if (!AreFarApart(from, *other)) continue;
    return FoundWay{step > 0 ? Between(from, *other) : Between(*other, from), at};
  }
  return std::nullopt;
}

/// The way beside a gap where the path runs on beyond it in much the same direction; no way where
/// it does not: two points alone say nothing about what lies between others.
std::optional<Way> FindSide(Path const& path, std::int32_t point, std::int32_t step) {
  std::optional<FoundWay> const side = FindWay(path, point, step);
  if (!side) return std::nullopt;
  if (Length(side->way) == 0.0) return Way{};
  std::optional<FoundWay> const beyond = FindWay(path, side->other, step);
  if (!beyond) return side->way;
  double const lengths = Length(side->way) * Length(beyond->way);
  bool const runsOn = lengths > 0.0 && Dot(side->way, beyond->way) >= kRunningOn * lengths;
  return runsOn ? side->way : Way{};
}

/// The room that corners and the greatest step leave in a wide gap.
JointRoom RoomInWideGap(Path const& path, std::int32_t split) {
  WPoint const& last = path.At(split - 1);
  WPoint const& first = path.At(split);
  std::optional<Way> const before = FindSide(path, split - 1, -1);
  std::optional<Way> const behind = FindSide(path, split, 1);
  if (!before || !behind) return {};
  double const gap = DistanceBetween(last, first);
  double const height = HeightOfCorner(*before, Between(last, first), *behind);
  double const room = BulgeOf(path.limits) * gap + 2.0 * std::max(last.w, first.w);
  return {std::max(height, 0.0) * gap + room, std::max(-height, 0.0) * gap + room};
}

}  // namespace

bool IsWideGap(Path const& path, std::int32_t split) {
  return AreFarApart(path.At(split - 1), path.At(split));
}

JointRoom RoomForJoint(Path const& path, std::int32_t split) {
  JointRoom const room = IsWideGap(path, split) ? RoomInWideGap(path, split) : JointRoom();
  double const most =
      path.limits.farthestBetweenPoints + std::max(path.At(split - 1).w, path.At(split).w);
  return {std::min(room.left, most), std::min(room.right, most)};
}

}  // namespace Vorn::Fewest
