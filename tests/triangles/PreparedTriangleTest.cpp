#include "geometry/triangles/PreparedTriangle.h"
#include "gtest/gtest.h"
#include "support/Bits.h"

namespace Vorn::Testing {
namespace {

using Triangles::PreparedTriangle;
using Triangle = GeometryUtils::Triangle;

PreparedTriangle At(double x, double y) {
  return PreparedTriangle(Triangle{{{x, y}, {x + 1.0, y}, {x, y + 1.0}}});
}

TEST(PreparedTriangle, IsApartWhereBoxesHaveNoCommonPoint) {
  PreparedTriangle const middle = At(0.0, 0.0);
  EXPECT_TRUE(middle.IsApartFrom(At(1.5, 0.0)));
  EXPECT_TRUE(middle.IsApartFrom(At(-1.5, 0.0)));
  EXPECT_TRUE(middle.IsApartFrom(At(0.0, 1.5)));
  EXPECT_TRUE(middle.IsApartFrom(At(0.0, -1.5)));
}

TEST(PreparedTriangle, IsNotApartWhereBoxesTouch) {
  PreparedTriangle const middle = At(0.0, 0.0);
  EXPECT_FALSE(middle.IsApartFrom(At(1.0, 0.0)));
  EXPECT_FALSE(middle.IsApartFrom(At(-1.0, 1.0)));
  EXPECT_FALSE(middle.IsApartFrom(At(0.0, -1.0)));
  EXPECT_FALSE(middle.IsApartFrom(middle));
}

TEST(PreparedTriangle, IsApartFromNothingThatIsNotANumber) {
  PreparedTriangle const odd(Triangle{{{kNaN, kNaN}, {kNaN, kNaN}, {kNaN, kNaN}}});
  EXPECT_FALSE(At(0.0, 0.0).IsApartFrom(odd));
  EXPECT_FALSE(odd.isOrdered);
  EXPECT_TRUE(At(0.0, 0.0).isOrdered);
}

}  // namespace
}  // namespace Vorn::Testing
