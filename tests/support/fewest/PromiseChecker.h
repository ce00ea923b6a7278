#pragma once

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <set>
#include <sstream>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

#include "vorn/GeometryUtils.h"

/// The promises of a contour of fewest pieces, measured once more: plainly, in extended precision,
/// comparing all pairs, with nothing of the library in it. For tests only: quadratic in the number
/// of pieces and, near crossings, in the number of points.
namespace Vorn::Testing {

/// What is to be measured. Range is any type with the members first and last.
template <typename Range>
struct FinishedChain {
  std::vector<WPoint> const& points;
  std::vector<GeometryUtils::Elem> const& contour;
  std::vector<Range> const& ranges;
  bool isClosed = false;
  double largestStep = std::numeric_limits<double>::infinity();
};

struct PromiseCheck {
  std::vector<std::string> complaints;  ///< none when all is kept
  double largestRatio = 0.0;
  std::int32_t largestIndex = -1;

  std::string Text() const {
    std::string text;
    for (std::string const& complaint : complaints) text += complaint + "\n";
    return text;
  }
};

namespace Checker {

using Real = long double;

constexpr Real kSlack = 1e-9L;  ///< of a ratio, an angle, or a length in units of a tolerance

struct Vec {
  Real x = 0;
  Real y = 0;
};

inline Vec operator+(Vec a, Vec b) { return {a.x + b.x, a.y + b.y}; }
inline Vec operator-(Vec a, Vec b) { return {a.x - b.x, a.y - b.y}; }
inline Vec operator*(Real f, Vec a) { return {f * a.x, f * a.y}; }
inline Real Dot(Vec a, Vec b) { return a.x * b.x + a.y * b.y; }
inline Real Cross(Vec a, Vec b) { return a.x * b.y - a.y * b.x; }
inline Real Norm(Vec a) { return std::hypot(a.x, a.y); }

template <typename AnyPoint>
Vec ToVec(AnyPoint const& p) {
  return {static_cast<Real>(p.x), static_cast<Real>(p.y)};
}

/// Enough to see what is wrong.
constexpr std::size_t kMostComplaints = 12;

inline Real const kPi = std::acos(Real{-1});

/// A piece with its own way of telling places: by angle about the centre, or along the segment.
struct Piece {
  Vec start;
  Vec end;
  bool isArc = false;
  Vec centre;
  Real radius = 0;
  Real sign = 0;
  Real sweep = 0;

  Piece(Vec from, GeometryUtils::Elem const& elem) : start(from), end(ToVec(elem.end)) {
    isArc = elem.type == GeometryUtils::ElemType::Arc;
    if (!isArc) return;
    centre = ToVec(elem.center);
    radius = elem.radius;
    sign = elem.direction > 0 ? 1 : -1;
    sweep = AngleTo(end);
  }

  /// Turned from the start in the sense of the arc, in [0, 2 pi).
  Real AngleTo(Vec p) const {
    Vec const u = start - centre;
    Vec const v = p - centre;
    Real const angle = std::atan2(sign * Cross(u, v), Dot(u, v));
    return angle < 0 ? angle + 2 * kPi : angle;
  }

  Real Length() const { return isArc ? radius * sweep : Norm(end - start); }

  /// Length from the start to the nearest point of the piece.
  Real Along(Vec p) const {
    if (!isArc) {
      Real const length = Length();
      if (length == 0) return 0;
      return std::clamp(Dot(p - start, end - start) / length, Real{0}, length);
    }
    Real const angle = AngleTo(p);
    if (angle <= sweep) return radius * angle;
    return Norm(p - start) < Norm(p - end) ? 0 : radius * sweep;
  }

  Real Distance(Vec p) const {
    Real const toEnds = std::min(Norm(p - start), Norm(p - end));
    if (isArc) {
      return AngleTo(p) <= sweep ? std::min(toEnds, std::fabs(Norm(p - centre) - radius)) : toEnds;
    }
    Vec const u = end - start;
    Real const along = Dot(p - start, u);
    if (along <= 0 || along >= Dot(u, u)) return toEnds;
    return std::fabs(Cross(u, p - start)) / Norm(u);
  }

  /// All magnitudes that rounding is relative to.
  Real Magnitude() const {
    return std::fabs(start.x) + std::fabs(start.y) + std::fabs(end.x) + std::fabs(end.y) +
           std::fabs(centre.x) + std::fabs(centre.y) + radius;
  }
};

/// The common points of the whole lines or circles of two pieces.
inline std::vector<Vec> CommonOfCarriers(Piece const& a, Piece const& b) {
  if (!a.isArc && !b.isArc) {
    Vec const u = a.end - a.start;
    Vec const v = b.end - b.start;
    Real const det = Cross(u, v);
    if (det == 0) return {};
    return {a.start + (Cross(b.start - a.start, v) / det) * u};
  }
  if (!a.isArc) return CommonOfCarriers(b, a);
  Vec foot;
  Vec along;
  if (b.isArc) {
    Vec const d = b.centre - a.centre;
    Real const length = Norm(d);
    if (length == 0) return {};
    Real const q = (length * length + (a.radius - b.radius) * (a.radius + b.radius)) / (2 * length);
    foot = a.centre + (q / length) * d;
    along = (1 / length) * Vec{-d.y, d.x};
  } else {
    Vec const u = b.end - b.start;
    Real const length = Norm(u);
    if (length == 0) return {};
    along = (1 / length) * u;
    foot = b.start + Dot(a.centre - b.start, along) * along;
  }
  Real const off = Norm(foot - a.centre);
  Real const half2 = (a.radius - off) * (a.radius + off);
  if (half2 < 0) return {};
  Real const half = std::sqrt(half2);
  return {foot + half * along, foot - half * along};
}

template <typename Range>
class Run {
 public:
  explicit Run(FinishedChain<Range> const& chain) : chain_(chain) {}

  PromiseCheck Check() {
    if (!CheckForm()) return result_;
    for (std::size_t k = 0; k + 1 < chain_.contour.size(); ++k) {
      pieces_.emplace_back(ToVec(chain_.contour[k].end), chain_.contour[k + 1]);
    }
    for (std::size_t k = 0; k < pieces_.size(); ++k) {
      CheckPoints(k);
      CheckArc(k);
    }
    CheckClosing();
    CheckCrossings();
    return result_;
  }

 private:
  std::size_t Count() const { return chain_.points.size(); }
  Vec PointAt(std::size_t i) const { return ToVec(chain_.points[i % Count()]); }
  Real ToleranceAt(std::size_t i) const { return chain_.points[i % Count()].w; }

  template <typename... Parts>
  void Complain(Parts const&... parts) {
    if (result_.complaints.size() == kMostComplaints) return;
    std::ostringstream text;
    text.precision(17);
    (text << ... << parts);
    result_.complaints.push_back(text.str());
  }

  bool CheckForm() {
    if (chain_.contour.size() < 2 || chain_.ranges.size() + 1 != chain_.contour.size()) {
      Complain("elements and ranges do not match");
      return false;
    }
    std::size_t next = static_cast<std::size_t>(chain_.ranges[0].first);
    std::size_t const end = next + Count();
    if (!chain_.isClosed && next != 0) Complain("starts with point ", next);
    for (auto const& range : chain_.ranges) {
      auto const first = static_cast<std::size_t>(range.first);
      auto const last = static_cast<std::size_t>(range.last);
      if (first >= Count() || last >= Count() || first != next % Count()) {
        Complain("range ", range.first, " to ", range.last, " does not go on from ", next);
        return false;
      }
      if (last < first && !chain_.isClosed) Complain("range wraps on an open contour");
      spans_.push_back({next, next + (last + Count() - first) % Count()});
      next = spans_.back().second + 1;
    }
    if (next != end) Complain("ranges hold ", next - spans_.front().first, " points");
    return next == end;
  }

  void CheckPoints(std::size_t k) {
    Piece const& piece = pieces_[k];
    Real reach = -std::numeric_limits<Real>::infinity();
    Real last = 0;
    for (std::size_t i = spans_[k].first; i <= spans_[k].second; ++i) {
      Real const w = ToleranceAt(i);
      Real const ratio = piece.Distance(PointAt(i)) / w;
      if (ratio > static_cast<Real>(result_.largestRatio)) {
        result_.largestRatio = static_cast<double>(ratio);
        result_.largestIndex = static_cast<std::int32_t>(i % Count());
      }
      // Extended precision itself rounds where the centre is far away.
      Real const allowed = 1 + kSlack + 1e-18L * piece.Magnitude() / w;
      if (ratio > allowed) Complain("point ", i % Count(), " is ", ratio, " off piece ", k);
      Real const along = AlongAfter(piece, last, i);
      last = along;
      if (reach - along > 1.65L * w * (1 + kSlack)) {
        Complain("point ", i % Count(), " steps back on piece ", k, " by ", reach - along);
      }
      reach = std::max(reach, along - 1.65L * w);
    }
    if (piece.isArc && std::isfinite(chain_.largestStep)) CheckSteps(k);
  }

  /// A point may be taken for any place of the piece within its tolerance. Where both ends are,
  /// that of the two is right which is nearer to the point before.
  Real AlongAfter(Piece const& piece, Real last, std::size_t i) const {
    Vec const p = PointAt(i);
    bool const isAtBothEnds = Norm(p - piece.start) <= ToleranceAt(i) * (1 + kSlack) &&
                              Norm(p - piece.end) <= ToleranceAt(i) * (1 + kSlack);
    if (!piece.isArc || !isAtBothEnds) return piece.Along(p);
    return last < piece.Length() - last ? 0 : piece.Length();
  }

  void CheckSteps(std::size_t k) {
    Piece const& piece = pieces_[k];
    Vec last = piece.start;
    Real lastAlong = 0;
    Real lastTolerance = 0;
    auto const step = [&](Vec p, Real along, Real w, std::size_t i) {
      Real const angle = std::fabs(along - lastAlong) / piece.radius;
      lastAlong = along;
      bool const isFar = Norm(p - last) > w + lastTolerance;
      if (isFar && angle > static_cast<Real>(chain_.largestStep) + kSlack) {
        Complain("a step of ", angle, " to point ", i % Count(), " on piece ", k);
      }
      last = p;
      lastTolerance = w;
    };
    for (std::size_t i = spans_[k].first; i <= spans_[k].second; ++i) {
      step(PointAt(i), AlongAfter(piece, lastAlong, i), ToleranceAt(i), i);
    }
    step(piece.end, piece.Length(), 0, spans_[k].second);
  }

  void CheckArc(std::size_t k) {
    Piece const& piece = pieces_[k];
    if (!piece.isArc) return;
    GeometryUtils::Elem const& elem = chain_.contour[k + 1];
    if (!(piece.radius > 0) || std::fabs(elem.direction) != 1.0) Complain("arc ", k, " is no arc");
    Real const rounding = 4e-16L * piece.Magnitude() * 4;
    auto const meets = [&](Vec joint, double angle) {
      Real const off = std::fabs(Norm(joint - piece.centre) - piece.radius);
      if (off > rounding) Complain("arc ", k, " misses its joint by ", off);
      Vec const byAngle = piece.centre + piece.radius * Vec{std::cos(static_cast<Real>(angle)),
                                                            std::sin(static_cast<Real>(angle))};
      if (Norm(byAngle - joint) > 2 * rounding) Complain("an angle of arc ", k, " is off");
    };
    meets(piece.start, elem.startAngle);
    meets(piece.end, elem.endAngle);
    if (elem.startAngle == elem.endAngle) Complain("arc ", k, " has equal angles");
    if ((2 * kPi - piece.sweep) * piece.radius < rounding) Complain("arc ", k, " is a full turn");
  }

  void CheckClosing() {
    if (!chain_.isClosed) return;
    Vec const gap = pieces_.back().end - pieces_.front().start;
    if (gap.x != 0 || gap.y != 0) Complain("the contour does not close");
  }

  bool AreNeighbours(std::size_t a, std::size_t b) const {
    return b == a + 1 || (chain_.isClosed && a == 0 && b + 1 == pieces_.size());
  }

  void CheckCrossings() {
    for (std::size_t a = 0; a < pieces_.size(); ++a) {
      for (std::size_t b = a + 1; b < pieces_.size(); ++b) {
        for (Vec const x : CommonOfCarriers(pieces_[a], pieces_[b])) CheckCrossing(a, b, x);
      }
    }
  }

  /// Near a joint the two ways to it must be apart by more than rounding to make a loop.
  bool IsAtJoint(std::size_t a, std::size_t b, Vec x) const {
    Piece const& first = pieces_[a];
    Piece const& second = pieces_[b];
    Real const rounding = 4e-15L * (first.Magnitude() + second.Magnitude());
    for (auto const& [joint, before, after] :
         {std::tuple{second.start, &first, &second}, std::tuple{first.start, &second, &first}}) {
      if (before->end.x != joint.x || before->end.y != joint.y) continue;
      if (Norm(x - joint) <= rounding) return true;
      Vec const middle = Real{0.5} * (x + joint);
      if (Norm(x - joint) > 0.01L * (first.Length() + second.Length())) continue;
      auto const apart = [&](Piece const& p) {
        if (!p.isArc) return p.Distance(middle);
        return std::fabs(Norm(middle - p.centre) - p.radius);
      };
      if (std::fabs(apart(*before) - apart(*after)) <= rounding) return true;
    }
    return false;
  }

  void CheckCrossing(std::size_t a, std::size_t b, Vec x) {
    // Strictly inside both pieces: touches at an end are left out.
    Real const rounding = 1e-15L * (pieces_[a].Magnitude() + pieces_[b].Magnitude());
    for (std::size_t const k : {a, b}) {
      if (pieces_[k].Distance(x) > rounding) return;
      Real const along = pieces_[k].Along(x);
      if (along <= rounding || along >= pieces_[k].Length() - rounding) return;
    }
    if (AreNeighbours(a, b) && IsAtJoint(a, b, x)) return;
    if (IsAtBothEnds(x) || (IsEdgeOfPath(a) && IsEdgeOfPath(b))) return;
    if (!PathCrossesNear(a, b, x)) {
      Complain("pieces ", a, " and ", b, " cross at (", x.x, ", ", x.y, ")");
    }
  }

  /// An open path may begin and end at one place: no order of its ends is told apart there. Where
  /// all points are within tolerance of it, the tolerances say nothing about the path.
  bool IsAtBothEnds(Vec x) const {
    if (chain_.isClosed || !IsWithin(0, x) || !IsWithin(Count() - 1, x)) return false;
    for (std::size_t i = 1; i + 1 < Count(); ++i) {
      if (!IsWithin(i, x)) return true;
    }
    return false;
  }

  bool IsWithin(std::size_t i, Vec x) const { return Norm(PointAt(i) - x) <= ToleranceAt(i); }

  using Edges = std::pair<std::size_t, std::size_t>;

  /// Whether a piece is the segment from a point to the next one.
  bool IsEdgeOfPath(std::size_t k) const {
    if (pieces_[k].isArc) return false;
    auto const isAt = [&](std::size_t i, Vec end) {
      return Norm(PointAt(i) - end) <= 1e-6L * ToleranceAt(i);
    };
    auto const [first, last] = spans_[k];
    std::size_t i = first;
    while (i <= last && isAt(i, pieces_[k].start)) ++i;
    std::size_t const passed = i;
    while (i <= last && isAt(i, pieces_[k].end)) ++i;
    bool const isThere = passed <= last || chain_.isClosed || k + 1 < pieces_.size();
    return passed > first && i > last && isThere && isAt(passed, pieces_[k].end);
  }

  /// Does an edge of the path meet another one near x? Pairs of edges are looked at from those that
  /// pass x on, one edge farther at a time, for as long as the two are near each other.
  bool PathCrossesNear(std::size_t a, std::size_t b, Vec x) const {
    std::set<Edges> seen;
    std::vector<Edges> open;
    auto const add = [&](std::size_t i, std::size_t j) {
      if (i > j) std::swap(i, j);
      if (i + 1 < j && seen.insert({i, j}).second) open.emplace_back(i, j);
    };
    for (std::size_t const i : EdgesAt(a, x)) {
      for (std::size_t const j : EdgesAt(b, x)) add(i, j);
    }
    std::size_t const starts = open.size();
    for (std::size_t next = 0; next < open.size(); ++next) {
      auto const [i, j] = open[next];
      bool const isLoop = LeavesBetween(i, j);
      if (isLoop && DoEdgesMeet(i, j)) return true;
      if (next >= starts && !(isLoop && AreNear(i, j))) continue;
      for (std::size_t const k : NeighboursOf(i)) add(k, j);
      for (std::size_t const k : NeighboursOf(j)) add(i, k);
    }
    return PathTouchesNear(a, b, x);
  }

  /// Whether the path passes x twice as good as in one place: nearer to itself than 1/32 of the
  /// sum of its tolerances, and it leaves x in between.
  bool PathTouchesNear(std::size_t a, std::size_t b, Vec x) const {
    for (std::size_t const i : EdgesPassing(a, x)) {
      for (std::size_t const j : EdgesPassing(b, x)) {
        Real const apart = Norm(FootOn(i, x) - FootOn(j, x));
        bool const isNear =
            32 * apart <= (LeastToleranceOf(i) + LeastToleranceOf(j)) * (1 + kSlack);
        if (i != j && isNear && LeavesBetween(std::min(i, j), std::max(i, j))) return true;
      }
    }
    return false;
  }

  Real LeastToleranceOf(std::size_t edge) const {
    return std::min(ToleranceAt(edge), ToleranceAt(edge + 1));
  }

  /// The edges of the points of piece k, a few more at either end, that are no farther from x than
  /// twice their tolerances.
  std::vector<std::size_t> EdgesPassing(std::size_t k, Vec x) const {
    auto const [first, last] = spans_[k];
    std::size_t const count = EdgeCount();
    std::size_t const more = std::min<std::size_t>(4, count);
    std::vector<std::size_t> edges;
    for (std::size_t number = first + count - more; number <= last + count + more; ++number) {
      if (!chain_.isClosed && (number < count || number >= 2 * count)) continue;
      std::size_t const edge = number % count;
      if (Norm(FootOn(edge, x) - x) <= 2 * LeastToleranceOf(edge)) edges.push_back(edge);
    }
    return edges;
  }

  Vec FootOn(std::size_t edge, Vec p) const {
    Vec const u = PointAt(edge + 1) - PointAt(edge);
    Real const length2 = Dot(u, u);
    Real const share = length2 == 0 ? 0 : Dot(p - PointAt(edge), u) / length2;
    return PointAt(edge) + std::clamp(share, Real{0}, Real{1}) * u;
  }

  std::size_t EdgeCount() const { return chain_.isClosed ? Count() : Count() - 1; }

  /// The edge before and behind, by the number of its first point.
  std::vector<std::size_t> NeighboursOf(std::size_t i) const {
    std::size_t const count = EdgeCount();
    if (chain_.isClosed) return {(i + 1) % count, (i + count - 1) % count};
    std::vector<std::size_t> neighbours;
    if (i > 0) neighbours.push_back(i - 1);
    if (i + 1 < count) neighbours.push_back(i + 1);
    return neighbours;
  }

  /// The edge of piece k that passes x, and its neighbours.
  std::vector<std::size_t> EdgesAt(std::size_t k, Vec x) const {
    auto const [first, last] = spans_[k];
    Real const place = pieces_[k].Along(x);
    std::size_t behind = first;
    while (behind <= last && pieces_[k].Along(PointAt(behind)) < place) ++behind;
    std::size_t const count = EdgeCount();
    std::size_t const edge = chain_.isClosed
                                 ? (behind + count - 1) % count
                                 : std::min(behind - std::min<std::size_t>(behind, 1), count - 1);
    std::vector<std::size_t> edges = NeighboursOf(edge);
    edges.push_back(edge);
    return edges;
  }

  struct Approach {
    Vec at;
    Real distance = std::numeric_limits<Real>::infinity();
  };

  /// Where two edges meet or come nearest to each other.
  Approach NearestOf(std::size_t i, std::size_t j) const {
    Vec const u = PointAt(i + 1) - PointAt(i);
    Vec const v = PointAt(j + 1) - PointAt(j);
    Real const det = Cross(u, v);
    if (det != 0 && DoEdgesMeet(i, j)) {
      return {PointAt(i) + (Cross(PointAt(j) - PointAt(i), v) / det) * u, 0};
    }
    Approach nearest;
    auto const take = [&](std::size_t point, std::size_t edge) {
      Vec const p = PointAt(point);
      Vec const foot = FootOn(edge, p);
      if (Norm(p - foot) < nearest.distance) nearest = {Real{0.5} * (p + foot), Norm(p - foot)};
    };
    take(i, j);
    take(i + 1, j);
    take(j, i);
    take(j + 1, i);
    return nearest;
  }

  /// Whether two edges are no farther apart than four of their tolerances, or than a joint may lie
  /// off a wide gap.
  bool AreNear(std::size_t i, std::size_t j) const {
    return NearestOf(i, j).distance <= std::max(RoomBeside(i), RoomBeside(j));
  }
  Real RoomBeside(std::size_t edge) const {
    Real const w = std::max(ToleranceAt(edge), ToleranceAt(edge + 1));
    Real const length = Norm(PointAt(edge + 1) - PointAt(edge));
    return length > 16 * w ? 4 * w + 0.134L * length : 4 * w;
  }

  bool DoEdgesMeet(std::size_t i, std::size_t j) const {
    auto const side = [](Vec p, Vec q, Vec r) {
      Real const cross = Cross(q - p, r - p);
      return cross > 0 ? 1 : (cross < 0 ? -1 : 0);
    };
    Vec const a = PointAt(i);
    Vec const b = PointAt(i + 1);
    Vec const c = PointAt(j);
    Vec const d = PointAt(j + 1);
    auto const apart = [](Real p, Real q, Real r, Real s) {
      return std::max(p, q) < std::min(r, s) || std::max(r, s) < std::min(p, q);
    };
    return !apart(a.x, b.x, c.x, d.x) && !apart(a.y, b.y, c.y, d.y) &&
           side(a, b, c) * side(a, b, d) <= 0 && side(c, d, a) * side(c, d, b) <= 0;
  }

  /// A knot of noise is no crossing: the path has to leave the place where edges i and j meet
  /// before it comes back, on a closed contour whichever way around.
  bool LeavesBetween(std::size_t i, std::size_t j) const {
    Vec const at = NearestOf(i, j).at;
    return Leaves(at, i + 1, j) && (!chain_.isClosed || Leaves(at, j + 1, i + Count()));
  }
  bool Leaves(Vec at, std::size_t first, std::size_t last) const {
    for (std::size_t k = first; k <= last; ++k) {
      if (Norm(PointAt(k) - at) > ToleranceAt(k)) return true;
    }
    return false;
  }

  FinishedChain<Range> chain_;
  std::vector<Piece> pieces_;
  std::vector<std::pair<std::size_t, std::size_t>> spans_;
  PromiseCheck result_;
};

}  // namespace Checker

template <typename Range>
PromiseCheck CheckPromises(FinishedChain<Range> const& chain) {
  return Checker::Run<Range>(chain).Check();
}

}  // namespace Vorn::Testing
