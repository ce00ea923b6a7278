#pragma once

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <optional>
#include <utility>
#include <vector>

#include "support/fewest/PromiseChecker.h"
#include "vorn/GeometryUtils.h"

/// The chain of the fewest pieces whose joints lie on a grid: every joint of the grid is joined
/// with every other by every arc that the tolerances of the points between them leave. What it
/// finds is a chain, so that no search may need more pieces; joints between those of the grid might
/// do with fewer still. For some 60 points.
namespace Vorn::Testing {

class ChainOracle {
 public:
  explicit ChainOracle(std::vector<WPoint> const& points) : points_(points) {}

  struct Found {
    std::vector<GeometryUtils::Elem> contour;
    struct Range {
      std::int32_t first;
      std::int32_t last;
    };
    std::vector<Range> ranges;
  };

  /// The chain, or nothing when the grid allows none of at most `most` pieces.
  std::optional<Found> FindChain(std::int32_t most) {
    MakeJoints();
    for (std::size_t i = 0; i < joints_.size() && joints_[i].split == 0; ++i) joints_[i].level = 0;
    for (std::int32_t level = 0; level < most; ++level) {
      for (std::size_t i = 0; i < joints_.size(); ++i) {
        if (joints_[i].level == level) Expand(i);
      }
      for (std::size_t i = 0; i < joints_.size(); ++i) {
        if (joints_[i].level == level + 1 && joints_[i].split == Count()) return TraceBack(i);
      }
    }
    return std::nullopt;
  }

 private:
  using Vec = Checker::Vec;
  using Elem = GeometryUtils::Elem;

  static constexpr std::int32_t kUnreached = std::numeric_limits<std::int32_t>::max();

  /// A joint in front of point `split`, and the piece by which it was reached.
  struct Joint {
    Vec at;
    std::size_t split = 0;
    std::int32_t level = kUnreached;
    std::size_t before = 0;
    Elem piece;
  };

  std::size_t Count() const { return points_.size(); }
  Vec At(std::size_t i) const { return Checker::ToVec(points_[i]); }

  /// At the middle of each gap and at its ends, across the chord of the gap: within the tolerance
  /// and, for corners that lie in the gap, up to half of it.
  void MakeJoints() {
    AddAcross(At(0), At(1) - At(0), points_[0].w, 0, false);
    for (std::size_t split = 1; split < Count(); ++split) {
      Vec const gap = At(split) - At(split - 1);
      for (long double const share : {0.02L, 0.5L, 0.98L}) {
        long double const w = std::min(points_[split - 1].w, points_[split].w);
        AddAcross(At(split - 1) + share * gap, gap, w, split, share == 0.5L);
      }
    }
    AddAcross(At(Count() - 1), At(Count() - 1) - At(Count() - 2), points_.back().w, Count(), false);
  }

  void AddAcross(Vec at, Vec along, long double w, std::size_t split, bool isWide) {
    long double const length = Checker::Norm(along);
    Vec const normal = (1 / length) * Vec{-along.y, along.x};
    for (int k = -4; k <= 4; ++k) Add(at + (0.24L * k * w) * normal, split);
    if (!isWide) return;
    for (int k = -4; k <= 4; ++k) {
      if (k != 0) Add(at + (0.125L * k * length) * normal, split);
    }
  }

  void Add(Vec at, std::size_t split) {
    // Joints are doubles, as in a contour.
    Vec const rounded{static_cast<double>(at.x), static_cast<double>(at.y)};
    Joint joint;
    joint.at = rounded;
    joint.split = split;
    joints_.push_back(joint);
  }

  void Expand(std::size_t from) {
    for (std::size_t to = from + 1; to < joints_.size(); ++to) {
      if (joints_[to].level != kUnreached || joints_[to].split <= joints_[from].split) continue;
      if (auto const piece = FindPiece(joints_[from], joints_[to])) {
        joints_[to].level = joints_[from].level + 1;
        joints_[to].before = from;
        joints_[to].piece = *piece;
      }
    }
  }

  /// Arcs from one joint to another are told apart by half their sweep, t: with L the distance from
  /// the chord and K = (p - start) (p - end) / |chord|, a point is within w of the circle when
  /// |L cos t + (K - w^2 / |chord|) sin t| <= w. Each side of it forbids one range of t. What is
  /// left is tried in the middle and near the ends of each stretch.
  std::optional<Elem> FindPiece(Joint const& from, Joint const& to) const {
    Vec const chord = to.at - from.at;
    long double const length = Checker::Norm(chord);
    if (length == 0) return std::nullopt;
    Stretches allowed{{-3.1L, 3.1L}};
    // From the middle on: there points are farthest from the joints and leave least.
    std::size_t const count = to.split - from.split;
    for (std::size_t k = 0; k < count && !allowed.empty(); ++k) {
      std::size_t const i = from.split + (k + count / 2) % count;
      long double const w = points_[i].w;
      // Positive on the side to which arcs of positive t bulge.
      long double const side = Checker::Cross(At(i) - from.at, chord) / length;
      long double const power = (Checker::Dot(At(i) - from.at, At(i) - to.at) - w * w) / length;
      Forbid(side, power, w, &allowed);
      Forbid(-side, -power, w, &allowed);
    }
    for (auto const& [low, high] : allowed) {
      for (long double const share : {0.5L, 0.1L, 0.9L}) {
        Elem const piece = MakePiece(from.at, to.at, low + share * (high - low));
        if (Keeps(from, to, piece)) return piece;
      }
    }
    return std::nullopt;
  }

  using Stretches = std::vector<std::pair<long double, long double>>;

  /// a cos t + b sin t > w between the two angles at which it equals w.
  static void Forbid(long double a, long double b, long double w, Stretches* allowed) {
    long double const size = std::hypot(a, b);
    if (size <= w) return;
    long double const middle = std::atan2(b, a);
    long double const half = std::acos(w / size);
    for (int turn = -1; turn <= 1; ++turn) {
      long double const shift = 2 * Checker::kPi * turn;
      Stretches left;
      for (auto const& [low, high] : *allowed) {
        if (low < middle - half + shift) {
          left.emplace_back(low, std::min(high, middle - half + shift));
        }
        if (high > middle + half + shift) {
          left.emplace_back(std::max(low, middle + half + shift), high);
        }
      }
      *allowed = std::move(left);
    }
  }

  /// Half a sweep above 0 bulges to the right of the chord and turns counter-clockwise.
  static Elem MakePiece(Vec from, Vec to, long double t) {
    Elem elem;
    elem.end = {static_cast<double>(to.x), static_cast<double>(to.y)};
    if (std::fabs(t) < 1e-9L) return elem;
    elem.type = GeometryUtils::ElemType::Arc;
    Vec const chord = to - from;
    long double const shift = 0.5L / std::tan(t);
    Vec const centre = from + 0.5L * chord + shift * Vec{-chord.y, chord.x};
    elem.center = {static_cast<double>(centre.x), static_cast<double>(centre.y)};
    elem.radius = static_cast<double>(Checker::Norm(from - Checker::ToVec(elem.center)));
    elem.direction = t > 0 ? 1.0 : -1.0;
    auto const angle = [&elem](Vec p) {
      return std::atan2(static_cast<double>(p.y) - elem.center.y,
                        static_cast<double>(p.x) - elem.center.x);
    };
    elem.startAngle = angle(from);
    elem.endAngle = angle(to);
    return elem;
  }

  /// Tolerances, order and steps of the points of one piece.
  bool Keeps(Joint const& from, Joint const& to, Elem const& elem) const {
    std::vector<WPoint> const run(points_.begin() + static_cast<std::ptrdiff_t>(from.split),
                                  points_.begin() + static_cast<std::ptrdiff_t>(to.split));
    Elem start;
    start.end = {static_cast<double>(from.at.x), static_cast<double>(from.at.y)};
    std::vector<Elem> const contour{start, elem};
    std::vector<typename Found::Range> const ranges{{0, static_cast<std::int32_t>(run.size()) - 1}};
    constexpr double kSixtyDegrees = 1.0471975511965976;
    return CheckPromises<typename Found::Range>({run, contour, ranges, false, kSixtyDegrees})
        .complaints.empty();
  }

  Found TraceBack(std::size_t joint) const {
    Found found;
    while (joints_[joint].level > 0) {
      std::size_t const before = joints_[joint].before;
      found.contour.push_back(joints_[joint].piece);
      found.ranges.push_back({static_cast<std::int32_t>(joints_[before].split),
                              static_cast<std::int32_t>(joints_[joint].split) - 1});
      joint = before;
    }
    Elem start;
    start.end = {static_cast<double>(joints_[joint].at.x),
                 static_cast<double>(joints_[joint].at.y)};
    found.contour.push_back(start);
    std::reverse(found.contour.begin(), found.contour.end());
    std::reverse(found.ranges.begin(), found.ranges.end());
    return found;
  }

  std::vector<WPoint> const& points_;
  std::vector<Joint> joints_;
};

}  // namespace Vorn::Testing
