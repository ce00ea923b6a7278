#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <vector>

#include "geometry/fewest/Polytope.h"
#include "support/RandomGeometry.h"

namespace Vorn::Fewest {
namespace {

using Testing::RandomGeometry;

constexpr std::array<Row, 4> kAxes = {
    Row{1.0, 0.0, 0.0, 0.0}, {0.0, 1.0, 0.0, 0.0}, {0.0, 0.0, 1.0, 0.0}, {0.0, 0.0, 0.0, 1.0}};

/// The cube of half side 1.
Polytope Cube() {
  InvertedRows inverted{kAxes, {}};
  InvertRows(kAxes, &inverted.inverse);
  Polytope cube;
  cube.Begin(inverted, {1.0, 1.0, 1.0, 1.0});
  return cube;
}

struct HalfSpace {
  Row row;
  double limit;
};

/// A half space that contains the ball of radius 0.5 about the origin and touches it.
HalfSpace RandomHalfSpace(RandomGeometry* random) {
  Row const row{random->Uniform(-1.0, 1.0), random->Uniform(-1.0, 1.0), random->Uniform(-1.0, 1.0),
                random->Uniform(-1.0, 1.0)};
  double const length =
      std::sqrt(row.a * row.a + row.bx * row.bx + row.by * row.by + row.d * row.d);
  return {row, 0.5 * length};
}

/// The corners of the cube and the half spaces, by trying every four of their boundaries.
std::vector<Circle> CornersByTrial(std::vector<HalfSpace> spaces) {
  for (Row const& axis : kAxes) {
    spaces.push_back({axis, 1.0});
    spaces.push_back({Negated(axis), 1.0});
  }
  std::size_t const n = spaces.size();
  std::vector<Circle> corners;
  for (std::size_t i = 0; i < n; ++i)
    for (std::size_t j = i + 1; j < n; ++j)
      for (std::size_t k = j + 1; k < n; ++k)
        for (std::size_t m = k + 1; m < n; ++m) {
          InvertedRows four{{spaces[i].row, spaces[j].row, spaces[k].row, spaces[m].row}, {}};
          if (!InvertRows(four.rows, &four.inverse)) continue;
          Circle const c =
              Solve(four, {spaces[i].limit, spaces[j].limit, spaces[k].limit, spaces[m].limit});
          bool const isInside = std::ranges::all_of(spaces, [&c](HalfSpace const& space) {
            return Apply(space.row, c) <= space.limit + 1e-9;
          });
          if (isInside) corners.push_back(c);
        }
  return corners;
}

/// Whether each corner has four neighbours that know it as a neighbour too.
bool AreLinksMutual(Polytope const& polytope) {
  for (int i = 0; i < polytope.CornerCount(); ++i) {
    for (std::int16_t const n : polytope.corners_[static_cast<std::size_t>(i)].neighbours) {
      if (n < 0 || n >= polytope.CornerCount()) return false;
      auto const& back = polytope.corners_[static_cast<std::size_t>(n)].neighbours;
      if (std::ranges::count(back, i) != 1) return false;
    }
  }
  return true;
}

TEST(Polytope, BeginsAsABoxWhosePeakIsACorner) {
  Polytope const cube = Cube();
  EXPECT_EQ(cube.CornerCount(), 16);
  EXPECT_FALSE(cube.IsEmpty());
  // bx^2 + by^2 - 4 a d where all are as large as they may be and a and d have opposite signs.
  EXPECT_EQ(cube.FindPeak().form, 6.0);
  EXPECT_EQ(cube.FindPeak().circle.a * cube.FindPeak().circle.d, -1.0);
}

TEST(Polytope, WhatCutsNothingOffChangesNothing) {
  Polytope cube = Cube();
  EXPECT_TRUE(cube.Cut({1.0, 0.0, 0.0, 0.0}, 1.0));
  EXPECT_TRUE(cube.Cut({1.0, 1.0, 1.0, 1.0}, 4.5));
  EXPECT_EQ(cube.CornerCount(), 16);
  EXPECT_EQ(cube.FindPeak().form, 6.0);
}

TEST(Polytope, ACornerCutOffLeavesOneOnEachOfItsEdges) {
  Polytope cube = Cube();
  EXPECT_TRUE(cube.Cut({1.0, 1.0, 1.0, 1.0}, 3.5));
  EXPECT_EQ(cube.CornerCount(), 19);
}

TEST(Polytope, AFaceCutOffLeavesABox) {
  Polytope cube = Cube();
  EXPECT_TRUE(cube.Cut({1.0, 0.0, 0.0, 0.0}, 0.5));
  EXPECT_TRUE(cube.Cut({-1.0, 0.0, 0.0, 0.0}, 0.5));
  EXPECT_EQ(cube.CornerCount(), 16);
  EXPECT_EQ(cube.FindPeak().form, 4.0);
}

TEST(Polytope, ThePeakMayLieInsideAnEdge) {
  Polytope cube = Cube();
  for (Row const& row : {kAxes[1], kAxes[2]}) {
    EXPECT_TRUE(cube.Cut(row, 0.0));
    EXPECT_TRUE(cube.Cut(Negated(row), 0.25));
  }
  // With a - d <= 1 the product -a d is largest at a = 1/2, d = -1/2.
  EXPECT_TRUE(cube.Cut({1.0, 0.0, 0.0, -1.0}, 1.0));
  EXPECT_TRUE(cube.Cut({-1.0, 0.0, 0.0, 1.0}, 0.0));
  EXPECT_NEAR(cube.FindPeak().form, 1.0 + 2.0 * 0.0625, 1e-12);
  EXPECT_NEAR(cube.FindPeak().circle.a, 0.5, 1e-12);
  EXPECT_NEAR(cube.FindPeak().circle.d, -0.5, 1e-12);
}

TEST(Polytope, EverythingCutOffLeavesNothing) {
  Polytope cube = Cube();
  EXPECT_TRUE(cube.Cut({1.0, 0.0, 0.0, 0.0}, -2.0));
  EXPECT_TRUE(cube.IsEmpty());
  EXPECT_EQ(cube.CornerCount(), 0);
  EXPECT_EQ(cube.FindPeak().form, -1.0);
}

TEST(Polytope, HasTheCornersThatTryingEveryFourBoundariesFinds) {
  constexpr std::uint64_t kSeed = 4711;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int round = 0; round < 40; ++round) {
    Polytope polytope = Cube();
    std::vector<HalfSpace> spaces;
    for (int i = 0; i < 5; ++i) {
      spaces.push_back(RandomHalfSpace(&random));
      ASSERT_TRUE(polytope.Cut(spaces.back().row, spaces.back().limit));
    }
    std::vector<Circle> const corners = CornersByTrial(spaces);
    EXPECT_EQ(polytope.CornerCount(), static_cast<int>(corners.size())) << "round " << round;
    EXPECT_TRUE(AreLinksMutual(polytope));
    Polytope::Peak const peak = polytope.FindPeak();
    for (Circle const& c : corners) EXPECT_LE(Form(c, c), peak.form + 1e-9);
    for (HalfSpace const& space : spaces) {
      EXPECT_LE(Apply(space.row, peak.circle), space.limit + 1e-9);
    }
    EXPECT_NEAR(Form(peak.circle, peak.circle), peak.form, 1e-9);
  }
}

TEST(Polytope, ACutWithoutRoomForItsCornersChangesNothing) {
  constexpr std::uint64_t kSeed = 4712;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int round = 0; round < 20; ++round) {
    Polytope polytope = Cube();
    int corners = 0;
    Polytope::Peak peak;
    HalfSpace space;
    do {
      corners = polytope.CornerCount();
      peak = polytope.FindPeak();
      space = RandomHalfSpace(&random);
    } while (polytope.Cut(space.row, space.limit));
    EXPECT_GT(corners, Polytope::kMostCorners / 2);
    EXPECT_EQ(polytope.CornerCount(), corners);
    EXPECT_EQ(polytope.FindPeak().form, peak.form);
    EXPECT_TRUE(AreLinksMutual(polytope));
  }
}

TEST(Polytope, ACutWithoutRoomForItsPlaneChangesNothing) {
  Polytope cube = Cube();
  int cuts = 0;
  while (cube.Cut({1.0, 0.0, 0.0, 0.0}, 1.0 - 0.001 * (cuts + 1))) ++cuts;
  EXPECT_EQ(cuts, Polytope::kMostPlanes - 8);
  EXPECT_EQ(cube.CornerCount(), 16);
  EXPECT_NEAR(cube.FindPeak().form, 6.0, 1e-12);  // at a = -1, d = 1
}

}  // namespace
}  // namespace Vorn::Fewest
