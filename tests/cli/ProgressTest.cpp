#include <gtest/gtest.h>

#include "cli/Progress.h"

namespace Vorn::Cli {
namespace {

TEST(DescribePace, TellsRateAndTimeLeft) {
  EXPECT_EQ(DescribePace(1000, 50, 10.0), "50 points/s, 10 s left");
  EXPECT_EQ(DescribePace(1000000, 25, 1.0), "250000 points/s, 3 s left");
  EXPECT_EQ(DescribePace(123456, 10, 1.0), "12000 points/s, 9 s left") << "two good digits";
  EXPECT_EQ(DescribePace(1000, 100, 10.0), "100 points/s");
}

TEST(DescribePace, LongTimesAreToldInMinutesAndHours) {
  EXPECT_EQ(DescribePace(1000, 10, 10.0), "10 points/s, 1 min 30 s left");
  EXPECT_EQ(DescribePace(1000, 50, 125.0), "4 points/s, 2 min 05 s left");
  EXPECT_EQ(DescribePace(100000, 1, 100.0), "10 points/s, 2 h 45 min left");
}

TEST(DescribePace, SaysNothingTooEarly) {
  EXPECT_EQ(DescribePace(1000, 50, 0.1), "");
  EXPECT_EQ(DescribePace(1000, 0, 10.0), "");
}

}  // namespace
}  // namespace Vorn::Cli
