#include <optional>
#include <vector>

#include "geometry/fewest/promises/Coverage.h"
#include "gtest/gtest.h"
#include "support/ContourBuilder.h"

namespace Vorn::Testing {
namespace {

using Promises::Chain;
using Promises::Coverage;
using Promises::kNone;

/// Three sides around five points.
struct Sides {
  std::vector<WPoint> points{{0, 0, 1}, {2, 0, 1}, {4, 0, 1}, {4, 4, 1}, {0, 4, 1}};
  std::vector<GeometryUtils::Elem> contour =
      ContourBuilder(0, 0).To(4, 0).To(4, 4).To(0, 0).Build();
  std::vector<Promises::PieceRange> ranges{{0, 2}, {3, 3}, {4, 4}};

  std::optional<Coverage> Covered(bool isClosed) const {
    return Coverage::Of(Chain{points, contour, ranges, isClosed, 1.0, 1.0});
  }
};

TEST(Coverage, NeighboursOfAnOpenContourEndWithIt) {
  Sides const sides;
  std::optional<Coverage> const coverage = sides.Covered(false);
  ASSERT_TRUE(coverage);
  EXPECT_EQ(coverage->Previous(0), kNone);
  EXPECT_EQ(coverage->Previous(2), 1U);
  EXPECT_EQ(coverage->Next(0), 1U);
  EXPECT_EQ(coverage->Next(2), kNone);
}

TEST(Coverage, NeighboursOfAClosedContourGoRound) {
  Sides const sides;
  std::optional<Coverage> const coverage = sides.Covered(true);
  ASSERT_TRUE(coverage);
  EXPECT_EQ(coverage->Previous(0), 2U);
  EXPECT_EQ(coverage->Previous(1), 0U);
  EXPECT_EQ(coverage->Next(2), 0U);
}

}  // namespace
}  // namespace Vorn::Testing
