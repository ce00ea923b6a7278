#include <gtest/gtest.h>

#include <algorithm>
#include <bit>
#include <cmath>
#include <limits>
#include <nlohmann/json.hpp>

#include "io/Contours.h"
#include "io/fit/MakeReport.h"

namespace Vorn::IO {
namespace {

FitReport StraightReport(double offset, double reported, Strategy strategy, double lastX = 2.0) {
  FitAnswer fit;
  fit.code = ErrorCode::Ok;
  fit.contour = {Contours::Segment(0, 0), Contours::Segment(lastX, 0)};
  fit.deviation = reported;
  fit.deviationIndex = 1;
  PointFile file = Contours::FileWith({{0, 0, 0.125}, {1, offset, 0.125}, {2, 0, 0.125}});
  return MakeReport({std::move(file), "", {}}, strategy, std::move(fit));
}

TEST(Verdict, RoundingBeyondOneIsForgivenAndNoMore) {
  EXPECT_EQ(StraightReport(0.125, 1.0, Strategy::Mixed).verdict, Verdict::WithinTolerance);
  EXPECT_EQ(StraightReport(0.125 * (1.0 + 0.9e-6), 1.0, Strategy::Mixed).verdict,
            Verdict::WithinTolerance);
  EXPECT_EQ(StraightReport(0.125 * (1.0 + 1.1e-6), 1.0, Strategy::Mixed).verdict,
            Verdict::OutsideTolerance);
}

/// Seen on a contour a thousand times as large as a part in millimetres.
TEST(Verdict, RoundingOfLargeCoordinatesIsForgiven) {
  EXPECT_EQ(StraightReport(0.125 * 1.000000013, 1.0, Strategy::Mixed).verdict,
            Verdict::WithinTolerance);
  EXPECT_EQ(StraightReport(0.0, 1.000000013, Strategy::Mixed).verdict, Verdict::WithinTolerance);
}

TEST(LargestDeviation, IsTheLargerOfReportedAndMeasured) {
  FitReport const reported = StraightReport(0.0625, 0.75, Strategy::Mixed);
  EXPECT_EQ(reported.LargestDeviation().relative, 0.75);
  EXPECT_EQ(reported.LargestDeviation().point, 1u);
  EXPECT_EQ(StraightReport(0.0625, 0.25, Strategy::Mixed).LargestDeviation().relative, 0.5);
  EXPECT_EQ(StraightReport(0.0625, 0.75, Strategy::Arc).LargestDeviation().relative, 0.5)
      << "a length is no multiple of the tolerance";
}

TEST(Verdict, ReportedDeviationCountsToo) {
  EXPECT_EQ(StraightReport(0.0, 1.1, Strategy::Mixed).verdict, Verdict::OutsideTolerance);
  EXPECT_EQ(StraightReport(0.0, std::numeric_limits<double>::quiet_NaN(), Strategy::Mixed).verdict,
            Verdict::OutsideTolerance);
}

TEST(Verdict, LengthReportedByTheSingleArcIsNotTakenForARelativeOne) {
  EXPECT_EQ(StraightReport(0.0, 1.1, Strategy::Arc).verdict, Verdict::WithinTolerance);
}

TEST(Verdict, ContourThatStopsEarlyIsNoFit) {
  EXPECT_EQ(StraightReport(0.0, 0.0, Strategy::Mixed, 1.0).verdict, Verdict::StopsEarly);
  EXPECT_EQ(StraightReport(0.0, 0.0, Strategy::Mixed, 1.6).verdict, Verdict::OutsideTolerance)
      << "nearer to the last point than half the spacing, but out of its tolerance";
  EXPECT_EQ(StraightReport(0.0, 0.0, Strategy::Cells, 1.0).verdict, Verdict::StopsEarly);
}

TEST(Json, HoldsEveryFieldWithItsExactBits) {
  FitReport const report = Contours::LineAndArcReport();
  auto const json = nlohmann::json::parse(ToJson(report));
  EXPECT_EQ(json.at("schemaVersion"), 1);
  EXPECT_EQ(json.at("input").at("file"), "part.csv");
  EXPECT_EQ(json.at("input").at("points"), 7);
  EXPECT_TRUE(json.at("input").at("units").is_null());
  EXPECT_EQ(json.at("input").at("tolerance").at("largest"), 0.02);
  EXPECT_EQ(json.at("strategy"), "mixed");
  EXPECT_EQ(json.at("code"), 0);
  EXPECT_EQ(json.at("verdict"), "within tolerance");
  EXPECT_EQ(json.at("counts").at("arcs"), 1);
  EXPECT_EQ(json.at("deviation").at("reported").at("value"), 0.5);
  EXPECT_EQ(json.at("deviation").at("reported").at("point"), 1);
  EXPECT_EQ(json.at("deviation").at("remeasured").at("point"), 3);
  ASSERT_EQ(json.at("elements").size(), 2u);

  auto const& line = json.at("elements").at(0);
  EXPECT_EQ(line.at("kind"), "line");
  EXPECT_FALSE(line.contains("radius"));
  EXPECT_EQ(line.at("points").at("count"), 3);

  auto const& arc = json.at("elements").at(1);
  auto const expectBits = [&](nlohmann::json const& value, double expected) {
    EXPECT_EQ(std::bit_cast<std::uint64_t>(value.get<double>()),
              std::bit_cast<std::uint64_t>(expected));
  };
  Piece const& piece = report.pieces[1];
  expectBits(arc.at("end").at("x"), piece.end.x);
  expectBits(arc.at("end").at("y"), piece.end.y);
  expectBits(arc.at("center").at("y"), piece.center.y);
  expectBits(arc.at("radius"), piece.radius);
  expectBits(arc.at("startAngle"), piece.startAngle);
  expectBits(arc.at("endAngle"), piece.endAngle);
  expectBits(arc.at("sweep"), piece.sweep);
  expectBits(arc.at("length"), piece.length);
  EXPECT_EQ(arc.at("direction"), "cw");
}

TEST(Json, HoldsWhatThePointsSayByThemselves) {
  FitReport const report = Contours::LineAndArcReport();
  auto const json = nlohmann::json::parse(ToJson(report));
  // Three points at the heights 0, 0.01, 0: the line of least squares is level.
  auto const& line = json.at("elements").at(0).at("leastSquares");
  EXPECT_EQ(line.at("points"), 3);
  EXPECT_NEAR(line.at("direction").get<double>(), 0.0, 1e-15);
  EXPECT_NEAR(line.at("formError").get<double>(), 0.01, 1e-15);
  EXPECT_NEAR(line.at("standardDeviation").get<double>(),
              std::sqrt(0.01 * 0.01 * (1.0 / 9 + 1.0 / 9 + 4.0 / 9)), 1e-15);
  auto const& arc = json.at("elements").at(1).at("leastSquares");
  EXPECT_EQ(arc.at("points"), 4);
  EXPECT_FALSE(arc.contains("direction"));
  EXPECT_NEAR(arc.at("radius").get<double>(), 1.0, 0.02);
  EXPECT_GT(arc.at("radiusDeviation").get<double>(), 0.0);
  EXPECT_NEAR(json.at("elements").at(0).at("turn").get<double>(), 0.0, 1e-15) << "tangential";
  EXPECT_TRUE(json.at("elements").at(1).at("turn").is_null());

  auto const& deviation = json.at("deviation");
  EXPECT_NEAR(deviation.at("mean").get<double>(), (0.01 + 0.015) / 7, 1e-15) << "both to the left";
  EXPECT_NEAR(deviation.at("rootMeanSquare").get<double>(),
              std::sqrt((0.01 * 0.01 + 0.015 * 0.015) / 7), 1e-15);
  EXPECT_EQ(deviation.at("outside"), 0);
  EXPECT_EQ(deviation.at("histogram").at("kind"), "relative");
  EXPECT_EQ(deviation.at("histogram").at("counts").size(), 20u);
}

TEST(Json, HoldsTheFieldsInTheirOrderAndTheProgram) {
  FitReport report = Contours::LineAndArcReport();
  EXPECT_TRUE(nlohmann::json::parse(ToJson(report)).at("program").is_null());
  report.head = {{{"part", "Cam"}, {"drawing", "7 \"b\""}}, "contour 1.2.3"};
  auto const json = nlohmann::ordered_json::parse(ToJson(report));
  EXPECT_EQ(json.at("program"), "contour 1.2.3");
  EXPECT_EQ(json.at("fields").dump(), R"({"part":"Cam","drawing":"7 \"b\""})");
}

TEST(Json, WritesNullForWhatIsNotKnown) {
  FitReport report = Contours::LineAndArcReport();
  report.fit.deviation = std::numeric_limits<double>::quiet_NaN();
  report.fit.deviationIndex = -1;
  report.ranges.reset();
  auto const json = nlohmann::json::parse(ToJson(report));
  EXPECT_TRUE(json.at("deviation").at("reported").at("value").is_null());
  EXPECT_TRUE(json.at("deviation").at("reported").at("point").is_null());
  EXPECT_TRUE(json.at("elements").at(0).at("points").is_null());
}

TEST(Json, FileNameThatIsNotUtf8StillGivesADocument) {
  FitReport report = Contours::LineAndArcReport();
  report.file.path = "caf\xE9.csv";
  auto const json = nlohmann::json::parse(ToJson(report));
  EXPECT_EQ(json.at("input").at("file"), "caf\xEF\xBF\xBD.csv");
}

}  // namespace
}  // namespace Vorn::IO
