#include <cmath>
#include <limits>

#include "geometry/fewest/promises/Expansion.h"
#include "geometry/fewest/promises/Orientation.h"
#include "gtest/gtest.h"
#include "support/RandomGeometry.h"

// Expected values: integers small enough for 128-bit arithmetic.

namespace Vorn::Testing {
namespace {

using Promises::DoEdgesMeet;
using Promises::Expansion;
using Promises::Orientation;
using Point = GeometryUtils::Point;

__extension__ using Wide = __int128;

int SignOf(Wide value) { return value == 0 ? 0 : (value < 0 ? -1 : 1); }

TEST(Expansion, KeepsWhatASumOfDoublesLoses) {
  Expansion sum(1e300);
  sum.Add(1.0);
  sum.Add(-1e300);
  EXPECT_EQ(sum.Sign(), 1);
  EXPECT_EQ(sum.Value(), 1.0);
  sum.Add(-1.0);
  EXPECT_EQ(sum.Sign(), 0);
  EXPECT_EQ(sum.Value(), 0.0);
}

TEST(Expansion, KeepsWhatADifferenceLoses) {
  Expansion difference = Expansion::Difference(1.0, 0x1p-80);
  difference.Add(-1.0);
  EXPECT_EQ(difference.Value(), -0x1p-80);
}

TEST(Expansion, SignOfADeterminantIsThatOfIntegers) {
  RandomGeometry random(4101);
  int vanishing = 0;
  for (int round = 0; round < 20000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 4101, round " << round);
    // Products of 53-bit numbers that differ in their last bits.
    auto const a = static_cast<std::int64_t>(random.Bits() >> 12U);
    auto const b = static_cast<std::int64_t>(random.Bits() >> 12U);
    std::int64_t const c = a + random.Integer(-1, 1);
    std::int64_t const d = b + random.Integer(-1, 1);
    Expansion det;
    det.AddProduct(Expansion(static_cast<double>(a)), Expansion(static_cast<double>(d)), 1.0);
    det.AddProduct(Expansion(static_cast<double>(b)), Expansion(static_cast<double>(c)), -1.0);
    int const expected = SignOf(Wide{a} * d - Wide{b} * c);
    EXPECT_EQ(det.Sign(), expected);
    vanishing += expected == 0 ? 1 : 0;
  }
  EXPECT_GT(vanishing, 1000);
}

TEST(Orientation, SeesTheLastBit) {
  Point const a{0.5, 0.5};
  Point const b{12.0, 12.0};
  double const up = std::nextafter(24.0, 25.0);
  EXPECT_EQ(Orientation(a, b, {24.0, 24.0}), 0);
  EXPECT_EQ(Orientation(a, b, {24.0, up}), 1);
  EXPECT_EQ(Orientation(a, b, {up, 24.0}), -1);
}

TEST(DoEdgesMeet, CountsTouchesAndOverlaps) {
  Point const a{0, 0};
  Point const b{4, 0};
  EXPECT_TRUE(DoEdgesMeet(a, b, {2, -1}, {2, 1}));
  EXPECT_TRUE(DoEdgesMeet(a, b, {2, 0}, {2, 1}));
  EXPECT_TRUE(DoEdgesMeet(a, b, {4, 0}, {5, 3}));
  EXPECT_TRUE(DoEdgesMeet(a, b, {3, 0}, {9, 0}));
  EXPECT_FALSE(DoEdgesMeet(a, b, {5, 0}, {9, 0}));
  EXPECT_FALSE(DoEdgesMeet(a, b, {2, 1e-300}, {2, 1}));
  EXPECT_FALSE(DoEdgesMeet(a, b, {0, 1}, {4, 1}));
}

}  // namespace
}  // namespace Vorn::Testing
