#include <gtest/gtest.h>

#include <cmath>

#include "cli/texts/Relative.h"

namespace Vorn::Cli {
namespace {

TEST(RelativeText, HasSixDigitsAfterThePoint) {
  EXPECT_EQ(RelativeText(0.5), "0.500000");
  EXPECT_EQ(RelativeText(1.0), "1.000000");
  EXPECT_EQ(RelativeText(12.25), "12.250000");
}

TEST(RelativeText, NeverReadsAsOneBesideIt) {
  EXPECT_EQ(RelativeText(0.999999), "0.999999");
  EXPECT_EQ(RelativeText(0.9999999), "0.9999999");
  EXPECT_EQ(RelativeText(1.0000001), "1.0000001");
  EXPECT_EQ(RelativeText(std::nextafter(1.0, 0.0)), "0.9999999999999999");
  EXPECT_EQ(RelativeText(std::nextafter(1.0, 2.0)), "1.0000000000000002");
}

TEST(RelativeText, HugeOnesHaveAnExponent) {
  EXPECT_EQ(RelativeText(1e12), "1e+12");
  EXPECT_EQ(RelativeText(std::nan("")), "nan");
}

}  // namespace
}  // namespace Vorn::Cli
