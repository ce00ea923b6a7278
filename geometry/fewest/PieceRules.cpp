#include "geometry/fewest/PieceRules.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>

#include "geometry/fewest/DenseOrder.h"
#include "geometry/fewest/Turn.h"

namespace Vorn::Fewest {

namespace {

/// The row of the advance of a circle along a step from a place: the unit direction of travel times
/// the step, which is negative where the circle runs against it.
Row AdvanceRow(Place const& p, double dx, double dy) {
  return {2.0 * (p.y * dx - p.x * dy), -dy, dx, 0.0};
}

/// A step back along the path that is shorter than this many times the sum of the tolerances of its
/// points counts as noise: each point may be off by its tolerance in any direction, which accounts
/// for 1, and neighbours of a reversal add the rest.
constexpr double kNoiseStep = 1.65;

/// A turn in radians below which a piece need not be looked at for a full one. Steps are at most 60
/// degrees, whose sine is 0.83 of their angle.
constexpr double kTurnToCount = 4.5;

/// Where a circle turns by no more than this between two points, in radians, the direction at the
/// first tells which one is ahead.
constexpr double kLittleTurn = 0.5;

/// From so many points on the spacing of a run is looked at before its points are.
constexpr std::int32_t kLongRun = 256;

/// Share of a tolerance by which rounding may break a row.
constexpr double kRoundingRoom = 1e-6;

/// A gate this flat to a piece has no offset for a place along it.
constexpr double kLeastSlope = 1e-3;

/// How many points at either end of a piece may lie beyond its joint.
constexpr std::int32_t kPointsNearJoint = 4;

double SquaredGradient(Circle const& circle, Place const& place) {
  Place const gradient = GradientAt(circle, place);
  return gradient.x * gradient.x + gradient.y * gradient.y;
}

/// From this stride on points are dense enough for a piece to end where they turn back. Between 1
/// and 6 sharp strokes of a glyph cost a piece more without the room of MostBack; found by trial.
constexpr std::int32_t kDenseStride = 6;

/// How far a point may lie back behind an earlier one that is not its neighbour: by noise and, in
/// scans that are not dense, by a tolerance, since the earlier one may lie beyond the end of its
/// piece.
double MostBack(Sample const& earlier, Sample const& point, std::int32_t stride) {
  double const beyondEnd = stride < kDenseStride ? earlier.w : 0.0;
  return kNoiseStep * (earlier.w + point.w) + beyondEnd;
}

/// How far a circle that has this gradient at a place advances from there to another one.
double AdvanceTo(Place const& gradient, Place const& from, Place const& to) {
  return gradient.y * (to.x - from.x) - gradient.x * (to.y - from.y);
}

}  // namespace

std::int32_t PieceRules::FindStride(Circle const& circle, Ends const& ends) const {
  if (ends.end - ends.first < kLongRun) return 1;
  RunSpacing const spacing = spacing_.Of(ends.first, ends.end);
  DenseOrder const dense(circle, spacing, frame_);
  constexpr double kRoom = 1.0 - 1e-6;
  double const largestStep = kRoom * kStepShare * path_.limits.sineOfHalfStep;
  double const mostBack = kRoom * 2.0 * kNoiseStep * spacing.leastTolerance;
  bool const isSure = dense.IsInOrder(kNoiseStep) && dense.HasSmallSteps(largestStep) &&
                      backsteps_.AreWithin(mostBack, circle, frame_, ends.first, ends.end);
  return isSure ? dense.Stride() : 1;
}

PieceRules::Check PieceRules::AddBrokenOrder(Circle const& circle, Ends const& ends) const {
  std::int32_t const stride = FindStride(circle, ends);
  if (stride > 1) return IsFullTurn(circle, ends, stride) ? Check::Hopeless : Check::Holds;
  StepBack worst;  // behind the point before it
  StepBack slow;   // behind the farthest one
  double length = 0.0;
  double const noise = kNoiseStep * (1.0 + kRoundingRoom) * frame_.scale;
  std::int32_t farthest = ends.first;
  WPoint const* last = &path_.At(ends.first);
  Place p = frame_.ToLocal(Place{last->x, last->y});
  Place gradient = GradientAt(circle, p);
  double here2 = gradient.x * gradient.x + gradient.y * gradient.y;
  // Points behind the joint are as far along as the joint.
  double const start = ends.from->isFree
                           ? -std::numeric_limits<double>::infinity()
                           : AdvanceTo(gradient, p, frame_.ToLocal(ends.from->gate.origin));
  double reach = std::max(0.0, start) - noise * path_.At(ends.first).w;
  for (std::int32_t i = ends.first + 1; i < ends.end; ++i) {
    WPoint const& next = path_.At(i);
    Place const q = frame_.ToLocal(Place{next.x, next.y});
    double const dx = q.x - p.x;
    double const dy = q.y - p.y;
    // The unit direction of travel times the step.
    double const advance = gradient.y * dx - gradient.x * dy;
    length += advance;
    double const along = std::max(length, start);
    double const room = noise * next.w;
    if (reach > along + room) {
      worst.Take({i - 1, i, -advance - noise * (last->w + next.w)});
      slow.Take({farthest, i, ExcessOfStepBack(circle, farthest, i)});
    }
    if (along - room > reach) {
      reach = along - room;
      farthest = i;
    }
    gradient = GradientAt(circle, q);
    double const gap2 = dx * dx + dy * dy;
    double const there2 = gradient.x * gradient.x + gradient.y * gradient.y;
    double const near2 = there2 < here2 ? there2 : here2;
    if (IsLargeStep(circle, gap2, near2, last->w * frame_.scale)) return AddStep(gap2, near2);
    last = &next;
    p = q;
    here2 = there2;
  }
  // An advance is the radius times the sine of a step, so this is the turn or less.
  if (2.0 * std::fabs(circle.a) * length > kTurnToCount && IsFullTurn(circle, ends, stride)) {
    return Check::Hopeless;
  }
  if (!(worst.excess > 0.0)) worst = slow;
  if (!(worst.excess > 0.0)) return Check::Holds;
  return programme_->Add(OrderCondition(worst)) ? Check::Added : Check::Hopeless;
}

double PieceRules::ExcessOfStepBack(Circle const& circle, std::int32_t earlier,
                                    std::int32_t point) const {
  Sample const p = frame_.ToLocal(path_.At(earlier));
  Sample const q = frame_.ToLocal(path_.At(point));
  double const dx = q.x - p.x;
  double const dy = q.y - p.y;
  bool const isNear = 2.0 * std::fabs(circle.a) * std::sqrt(dx * dx + dy * dy) <= kLittleTurn;
  double const advance = Apply(AdvanceRow(PlaceOf(p), dx, dy), circle);
  return isNear ? -advance - (1.0 + kRoundingRoom) * MostBack(p, q, StrideFrom(path_, earlier))
                : 0.0;
}

Condition PieceRules::OrderCondition(StepBack const& broken) const {
  Sample const p = frame_.ToLocal(path_.At(broken.earlier));
  Sample const q = frame_.ToLocal(path_.At(broken.point));
  Row const advance = AdvanceRow(PlaceOf(p), q.x - p.x, q.y - p.y);
  bool const areNeighbours = broken.earlier + 1 == broken.point;
  double const limit =
      areNeighbours ? kNoiseStep * (p.w + q.w) : MostBack(p, q, StrideFrom(path_, broken.earlier));
  return {Negated(advance), Condition::Kind::HalfSpace, limit};
}

bool PieceRules::IsLargeStep(Circle const& circle, double gap2, double near2, double w) const {
  double const limit = kStepShare * path_.limits.sineOfHalfStep;
  return !(circle.a * circle.a * gap2 <= limit * limit * near2 || gap2 <= w * w);
}

PieceRules::Check PieceRules::AddStep(double gap2, double near2) const {
  double const most = kStepShare * path_.limits.sineOfHalfStep * std::sqrt(near2 / gap2);
  if (!(most > 0.0)) return Check::Hopeless;
  Condition const condition{{1.0, 0.0, 0.0, 0.0}, Condition::Kind::Slab, most};
  return programme_->Add(condition) ? Check::Added : Check::Hopeless;
}

bool PieceRules::IsFullTurn(Circle const& circle, Ends const& ends, std::int32_t stride) const {
  Turn turn(circle);
  if (!ends.from->isFree) turn.Add(frame_.ToLocal(ends.from->gate.origin));
  for (std::int32_t i = ends.first; i < ends.end - 1; i += stride) {
    turn.Add(PlaceOf(frame_.ToLocal(path_.At(i))));
  }
  turn.Add(PlaceOf(frame_.ToLocal(path_.At(ends.end - 1))));
  if (ends.to != nullptr && !ends.to->isFree) turn.Add(frame_.ToLocal(ends.to->gate.origin));
  // Both ends of an open path may be drawn back within the tolerances of its ends.
  bool const isWhole = ends.from->isFree && ends.end == path_.Count();
  double const w = share_ * std::min(path_.At(ends.first).w, path_.At(ends.end - 1).w);
  double const room = (isWhole ? 0.5 : -4.0) * w * frame_.scale * 2.0 * std::fabs(circle.a);
  return turn.Angle() > 2.0 * std::numbers::pi + room;
}

PieceRules::Check PieceRules::AddBrokenView(Circle const& circle, Joint const& joint,
                                            JointView const& view) const {
  if (view.isNextToGate) {
    // The joint lies on the circle, where the gradient has length 1.
    double const near2 = std::min(1.0, SquaredGradient(circle, view.point));
    if (IsLargeStep(circle, view.gap2, near2, view.tolerance)) return AddStep(view.gap2, near2);
  }
  // From a quarter turn on the direction at the point says nothing about its order.
  if (2.0 * circle.a * circle.a * view.gap2 > 1.0) return Check::Holds;
  double const room = share_ * view.tolerance;
  Row const advance = AdvanceRow(view.point, view.sense * view.dx, view.sense * view.dy);
  if (Apply(advance, circle) >= -kRoundingRoom * view.tolerance ||
      view.gap2 <= room * room * (1.0 + kRoundingRoom)) {
    return Check::Holds;
  }
  if (!joint.isFixed) return AddOffsetLimit(circle, joint, view);
  Condition const condition{Negated(advance), Condition::Kind::HalfSpace, 0.0};
  return programme_->Add(condition) ? Check::Added : Check::Hopeless;
}

std::optional<PieceRules::Joint> PieceRules::FindJoint(Circle const& circle,
                                                       Opening const& opening) const {
  Joint joint;
  joint.gate = opening.gate;
  joint.gate.origin = frame_.ToLocal(opening.gate.origin);
  joint.isFixed = opening.low == opening.high;
  joint.offset = opening.low * frame_.scale;
  if (!joint.isFixed && !FindCrossing(circle, joint.gate, &joint.offset)) return {};
  joint.place = PlaceOn(joint.gate, joint.offset);
  return joint;
}

PieceRules::JointView PieceRules::ViewJoint(Joint const& joint, std::int32_t point) const {
  Sample const sample = frame_.ToLocal(path_.At(point));
  std::int32_t const split = joint.gate.split;
  JointView view;
  view.point = PlaceOf(sample);
  view.tolerance = sample.w;
  view.sense = point >= split ? 1.0 : -1.0;
  view.isNextToGate = point == (view.sense > 0.0 ? split : split - 1);
  view.dx = view.point.x - joint.place.x;
  view.dy = view.point.y - joint.place.y;
  view.gap2 = view.dx * view.dx + view.dy * view.dy;
  return view;
}

PieceRules::Check PieceRules::AddOffsetLimit(Circle const& circle, Joint const& joint,
                                             JointView const& view) const {
  Gate const& gate = joint.gate;
  Place const normal = GradientAt(circle, view.point);
  double const room = share_ * view.tolerance;
  double const fromOriginX = view.point.x - gate.origin.x;
  double const fromOriginY = view.point.y - gate.origin.y;
  double const slope = normal.y * gate.across.x - normal.x * gate.across.y;
  double const foot = fromOriginX * gate.across.x + fromOriginY * gate.across.y;
  double const apart = fromOriginX * gate.across.y - fromOriginY * gate.across.x;
  double const reach = room * room - apart * apart;
  double const half = reach > 0.0 ? std::sqrt(reach) : -1.0;
  bool const hasLimit = std::fabs(slope) > kLeastSlope;
  double limit = hasLimit ? (normal.y * fromOriginX - normal.x * fromOriginY) / slope : foot;
  bool const isUpper = joint.offset > limit;
  if (std::fabs(limit - foot) <= half) {
    limit = isUpper ? foot + half : foot - half;
  } else if (!hasLimit) {
    return Check::Hopeless;
  }
  double const weight = 1.0 / (path_.leastTolerance * frame_.scale);
  Row const value = Weighted(ValueRow(PlaceOn(gate, limit)), weight);
  Condition const condition{isUpper ? Negated(value) : value, Condition::Kind::HalfSpace, 0.0};
  return programme_->Add(condition) ? Check::Added : Check::Hopeless;
}

PieceRules::Check PieceRules::AddBrokenJoint(Circle const& circle, Opening const& opening,
                                             std::int32_t first, std::int32_t last) const {
  std::optional<Joint> const joint = FindJoint(circle, opening);
  if (!joint) return Check::Hopeless;
  bool const isStart = first >= joint->gate.split;
  for (std::int32_t k = 0; k < last - first; ++k) {
    std::int32_t const point = isStart ? first + k : last - 1 - k;
    Check const check = AddBrokenView(circle, *joint, ViewJoint(*joint, point));
    if (check != Check::Holds) return check;
  }
  return Check::Holds;
}

PieceRules::Check PieceRules::AddBroken(Circle const& circle, Ends const& ends) const {
  if (ends.first >= ends.end) return Check::Holds;
  Check const order = AddBrokenOrder(circle, ends);
  if (order != Check::Holds) return order;
  if (!ends.from->isFree) {
    std::int32_t const last =
        std::min(ends.end, ends.first + kPointsNearJoint * StrideFrom(path_, ends.first));
    Check const start = AddBrokenJoint(circle, *ends.from, ends.first, last);
    if (start != Check::Holds) return start;
  }
  if (ends.to == nullptr || ends.to->isFree) return Check::Holds;
  std::int32_t const stride = StrideFrom(path_, std::max(ends.first, ends.end - kPointsNearJoint));
  std::int32_t const first = std::max(ends.first, ends.end - kPointsNearJoint * stride);
  return AddBrokenJoint(circle, *ends.to, first, ends.end);
}

}  // namespace Vorn::Fewest
