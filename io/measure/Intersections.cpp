#include "vorn/io/Intersections.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <numbers>

#include "io/measure/PieceMeetings.h"
#include "io/pieces/BoxIndex.h"
#include "io/pieces/Frame.h"
#include "io/pieces/Turning.h"

namespace Vorn::IO {

namespace {

constexpr double kFullTurn = 2.0 * std::numbers::pi;

/// Directions that differ by less count as one: what is left of equal ones after coordinates with
/// nine digits.
constexpr double kSameDirection = 1e-7;

/// A contour without its pieces of no length, and where each begins along it.
struct Path {
  Path(std::vector<Piece> const& all, double joint) : tolerance(joint) {
    for (std::size_t i = 0; i < all.size(); ++i) {
      Piece const& piece = all[i];
      if (piece.length > tolerance) {
        pieces.push_back(piece);
        numbers.push_back(i);
        starts.push_back(length);
      }
      length += piece.length;
    }
    isClosed = !pieces.empty() && Distance(pieces.back().end, pieces.front().start) <= tolerance;
  }

  /// The piece that begins where this one ends.
  std::optional<std::size_t> After(std::size_t piece) const {
    bool const isLast = piece + 1 == pieces.size();
    if (isLast) return isClosed ? std::optional<std::size_t>(0) : std::nullopt;
    return Joins(piece, piece + 1) ? std::optional<std::size_t>(piece + 1) : std::nullopt;
  }

  std::optional<std::size_t> Before(std::size_t piece) const {
    std::size_t const last = pieces.size() - 1;
    std::size_t const before = piece == 0 ? last : piece - 1;
    return After(before) == piece ? std::optional<std::size_t>(before) : std::nullopt;
  }

  bool Joins(std::size_t before, std::size_t after) const {
    return Distance(pieces[before].end, pieces[after].start) <= tolerance;
  }

  double tolerance;
  std::vector<Piece> pieces;
  std::vector<std::size_t> numbers;  ///< of the pieces in the file
  std::vector<double> starts;
  double length = 0.0;
  bool isClosed = false;
};

/// Where a path comes from and where it goes on to at a point, as angles.
struct Branches {
  double back = 0.0;
  double forth = 0.0;
};

double AngleOf(XY const& direction) { return std::atan2(direction.y, direction.x); }

/// Nothing where the path ends.
std::optional<Branches> BranchesAt(Path const& path, std::size_t piece, XY const& point) {
  std::optional<std::size_t> in = piece;
  std::optional<std::size_t> out = piece;
  Piece const& here = path.pieces[piece];
  if (Distance(here.start, point) <= path.tolerance) in = path.Before(piece);
  if (Distance(here.end, point) <= path.tolerance) out = path.After(piece);
  if (!in || !out) return {};
  Piece const& from = path.pieces[*in];
  Piece const& to = path.pieces[*out];
  XY const came = DirectionAt(from, *in == piece ? PositionOn(from, point) : from.length);
  XY const goes = DirectionAt(to, *out == piece ? PositionOn(to, point) : 0.0);
  return Branches{AngleOf({-came.x, -came.y}), AngleOf(goes)};
}

/// Radians from one direction to another, counter-clockwise.
double TurnFrom(double from, double to) { return TurnBetween(from, to, true); }

bool AreSame(double a, double b) {
  double const turn = TurnFrom(a, b);
  return std::min(turn, kFullTurn - turn) <= kSameDirection;
}

/// Whether exactly one branch of `b` leaves to the left of `a`. Where branches coincide the
/// directions alone do not tell, and the two are said to touch.
bool DoCross(Branches const& a, Branches const& b) {
  for (double const ofA : {a.back, a.forth}) {
    if (AreSame(ofA, b.back) || AreSame(ofA, b.forth)) return false;
  }
  double const width = TurnFrom(a.forth, a.back);
  return (TurnFrom(a.forth, b.back) < width) != (TurnFrom(a.forth, b.forth) < width);
}

Intersection::Kind KindOf(Path const& a, std::size_t i, Path const& b, std::size_t j,
                          Meeting const& meeting) {
  if (meeting.until) return Intersection::Kind::Overlap;
  std::optional<Branches> const ofA = BranchesAt(a, i, meeting.at);
  std::optional<Branches> const ofB = BranchesAt(b, j, meeting.at);
  if (ofA && ofB && DoCross(*ofA, *ofB)) return Intersection::Kind::Crossing;
  return Intersection::Kind::Touching;
}

OnContour PlaceOn(Path const& path, std::size_t piece, XY const& point) {
  return {path.numbers[piece], path.starts[piece] + PositionOn(path.pieces[piece], point)};
}

bool IsSamePlace(Path const& path, double a, double b) {
  double const apart = std::fabs(a - b);
  double const allowed = 4.0 * path.tolerance;
  return apart <= allowed || (path.isClosed && path.length - apart <= allowed);
}

/// Drops places that were found from the pieces on both sides of a joint.
class Merger {
 public:
  Merger(Path const& a, Path const& b) : a_(a), b_(b) {}

  std::vector<Intersection> Merge(std::vector<Intersection> const& sorted) {
    for (Intersection const& next : sorted) {
      if (!IsKnown(next)) kept_.push_back(next);
    }
    return std::move(kept_);
  }

 private:
  bool IsKnown(Intersection const& next) const {
    // Along the first path only neighbours can be the same, but for its seam.
    for (std::size_t i = kept_.size(); i > 0; --i) {
      Intersection const& other = kept_[i - 1];
      if (next.a.position - other.a.position > 4.0 * a_.tolerance) break;
      if (AreSame(other, next)) return true;
    }
    for (Intersection const& other : kept_) {
      if (other.a.position > 4.0 * a_.tolerance) break;
      if (AreSame(other, next)) return true;
    }
    return false;
  }

  /// A stretch holds its ends, which the neighbours of its pieces find as points.
  bool AreSame(Intersection const& known, Intersection const& next) const {
    if (next.kind == Intersection::Kind::Overlap) return false;
    return known.kind != Intersection::Kind::Overlap &&
           IsSamePlace(a_, known.a.position, next.a.position) &&
           IsSamePlace(b_, known.b.position, next.b.position);
  }

  Path const& a_;
  Path const& b_;
  std::vector<Intersection> kept_;
};

/// Takes the points out that are ends of a stretch.
void DropEndsOfStretches(double tolerance, std::vector<Intersection>* found) {
  std::vector<XY> ends;
  for (Intersection const& one : *found) {
    if (one.until) ends.insert(ends.end(), {one.at, *one.until});
  }
  std::sort(ends.begin(), ends.end(), [](XY const& a, XY const& b) { return a.x < b.x; });
  auto const isEnd = [&](XY const& point) {
    auto end = std::lower_bound(ends.begin(), ends.end(), point.x - tolerance,
                                [](XY const& a, double x) { return a.x < x; });
    for (; end != ends.end() && end->x <= point.x + tolerance; ++end) {
      if (Distance(*end, point) <= tolerance) return true;
    }
    return false;
  };
  std::erase_if(*found, [&](Intersection const& one) {
    return one.kind != Intersection::Kind::Overlap && isEnd(one.at);
  });
}

std::vector<Intersection> Sorted(Path const& a, Path const& b, std::vector<Intersection> found) {
  DropEndsOfStretches(2.0 * a.tolerance, &found);
  std::sort(found.begin(), found.end(), [](Intersection const& one, Intersection const& other) {
    return std::array{one.a.position, one.b.position} <
           std::array{other.a.position, other.b.position};
  });
  return Merger(a, b).Merge(found);
}

void AddMeetings(Path const& a, std::size_t i, Path const& b, std::size_t j,
                 std::vector<Meeting> const& meetings, std::vector<Intersection>* found) {
  for (Meeting const& meeting : meetings) {
    found->push_back({KindOf(a, i, b, j, meeting), meeting.at, meeting.until,
                      PlaceOn(a, i, meeting.at), PlaceOn(b, j, meeting.at)});
  }
}

/// Without the joint that the two pieces share as neighbours.
std::vector<Meeting> WithoutJoint(Path const& path, std::size_t i, std::size_t j,
                                  std::vector<Meeting> meetings) {
  auto const drop = [&](XY const& joint) {
    std::erase_if(meetings, [&](Meeting const& meeting) {
      return !meeting.until && Distance(meeting.at, joint) <= 2.0 * path.tolerance;
    });
  };
  if (path.After(i) == j) drop(path.pieces[i].end);
  if (path.After(j) == i) drop(path.pieces[j].end);
  return meetings;
}

/// The box around both.
Extent Around(Extent const& a, Extent const& b) {
  return {{std::min(a.low.x, b.low.x), std::min(a.low.y, b.low.y)},
          {std::max(a.high.x, b.high.x), std::max(a.high.y, b.high.y)}};
}

/// Gives places found in a local frame their own in the plane.
std::vector<Intersection> PutBack(XY const& origin, std::vector<Intersection> found) {
  auto const shift = [&origin](XY* point) { *point = {point->x + origin.x, point->y + origin.y}; };
  for (Intersection& one : found) {
    shift(&one.at);
    if (one.until) shift(&*one.until);
  }
  return found;
}

std::vector<Intersection> PlacesOfBoth(Path const& a, Path const& b) {
  std::vector<Intersection> found;
  BoxIndex const index(b.pieces, 2.0 * b.tolerance);
  for (std::size_t i = 0; i < a.pieces.size(); ++i) {
    index.Visit(ExtentOf({a.pieces[i]}), [&](std::size_t j) {
      AddMeetings(a, i, b, j, MeetingsOf(a.pieces[i], b.pieces[j], a.tolerance), &found);
    });
  }
  return Sorted(a, b, std::move(found));
}

std::vector<Intersection> PlacesOfOne(Path const& path) {
  std::vector<Intersection> found;
  BoxIndex const index(path.pieces, 2.0 * path.tolerance);
  for (std::size_t i = 0; i < path.pieces.size(); ++i) {
    index.Visit(ExtentOf({path.pieces[i]}), [&](std::size_t j) {
      if (j <= i) return;
      AddMeetings(
          path, i, path, j,
          WithoutJoint(path, i, j, MeetingsOf(path.pieces[i], path.pieces[j], path.tolerance)),
          &found);
    });
  }
  return Sorted(path, path, std::move(found));
}

}  // namespace

std::vector<Intersection> IntersectionsOf(ContourFile const& a, ContourFile const& b) {
  if (a.pieces.empty() || b.pieces.empty()) return {};
  double const tolerance = std::max(JointTolerance(a.pieces), JointTolerance(b.pieces));
  XY const origin = OriginFor(Around(ExtentOf(a.pieces), ExtentOf(b.pieces)));
  Path const first(SeenFrom(origin, a.pieces), tolerance);
  Path const second(SeenFrom(origin, b.pieces), tolerance);
  if (first.pieces.empty() || second.pieces.empty()) return {};
  return PutBack(origin, PlacesOfBoth(first, second));
}

std::vector<Intersection> SelfIntersectionsOf(ContourFile const& contour) {
  if (contour.pieces.empty()) return {};
  XY const origin = OriginFor(ExtentOf(contour.pieces));
  Path const path(SeenFrom(origin, contour.pieces), JointTolerance(contour.pieces));
  if (path.pieces.empty()) return {};
  return PutBack(origin, PlacesOfOne(path));
}

}  // namespace Vorn::IO
