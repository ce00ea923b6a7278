#include <cmath>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <map>
#include <vector>

#include "geometry/contours/FlatSelfIntersection.h"
#include "geometry/contours/SelfIntersection.h"
#include "geometry/contours/near/NearPairs.h"
#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/ContourBuilder.h"
#include "support/RandomGeometry.h"
#include "support/ReferenceSelfIntersection.h"
#include "vorn/GeometryUtils.h"

// The search for near pairs must answer what the plain walk over all pairs answers.

namespace Vorn::Testing {
namespace {

using Arc = GeometryUtils::Arc;
using Elem = GeometryUtils::Elem;
using Point = GeometryUtils::Point;
using Contour = std::vector<Elem>;

constexpr std::size_t kAlwaysSearch = 0;
constexpr std::size_t kNeverSearch = std::numeric_limits<std::size_t>::max();
double const kPi = std::acos(-1.0);

ErrorCode CheckContour(Contour const& contour, std::size_t plainSize) {
  return Contours::CheckContour(contour, plainSize);
}

class ContourComparison {
 public:
  void Compare(Contour const& contour) {
    ErrorCode const expected = ReferenceCheckOfContour(contour);
    ASSERT_EQ(CheckContour(contour, kAlwaysSearch), expected);
    ASSERT_EQ(CheckContour(contour, kNeverSearch), expected);
    ASSERT_EQ(GeometryUtils::CheckPolySelfIntersection(contour), expected);
    ++counts_[expected];
  }

  int Count(ErrorCode code) const {
    auto const found = counts_.find(code);
    return found == counts_.end() ? 0 : found->second;
  }

  void ExpectEachCodeAtLeast(int least) const {
    EXPECT_GE(Count(ErrorCode::Ok), least);
    EXPECT_GE(Count(ErrorCode::Failed), least);
    EXPECT_GE(Count(ErrorCode::SelfIntersection), least);
  }

 private:
  std::map<ErrorCode, int> counts_;
};

Point Polar(double radius, double angle) {
  return {radius * std::cos(angle), radius * std::sin(angle)};
}

Point Turned(Point const& p, double angle) {
  return {p.x * std::cos(angle) - p.y * std::sin(angle),
          p.x * std::sin(angle) + p.y * std::cos(angle)};
}

Contour PathOf(std::vector<Point> const& points) {
  Contour contour;
  for (Point const& p : points) GeometryUtils::AddSegm(&contour, p);
  return contour;
}

/// Sizes on both sides of the one at which the search begins.
std::int32_t RandomSize(RandomGeometry& random) {
  auto const limit = static_cast<std::int32_t>(Contours::kPlainSize);
  return random.Integer(0, 3) == 0 ? random.Integer(1, 400) : random.Integer(1, 2 * limit);
}

/// A ring whose radius wavers; roughness decides whether it is smooth or made of teeth.
std::vector<Point> RingOf(RandomGeometry& random, std::int32_t count, double roughness) {
  std::vector<Point> points;
  for (std::int32_t i = 0; i < count; ++i) {
    double const radius = 10.0 + (random.Flip() ? roughness : -roughness) * random.Unit();
    points.push_back(Polar(radius, 2.0 * kPi * i / count));
  }
  points.push_back(points.front());
  return points;
}

/// Long thin needles side by side, at any slope.
std::vector<Point> CombOf(RandomGeometry& random, std::int32_t count) {
  std::vector<Point> points;
  double const slope = random.Uniform(-3, 3);
  double const step = random.Uniform(1e-6, 1.0);
  for (std::int32_t i = 0; i < count; ++i) {
    points.push_back(Turned({i * step, i % 2 == 0 ? 0.0 : 100.0}, slope));
  }
  return points;
}

/// Needles around a centre.
std::vector<Point> FanOf(RandomGeometry& random, std::int32_t count) {
  std::vector<Point> points;
  double const inner = random.Uniform(0.01, 50);
  for (std::int32_t i = 0; i < count; ++i) {
    points.push_back(Polar(i % 2 == 0 ? inner : 100.0, 2.0 * kPi * i / count));
  }
  points.push_back(points.front());
  return points;
}

/// Moves one point somewhere else, which most often makes a crossing.
void Disturb(RandomGeometry& random, std::vector<Point>* points) {
  auto const last = static_cast<std::int32_t>(points->size()) - 1;
  (*points)[static_cast<std::size_t>(random.Integer(0, last))] = random.PointIn(-15, 15);
}

TEST(AnyPair, TestsAPieceWithoutAnExtentAgainstEveryOther) {
  Contours::Piece const regular{{0.0, 0.0}, {1.0, 0.0}, nullptr};
  Contours::Piece const irregular{{50.0, 50.0}, {kInf, 50.0}, nullptr};
  std::vector<Contours::Piece> const three = {regular, regular, regular};
  std::vector<Contours::Piece> const odd = {irregular};
  std::vector<std::size_t> tested;
  auto const note = [&tested](std::size_t i, std::size_t k) {
    tested.push_back(i + k);
    return false;
  };
  EXPECT_FALSE(Contours::AnyPair(three, odd, note));
  EXPECT_EQ(tested, (std::vector<std::size_t>{0, 1, 2}));
  tested.clear();
  EXPECT_FALSE(Contours::AnyPair(odd, three, note));
  EXPECT_EQ(tested, (std::vector<std::size_t>{0, 1, 2}));
}

TEST(SearchOfContours, AgreesOnChainsOfSegments) {
  RandomGeometry random(61);
  ContourComparison comparison;
  for (int round = 0; round < 2000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 61, round " << round);
    std::int32_t const size = RandomSize(random);
    std::vector<Point> points;
    switch (round % 5) {
      case 0:
        points = RingOf(random, size, 0.0);
        break;
      case 1:
        points = RingOf(random, size, 3.0);
        break;
      case 2:
        points = CombOf(random, size);
        break;
      case 3:
        points = FanOf(random, size);
        break;
      default:
        for (std::int32_t i = 0; i < size; ++i) points.push_back(random.PointIn(-10, 10));
    }
    if (random.Flip()) Disturb(random, &points);
    ASSERT_NO_FATAL_FAILURE(comparison.Compare(PathOf(points)));
  }
  comparison.ExpectEachCodeAtLeast(15);
}

TEST(SearchOfContours, AgreesOnGridPathsWithOverlaps) {
  RandomGeometry random(62);
  ContourComparison comparison;
  for (int round = 0; round < 3000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 62, round " << round);
    // Mostly to the right and back on few lines: overlaps and touches, now and then a crossing.
    std::vector<Point> points{{0, 0}};
    std::int32_t const size = RandomSize(random);
    double const slope = round % 3 == 0 ? 0.0 : random.Integer(-2, 2);
    for (std::int32_t i = 0; i < size; ++i) {
      Point p = points.back();
      double const x = random.Integer(0, 20) == 0 ? random.Integer(-3, 0) : random.Integer(0, 3);
      if (random.Integer(0, 30) == 0) p.y += 1.0;
      points.push_back({p.x + x, p.y + slope * x});
    }
    ASSERT_NO_FATAL_FAILURE(comparison.Compare(PathOf(points)));
  }
  comparison.ExpectEachCodeAtLeast(30);
}

TEST(SearchOfContours, AgreesOnSegmentsThatAlmostMeet) {
  // End points on other segments, off by a few units in the last place.
  RandomGeometry random(63);
  ContourComparison comparison;
  for (int round = 0; round < 4000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 63, round " << round);
    std::vector<Point> points = CombOf(random, random.Integer(4, 30));
    auto const count = static_cast<std::int32_t>(points.size());
    for (int touch = 0; touch < 3; ++touch) {
      auto const at = static_cast<std::size_t>(random.Integer(0, count - 2));
      auto const moved = static_cast<std::size_t>(random.Integer(0, count - 1));
      double const t = random.Integer(0, 4) / 4.0;
      Point p{points[at].x + t * (points[at + 1].x - points[at].x),
              points[at].y + t * (points[at + 1].y - points[at].y)};
      for (int step = random.Integer(0, 3); step > 0; --step) {
        p.x = std::nextafter(p.x, random.Flip() ? kInf : -kInf);
      }
      points[moved] = p;
    }
    ASSERT_NO_FATAL_FAILURE(comparison.Compare(PathOf(points)));
  }
  EXPECT_GT(comparison.Count(ErrorCode::Ok), 30);
  EXPECT_GT(comparison.Count(ErrorCode::SelfIntersection), 300);
}

/// A ring of arcs and segments that join; arcs of one circle or of others.
Contour RingWithArcs(RandomGeometry& random, std::int32_t count, double bulge) {
  double const first = random.Uniform(-3, 3);
  Point const start = Polar(10.0, first);
  ContourBuilder builder(start.x, start.y);
  for (std::int32_t i = 1; i <= count; ++i) {
    Point const end = i == count ? start : Polar(10.0, first + 2.0 * kPi * i / count);
    if (random.Flip()) {
      builder.To(end.x, end.y);
    } else if (bulge == 0.0) {
      builder.Around({0, 0}, end.x, end.y, 1.0);
    } else {
      Point const from = builder.Build().back().end;
      double const t = random.Uniform(-bulge, bulge);
      Point const center{0.5 * (from.x + end.x) - t * (end.y - from.y),
                         0.5 * (from.y + end.y) + t * (end.x - from.x)};
      builder.Around(center, end.x, end.y, random.Flip() ? 1.0 : -1.0);
    }
  }
  return builder.Build();
}

TEST(SearchOfContours, AgreesOnRingsOfArcs) {
  RandomGeometry random(64);
  ContourComparison comparison;
  for (int round = 0; round < 2000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 64, round " << round);
    double const bulges[] = {0.0, 0.1, 2.0, 1e3, 1e7};
    Contour contour = RingWithArcs(random, RandomSize(random), bulges[round % 5]);
    auto const last = static_cast<std::int32_t>(contour.size()) - 1;
    if (random.Integer(0, 3) == 0) {
      Elem& elem = contour[static_cast<std::size_t>(random.Integer(0, last))];
      elem.end = random.PointIn(-12, 12);
    }
    ASSERT_NO_FATAL_FAILURE(comparison.Compare(contour));
  }
  EXPECT_GT(comparison.Count(ErrorCode::Ok), 50);
  EXPECT_GT(comparison.Count(ErrorCode::SelfIntersection), 300);
}

/// An arc that need not agree with its neighbours, small most of the time.
Arc LooseArc(RandomGeometry& random, Point const& end, double size) {
  double const anyStart = random.Uniform(-3.2, 3.2);
  return {end,
          random.PointIn(-10, 10),
          size * random.Uniform(0.01, 1.0),
          random.Flip() ? 1.0 : -1.0,
          anyStart,
          random.Integer(0, 20) == 0 ? random.Uniform(-9, 9) : anyStart + random.Uniform(-1, 1)};
}

TEST(SearchOfContours, AgreesOnLooseArcsAndTheirErrors) {
  RandomGeometry random(65);
  ContourComparison comparison;
  for (int round = 0; round < 6000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 65, round " << round);
    std::int32_t const size = random.Integer(2, round % 4 == 0 ? 150 : 30);
    double const reach = random.Integer(0, 3) == 0 ? 3.0 : 0.1;
    ContourBuilder builder(0, 0);
    for (std::int32_t i = 0; i < size; ++i) {
      Point const from = builder.Build().back().end;
      Point const to{from.x + random.Uniform(-reach, reach), from.y + random.Uniform(0, reach)};
      if (random.Integer(0, 12) == 0) builder.Stay();
      if (random.Integer(0, 2) == 0) {
        builder.To(to.x, to.y);
        continue;
      }
      Arc arc = LooseArc(random, to, reach);
      if (random.Integer(0, 3 * size) == 0) arc.endAngle = arc.startAngle;
      if (random.Integer(0, 3 * size) == 0) arc.radius = random.Integer(-1, 0);
      builder.Arc(arc);
      if (random.Integer(0, 60) == 0) builder.Arc(arc);
    }
    if (random.Integer(0, 20) == 0) builder.OfType(2, 1, 1).To(3, 3);
    ASSERT_NO_FATAL_FAILURE(comparison.Compare(builder.Build()));
  }
  comparison.ExpectEachCodeAtLeast(300);
}

TEST(SearchOfContours, AgreesWhereOneErrorFollowsOneCrossing) {
  // A zigzag with arcs far away; one invalid arc and one way back across at any two places. Arcs
  // first pass over what would fail a segment.
  RandomGeometry random(66);
  ContourComparison comparison;
  for (int round = 0; round < 3000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 66, round " << round);
    std::int32_t const size = random.Integer(6, 40);
    std::int32_t const invalid = random.Integer(-9, size - 1);
    std::int32_t const crossing = random.Integer(-9, size - 1);
    bool const isRadius = random.Integer(0, 3) == 0;
    std::int32_t const leadingArcs = random.Integer(0, 4);
    ContourBuilder builder(-1, 0);
    for (std::int32_t i = 0; i < size; ++i) {
      Point const to{1.0 * i, i % 2 == 0 ? 0.0 : 1.0};
      Arc arc{to, {5.0 * i, 99.0}, 1.0, 1.0, -1.0, 1.0};
      if (i == invalid && isRadius) arc.radius = 0.0;
      if (i == invalid && !isRadius) arc.endAngle = arc.startAngle;
      bool const isArc = i < leadingArcs || i == invalid || random.Integer(0, 2) == 0;
      if (i == crossing) {
        builder.To(to.x - random.Integer(1, size), 0.5);
      } else if (isArc) {
        builder.Arc(arc);
      } else {
        builder.To(to.x, to.y);
      }
    }
    ASSERT_NO_FATAL_FAILURE(comparison.Compare(builder.Build()));
  }
  comparison.ExpectEachCodeAtLeast(150);
}

TEST(SearchOfContours, AgreesOnArcsAboutTheSameOrNearlyTheSameCircle) {
  RandomGeometry random(67);
  ContourComparison comparison;
  for (int round = 0; round < 4000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 67, round " << round);
    ContourBuilder builder(0, 0);
    std::int32_t const size = random.Integer(3, 12);
    double const scale = std::ldexp(1.0, random.Integer(-40, 40));
    for (std::int32_t i = 0; i < size; ++i) {
      double const tiny = std::ldexp(random.Uniform(-1, 1), -random.Integer(10, 60));
      double const start = random.Uniform(-3.2, 3.2);
      double const gap = random.Flip() ? tiny : 0.0;
      // Circles that touch from within or without, coincide or almost do.
      double const ratio = random.Integer(0, 2) == 0 ? random.Integer(1, 3) : 1.0;
      Point const center{scale * ((random.Flip() ? ratio - 1.0 : 0.0) + gap), scale * tiny};
      Point const end{scale * random.Uniform(-1, 1), scale * random.Uniform(-1, 1)};
      if (random.Integer(0, 3) == 0) {
        // Almost tangent to the unit circle.
        builder.To(scale * (1.0 + tiny), end.y).To(scale * (1.0 + gap), -end.y);
      } else {
        builder.Arc(
            {end, center, scale * (ratio + gap), 1.0, start, start + random.Uniform(0.001, 0.5)});
      }
    }
    ASSERT_NO_FATAL_FAILURE(comparison.Compare(builder.Build()));
  }
  EXPECT_GT(comparison.Count(ErrorCode::Ok), 100);
  EXPECT_GT(comparison.Count(ErrorCode::SelfIntersection), 100);
}

TEST(SearchOfContours, AgreesOnAnyBits) {
  RandomGeometry random(68);
  ContourComparison comparison;
  double const odd[] = {kNaN,  kInf,  -kInf, 0.0,   -0.0, 1e308, 5e-324,
                        1e-70, 1e-59, 1e59,  1e-30, 1e30, 1.0,   -1.0};
  for (int round = 0; round < 12000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 68, round " << round);
    Contour contour;
    std::int32_t const count = random.Integer(3, 14);
    // From hardly any odd value to nothing else.
    std::int32_t const rarity = random.Integer(1, 60);
    auto const value = [&](double regular) {
      if (random.Integer(0, rarity) != 0) return regular;
      return random.Flip() ? odd[random.Integer(0, 13)] : random.AnyDouble();
    };
    for (std::int32_t i = 0; i < count; ++i) {
      Elem elem;
      bool const isArc = i > 0 && random.Integer(0, 2) == 0;
      elem.type = isArc ? GeometryUtils::ElemType::Arc : GeometryUtils::ElemType::Segment;
      if (random.Integer(0, 100) == 0) elem.type = static_cast<GeometryUtils::ElemType>(2);
      elem.end = {value(i + random.Unit()), value(random.Integer(0, 1) + random.Unit())};
      elem.center = {value(i + random.Unit()), value(random.Unit())};
      elem.radius = value(0.4 * random.Unit());
      elem.direction = value(random.Flip() ? 1.0 : -1.0);
      elem.startAngle = value(random.Uniform(-3, 3));
      elem.endAngle = value(random.Uniform(-3, 3));
      contour.push_back(elem);
    }
    ASSERT_NO_FATAL_FAILURE(comparison.Compare(contour));
  }
  comparison.ExpectEachCodeAtLeast(500);
}

// Flat polylines.

int AnswerOf(ErrorCode code, bool isCrossing) {
  return code == ErrorCode::Ok && isCrossing ? ReferenceFlatCheck::kCrossing
                                             : static_cast<int>(code);
}

class FlatComparison {
 public:
  void Compare(std::vector<double> coords, std::vector<std::int32_t> const& indices) {
    int const expected = ReferenceFlatCheck(coords, indices).Answer();
    for (std::size_t const plainSize : {kAlwaysSearch, kNeverSearch}) {
      auto const verdict = Flat::CheckRuns(Flat::Data(coords), Flat::RunsOf(indices), plainSize);
      ASSERT_EQ(AnswerOf(verdict.code, verdict.isCrossing), expected);
    }
    bool found = false;
    ErrorCode const code = GeometryUtils::CheckPolySelfIntersection(coords, indices, &found);
    ASSERT_EQ(AnswerOf(code, found), expected);
    ++counts_[expected];
  }

  int Count(int answer) const {
    auto const found = counts_.find(answer);
    return found == counts_.end() ? 0 : found->second;
  }

 private:
  std::map<int, int> counts_;
};

TEST(SearchOfFlatPolylines, AgreesOnOneStraightRun) {
  RandomGeometry random(71);
  FlatComparison comparison;
  for (int round = 0; round < 1500; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 71, round " << round);
    std::int32_t const size = RandomSize(random) + 1;
    std::vector<Point> points = round % 3 == 0   ? RingOf(random, size, 3.0)
                                : round % 3 == 1 ? CombOf(random, size)
                                                 : FanOf(random, size);
    points.pop_back();
    if (points.size() < 2) points.push_back({77, 77});
    if (random.Integer(0, 3) == 0) Disturb(random, &points);
    std::vector<double> coords;
    for (Point const& p : points) {
      coords.insert(coords.end(), {p.x, p.y});
      if (random.Integer(0, 200) == 0) coords.insert(coords.end(), {p.x, p.y});
    }
    auto const last = static_cast<std::int32_t>(coords.size()) - 2;
    ASSERT_NO_FATAL_FAILURE(comparison.Compare(coords, {last}));
  }
  EXPECT_GT(comparison.Count(0), 300);
  EXPECT_GT(comparison.Count(ReferenceFlatCheck::kCrossing), 200);
}

TEST(SearchOfFlatPolylines, AgreesOnRunsOfBothKinds) {
  RandomGeometry random(72);
  FlatComparison comparison;
  for (int round = 0; round < 6000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 72, round " << round);
    std::vector<double> coords;
    std::vector<std::int32_t> indices;
    std::int32_t const runs = random.Integer(1, 4);
    double const arcSize = random.Flip() ? 0.5 : 0.01;
    double x = 0.0;
    for (std::int32_t run = 0; run < runs; ++run) {
      bool const isStraight = random.Flip();
      std::int32_t const count = random.Integer(0, round % 5 == 0 ? 70 : 12);
      for (std::int32_t i = 0; i < count; ++i) {
        x += random.Uniform(0.01, 1.0);
        double const y = random.Integer(0, 1) + 0.1 * random.Unit();
        coords.insert(coords.end(), {x, y});
        if (isStraight) continue;
        double const start = random.Uniform(-3, 3);
        double const end = random.Integer(0, 400) == 0 ? start : start + random.Uniform(-1, 1);
        double const radius = random.Integer(0, 400) == 0 ? 0.0 : arcSize * random.Unit();
        coords.insert(coords.end(), {x + random.Unit(), 2.0 + y, radius, 1.0, start, end});
      }
      auto const offset = static_cast<std::int32_t>(coords.size());
      indices.push_back(isStraight && offset > 0 ? offset : -offset);
    }
    // What the last pieces read of the vertex after them.
    coords.insert(coords.end(), {x + 1.0, 0.5, x + 2.0, 0.5});
    if (random.Integer(0, 20) == 0) coords.resize(coords.size() - 3);
    ASSERT_NO_FATAL_FAILURE(comparison.Compare(coords, indices));
  }
  EXPECT_GT(comparison.Count(0), 500);
  EXPECT_GT(comparison.Count(1), 50);
  EXPECT_GT(comparison.Count(2), 50);
  EXPECT_GT(comparison.Count(ReferenceFlatCheck::kCrossing), 500);
}

TEST(SearchOfFlatPolylines, AgreesOnAnyEntriesAndBits) {
  RandomGeometry random(73);
  FlatComparison comparison;
  double const odd[] = {kNaN, kInf, -kInf, 0.0, -0.0, 1e308, 5e-324, 1.0, -1.0, 3.0};
  for (int round = 0; round < 12000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 73, round " << round);
    std::vector<double> coords(static_cast<std::size_t>(random.Integer(1, 60)));
    std::int32_t const rarity = random.Integer(1, 60);
    for (double& value : coords) {
      value = random.Uniform(0.1, 4);
      if (random.Integer(0, rarity) == 0) value = odd[random.Integer(0, 9)];
    }
    auto const size = static_cast<std::int32_t>(coords.size());
    std::vector<std::int32_t> indices;
    for (std::int32_t run = random.Integer(1, 4); run > 0; --run) {
      indices.push_back(random.Integer(-size, size));
    }
    // A last entry equal to the size would append the closing vertex.
    if (indices.back() == size) indices.back() = size - 1;
    ASSERT_NO_FATAL_FAILURE(comparison.Compare(coords, indices));
  }
  EXPECT_GT(comparison.Count(0), 500);
  EXPECT_GT(comparison.Count(1), 50);
  EXPECT_GT(comparison.Count(2), 500);
  EXPECT_GT(comparison.Count(ReferenceFlatCheck::kCrossing), 500);
}

}  // namespace
}  // namespace Vorn::Testing
