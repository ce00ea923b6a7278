#include <limits>
#include <vector>

#include "geometry/cells/fast/LetterTable.h"
#include "gtest/gtest.h"

namespace Vorn::Testing {
namespace {

using Cells::AreIdentical;
using Cells::BoxedTriangle;
using Cells::LetterTable;
using Triangle = GeometryUtils::Triangle;

constexpr Triangle kTriangle{{{0.0, 0.0}, {1.0, 0.0}, {0.0, 1.0}}};

TEST(AreIdentical, ComparesBits) {
  EXPECT_TRUE(AreIdentical(kTriangle, kTriangle));
  Triangle other = kTriangle;
  other.pts[0].x = -0.0;
  EXPECT_FALSE(AreIdentical(kTriangle, other));
  other.pts[0].x = std::numeric_limits<double>::quiet_NaN();
  EXPECT_TRUE(AreIdentical(other, other));
}

TEST(LetterTable, FindsWhatItHasAndAppendsWhatItHasNot) {
  LetterTable table(1);
  std::vector<BoxedTriangle> triangles;
  Triangle other = kTriangle;
  other.pts[2].y = 2.0;
  EXPECT_EQ(table.FindOrAdd(kTriangle, &triangles), 0U);
  EXPECT_EQ(table.FindOrAdd(other, &triangles), 1U);
  EXPECT_EQ(table.FindOrAdd(kTriangle, &triangles), 0U);
  ASSERT_EQ(triangles.size(), 2U);
  EXPECT_TRUE(AreIdentical(triangles[1].triangle, other));
}

TEST(LetterTable, LeavesLettersOfOthersAlone) {
  LetterTable table(4);
  std::vector<BoxedTriangle> triangles;
  triangles.emplace_back(kTriangle);
  EXPECT_EQ(table.FindOrAdd(kTriangle, &triangles), 1U)
      << "the first triangle was not put in by the table";
}

TEST(LetterTable, GrowsFarBeyondWhatWasExpected) {
  LetterTable table(1);
  std::vector<BoxedTriangle> triangles;
  std::vector<Triangle> inserted;
  for (int i = 0; i < 5000; ++i) {
    // Integers on purpose: the low bits of all coordinates are zero.
    Triangle triangle = kTriangle;
    triangle.pts[0] = {static_cast<double>(i % 70), static_cast<double>(i / 70)};
    inserted.push_back(triangle);
    ASSERT_EQ(table.FindOrAdd(triangle, &triangles), static_cast<Cells::Letter>(i));
  }
  for (std::size_t i = 0; i < inserted.size(); ++i) {
    ASSERT_EQ(table.FindOrAdd(inserted[i], &triangles), i);
  }
  EXPECT_EQ(triangles.size(), inserted.size());
}

}  // namespace
}  // namespace Vorn::Testing
