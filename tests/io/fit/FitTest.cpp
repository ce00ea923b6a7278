#include <gtest/gtest.h>

#include <cmath>

#include "io/fit/Fit.h"

namespace Vorn::IO {
namespace {

TEST(Fit, HandsOnCodeContourAndDeviation) {
  FitAnswer const answer = Fit({{0, 0, 0.1}, {3, 4, 0.1}}, Strategy::Mixed, nullptr);
  EXPECT_EQ(answer.code, ErrorCode::Ok);
  ASSERT_EQ(answer.contour.size(), 2u);
  EXPECT_EQ(answer.contour[1].end.y, 4.0);
  EXPECT_EQ(answer.deviation, 0.0);
  EXPECT_EQ(answer.deviationIndex, -1);
}

TEST(Fit, FailureLeavesTheDeviationUnknown) {
  FitAnswer const answer = Fit({{0, 0, 1}, {1, 0, 1}}, Strategy::Mixed, nullptr);
  EXPECT_EQ(answer.code, ErrorCode::PointsTooClose);
  EXPECT_TRUE(std::isnan(answer.deviation));
}

TEST(Describe, GivesNumberNameAndMeaning) {
  EXPECT_EQ(Describe(ErrorCode::NoFit),
            "23, NoFit: no arc passes the points within their tolerances");
  EXPECT_EQ(Describe(static_cast<ErrorCode>(99)), "99, unknown");
}

TEST(NameOf, IsWhatTheCommandLineTakes) {
  EXPECT_EQ(NameOf(Strategy::Mixed), "mixed");
  EXPECT_EQ(NameOf(Strategy::Cells), "cells");
  EXPECT_EQ(NameOf(Strategy::Arc), "arc");
  EXPECT_EQ(NameOf(Strategy::Fewest), "fewest");
}

}  // namespace
}  // namespace Vorn::IO
