#pragma once

#include <cmath>
#include <cstdint>
#include <random>
#include <utility>
#include <vector>

#include "vorn/GeometryUtils.h"

/// Closed outlines that do not cross themselves, of segments only or with arcs.
namespace Vorn::Benchmarks {

/// Builds a contour element by element.
class OutlineBuilder {
 public:
  using Point = GeometryUtils::Point;

  explicit OutlineBuilder(Point const& start) { To(start); }

  /// Appends a segment.
  void To(Point const& end) { GeometryUtils::AddSegm(&contour_, end); }

  /// Appends an arc about a centre.
  void Around(Point const& center, Point const& end, bool clockwise) {
    Point const start = contour_.back().end;
    double const radius = std::hypot(start.x - center.x, start.y - center.y);
    GeometryUtils::AddArc(&contour_, start, end, center, radius, clockwise);
  }

  /// Appends a segment back to the start and hands the contour out.
  std::vector<GeometryUtils::Elem> Close() {
    To(contour_.front().end);
    return std::move(contour_);
  }

  /// Pieces so far, the closing one not counted.
  std::int64_t Size() const { return static_cast<std::int64_t>(contour_.size()) - 1; }

 private:
  std::vector<GeometryUtils::Elem> contour_;
};

/// A closed curve about the origin with a gentle wave. With arcs, every other chord bulges outward.
inline std::vector<GeometryUtils::Elem> MakeRing(std::int64_t count, bool hasArcs) {
  constexpr double kRadius = 100.0;
  constexpr double kWave = 0.1;
  constexpr int kWaves = 5;
  double const step = 2.0 * std::acos(-1.0) / static_cast<double>(count);
  auto const at = [&](std::int64_t i) {
    double const angle = step * static_cast<double>(i);
    double const radius = kRadius * (1.0 + kWave * std::sin(kWaves * angle));
    return GeometryUtils::Point{radius * std::cos(angle), radius * std::sin(angle)};
  };
  OutlineBuilder outline(at(0));
  for (std::int64_t i = 1; i < count; ++i) {
    if (hasArcs && i % 2 == 0) {
      // The centre lies a chord away from the middle of the chord, on the inner side.
      auto const a = at(i - 1);
      auto const b = at(i);
      outline.Around({0.5 * (a.x + b.x) - (b.y - a.y), 0.5 * (a.y + b.y) + (b.x - a.x)}, b, false);
    } else {
      outline.To(at(i));
    }
  }
  return outline.Close();
}

/// How far the tips of a comb lie from its base line, which runs along the x axis in steps of 1.
struct CombShape {
  double length;  ///< largest height of a tooth
  double lean;    ///< sideways shift of the tip for each unit of height
};

/// A base line with teeth of random height between half and all of the length. With arcs, round
/// caps are put on the teeth.
inline std::vector<GeometryUtils::Elem> MakeComb(std::int64_t count, bool hasArcs,
                                                 CombShape const& shape) {
  constexpr std::uint64_t kSeed = 7;
  constexpr std::int64_t kPiecesBelow = 3;
  constexpr double kCapRadius = 0.25;
  std::mt19937_64 random(kSeed);
  std::uniform_real_distribution<double> share(0.5, 1.0);

  OutlineBuilder outline({0.0, 0.0});
  double x = 0.0;
  std::int64_t const piecesPerTooth = hasArcs ? 4 : 2;
  while (outline.Size() + piecesPerTooth + kPiecesBelow <= count) {
    double const height = shape.length * share(random);
    double const shift = shape.lean * height;
    if (hasArcs) {
      outline.To({x + shift, height});
      outline.Around({x + kCapRadius + shift, height}, {x + 2.0 * kCapRadius + shift, height},
                     true);
      outline.To({x + 2.0 * kCapRadius, 0.0});
    } else {
      outline.To({x + 0.5 + shift, height});
    }
    x += 1.0;
    outline.To({x, 0.0});
  }
  outline.To({x, -1.0});
  outline.To({0.0, -1.0});
  return outline.Close();
}

/// Upright teeth of up to two units, one beside the other.
inline std::vector<GeometryUtils::Elem> MakeTeeth(std::int64_t count, bool hasArcs) {
  return MakeComb(count, hasArcs, {2.0, 0.0});
}

/// Leaning needles as long as half the base line: the box of each overlaps most others.
inline std::vector<GeometryUtils::Elem> MakeNeedles(std::int64_t count, bool hasArcs) {
  double const base = static_cast<double>(count) / (hasArcs ? 4.0 : 2.0);
  return MakeComb(count, hasArcs, {0.5 * base, 1.0});
}

}  // namespace Vorn::Benchmarks
