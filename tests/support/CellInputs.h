#pragma once

#include <algorithm>
#include <array>
#include <cmath>
#include <utility>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/RandomGeometry.h"
#include "vorn/GeometryUtils.h"

/// Random and degenerate triangles, cells and measured runs, and comparisons of whole cells.
namespace Vorn::Testing {

using Cell = std::vector<GeometryUtils::Triangle>;

inline bool SameBits(GeometryUtils::Triangle const& a, GeometryUtils::Triangle const& b) {
  return SameBits(a.pts[0], b.pts[0]) && SameBits(a.pts[1], b.pts[1]) &&
         SameBits(a.pts[2], b.pts[2]);
}

inline void PrintPoint(std::ostream& out, GeometryUtils::Point const& p) {
  out << std::setprecision(17) << "(" << p.x << ", " << p.y << ")";
}

inline std::string Describe(GeometryUtils::Triangle const& t) {
  std::ostringstream out;
  for (auto const& p : t.pts) PrintPoint(out, p);
  return out.str();
}

inline std::string Describe(Cell const& cell) {
  std::ostringstream out;
  for (auto const& t : cell) out << "  " << Describe(t) << "\n";
  return out.str();
}

inline std::string Describe(std::vector<GeometryUtils::Point> const& points) {
  std::ostringstream out;
  for (auto const& p : points) PrintPoint(out, p);
  return out.str();
}

/// Same number of triangles with the same bits in the same order.
inline testing::AssertionResult SameCell(Cell const& expected, Cell const& actual) {
  bool const same = std::equal(expected.begin(), expected.end(), actual.begin(), actual.end(),
                               [](auto const& a, auto const& b) { return SameBits(a, b); });
  if (same) return testing::AssertionSuccess();
  return testing::AssertionFailure() << "expected\n"
                                     << Describe(expected) << "but got\n"
                                     << Describe(actual);
}

inline testing::AssertionResult SamePoints(std::vector<GeometryUtils::Point> const& expected,
                                           std::vector<GeometryUtils::Point> const& actual) {
  bool const same = std::equal(expected.begin(), expected.end(), actual.begin(), actual.end(),
                               [](auto const& a, auto const& b) { return SameBits(a, b); });
  if (same) return testing::AssertionSuccess();
  return testing::AssertionFailure()
         << "expected " << Describe(expected) << " but got " << Describe(actual);
}

/// A triangle whose coordinates no operation computes, to see that a vector is appended to.
inline GeometryUtils::Triangle SentinelTriangle() {
  return {{kPointSentinel, kPointSentinel, kPointSentinel}};
}

inline GeometryUtils::Point Lerp(GeometryUtils::Point const& p, GeometryUtils::Point const& q,
                                 double t) {
  return {p.x + (q.x - p.x) * t, p.y + (q.y - p.y) * t};
}

inline GeometryUtils::Triangle Reversed(GeometryUtils::Triangle const& t) {
  return {{t.pts[2], t.pts[1], t.pts[0]}};
}

inline GeometryUtils::Triangle Rotated(GeometryUtils::Triangle const& t, int by) {
  return {{t.pts[by % 3], t.pts[(by + 1) % 3], t.pts[(by + 2) % 3]}};
}

struct TrianglePair {
  GeometryUtils::Triangle first;
  GeometryUtils::Triangle second;
};

/// Families of pairs; each makes another degenerate relation frequent.
enum class PairKind {
  kSmallGrid,      ///< shared vertices, shared and collinear sides, zero areas
  kScaledGrid,     ///< the same with coordinates that are not exact
  kRandom,         ///< nothing special
  kSharedParts,    ///< vertices of the second on vertices, sides and side lines of the first
  kSlivers,        ///< both 1e-12 thin and nearly parallel
  kDegenerate,     ///< (P, Q, Q) and (P, P, P) against a proper triangle
  kContained,      ///< one strictly inside the other
  kSameVertices,   ///< the same triangle turned or reversed
  kThroughOrigin,  ///< sides on lines through the origin, where overlaps along a line are seen
  kExtremeScale,   ///< squares that underflow or overflow
  kNotFinite,      ///< not-a-numbers, infinities, signed zeros among ordinary numbers
};

inline constexpr std::array kAllPairKinds{
    PairKind::kSmallGrid,    PairKind::kScaledGrid,   PairKind::kRandom,
    PairKind::kSharedParts,  PairKind::kSlivers,      PairKind::kDegenerate,
    PairKind::kContained,    PairKind::kSameVertices, PairKind::kThroughOrigin,
    PairKind::kExtremeScale, PairKind::kNotFinite};

inline GeometryUtils::Triangle Scaled(GeometryUtils::Triangle t, double factor) {
  for (auto& p : t.pts) p = Scale(p, factor);
  return t;
}

inline GeometryUtils::Point RelatedPoint(RandomGeometry& random, GeometryUtils::Triangle const& t) {
  auto const& start = t.pts[random.Integer(0, 2)];
  auto const& end = t.pts[random.Integer(0, 2)];
  switch (random.Integer(0, 4)) {
    case 0:
      return start;
    case 1:
      return Lerp(start, end, 0.5);
    case 2:
      return Lerp(start, end, random.Uniform(-1.0, 2.0));
    case 3:
      return Lerp(start, Lerp(t.pts[0], t.pts[2], random.Unit()), random.Unit());
    default:
      return random.PointIn(-2.0, 2.0);
  }
}

inline GeometryUtils::Triangle Sliver(RandomGeometry& random) {
  auto const p = random.PointIn(-1.0, 1.0);
  auto const q = random.PointIn(-1.0, 1.0);
  double const t = random.Uniform(-0.2, 1.2);
  double const side = random.Flip() ? 1e-12 : -1e-12;
  auto const r = Lerp(p, q, t);
  return {{p, q, {r.x - (q.y - p.y) * side, r.y + (q.x - p.x) * side}}};
}

inline double SpecialNumber(RandomGeometry& random) {
  double const specials[] = {kNaN,
                             kInf,
                             -kInf,
                             0.0,
                             -0.0,
                             std::numeric_limits<double>::min(),
                             std::numeric_limits<double>::denorm_min(),
                             std::numeric_limits<double>::max(),
                             1.0,
                             -1.0,
                             0.5,
                             2.0};
  return specials[random.Integer(0, static_cast<std::int32_t>(std::size(specials)) - 1)];
}

inline TrianglePair NotFinitePair(RandomGeometry& random) {
  TrianglePair pair{random.GridTriangle(2), random.GridTriangle(2)};
  int const count = random.Integer(1, 3);
  for (int k = 0; k < count; ++k) {
    auto& t = random.Flip() ? pair.first : pair.second;
    auto& p = t.pts[random.Integer(0, 2)];
    (random.Flip() ? p.x : p.y) = SpecialNumber(random);
  }
  return pair;
}

inline TrianglePair OriginPair(RandomGeometry& random) {
  auto const direction = random.GridPoint(3);
  auto const onLine = [&] { return Scale(direction, 0.25 * random.Integer(-8, 8)); };
  TrianglePair pair;
  pair.first = {{onLine(), onLine(), random.GridPoint(4)}};
  pair.second = {{onLine(), onLine(), random.Flip() ? onLine() : random.GridPoint(4)}};
  pair.first = Rotated(pair.first, random.Integer(0, 2));
  pair.second = Rotated(pair.second, random.Integer(0, 2));
  return pair;
}

inline TrianglePair MakePair(RandomGeometry& random, PairKind kind) {
  TrianglePair pair;
  switch (kind) {
    case PairKind::kSmallGrid: {
      int const reach = random.Integer(1, 3);
      return {random.GridTriangle(reach), random.GridTriangle(reach)};
    }
    case PairKind::kScaledGrid: {
      double const step = random.Flip() ? 0.1 : 1.0 / 3.0;
      return {Scaled(random.GridTriangle(3), step), Scaled(random.GridTriangle(3), step)};
    }
    case PairKind::kRandom:
      return {random.TriangleIn(-1.0, 1.0), random.TriangleIn(-1.0, 1.0)};
    case PairKind::kSharedParts:
      pair.first = random.TriangleIn(-1.0, 1.0);
      for (auto& p : pair.second.pts) p = RelatedPoint(random, pair.first);
      break;
    case PairKind::kSlivers:
      pair.first = Sliver(random);
      pair.second = Sliver(random);
      if (random.Flip()) {
        pair.second = pair.first;
        for (auto& p : pair.second.pts) p.y += random.Uniform(-1e-12, 1e-12);
      }
      break;
    case PairKind::kDegenerate: {
      pair.second = random.Flip() ? random.GridTriangle(2) : random.TriangleIn(-1.0, 1.0);
      auto const p = RelatedPoint(random, pair.second);
      auto const q = random.Integer(0, 3) == 0 ? p : RelatedPoint(random, pair.second);
      pair.first = Rotated({{p, q, q}}, random.Integer(0, 2));
      break;
    }
    case PairKind::kContained: {
      pair.second = random.TriangleIn(-1.0, 1.0);
      auto const& v = pair.second.pts;
      auto const middle = Lerp(Lerp(v[0], v[1], 0.5), v[2], 0.4);
      double const factor = random.Uniform(0.05, 0.9);
      for (int k = 0; k < 3; ++k) pair.first.pts[k] = Lerp(middle, v[k], factor);
      if (random.Flip()) pair.first = Reversed(pair.first);
      break;
    }
    case PairKind::kSameVertices:
      pair.first = random.Flip() ? random.GridTriangle(2) : random.TriangleIn(-1.0, 1.0);
      pair.second = Rotated(pair.first, random.Integer(0, 2));
      if (random.Flip()) pair.second = Reversed(pair.second);
      break;
    case PairKind::kThroughOrigin:
      pair = OriginPair(random);
      break;
    case PairKind::kExtremeScale: {
      double const scales[] = {1e-160, 1e-154, 1e-308, 5e-324, 1e154, 1e160, 1e300};
      double const scale = scales[random.Integer(0, static_cast<int>(std::size(scales)) - 1)];
      return {Scaled(random.GridTriangle(3), scale), Scaled(random.GridTriangle(3), scale)};
    }
    case PairKind::kNotFinite:
      return NotFinitePair(random);
  }
  if (random.Flip()) std::swap(pair.first, pair.second);
  return pair;
}

/// Points along a line, a tenth of a millimetre to a millimetre apart, each off the line by less
/// than its tolerance.
inline std::vector<WPoint> NoisyLine(RandomGeometry& random, int count, double tolerance) {
  double const angle = random.Uniform(-3.1, 3.1);
  double const c = std::cos(angle);
  double const s = std::sin(angle);
  auto const start = random.PointIn(-50.0, 50.0);
  std::vector<WPoint> points;
  double along = 0.0;
  for (int i = 0; i < count; ++i) {
    double const across = random.Uniform(-0.7, 0.7) * tolerance;
    double const w = tolerance * random.Uniform(0.8, 1.0);
    points.push_back({start.x + along * c - across * s, start.y + along * s + across * c, w});
    along += random.Uniform(4.0, 10.0) * tolerance;
  }
  return points;
}

/// Points along an arc in one sense, each off it by less than its tolerance.
inline std::vector<WPoint> NoisyArc(RandomGeometry& random, int count, double radius,
                                    double tolerance) {
  double const from = random.Uniform(-3.1, 3.1);
  double const sweep = random.Uniform(0.8, 3.0) * (random.Flip() ? 1.0 : -1.0);
  auto const center = random.PointIn(-20.0, 20.0);
  std::vector<WPoint> points;
  for (int i = 0; i < count; ++i) {
    double const angle = from + sweep * i / (count - 1);
    double const r = radius + random.Uniform(-0.7, 0.7) * tolerance;
    points.push_back({center.x + r * std::cos(angle), center.y + r * std::sin(angle),
                      tolerance * random.Uniform(0.8, 1.0)});
  }
  return points;
}

}  // namespace Vorn::Testing
