#include <cmath>
#include <limits>

#include "geometry/fitting/arc/CentreChoices.h"
#include "gtest/gtest.h"

namespace Vorn::Testing {
namespace {

using Fitting::UncertainCentre;

constexpr double kInfinity = std::numeric_limits<double>::infinity();

/// 16 errors to first order; the rounding that is added to each is 2^-48.
constexpr double kSafety = 16.0;

TEST(Choice, TakesTheFirstOfTheLeastAndTellsItsLead) {
  Fitting::Choice<int> choice;
  EXPECT_EQ(choice.count, 0);
  choice.Offer(3.0, 10);
  EXPECT_EQ(choice.Lead(), kInfinity);
  choice.Offer(5.0, 11);
  EXPECT_EQ(choice.Lead(), 2.0);
  choice.Offer(1.0, 12);
  EXPECT_EQ(choice.Lead(), 2.0);
  choice.Offer(1.0, 13);
  EXPECT_EQ(choice.Lead(), 0.0);
  EXPECT_EQ(choice.best, 12);
  EXPECT_EQ(choice.count, 4);
}

TEST(AngleBetween, IsTheShorterWayRound) {
  EXPECT_EQ(Fitting::AngleBetween(0.5, 2.0), 1.5);
  EXPECT_EQ(Fitting::AngleBetween(2.0, 0.5), 1.5);
  EXPECT_NEAR(Fitting::AngleBetween(-3.0, 3.0), 0.2831853071795865, 1e-14);
}

TEST(UncertainCentre, DirectionsTurnByTheErrorOverTheDistance) {
  UncertainCentre const centre({{1.0, 2.0}, 0.5});
  EXPECT_EQ(centre.DirectionSlack({5.0, 2.0}), kSafety * (0.125 + 0x1p-48));
  EXPECT_EQ(centre.DirectionSlack({1.0, 2.25}), kSafety * (2.0 + 0x1p-48));
}

TEST(UncertainCentre, SquaredDistancesChangeByTwiceDistanceTimesError) {
  UncertainCentre const centre({{1.0, 2.0}, 0.5});
  EXPECT_EQ(centre.SquaredDistanceSlack(16.0), kSafety * (0.5 + 0x1p-46) * 4.5);
}

TEST(UncertainCentre, WithoutAnErrorIsExact) {
  EXPECT_TRUE(UncertainCentre({{1.0, 2.0}, 0.0}).IsExact());
  EXPECT_FALSE(UncertainCentre({{1.0, 2.0}, 1e-300}).IsExact());
}

TEST(UncertainCentre, DirectionsAreApartBeyondBothSlacks) {
  UncertainCentre const centre({{0.0, 0.0}, 0x1p-10});
  // Both slacks together are 16 * (2^-10 + 2^-10) = 1/32, and a little for rounding.
  EXPECT_TRUE(centre.AreClearlyApart({1.0, 0.0}, {std::cos(0.032), std::sin(0.032)}));
  EXPECT_FALSE(centre.AreClearlyApart({1.0, 0.0}, {std::cos(0.031), std::sin(0.031)}));
}

}  // namespace
}  // namespace Vorn::Testing
