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

Point At(WPoint const& p) { return {p.x, p.y}; }

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
  if (IsWhereThePathCloses(meeting.at)) return true;
  Passage const ofFirst = Follow(first, meeting.alongFirst, second);
  if (ofFirst.IsJoined() || ofFirst.StaysOnOneSide()) return false;
  Passage const ofSecond = Follow(second, meeting.alongSecond, first);
  if (ofSecond.IsJoined() || ofSecond.StaysOnOneSide()) return false;
  return DoMeet(ofFirst.first, ofFirst.last, ofSecond.first, ofSecond.last);
}

OwnPath::Passage OwnPath::Follow(std::size_t piece, double along, std::size_t other) {
  std::int64_t const beyond = FirstNumberBeyond(piece, along);
  DrawnPiece const drawnOther = coverage_.Drawn(other);
  Strand back{beyond, -1, piece, other, drawnOther};
  Strand forth{beyond - 1, 1, piece, other, drawnOther};
  Side const before = FollowOneWay(&back);
  Side const after = before == Side::Joined ? Side::Joined : FollowOneWay(&forth);
  return {back.number, forth.number, before, after};
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

OwnPath::Side OwnPath::FollowOneWay(Strand* strand) {
  while (StepOn(strand)) {
    if (--budget_ < 0) return Side::Joined;
    WPoint const& p = PointOf(strand->number);
    Place place;
    if (!MoveToNearest(strand, At(p), &place)) return Side::Joined;
    if (place.distance > p.w + widest_[strand->other]) return SideOf(*strand, At(p), place);
  }
  return Side::Unknown;
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
  double left = place.left;
  if (place.beside != Beside::Piece) {
    std::size_t const neighbour = place.beside == Beside::End ? coverage_.Next(strand.other)
                                                              : coverage_.Previous(strand.other);
    if (neighbour == kNone) return Side::Unknown;
    left += PlaceOf(coverage_.Drawn(neighbour), p).left;
  }
  return left > 0.0 ? Side::Left : Side::Right;
}

WPoint const& OwnPath::PointOf(std::int64_t number) const {
  auto const size = static_cast<std::int64_t>(coverage_.GetChain().points.size());
  return coverage_.GetChain().points[static_cast<std::size_t>((number % size + size) % size)];
}

bool OwnPath::DoMeet(std::int64_t first, std::int64_t last, std::int64_t otherFirst,
                     std::int64_t otherLast) {
  budget_ -= last - first + otherLast - otherFirst;
  if (budget_ < 0 || first >= last || otherFirst >= otherLast) return false;
  Bounds mine;
  Bounds theirs;
  for (std::int64_t i = first; i <= last; ++i) mine.Include(PointOf(i));
  for (std::int64_t k = otherFirst; k <= otherLast; ++k) theirs.Include(PointOf(k));
  if (mine.IsApartFrom(theirs)) return false;
  bool const isMineLonger = last - first >= otherLast - otherFirst;
  if ((isMineLonger ? last - first : otherLast - otherFirst) == 1) {
    return DoEdgesMeet(At(PointOf(first)), At(PointOf(last)), At(PointOf(otherFirst)),
                       At(PointOf(otherLast)));
  }
  if (isMineLonger) {
    std::int64_t const middle = first + (last - first) / 2;
    return DoMeet(first, middle, otherFirst, otherLast) ||
           DoMeet(middle, last, otherFirst, otherLast);
  }
  std::int64_t const middle = otherFirst + (otherLast - otherFirst) / 2;
  return DoMeet(first, last, otherFirst, middle) || DoMeet(first, last, middle, otherLast);
}

}  // namespace Vorn::Promises
