#include <gtest/gtest.h>

#include <chrono>
#include <cmath>
#include <numbers>

#include "io/pieces/Shapes.h"
#include "support/RandomGeometry.h"
#include "vorn/io/Deviations.h"
#include "vorn/io/Intersections.h"

namespace Vorn::IO {
namespace {

using Kind = Intersection::Kind;

ContourFile Way(std::vector<XY> const& corners) {
  ContourFile contour;
  contour.path = "way";
  for (std::size_t i = 1; i < corners.size(); ++i) {
    contour.pieces.push_back(MakeLine(corners[i - 1], corners[i]));
  }
  return contour;
}

ContourFile Circle(XY const& center, double radius) {
  ContourFile contour;
  contour.isClosed = true;
  contour.pieces = MakeCircle({center.x + radius, center.y}, center, radius, true);
  return contour;
}

/// "crossing 1,2; touching 3,4" with coordinates to six digits.
std::string Summary(std::vector<Intersection> const& found) {
  std::string text;
  auto const add = [&text](double value) {
    std::ostringstream number;
    number << std::round(value * 1e6) / 1e6 + 0.0;
    text += number.str();
  };
  for (Intersection const& one : found) {
    text += text.empty() ? "" : "; ";
    text += NameOf(one.kind) + " ";
    add(one.at.x);
    text += ",";
    add(one.at.y);
    if (!one.until) continue;
    text += " to ";
    add(one.until->x);
    text += ",";
    add(one.until->y);
  }
  return text;
}

std::string Of(ContourFile const& a, ContourFile const& b) {
  return Summary(IntersectionsOf(a, b));
}

std::string OfItself(ContourFile const& contour) { return Summary(SelfIntersectionsOf(contour)); }

TEST(IntersectionsOf, LinesCrossTouchOverlapOrMiss) {
  ContourFile const line = Way({{0, 0}, {4, 0}});
  EXPECT_EQ(Of(line, Way({{1, -1}, {1, 1}})), "crossing 1,0");
  EXPECT_EQ(Of(line, Way({{1, 0}, {1, 1}})), "touching 1,0");
  EXPECT_EQ(Of(line, Way({{4, 0}, {5, 3}})), "touching 4,0");
  EXPECT_EQ(Of(line, Way({{1, 0.1}, {1, 1}})), "");
  EXPECT_EQ(Of(line, Way({{0, 1}, {4, 1}})), "");
  EXPECT_EQ(Of(line, Way({{3, 0}, {9, 0}})), "overlap 3,0 to 4,0");
  EXPECT_EQ(Of(line, Way({{3, 0}, {1, 0}})), "overlap 1,0 to 3,0");
  EXPECT_EQ(Of(line, Way({{4, 0}, {9, 0}})), "touching 4,0");
}

TEST(IntersectionsOf, OverlapsAreFoundAwayFromTheOriginToo) {
  ContourFile const line = Way({{100, 107}, {104, 109}});
  EXPECT_EQ(Of(line, Way({{102, 108}, {110, 112}})), "overlap 102,108 to 104,109");
}

TEST(IntersectionsOf, LineAndCircle) {
  ContourFile const circle = Circle({0, 0}, 5);
  EXPECT_EQ(Of(Way({{-9, 3}, {9, 3}}), circle), "crossing -4,3; crossing 4,3");
  EXPECT_EQ(Of(Way({{9, 3}, {-9, 3}}), circle), "crossing 4,3; crossing -4,3") << "along A";
  EXPECT_EQ(Of(Way({{-9, 5}, {9, 5}}), circle), "touching 0,5");
  EXPECT_EQ(Of(Way({{-9, 5.001}, {9, 5.001}}), circle), "");
  EXPECT_EQ(Of(Way({{0, 0}, {9, 0}}), circle), "crossing 5,0") << "once, where the halves join";
  EXPECT_EQ(Of(Way({{0, 0}, {3, 4}}), circle), "touching 3,4");
  EXPECT_EQ(Of(Way({{0, 0}, {1, 1}}), circle), "");
}

TEST(IntersectionsOf, Circles) {
  EXPECT_EQ(Of(Circle({0, 0}, 5), Circle({6, 0}, 5)), "crossing 3,4; crossing 3,-4");
  EXPECT_EQ(Of(Circle({0, 0}, 5), Circle({0, 8}, 3)), "touching 0,5");
  EXPECT_EQ(Of(Circle({0, 0}, 5), Circle({0, 2}, 3)), "touching 0,5");
  EXPECT_EQ(Of(Circle({0, 0}, 5), Circle({0, 0}, 3)), "");
  EXPECT_EQ(Of(Circle({0, 0}, 5), Circle({20, 0}, 3)), "");
}

TEST(IntersectionsOf, ArcsOfOneCircleOverlapInOneOrTwoStretches) {
  ContourFile a;
  ContourFile b;
  a.pieces = {MakeArc({5, 0}, {-5, 0}, {0, 0}, 5, true)};
  b.pieces = {MakeArc({0, 5}, {0, -5}, {0, 0}, 5, true)};
  EXPECT_EQ(Of(a, b), "overlap 0,5 to -5,0");
  b.pieces = {MakeArc({-5, 0}, {5, 0}, {0, 0}, 5, true)};
  EXPECT_EQ(Of(a, b), "touching 5,0; touching -5,0");
  // Three quarters each, which share a quarter at either end.
  a.pieces = {MakeArc({5, 0}, {0, -5}, {0, 0}, 5, true)};
  b.pieces = {MakeArc({-5, 0}, {0, 5}, {0, 0}, 5, true)};
  EXPECT_EQ(Of(a, b), "overlap 5,0 to 0,5; overlap -5,0 to 0,-5");
}

TEST(IntersectionsOf, AtJointsTheBranchesDecide) {
  ContourFile const corner = Way({{-2, 0}, {0, 0}, {0, -2}});
  EXPECT_EQ(Of(corner, Way({{-1, -1}, {1, 1}})), "crossing 0,0");
  EXPECT_EQ(Of(corner, Way({{-1, 1}, {1, -1}})), "touching 0,0");
  EXPECT_EQ(Of(corner, Way({{-1, -1}, {0, 0}, {1, 1}})), "crossing 0,0") << "joint on joint";
  EXPECT_EQ(Of(corner, Way({{-1, 2}, {0, 0}, {2, 1}})), "touching 0,0");
  EXPECT_EQ(Of(corner, Way({{1, 1}, {0, 0}})), "touching 0,0") << "one ends there";
}

TEST(IntersectionsOf, TellsPiecesAndPositions) {
  auto const found = IntersectionsOf(Way({{0, 0}, {4, 0}, {4, 4}}), Way({{3, 3}, {9, 3}}));
  ASSERT_EQ(found.size(), 1u);
  EXPECT_EQ(found[0].a.piece, 1u);
  EXPECT_EQ(found[0].a.position, 7.0);
  EXPECT_EQ(found[0].b.piece, 0u);
  EXPECT_EQ(found[0].b.position, 1.0);
}

TEST(IntersectionsOf, PiecesWithoutLengthCountForNothing) {
  EXPECT_EQ(Of(Way({{0, 0}, {2, 0}, {2, 0}, {4, 0}}), Way({{2, -1}, {2, 1}})), "crossing 2,0");
  EXPECT_EQ(Of(Way({{1, 1}, {1, 1}}), Way({{0, 0}, {2, 2}})), "");
}

TEST(SelfIntersectionsOf, FindsWhatIsNoJoint) {
  EXPECT_EQ(OfItself(Way({{0, 0}, {4, 0}, {4, 3}, {0, 0}})), "");
  EXPECT_EQ(OfItself(Way({{0, 0}, {4, 0}, {2, 2}, {2, -2}})), "crossing 2,0");
  EXPECT_EQ(OfItself(Way({{0, 0}, {4, 0}, {4, 3}, {2, 0}})), "touching 2,0");
  EXPECT_EQ(OfItself(Way({{0, 0}, {4, 0}, {1, 0}})), "overlap 1,0 to 4,0");
  EXPECT_EQ(OfItself(Circle({1, 2}, 3)), "");
  ContourFile bay;
  bay.pieces = {MakeArc({5, 0}, {0, -5}, {0, 0}, 5, true), MakeLine({0, -5}, {5, 5})};
  EXPECT_EQ(OfItself(bay), "crossing 4,3") << "neighbours may meet elsewhere";
}

TEST(SelfIntersectionsOf, TheJointOfALineAndAnArcIsNoneWhereTheRadiusIsRounded) {
  // The line runs into the circle of the last arc from inside, and comes to the joint from within
  // its rounding: seen from the arc of this radius the joint lies just after its start.
  XY const joint{15.216896293086625, 27.595506452317007};
  XY const corner{16.080436589371594, 27.881008833133762};
  ContourFile chain;
  chain.pieces = {MakeArc({9.603293131044769, 26.01778024618891}, corner,
                          {17.446659285356198, 10.941742930637318}, 16.994272381320187, false),
                  MakeLine(corner, joint),
                  MakeArc(joint, {16.1708426089926, 27.490280786453326},
                          {15.846523852011382, 28.9268155192238}, 1.4726896124390176, true)};
  EXPECT_EQ(OfItself(chain), "");
  chain.pieces.push_back(MakeLine(chain.pieces.back().end, {15.5, 28.5}));
  EXPECT_EQ(OfItself(chain), "crossing 15.9203,27.8673; crossing 15.9417,27.8351")
      << "through the arc and the line";
}

TEST(SelfIntersectionsOf, TheEndOfAnOpenWayMayCrossItsBeginning) {
  EXPECT_EQ(OfItself(Way({{0, 0}, {4, 0}, {4, 3}, {2, 0.01}})), "");
  EXPECT_EQ(OfItself(Way({{0, 0}, {4, 0}, {4, 3}, {2, -0.01}})), "crossing 2.00664,0");
  ContourFile arcs;
  arcs.pieces = {MakeArc({0, 0}, {4, 0}, {2, 0}, 2.0, true), MakeLine({4, 0}, {4, -5})};
  arcs.pieces.push_back(MakeLine({4, -5}, {2, -2.01}));
  EXPECT_EQ(OfItself(arcs), "");
  arcs.pieces.back() = MakeLine({4, -5}, {2, -1.99});
  EXPECT_EQ(SelfIntersectionsOf(arcs).size(), 1u);
}

TEST(SelfIntersectionsOf, EightIsFoundOnce) {
  EXPECT_EQ(OfItself(Way({{-2, -1}, {0, 0}, {2, 1}, {2, -1}, {0, 0}, {-2, 1}, {-2, -1}})),
            "crossing 0,0");
}

/// A random way of lines and arcs.
ContourFile RandomWay(std::uint64_t seed, std::size_t pieces, double step) {
  Testing::RandomGeometry random(seed);
  ContourFile contour;
  XY at = random.PointIn(-5.0, 5.0);
  for (std::size_t i = 0; i < pieces; ++i) {
    XY const next = {at.x + random.Uniform(-step, step), at.y + random.Uniform(-step, step)};
    contour.pieces.push_back(random.Flip() ? MakeLine(at, next)
                                           : MakeBulge(at, next, random.Uniform(-2.0, 2.0)));
    at = next;
  }
  return contour;
}

/// How often short chords of the two pieces cross: another way to the number of crossings.
std::size_t CrossingsOfChords(ContourFile const& a, ContourFile const& b) {
  constexpr int kChords = 400;
  auto const points = [](Piece const& piece) {
    std::vector<XY> result;
    for (int i = 0; i <= kChords; ++i) {
      double const part = static_cast<double>(i) / kChords;
      result.push_back(piece.IsArc() ? PointOnArc(piece, part * piece.sweep)
                                     : XY{piece.start.x + part * (piece.end.x - piece.start.x),
                                          piece.start.y + part * (piece.end.y - piece.start.y)});
    }
    return result;
  };
  auto const side = [](XY const& p, XY const& q, XY const& r) {
    return (q.x - p.x) * (r.y - p.y) > (q.y - p.y) * (r.x - p.x);
  };
  std::size_t count = 0;
  for (Piece const& one : a.pieces) {
    std::vector<XY> const p = points(one);
    for (Piece const& other : b.pieces) {
      std::vector<XY> const q = points(other);
      for (std::size_t i = 1; i < p.size(); ++i) {
        for (std::size_t j = 1; j < q.size(); ++j) {
          count += side(p[i - 1], p[i], q[j - 1]) != side(p[i - 1], p[i], q[j]) &&
                   side(q[j - 1], q[j], p[i - 1]) != side(q[j - 1], q[j], p[i]);
        }
      }
    }
  }
  return count;
}

TEST(IntersectionsOf, AgreesWithCrossingsOfShortChords) {
  std::size_t total = 0;
  for (std::uint64_t seed = 1; seed <= 30; ++seed) {
    ContourFile const a = RandomWay(seed, 4, 6.0);
    ContourFile const b = RandomWay(seed + 1000, 4, 6.0);
    auto const found = IntersectionsOf(a, b);
    EXPECT_EQ(found.size(), CrossingsOfChords(a, b)) << "seed " << seed;
    total += found.size();
    for (Intersection const& one : found) {
      EXPECT_EQ(one.kind, Kind::Crossing) << "seed " << seed;
      EXPECT_LT(DistanceTo(a.pieces[one.a.piece], one.at.x, one.at.y), 1e-8) << "seed " << seed;
      EXPECT_LT(DistanceTo(b.pieces[one.b.piece], one.at.x, one.at.y), 1e-8) << "seed " << seed;
    }
    EXPECT_EQ(IntersectionsOf(b, a).size(), found.size()) << "seed " << seed;
  }
  EXPECT_GT(total, 40u);
}

TEST(IntersectionsOf, TenThousandPiecesAgainstAsManyAreQuick) {
  ContourFile a;
  ContourFile b;
  // Zigzags along x, out of step, that cross once on the way up and once on the way down.
  for (int i = 0; i < 10000; ++i) {
    a.pieces.push_back(
        MakeLine({1.0 * i, i % 2 == 0 ? 0.0 : 1.0}, {1.0 * (i + 1), i % 2 == 0 ? 1.0 : 0.0}));
    b.pieces.push_back(
        MakeLine({1.0 * i, i % 2 == 0 ? 1.0 : 0.0}, {1.0 * (i + 1), i % 2 == 0 ? 0.0 : 1.0}));
  }
  auto const begin = std::chrono::steady_clock::now();
  EXPECT_EQ(IntersectionsOf(a, b).size(), 10000u);
  EXPECT_EQ(SelfIntersectionsOf(a).size(), 0u);
  std::chrono::duration<double> const taken = std::chrono::steady_clock::now() - begin;
  RecordProperty("milliseconds", static_cast<int>(1000.0 * taken.count()));
  EXPECT_LT(taken.count(), 5.0) << "every pair would take minutes";
}

}  // namespace
}  // namespace Vorn::IO
