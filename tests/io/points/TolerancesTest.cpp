#include <gtest/gtest.h>

#include "vorn/io/Failure.h"
#include "vorn/io/Spacing.h"
#include "vorn/io/Tolerances.h"

namespace Vorn::IO {
namespace {

PointFile FileWith(std::vector<WPoint> points) {
  PointFile file;
  file.path = "p.csv";
  for (std::size_t i = 0; i < points.size(); ++i) file.lines.push_back(i + 2);
  file.points = std::move(points);
  return file;
}

std::optional<FailureKind> KindOfRefusal(ToleranceChoice const& choice, PointFile file,
                                         std::string* message) {
  try {
    AssignTolerances(choice, &file);
  } catch (Failure const& failure) {
    *message = failure.what();
    return failure.Kind();
  }
  return {};
}

TEST(AssignTolerances, OneToleranceGoesToEveryPoint) {
  PointFile file = FileWith({{0, 0, 9}, {1, 0, 9}});
  AssignTolerances({.same = 0.5, .column = {}, .cap = {}}, &file);
  EXPECT_EQ(file.points[0].w, 0.5);
  EXPECT_EQ(file.points[1].w, 0.5);
}

TEST(AssignTolerances, PerPointTakesTheNearerNeighbourAndTheCap) {
  PointFile file = FileWith({{0, 0, 0}, {1, 0, 0}, {1, 10, 0}, {1, 100, 0}});
  AssignTolerances({.same = {}, .column = {}, .cap = 4.0}, &file);
  EXPECT_EQ(file.points[0].w, 0.3 * 1.0);
  EXPECT_EQ(file.points[1].w, 0.3 * 1.0);
  EXPECT_EQ(file.points[2].w, 0.3 * 10.0);
  EXPECT_EQ(file.points[3].w, 4.0);
  EXPECT_FALSE(FindClosePair(file.points).has_value());
}

TEST(AssignTolerances, PerPointNamesCoincidingNeighbours) {
  std::string message;
  EXPECT_EQ(KindOfRefusal({.same = {}, .column = {}, .cap = 4.0},
                          FileWith({{0, 0, 0}, {1, 0, 0}, {1, 0, 0}, {2, 0, 0}}), &message),
            FailureKind::PointsTooClose);
  EXPECT_EQ(message,
            "p.csv: point 1 (line 3) and point 2 (line 4) coincide: no tolerance can follow from "
            "a spacing of zero");
}

TEST(AssignTolerances, OptionGoesBeforeColumnBeforeComment) {
  PointFile file = FileWith({{0, 0, 0.1}, {1, 0, 0.2}});
  file.hasTolerances = true;
  file.tolerance = 0.7;
  AssignTolerances({}, &file);
  EXPECT_EQ(file.points[1].w, 0.2);
  file.hasTolerances = false;
  AssignTolerances({}, &file);
  EXPECT_EQ(file.points[1].w, 0.7);
  AssignTolerances({.same = 0.5, .column = {}, .cap = {}}, &file);
  EXPECT_EQ(file.points[1].w, 0.5);
}

TEST(AssignTolerances, NoToleranceAnywhereIsAUsageError) {
  std::string message;
  EXPECT_EQ(KindOfRefusal({}, FileWith({{0, 0, 0}, {1, 0, 0}}), &message),
            FailureKind::BadArgument);
  EXPECT_EQ(message, "no tolerance: p.csv has no column 'w' and no comment '# tolerance T'");
}

TEST(AssignTolerances, PerPointOfAClosedContourTakesTheSeamIn) {
  PointFile open = FileWith({{0, 0, 0}, {10, 0, 0}, {10, 10, 0}, {0, 2, 0}});
  PointFile closed = open;
  AssignTolerances({.same = {}, .column = {}, .cap = 9.0}, &open, false);
  AssignTolerances({.same = {}, .column = {}, .cap = 9.0}, &closed, true);
  EXPECT_EQ(open.points[0].w, 0.3 * 10.0);
  EXPECT_EQ(closed.points[0].w, 0.3 * 2.0);
  EXPECT_EQ(closed.points[3].w, 0.3 * 2.0);
  EXPECT_EQ(closed.points[1].w, open.points[1].w);
}

TEST(AssignTolerances, ARepeatedFirstPointHasOneTolerance) {
  PointFile file = FileWith({{0, 0, 0}, {4, 0, 0}, {4, 4, 0}, {0, 1, 0}, {0, 0, 0}});
  AssignTolerances({.same = {}, .column = {}, .cap = 9.0}, &file, true);
  EXPECT_EQ(file.points.front().w, 0.3 * 1.0);
  EXPECT_EQ(file.points.back().w, 0.3 * 1.0);
}

TEST(AssignTolerances, WhoOnlyLooksGetsZeroWherePointsCoincide) {
  PointFile file = FileWith({{0, 0, 0}, {1, 0, 0}, {1, 0, 0}, {3, 0, 0}});
  AssignTolerances({.same = {}, .column = {}, .cap = 4.0}, &file, false, Coinciding::GivenZero);
  EXPECT_EQ(file.points[0].w, 0.3);
  EXPECT_EQ(file.points[1].w, 0.0);
  EXPECT_EQ(file.points[2].w, 0.0);
  EXPECT_EQ(file.points[3].w, 0.3 * 2.0);
}

TEST(AssignTolerances, SaysWhereTheyCameFrom) {
  PointFile file = FileWith({{0, 0, 0.1}, {1, 0, 0.2}});
  EXPECT_EQ(AssignTolerances({.same = 0.5, .column = {}, .cap = {}}, &file),
            "given for all points");
  EXPECT_EQ(AssignTolerances({.same = {}, .column = {}, .cap = 0.5}, &file),
            "0.3 of the spacing, at most 0.5");
  file.tolerance = 0.7;
  EXPECT_EQ(AssignTolerances({}, &file), "comment in the file");
  file.hasTolerances = true;
  file.toleranceColumn = "tol";
  EXPECT_EQ(AssignTolerances({}, &file), "column 'tol' of the file");
}

TEST(IsToleranceStated, ByTheChoiceOrTheFile) {
  PointFile file = FileWith({{0, 0, 0}});
  EXPECT_FALSE(IsToleranceStated({}, file));
  EXPECT_TRUE(IsToleranceStated({.same = 0.0, .column = {}, .cap = {}}, file));
  EXPECT_TRUE(IsToleranceStated({.same = {}, .column = "w", .cap = {}}, file));
  EXPECT_TRUE(IsToleranceStated({.same = {}, .column = {}, .cap = 1.0}, file));
  file.tolerance = 1.0;
  EXPECT_TRUE(IsToleranceStated({}, file));
  file.tolerance.reset();
  file.hasTolerances = true;
  EXPECT_TRUE(IsToleranceStated({}, file));
}

TEST(ToleranceForSpacing, IsAtMostTheCapAndAlwaysPassesTheSpacingRule) {
  EXPECT_EQ(ToleranceForSpacing(1.0, 2.0), 0.3 * 2.0);
  EXPECT_EQ(ToleranceForSpacing(0.5, 2.0), 0.5);
  EXPECT_EQ(ToleranceForSpacing(1.0, 0.0), 0.0);
  for (double spacing = 1e-9; spacing < 1e9; spacing *= 1.7) {
    double const w = ToleranceForSpacing(1e300, spacing);
    EXPECT_FALSE(AreTooClose({0, 0, w}, {spacing, 0, w})) << spacing;
    EXPECT_LT(NeededDistance({0, 0, w}, {spacing, 0, w}), spacing);
  }
}

TEST(ColumnFor, ReadsAColumnOnlyWhenNoOtherOptionRules) {
  EXPECT_EQ(ColumnFor({}).use, ToleranceColumn::Use::IfPresent);
  EXPECT_EQ(ColumnFor({.same = 1.0, .column = {}, .cap = {}}).use, ToleranceColumn::Use::Ignore);
  EXPECT_EQ(ColumnFor({.same = {}, .column = {}, .cap = 1.0}).use, ToleranceColumn::Use::Ignore);
  ToleranceColumn const named = ColumnFor({.same = {}, .column = "tol", .cap = {}});
  EXPECT_EQ(named.use, ToleranceColumn::Use::Required);
  EXPECT_EQ(named.name, "tol");
}

}  // namespace
}  // namespace Vorn::IO
