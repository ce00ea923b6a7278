#include <array>
#include <cmath>
#include <cstddef>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/RandomGeometry.h"
#include "vorn/MathUtils.h"

namespace Vorn::Testing {
namespace {

using Three = std::array<double, 3>;

constexpr Three kUnwritten{kSentinel, kSentinel, kSentinel};

struct Ends {
  bool found = false;
  Three out1 = kUnwritten;
  Three out2 = kUnwritten;
};

Ends Calc(Three const& p1, Three const& p2, Three const& q1, Three const& q2) {
  Ends ends;
  ends.found = MathUtils::CalcNormalized3DVectors(p1.data(), p2.data(), q1.data(), q2.data(),
                                                  ends.out1.data(), ends.out2.data());
  return ends;
}

bool IsNaN(Three const& p) { return std::isnan(p[0]) && std::isnan(p[1]) && std::isnan(p[2]); }

std::array<long double, 3> Cross(std::array<long double, 3> const& u,
                                 std::array<long double, 3> const& v) {
  return {u[1] * v[2] - u[2] * v[1], u[2] * v[0] - u[0] * v[2], u[0] * v[1] - u[1] * v[0]};
}

TEST(CalcNormalized3DVectors, DisplacesBothEndsByTheLengthInTheCommonPlane) {
  Ends const ends = Calc({0, 0, 0}, {2, 0, 0}, {0, 1, 0}, {1, 3, 0});
  ASSERT_TRUE(ends.found);
  EXPECT_EQ(ends.out1, (Three{0, 2, 0}));
  EXPECT_EQ(ends.out2, (Three{2, 2, 0}));
}

TEST(CalcNormalized3DVectors, GoesInThePositiveSenseWhereverTheFurtherPointsLie) {
  Ends const ends = Calc({0, 0, 0}, {2, 0, 0}, {0, -1, 0}, {1, -3, 0});
  ASSERT_TRUE(ends.found);
  EXPECT_EQ(ends.out1, (Three{0, 2, 0}));
  EXPECT_EQ(ends.out2, (Three{2, 2, 0}));
}

TEST(CalcNormalized3DVectors, WorksAlongEveryAxis) {
  Ends const alongY = Calc({0, 1, 0}, {0, 5, 0}, {1, 1, 0}, {2, 3, 0});
  ASSERT_TRUE(alongY.found);
  EXPECT_EQ(alongY.out1, (Three{4, 1, 0}));
  EXPECT_EQ(alongY.out2, (Three{4, 5, 0}));
  Ends const alongZ = Calc({0, 0, 0}, {0, 0, 8}, {1, 0, 0}, {2, 0, 1});
  ASSERT_TRUE(alongZ.found);
  EXPECT_EQ(alongZ.out1, (Three{8, 0, 0}));
  EXPECT_EQ(alongZ.out2, (Three{8, 0, 8}));
}

TEST(CalcNormalized3DVectors, AnAxisThatFailsAtItsLastPivotHidesTheLaterOnes) {
  // In the plane x = 0 no point lies farther along x; the solver sees that only at the last pivot,
  // which it does not check. Its not-a-number is the first answer, and nothing is nearer than that.
  Ends const ends = Calc({0, 1, 0}, {0, 5, 0}, {0, 1, 1}, {0, 3, 2});
  ASSERT_TRUE(ends.found);
  EXPECT_TRUE(std::isnan(ends.out1[0]));
  EXPECT_TRUE(std::isnan(ends.out2[0]));
}

TEST(CalcNormalized3DVectors, OfEquallyNearAxesTheFirstWins) {
  // Along x the answer is (L, -L, 0), along y it is (-L, L, 0).
  Ends const ends = Calc({0, 0, 0}, {1, 1, 0}, {0, 1, 0}, {0, 2, 0});
  ASSERT_TRUE(ends.found);
  EXPECT_DOUBLE_EQ(ends.out1[0], std::sqrt(2.0));
  EXPECT_DOUBLE_EQ(ends.out1[1], -std::sqrt(2.0));
  EXPECT_EQ(ends.out1[2], 0.0);
}

TEST(CalcNormalized3DVectors, ANearerAxisReplacesTheFirst) {
  // The displacement direction is (1, -2, 0): along x it is L * (1, -2, 0), along y L * (-1/2, 1,
  // 0).
  Ends const ends = Calc({0, 0, 0}, {2, 1, 0}, {0, 1, 0}, {0, 3, 0});
  ASSERT_TRUE(ends.found);
  double const length = std::sqrt(5.0);
  EXPECT_DOUBLE_EQ(ends.out1[0], -length / 2.0);
  EXPECT_DOUBLE_EQ(ends.out1[1], length);
  EXPECT_DOUBLE_EQ(ends.out2[0], 2.0 - length / 2.0);
  EXPECT_DOUBLE_EQ(ends.out2[1], 1.0 + length);
}

TEST(CalcNormalized3DVectors, AveragesRawDeterminantsNotUnitNormals) {
  // The planes y = 0 (further point 1 away) and x = 0 (further point 3 away) have the raw normals
  // (0, 1, 0) and (-3, 0, 0), so the middle plane is y = 3 x; unit normals would give y = x.
  Ends const ends = Calc({0, 0, 0}, {0, 0, 1}, {1, 0, 0}, {0, 3, 0});
  ASSERT_TRUE(ends.found);
  EXPECT_DOUBLE_EQ(ends.out1[0], 1.0 / 3.0);
  EXPECT_EQ(ends.out1[1], 1.0);
  EXPECT_EQ(ends.out1[2], 0.0);
  EXPECT_EQ(ends.out2[2], 1.0);
}

TEST(CalcNormalized3DVectors, AgreesWithTheCrossProductInSpace) {
  RandomGeometry random(21);
  int compared = 0;
  for (int round = 0; round < 2000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 21, round " << round);
    Three p1;
    Three p2;
    Three q1;
    Three q2;
    for (Three* p : {&p1, &p2, &q1, &q2}) {
      for (double& v : *p) v = random.Uniform(-10, 10);
    }
    auto const difference = [](Three const& u, Three const& v) {
      std::array<long double, 3> w{};
      for (std::size_t j = 0; j < 3; ++j) {
        w[j] = static_cast<long double>(u[j]) - static_cast<long double>(v[j]);
      }
      return w;
    };
    auto const d = difference(p2, p1);
    auto const n1 = Cross(d, difference(q1, p1));
    auto const n2 = Cross(d, difference(q2, p1));
    std::array<long double, 3> const normal{n1[0] + n2[0], n1[1] + n2[1], n1[2] + n2[2]};
    auto const side = Cross(normal, d);
    long double const length = std::sqrt(d[0] * d[0] + d[1] * d[1] + d[2] * d[2]);
    long double const norm = std::sqrt(side[0] * side[0] + side[1] * side[1] + side[2] * side[2]);
    std::size_t axis = 0;
    for (std::size_t j = 1; j < 3; ++j) {
      if (std::fabs(side[j]) > std::fabs(side[axis])) axis = j;
    }
    // Left out: nearly equal axes, between which rounding decides, and ill-conditioned planes.
    bool isClear = norm > 10.0L && length > 1.0L;
    for (std::size_t j = 0; j < 3; ++j) {
      if (j != axis && std::fabs(side[axis]) - std::fabs(side[j]) < 1e-3L * norm) isClear = false;
    }
    if (!isClear) continue;
    ++compared;
    Ends const ends = Calc(p1, p2, q1, q2);
    ASSERT_TRUE(ends.found);
    for (std::size_t j = 0; j < 3; ++j) {
      auto const shift = static_cast<double>(side[j] * length / side[axis]);
      EXPECT_NEAR(ends.out1[j], p1[j] + shift, 1e-8);
      EXPECT_NEAR(ends.out2[j], p2[j] + shift, 1e-8);
    }
  }
  EXPECT_GT(compared, 1500);
}

TEST(CalcNormalized3DVectors, MirrorSymmetricPointsCancelThePlane) {
  // Nothing but the unchecked last pivot is left of the plane's row.
  Ends const ends = Calc({0, 0, 0}, {1, 0, 0}, {0, 1, 0}, {0, -1, 0});
  ASSERT_TRUE(ends.found);
  EXPECT_TRUE(IsNaN(ends.out1));
  EXPECT_TRUE(IsNaN(ends.out2));
}

TEST(CalcNormalized3DVectors, EqualEndsFailAndWriteNothing) {
  for (Three const& p : {Three{0, 0, 0}, Three{1, 2, 3}, Three{-4, 0, 8}}) {
    Ends const ends = Calc(p, p, {1, 0, 0}, {0, 1, 0});
    EXPECT_FALSE(ends.found);
    EXPECT_EQ(ends.out1, kUnwritten);
    EXPECT_EQ(ends.out2, kUnwritten);
  }
}

TEST(CalcNormalized3DVectors, EqualEndsWithARoundedPlaneGiveNonFiniteOutputs) {
  // Two equal rows should give a zero determinant; where rounding leaves a little, the system
  // counts as solvable up to its last pivot, which nobody checks.
  RandomGeometry random(22);
  int solvable = 0;
  int failed = 0;
  for (int round = 0; round < 500; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 22, round " << round);
    Three const p{random.Uniform(-1, 1), random.Uniform(-1, 1), random.Uniform(-1, 1)};
    Three const q1{random.Uniform(-1, 1), random.Uniform(-1, 1), random.Uniform(-1, 1)};
    Three const q2{random.Uniform(-1, 1), random.Uniform(-1, 1), random.Uniform(-1, 1)};
    Ends const ends = Calc(p, p, q1, q2);
    if (!ends.found) {
      ++failed;
      EXPECT_EQ(ends.out1, kUnwritten);
      EXPECT_EQ(ends.out2, kUnwritten);
      continue;
    }
    ++solvable;
    for (Three const& out : {ends.out1, ends.out2}) {
      EXPECT_FALSE(std::isfinite(out[0]) && std::isfinite(out[1]) && std::isfinite(out[2]));
    }
  }
  EXPECT_GT(solvable, 0);
  EXPECT_GT(failed, 0);
}

TEST(CalcNormalized3DVectors, NotANumberAndInfinityGiveNotANumber) {
  for (double const odd : {kNaN, kInf, -kInf}) {
    Ends const ends = Calc({0, 0, 0}, {2, 1, 3}, {odd, 1, 0}, {1, 3, 0});
    ASSERT_TRUE(ends.found);
    EXPECT_TRUE(IsNaN(ends.out1));
    EXPECT_TRUE(IsNaN(ends.out2));
  }
}

TEST(CalcNormalized3DVectors, AnyBitsEndInAnAnswer) {
  RandomGeometry random(23);
  for (int round = 0; round < 2000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 23, round " << round);
    Three points[4];
    for (Three& p : points) {
      for (double& v : p) v = random.AnyDouble();
    }
    Ends const ends = Calc(points[0], points[1], points[2], points[3]);
    EXPECT_EQ(ends.out1 == kUnwritten, !ends.found);
    EXPECT_EQ(ends.out2 == kUnwritten, !ends.found);
  }
}

}  // namespace
}  // namespace Vorn::Testing
