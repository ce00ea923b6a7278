#include <gtest/gtest.h>

#include <cmath>

#include "geometry/fewest/Path.h"

namespace Vorn::Fewest {
namespace {

TEST(BisectorGate, LiesBetweenTheNormals) {
  Gate const gate = BisectorGate({3.0, -2.0}, {0.0, 1.0}, {1.0, 0.0});
  EXPECT_EQ(gate.origin.x, 3.0);
  EXPECT_EQ(gate.origin.y, -2.0);
  EXPECT_DOUBLE_EQ(gate.across.x, std::sqrt(0.5));
  EXPECT_DOUBLE_EQ(gate.across.y, std::sqrt(0.5));
  EXPECT_FALSE(gate.isCusp);
}

TEST(BisectorGate, BeyondATurnOf120DegreesBisectsTheOuterAngle) {
  // The sine of the angle between the normals is 0.6 or 0.9, its cosine -0.8 or about -0.44.
  Gate const cusp = BisectorGate({0.0, 0.0}, {1.0, 0.0}, {-0.8, 0.6});
  EXPECT_TRUE(cusp.isCusp);
  EXPECT_DOUBLE_EQ(cusp.across.x, 1.8 / std::sqrt(3.6));
  EXPECT_DOUBLE_EQ(cusp.across.y, -0.6 / std::sqrt(3.6));
  EXPECT_FALSE(BisectorGate({0.0, 0.0}, {1.0, 0.0}, {-0.44, 0.9}).isCusp);
}

TEST(BisectorGate, WithoutNormalsIsUpright) {
  Gate const gate = BisectorGate({0.0, 0.0}, {0.0, 0.0}, {0.0, 0.0});
  EXPECT_EQ(gate.across.x, 0.0);
  EXPECT_EQ(gate.across.y, 1.0);
}

}  // namespace
}  // namespace Vorn::Fewest
