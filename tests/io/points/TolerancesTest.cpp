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
