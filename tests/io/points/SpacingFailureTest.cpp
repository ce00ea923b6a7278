#include <gtest/gtest.h>

#include "io/Contours.h"
#include "vorn/io/FitContour.h"
#include "vorn/io/SpacingFailure.h"

namespace Vorn::IO {
namespace {

using Contours::FileWith;

/// The failure of a fit of these points, or nothing if there is none of this type.
std::optional<SpacingFailure> FailureOf(PointFile file, FitChoice const& choice) {
  try {
    FitContour(std::move(file), choice, nullptr);
  } catch (SpacingFailure const& failure) {
    return failure;
  }
  return {};
}

TEST(SpacingFailure, OfAFitTellsThePairAndWhatWasAsked) {
  FitChoice choice;
  choice.strategy = Strategy::Mixed;
  choice.tolerance.same = 0.25;
  auto const failure = FailureOf(FileWith({{0, 0, 0}, {1, 0, 0}, {1.5, 0, 0}, {3, 0, 0}}), choice);
  ASSERT_TRUE(failure);
  EXPECT_EQ(failure->Kind(), FailureKind::PointsTooClose);
  EXPECT_EQ(failure->Help(), Remedy::SpacePoints);
  EXPECT_EQ(failure->Where().file, "part.csv");
  CloseNeighbours const& neighbours = failure->Neighbours();
  EXPECT_EQ(neighbours.pair.first, 1u);
  EXPECT_EQ(neighbours.pair.second, 2u);
  EXPECT_EQ(neighbours.pair.distance, 0.5);
  EXPECT_EQ(neighbours.pair.needed, 0.75);
  EXPECT_EQ(neighbours.largestTolerance, 0.166666) << "0.5 / 3 in six digits";
  EXPECT_EQ(neighbours.tolerance.same, 0.25);
  EXPECT_EQ(neighbours.outline, 0u);
}

TEST(SpacingFailure, OfAClosedContourNamesPointsAsTheFileCountsThem) {
  // A square whose last point is close to its first: the pair spans the end of the file.
  FitChoice choice;
  choice.strategy = Strategy::Mixed;
  choice.tolerance.same = 0.5;
  choice.closed = ClosedChoice::Yes;
  auto const failure =
      FailureOf(FileWith({{0, 0, 0}, {8, 0, 0}, {8, 8, 0}, {0, 8, 0}, {0, 1, 0}}), choice);
  ASSERT_TRUE(failure);
  EXPECT_EQ(failure->Neighbours().pair.first, 4u);
  EXPECT_EQ(failure->Neighbours().pair.second, 0u);
  EXPECT_EQ(failure->Neighbours().pair.distance, 1.0);
}

TEST(SpacingFailure, OfPointsInOnePlaceAdvisesToLeaveOneOut) {
  PointFile file = FileWith({{0, 0, 0}, {1, 0, 0}, {1, 0, 0}});
  file.outline = 3;
  FitChoice choice;
  choice.tolerance.cap = 4.0;
  auto const failure = FailureOf(file, choice);
  ASSERT_TRUE(failure);
  EXPECT_EQ(failure->Kind(), FailureKind::PointsTooClose);
  EXPECT_EQ(failure->Help(), Remedy::LeaveOneOut);
  EXPECT_EQ(failure->Neighbours().pair.first, 1u);
  EXPECT_EQ(failure->Neighbours().pair.second, 2u);
  EXPECT_EQ(failure->Neighbours().pair.distance, 0.0);
  EXPECT_EQ(failure->Neighbours().tolerance.cap, 4.0);
  EXPECT_FALSE(failure->Neighbours().largestTolerance);
  EXPECT_EQ(failure->Neighbours().outline, 3u);
}

TEST(SpacingFailure, NamesNoProgram) {
  FitChoice choice;
  choice.strategy = Strategy::Mixed;
  choice.tolerance.same = 1.0;
  auto const failure = FailureOf(FileWith({{0, 0, 0}, {1, 0, 0}}), choice);
  ASSERT_TRUE(failure);
  EXPECT_EQ(std::string(failure->what()).find("--"), std::string::npos) << failure->what();
}

TEST(SpacingFailure, IsAFailureWhenCaughtAsOne) {
  FitChoice choice;
  choice.strategy = Strategy::Mixed;
  choice.tolerance.same = 1.0;
  try {
    FitContour(FileWith({{0, 0, 0}, {1, 0, 0}}), choice, nullptr);
    ADD_FAILURE() << "the points are too close";
  } catch (Failure const& failure) {
    EXPECT_EQ(failure.Kind(), FailureKind::PointsTooClose);
    EXPECT_NE(dynamic_cast<SpacingFailure const*>(&failure), nullptr);
  }
}

}  // namespace
}  // namespace Vorn::IO
