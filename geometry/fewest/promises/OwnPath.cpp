#include "geometry/fewest/promises/OwnPath.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "geometry/fewest/promises/Orientation.h"

namespace Vorn::Promises {

namespace {

using Point = GeometryUtils::Point;

/// How many times all points may be looked at, and how many more looks short paths have.
constexpr std::int64_t kRounds = 512;
constexpr std::int64_t kLeastBudget = 1 << 20;

/// The end of a piece lies on a point when it is no farther from it than this share of its
/// tolerance: moving the points near the origin and back rounds.
constexpr double kOnPoint = 1e-6;

/// So many edges either way are looked at first where strands may run beside each other for long.
constexpr std::int64_t kFirstReach = 4;

/// Strands of the path touch where they are no farther apart than this share of the sum of their
/// tolerances: of a fold that is narrower no scan could tell whether its sides meet.
constexpr double kTouching = 1.0 / 32.0;

/// Halving a step of the path so often leads to where it comes apart from another strand.
constexpr int kMostHalvings = 40;

/// A loop of the path is more than a knot of noise when one of its points is farther from the
/// crossing than this many times its tolerance.
constexpr double kLeavesPlace = 2.0;

Point At(WPoint const& p) { return {p.x, p.y}; }
bool AreEqual(WPoint const& p, WPoint const& q) { return p.x == q.x && p.y == q.y; }

struct Bounds {
  double xLow = std::numeric_limits<double>::infinity();
  double xHigh = -std::numeric_limits<double>::infinity();
  double yLow = std::numeric_limits<double>::infinity();
  double yHigh = -std::numeric_limits<double>::infinity();

  void Include(WPoint const& p) {
    xLow = std::min(xLow, p.x);
    xHigh = std::max(xHigh, p.x);
    yLow = std::min(yLow, p.y);
    yHigh = std::max(yHigh, p.y);
  }
  bool IsApartFrom(Bounds const& other) const {
    return xLow > other.xHigh || other.xLow > xHigh || yLow > other.yHigh || other.yLow > yHigh;
  }
};

/// Whether two places on strands are as good as one.
bool DoTouch(Approach const& one, Approach const& other) {
  return std::hypot(one.at.x - other.at.x, one.at.y - other.at.y) <=
         kTouching * (one.tolerance + other.tolerance);
}

/// The direction of a piece at an end of it; its length does not matter.
Point DirectionAt(DrawnPiece const& piece, Point const& end) {
  if (!piece.isArc) return piece.toEnd;
  return {piece.sense * (piece.centre.y - end.y), piece.sense * (end.x - piece.centre.x)};
}

/// Whether the second of two neighbours goes back over the first: they turn by more than a right
/// angle at their joint.
bool DoFold(DrawnPiece const& before, DrawnPiece const& behind) {
  Point const in = DirectionAt(before, before.end);
  Point const out = DirectionAt(behind, behind.start);
  return in.x * out.x + in.y * out.y < 0.0;
}

/// How far the second of two neighbours that fold lies on the left of the first, where the shorter
/// one ends or an arc has turned by a radian.
double WayBackOnTheLeft(DrawnPiece const& before, DrawnPiece const& behind) {
  double along = std::min(before.length, behind.length);
  if (before.isArc) along = std::min(along, before.radius);
  if (behind.isArc) along = std::min(along, behind.radius);
  return PlaceOf(before, PointAt(behind, along)).left;
}

}  // namespace

OwnPath::OwnPath(Coverage const& coverage)
    : coverage_(coverage),
      budget_(kLeastBudget +
              kRounds * static_cast<std::int64_t>(coverage.GetChain().points.size())) {
  widest_.reserve(coverage.PieceCount());
  for (std::size_t piece = 0; piece < coverage.PieceCount(); ++piece) {
    NumberRange const& range = coverage.RangeOf(piece);
    double widest = 0.0;
    for (std::size_t i = range.first; i <= range.last; ++i) {
      widest = std::max(widest, coverage.PointOf(i).w);
    }
    widest_.push_back(widest);
  }
}

bool OwnPath::IsWhereThePathCloses(Point const& p) const {
  auto const isWithin = [&p](WPoint const& other) {
    return std::hypot(other.x - p.x, other.y - p.y) <= other.w;
  };
  std::vector<WPoint> const& points = coverage_.GetChain().points;
  return !coverage_.IsClosed() && isWithin(points.front()) && isWithin(points.back()) &&
         !std::all_of(points.begin(), points.end(), isWithin);
}

bool OwnPath::Crosses(std::size_t first, std::size_t second, Meeting const& meeting) {
  if (IsWhereThePathCloses(meeting.at) || (IsEdge(first) && IsEdge(second))) return true;
  Passage const ofFirst = Follow(first, meeting.alongFirst, second, meeting.at);
  if (ofFirst.StaysOnOneSide()) return false;
  Passage const ofSecond = Follow(second, meeting.alongSecond, first, meeting.at);
  if (ofSecond.StaysOnOneSide()) return false;
  if (!ofFirst.IsJoined() && !ofSecond.IsJoined()) {
    Run const firstRun{ofFirst.first, ofFirst.last};
    Run const secondRun{ofSecond.first, ofSecond.last};
    return DoMeet(firstRun, secondRun) ||
           DoTouch(EdgeBeside(meeting.at, firstRun, ofFirst.beyond),
                   EdgeBeside(meeting.at, secondRun, ofSecond.beyond));
  }
  bool const isAhead = ofFirst.after == Side::Joined || ofSecond.before == Side::Joined;
  bool const isBehind = ofFirst.before == Side::Joined || ofSecond.after == Side::Joined;
  return (isAhead && HasLoop(ofFirst, ofSecond, meeting.at)) ||
         (isBehind && HasLoop(ofSecond, ofFirst, meeting.at));
}

bool OwnPath::IsEdge(std::size_t piece) const {
  DrawnPiece const drawn = coverage_.Drawn(piece);
  if (drawn.isArc || drawn.length == 0.0) return false;
  auto const isAt = [this](std::size_t number, Point const& end) {
    WPoint const& p = coverage_.PointOf(number);
    return std::hypot(p.x - end.x, p.y - end.y) <= kOnPoint * p.w;
  };
  NumberRange const& range = coverage_.RangeOf(piece);
  std::size_t next = range.first;
  while (next <= range.last && isAt(next, drawn.start)) ++next;
  if (next == range.first) return false;
  // The points behind those at the start are at the end, or the end is the first point behind.
  while (next <= range.last && isAt(next, drawn.end)) ++next;
  bool const endsPath = !coverage_.IsClosed() && coverage_.Next(piece) == kNone;
  return next > range.last && (isAt(range.last, drawn.end) || (!endsPath && isAt(next, drawn.end)));
}

bool OwnPath::HasLoop(Passage const& out, Passage const& back, Point const& at) {
  auto const size = static_cast<std::int64_t>(coverage_.GetChain().points.size());
  // The running number at which the strand comes back, not before that at which it goes out.
  std::int64_t const length = ((back.beyond - out.beyond) % size + size) % size;
  std::int64_t const shift = out.beyond + length - back.beyond;
  budget_ -= length;
  if (budget_ < 0) return false;
  std::int64_t tip = out.beyond;
  double farthest = 0.0;
  for (std::int64_t number = out.beyond; number < out.beyond + length; ++number) {
    WPoint const& p = PointOf(number);
    double const ratio = std::hypot(p.x - at.x, p.y - at.y) / p.w;
    if (ratio > farthest) {
      farthest = ratio;
      tip = number;
    }
  }
  if (farthest <= kLeavesPlace) return false;
  // Short of a whole round on a closed contour, so that no edge is met twice.
  std::int64_t const reach = coverage_.IsClosed() ? (size - 1 - length) / 2 : size;
  std::int64_t const first = std::max(out.first, out.beyond - reach);
  std::int64_t const last = std::min(back.last, back.beyond + reach) + shift;
  Run const wayOut{first, tip};
  Run const wayBack{tip, last};
  return DoMeetNear(wayOut, out.beyond, wayBack, back.beyond + shift) ||
         DoTouch(EdgeBeside(at, wayOut, out.beyond), EdgeBeside(at, wayBack, back.beyond + shift));
}

Approach OwnPath::EdgeBeside(Point const& at, Run const& run, std::int64_t beyond) const {
  if (beyond <= run.first || beyond > run.last) return {};
  WPoint const& from = PointOf(beyond - 1);
  WPoint const& to = PointOf(beyond);
  DrawnPiece const edge = DrawSegment(At(from), At(to));
  return {PointAt(edge, PlaceOf(edge, at).along), std::min(from.w, to.w)};
}

bool OwnPath::DoMeetNear(Run const& mine, std::int64_t near, Run const& other,
                         std::int64_t otherNear) {
  auto const isWhole = [](Run const& part, Run const& run) {
    return part.first == run.first && part.last == run.last;
  };
  for (std::int64_t reach = kFirstReach;; reach *= 4) {
    Run const part{std::max(mine.first, near - reach), std::min(mine.last, near + reach)};
    Run const otherPart{std::max(other.first, otherNear - reach),
                        std::min(other.last, otherNear + reach)};
    if (DoMeet(part, otherPart)) return true;
    if (budget_ < 0 || (isWhole(part, mine) && isWhole(otherPart, other))) return false;
  }
}

OwnPath::Passage OwnPath::Follow(std::size_t piece, double along, std::size_t other,
                                 Point const& at) {
  std::int64_t const beyond = FirstNumberBeyond(piece, along);
  DrawnPiece const drawnOther = coverage_.Drawn(other);
  Strand back{beyond, -1, piece, other, drawnOther};
  Strand forth{beyond - 1, 1, piece, other, drawnOther};
  Side const before = FollowOneWay(&back, at);
  Side const after = FollowOneWay(&forth, at);
  return {beyond, back.number, forth.number, before, after};
}

std::int64_t OwnPath::FirstNumberBeyond(std::size_t piece, double along) const {
  DrawnPiece const drawn = coverage_.Drawn(piece);
  NumberRange const& range = coverage_.RangeOf(piece);
  std::size_t low = range.first;
  std::size_t high = range.last + 1;
  while (low < high) {
    std::size_t const middle = low + (high - low) / 2;
    if (PlaceOf(drawn, At(coverage_.PointOf(middle))).along <= along) {
      low = middle + 1;
    } else {
      high = middle;
    }
  }
  return static_cast<std::int64_t>(low);
}

OwnPath::Side OwnPath::FollowOneWay(Strand* strand, Point from) {
  while (StepOn(strand)) {
    if (--budget_ < 0) return Side::Joined;
    WPoint const& p = PointOf(strand->number);
    Strand const last = *strand;
    Place place;
    if (!MoveToNearest(strand, At(p), &place)) return Side::Joined;
    if (IsApart(*strand, place, p.w)) return SideWhereApart(last, from, p);
    from = At(p);
  }
  return Side::Unknown;
}

bool OwnPath::IsApart(Strand const& strand, Place const& place, double w) const {
  return place.distance > w + widest_[strand.other];
}

OwnPath::Side OwnPath::SideWhereApart(Strand const& strand, Point const& from,
                                      WPoint const& p) const {
  Side side = Side::Unknown;
  Point at = At(p);
  for (int halving = 0; halving < kMostHalvings; ++halving) {
    Strand there = strand;
    Place place;
    if (!MoveToNearest(&there, at, &place) || !IsApart(there, place, p.w)) break;
    side = SideOf(there, at, place);
    at = {0.5 * (from.x + at.x), 0.5 * (from.y + at.y)};
  }
  return side;
}

bool OwnPath::StepOn(Strand* strand) const {
  auto const size = static_cast<std::int64_t>(coverage_.GetChain().points.size());
  std::int64_t const next = strand->number + strand->step;
  if (coverage_.IsClosed() ? next < -size || next > 2 * size : next < 0 || next >= size) {
    return false;
  }
  NumberRange const& range = coverage_.RangeOf(strand->piece);
  auto const start = static_cast<std::int64_t>(range.first);
  auto const count = static_cast<std::int64_t>(range.last - range.first);
  std::int64_t const within = ((next - start) % size + size) % size;
  if (within > count) {
    strand->piece =
        strand->step > 0 ? coverage_.Next(strand->piece) : coverage_.Previous(strand->piece);
  }
  strand->number = next;
  return true;
}

bool OwnPath::MoveToNearest(Strand* strand, Point const& p, Place* place) const {
  if (strand->other == strand->piece) return false;
  *place = PlaceOf(strand->drawnOther, p);
  for (int moves = 0; moves < 2 && place->beside != Beside::Piece; ++moves) {
    bool const isForward = place->beside == Beside::End;
    std::size_t const neighbour =
        isForward ? coverage_.Next(strand->other) : coverage_.Previous(strand->other);
    if (neighbour == kNone) return true;
    if (neighbour == strand->piece) return false;
    DrawnPiece const drawnNeighbour = coverage_.Drawn(neighbour);
    Place const there = PlaceOf(drawnNeighbour, p);
    bool const isNearer =
        isForward ? there.distance <= place->distance : there.distance < place->distance;
    if (!isNearer) return true;
    strand->other = neighbour;
    strand->drawnOther = drawnNeighbour;
    *place = there;
  }
  return true;
}

OwnPath::Side OwnPath::SideOf(Strand const& strand, Point const& p, Place const& place) const {
  if (place.beside == Beside::Piece) return place.left > 0.0 ? Side::Left : Side::Right;
  bool const isBehind = place.beside == Beside::End;
  std::size_t const neighbour =
      isBehind ? coverage_.Next(strand.other) : coverage_.Previous(strand.other);
  if (neighbour == kNone) return Side::Unknown;
  DrawnPiece const drawn = coverage_.Drawn(neighbour);
  DrawnPiece const& before = isBehind ? strand.drawnOther : drawn;
  DrawnPiece const& behind = isBehind ? drawn : strand.drawnOther;
  if (!DoFold(before, behind)) {
    return place.left + PlaceOf(drawn, p).left > 0.0 ? Side::Left : Side::Right;
  }
  double const wayBack = WayBackOnTheLeft(before, behind);
  if (std::fabs(wayBack) <= widest_[strand.other] + widest_[neighbour]) return Side::Unknown;
  return wayBack > 0.0 ? Side::Right : Side::Left;
}

WPoint const& OwnPath::PointOf(std::int64_t number) const {
  auto const size = static_cast<std::int64_t>(coverage_.GetChain().points.size());
  return coverage_.GetChain().points[static_cast<std::size_t>((number % size + size) % size)];
}

bool OwnPath::DoMeet(Run const& mine, Run const& other) {
  budget_ -= mine.Size() + other.Size();
  if (budget_ < 0 || mine.Size() <= 0 || other.Size() <= 0) return false;
  auto const boundsOf = [this](Run const& run) {
    Bounds bounds;
    for (std::int64_t i = run.first; i <= run.last; ++i) bounds.Include(PointOf(i));
    return bounds;
  };
  if (boundsOf(mine).IsApartFrom(boundsOf(other))) return false;
  bool const isMineLonger = mine.Size() >= other.Size();
  Run const& longer = isMineLonger ? mine : other;
  if (longer.Size() == 1) {
    return !AreEqual(PointOf(mine.last), PointOf(other.first)) &&
           !AreEqual(PointOf(other.last), PointOf(mine.first)) &&
           DoEdgesMeet(At(PointOf(mine.first)), At(PointOf(mine.last)), At(PointOf(other.first)),
                       At(PointOf(other.last)));
  }
  std::int64_t const middle = longer.first + longer.Size() / 2;
  Run const& shorter = isMineLonger ? other : mine;
  return DoMeet({longer.first, middle}, shorter) || DoMeet({middle, longer.last}, shorter);
}

}  // namespace Vorn::Promises
