#include <gtest/gtest.h>

#include <cmath>
#include <nlohmann/json.hpp>

#include "io/Contours.h"
#include "vorn/io/InfoReport.h"

namespace Vorn::IO {
namespace {

using Json = nlohmann::json;

/// A path of five points with a right angle to the left at the third and its fourth one twice.
PointFile Angle() {
  return Contours::FileWith(
      {{0, 0, 0.25}, {3, 0, 0.25}, {6, 0, 0.5}, {6, 4, 0.25}, {6, 4, 0.25}, {6, 9, 0.25}});
}

InfoReport ReportOf(PointFile file) {
  InfoReport report;
  report.info = Analyse(file.points, ClosedChoice::No);
  report.file = std::move(file);
  return report;
}

TEST(CheckRule, TellsTheRangeOfTolerancesAndWhatIsTooClose) {
  RuleCheck const rule = CheckRule(Angle().points, {}, "column 'w'");
  EXPECT_EQ(rule.source, "column 'w'");
  EXPECT_EQ(rule.smallest, 0.25);
  EXPECT_EQ(rule.largest, 0.5);
  ASSERT_EQ(rule.broken.size(), 1u);
  EXPECT_EQ(rule.broken[0].first, 3u);
  EXPECT_EQ(rule.broken[0].second, 4u);
  EXPECT_EQ(rule.broken[0].distance, 0.0);
  EXPECT_EQ(rule.broken[0].needed, 0.75);
}

TEST(CheckRule, NoPointsBreakNone) {
  RuleCheck const rule = CheckRule({}, {}, "nobody");
  EXPECT_EQ(rule.source, "nobody");
  EXPECT_TRUE(rule.broken.empty());
}

TEST(InfoJson, HoldsTheFactsOfThePoints) {
  Json const json = Json::parse(ToJson(ReportOf(Angle())));
  EXPECT_EQ(json.at("schemaVersion"), 1);
  EXPECT_EQ(json.at("file"), "part.csv");
  EXPECT_EQ(json.at("points"), 6);
  EXPECT_EQ(json.at("length"), 15.0);
  EXPECT_EQ(json.at("extent"), Json({{"x", {0.0, 6.0}}, {"y", {0.0, 9.0}}}));
  EXPECT_TRUE(json.at("units").is_null());
  Json const& spacing = json.at("spacing");
  EXPECT_EQ(spacing.at("least").at("distance"), 0.0);
  EXPECT_EQ(spacing.at("least").at("between"),
            Json({{{"point", 3}, {"line", 5}}, {{"point", 4}, {"line", 6}}}));
  EXPECT_EQ(spacing.at("median"), 3.0);
  EXPECT_EQ(spacing.at("most").at("distance"), 5.0);
  EXPECT_EQ(json.at("closed").at("isClosed"), false);
  EXPECT_NEAR(json.at("closed").at("gap").get<double>(), std::hypot(6.0, 9.0), 1e-15);
}

TEST(InfoJson, DuplicatesNameBothPoints) {
  Json const json = Json::parse(ToJson(ReportOf(Angle())));
  ASSERT_EQ(json.at("duplicates").size(), 1u);
  Json const& duplicate = json.at("duplicates")[0];
  EXPECT_EQ(duplicate.at("point"), 4);
  EXPECT_EQ(duplicate.at("line"), 6);
  EXPECT_EQ(duplicate.at("repeats"), Json({{"point", 3}, {"line", 5}}));
  EXPECT_EQ(duplicate.at("neighbours"), true);
}

TEST(InfoJson, CornersTurnLeftPositive) {
  InfoReport report = ReportOf(Angle());
  report.info.corners = {{2, 90.0, true}, {4, 170.0, false}};
  Json const corners = Json::parse(ToJson(report)).at("corners");
  ASSERT_EQ(corners.size(), 2u);
  EXPECT_EQ(corners[0].at("degrees"), 90.0);
  EXPECT_EQ(corners[0].at("reversal"), false);
  EXPECT_EQ(corners[1].at("degrees"), -170.0);
  EXPECT_EQ(corners[1].at("reversal"), true);
}

TEST(InfoJson, WithoutARuleANoiseOrASuggestionTheseAreNull) {
  InfoReport report = ReportOf(Angle());
  report.info.noise.reset();
  report.info.largestTolerance.reset();
  report.info.suggestion = {};
  Json const json = Json::parse(ToJson(report));
  for (char const* key : {"tolerance", "noise", "largestTolerance", "suggestion"}) {
    EXPECT_TRUE(json.at(key).is_null()) << key;
  }
}

TEST(InfoJson, TheSuggestionTellsItsStrategyOnlyWhereItNeedsOne) {
  InfoReport report = ReportOf(Angle());
  report.info.suggestion = {Suggestion::Way::Same, 0.125, "five times the noise"};
  Json same = Json::parse(ToJson(report)).at("suggestion");
  EXPECT_EQ(same.at("value"), 0.125);
  EXPECT_TRUE(same.at("strategy").is_null());
  EXPECT_EQ(same.at("reason"), "five times the noise");
  report.info.suggestion.way = Suggestion::Way::Fewest;
  EXPECT_EQ(Json::parse(ToJson(report)).at("suggestion").at("strategy"), "fewest");
}

TEST(InfoJson, BrokenPairsOfTheRuleAreListed) {
  InfoReport report = ReportOf(Angle());
  report.rule = CheckRule(report.file.points, {}, "column 'w'");
  Json const rule = Json::parse(ToJson(report)).at("tolerance");
  EXPECT_EQ(rule.at("source"), "column 'w'");
  EXPECT_EQ(rule.at("smallest"), 0.25);
  EXPECT_EQ(rule.at("largest"), 0.5);
  ASSERT_EQ(rule.at("tooClose").size(), 1u);
  EXPECT_EQ(rule.at("tooClose")[0].at("needed"), 0.75);
  EXPECT_EQ(rule.at("tooClose")[0].at("between")[1].at("point"), 4);
}

TEST(InfoJson, PointsOfNoTableHaveNoLines) {
  PointFile file = Angle();
  file.lines.clear();
  Json const json = Json::parse(ToJson(ReportOf(file)));
  EXPECT_TRUE(json.at("duplicates")[0].at("line").is_null());
}

TEST(PointFile, NamesPointsByLineOrPlaceOrNumberAlone) {
  PointFile file = Angle();
  EXPECT_EQ(file.NameOf(1), "point 1 (line 3)");
  EXPECT_EQ(file.LineOf(5), 7u);
  EXPECT_FALSE(file.LineOf(6));
  file.lines.clear();
  EXPECT_EQ(file.NameOf(3), "point 3 at (6, 4)");
  file.path.clear();
  EXPECT_EQ(file.NameOf(3), "point 3");
}

TEST(OutlineSuffix, NamesOneOfSeveral) {
  EXPECT_EQ(OutlineSuffix(0), "");
  EXPECT_EQ(OutlineSuffix(1), ", outline 1");
  EXPECT_EQ(OutlineSuffix(12), ", outline 12");
}

}  // namespace
}  // namespace Vorn::IO
