#include <gtest/gtest.h>

#include "geometry/intersections/Circles.h"
#include "geometry/triangles/InlineVector.h"
#include "math/Assert.h"

namespace Vorn {
namespace {

TEST(Assert, TrueConditionsPass) {
  int evaluations = 0;
  VORN_ASSERT(++evaluations > 0);
#if defined(VORN_ASSERTIONS)
  EXPECT_EQ(evaluations, 1);
#else
  EXPECT_EQ(evaluations, 0) << "a condition costs nothing where assertions are off";
#endif
}

#if defined(VORN_ASSERTIONS)

TEST(AssertDeathTest, FalseConditionEndsTheProgramAndIsNamed) {
  int const two = 2;
  EXPECT_DEATH(VORN_ASSERT(two == 3), "AssertTest\\.cpp:[0-9]+: assertion failed: two == 3");
}

TEST(AssertDeathTest, OverfullArrayEndsTheProgram) {
  Triangles::InlineVector<int, 2> numbers;
  numbers.push_back(1);
  numbers.push_back(2);
  EXPECT_DEATH(numbers.push_back(3), "assertion failed: size_ < kCapacity");
}

TEST(AssertDeathTest, ThirdPointOfACircleEndsTheProgram) {
  Intersections::CirclePoints points;
  points.Add({1.0, 0.0});
  points.Add({0.0, 1.0});
  EXPECT_DEATH(points.Add({-1.0, 0.0}), "assertion failed: count < 2");
}

#endif

}  // namespace
}  // namespace Vorn
