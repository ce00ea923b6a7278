#include <gtest/gtest.h>

#include <cmath>
#include <set>

#include "io/fit/Fit.h"
#include "vorn/io/Failure.h"

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

TEST(Describe, EveryCodeHasItsNumberAndAMeaningOfItsOwn) {
  std::set<std::string> meanings;
  for (ErrorCode const code :
       {ErrorCode::Ok, ErrorCode::InvalidArcRadius, ErrorCode::Failed, ErrorCode::OutOfMemory,
        ErrorCode::IntersectionUndefined, ErrorCode::SelfIntersection, ErrorCode::PointsTooClose,
        ErrorCode::OrientationMismatch, ErrorCode::NoFit, ErrorCode::InvalidLineCell}) {
    std::string const text = Describe(code);
    std::string const number = std::to_string(static_cast<int>(code)) + ", ";
    ASSERT_TRUE(text.starts_with(number)) << text;
    EXPECT_EQ(text.find("unknown"), std::string::npos) << text;
    EXPECT_TRUE(meanings.insert(text.substr(number.size())).second) << text;
  }
}

TEST(Fit, TheFewestPiecesAreNotOfTheCore) {
  try {
    Fit({{0, 0, 0.1}, {1, 0, 0.1}}, Strategy::Fewest, nullptr);
    ADD_FAILURE() << "the core has no such strategy";
  } catch (Failure const& failure) {
    EXPECT_EQ(failure.Kind(), FailureKind::Internal);
  }
}

TEST(DescribeVerdict, EveryOneHasWordsOfItsOwn) {
  std::set<std::string> words;
  for (Verdict const verdict : {Verdict::WithinTolerance, Verdict::OutsideTolerance,
                                Verdict::NotClosed, Verdict::StopsEarly}) {
    EXPECT_TRUE(words.insert(Describe(verdict)).second);
  }
  EXPECT_EQ(words.count("unknown"), 0u);
  EXPECT_EQ(Describe(static_cast<Verdict>(99)), "unknown");
}

TEST(Strategy, OnlyTheSingleArcReportsALengthAndTwoNeedSpacing) {
  EXPECT_FALSE(IsDeviationRelative(Strategy::Arc));
  EXPECT_TRUE(IsDeviationRelative(Strategy::Mixed));
  EXPECT_TRUE(IsDeviationRelative(Strategy::Cells));
  EXPECT_TRUE(IsDeviationRelative(Strategy::Fewest));
  EXPECT_TRUE(NeedsSpacing(Strategy::Mixed));
  EXPECT_TRUE(NeedsSpacing(Strategy::Cells));
  EXPECT_FALSE(NeedsSpacing(Strategy::Arc));
  EXPECT_FALSE(NeedsSpacing(Strategy::Fewest));
  EXPECT_EQ(NameOf(static_cast<Strategy>(99)), "unknown");
}

TEST(NameOf, IsWhatTheCommandLineTakes) {
  EXPECT_EQ(NameOf(Strategy::Mixed), "mixed");
  EXPECT_EQ(NameOf(Strategy::Cells), "cells");
  EXPECT_EQ(NameOf(Strategy::Arc), "arc");
  EXPECT_EQ(NameOf(Strategy::Fewest), "fewest");
}

}  // namespace
}  // namespace Vorn::IO
