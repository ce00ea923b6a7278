#include <cmath>
#include <limits>
#include <vector>

#include "geometry/cells/fast/Pair.h"
#include "gtest/gtest.h"
#include "support/Bits.h"

// Both kinds of pairs must do in each lane what plain doubles do.

namespace Vorn::Testing {
namespace {

using Cells::Least;
using Cells::Most;
using Cells::Sizes;
using Cells::Union;

constexpr double kNan = std::numeric_limits<double>::quiet_NaN();

std::vector<double> const kValues = {
    0.0,   -0.0,   1.0,      -1.5,      5e-324, -2.2250738585072014e-308,
    1e300, -1e300, HUGE_VAL, -HUGE_VAL, kNan};

template <typename Pair>
Pair PairOf(double first, double second) {
  Pair pair{};
  pair[0] = first;
  pair[1] = second;
  return pair;
}

/// Calls a check with all pairs of two values.
template <typename Check>
void ForAllValues(Check const& check) {
  for (double const a : kValues) {
    for (double const b : kValues) {
      SCOPED_TRACE(testing::Message() << a << ", " << b);
      check(a, b);
    }
  }
}

template <typename Pair>
class PairTest : public testing::Test {};

#if defined(__GNUC__) && !defined(VORN_PLAIN_PAIRS)
using PairTypes = testing::Types<Cells::PlainPair, Cells::VectorPair>;
#else
using PairTypes = testing::Types<Cells::PlainPair>;
#endif
TYPED_TEST_SUITE(PairTest, PairTypes);

TYPED_TEST(PairTest, ArithmeticIsThatOfPlainDoubles) {
  ForAllValues([](double a, double b) {
    auto const p = PairOf<TypeParam>(a, b);
    auto const q = PairOf<TypeParam>(b, a);
    TypeParam const difference = p - q;
    TypeParam const fromNumber = b - p;
    TypeParam const product = p * q;
    EXPECT_SAME_BITS(difference[0], a - b);
    EXPECT_SAME_BITS(difference[1], b - a);
    EXPECT_SAME_BITS(fromNumber[0], b - a);
    EXPECT_SAME_BITS(fromNumber[1], b - b);
    EXPECT_SAME_BITS(product[0], a * b);
    EXPECT_SAME_BITS(product[1], b * a);
  });
}

TYPED_TEST(PairTest, ComparisonsSetAllBitsOfTheLanesWhereTheyHold) {
  ForAllValues([](double a, double b) {
    auto const p = PairOf<TypeParam>(a, b);
    auto const expectBits = [](auto const& bits, bool first, bool second) {
      EXPECT_EQ(bits[0], first ? -1 : 0);
      EXPECT_EQ(bits[1], second ? -1 : 0);
    };
    expectBits(p > a, a > a, b > a);
    expectBits(a > p, a > a, a > b);
    expectBits(p <= b, a <= b, b <= b);
  });
}

TYPED_TEST(PairTest, LeastAndMostKeepTheFirstOfWhatCannotBeOrdered) {
  ForAllValues([](double a, double b) {
    auto const p = PairOf<TypeParam>(a, 1.0);
    auto const q = PairOf<TypeParam>(b, 2.0);
    EXPECT_SAME_BITS(Least(p, q)[0], b < a ? b : a);
    EXPECT_SAME_BITS(Least(p, q)[1], 1.0);
    EXPECT_SAME_BITS(Most(p, q)[0], b > a ? b : a);
    EXPECT_SAME_BITS(Most(p, q)[1], 2.0);
  });
}

TYPED_TEST(PairTest, SizesHaveNoSign) {
  for (double const value : kValues) {
    EXPECT_SAME_BITS(Sizes(PairOf<TypeParam>(value, -3.0))[0], std::fabs(value));
    EXPECT_SAME_BITS(Sizes(PairOf<TypeParam>(value, -3.0))[1], 3.0);
  }
}

TYPED_TEST(PairTest, BitsAreMaskedShiftedAndUnited) {
  auto const all = PairOf<TypeParam>(1.0, 1.0) > 0.0;
  decltype(all & all) mask = all;
  mask = mask & (mask << 3);
  EXPECT_EQ(mask[0], -8);
  auto const second = PairOf<TypeParam>(-1.0, 1.0) > 0.0;
  EXPECT_EQ((mask | second)[0], -8);
  EXPECT_EQ((mask | second)[1], -1);
  EXPECT_EQ(Union(second), ~0U);
  EXPECT_EQ(Union(PairOf<TypeParam>(-1.0, -1.0) > 0.0), 0U);
}

}  // namespace
}  // namespace Vorn::Testing
