#include <algorithm>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <ostream>
#include <string>
#include <vector>

#include "gtest/gtest.h"
#include "support/FittingCalls.h"
#include "support/ReferenceFitting.h"
#include "support/Remeasure.h"
#include "support/SharedData.h"

namespace Vorn::Testing {
namespace {

using Elem = GeometryUtils::Elem;
using ElemType = GeometryUtils::ElemType;
using Strategy = GeometryUtils::FittingStrategy;

/// A measured contour and the tolerance that suits it: one for all points, or a cap for tolerances
/// that follow the spacing where that is very uneven.
struct DataFile {
  char const* name;
  double tolerance;
  bool isPerPoint;
  std::size_t maxPoints;
  std::size_t referencePoints;  ///< how many the plain reference fits in a second or two
};

constexpr std::size_t kAll = static_cast<std::size_t>(-1);

constexpr DataFile kFiles[] = {
    {"rail_head_known_arcs", 0.01, false, kAll, 300},
    {"wheel_worn_a", 0.03, false, kAll, 300},
    {"rail_worn_low", 0.025, false, kAll, kAll},
    {"mirror_sphere_83m", 0.00005, false, kAll, kAll},
    {"hatch_boundary", 0.002, false, kAll, kAll},
    {"glyph_five", 2.0, true, kAll, kAll},
    {"test_track_centreline", 0.03, true, 1000, 100},
    {"gcode_letter_d", 0.015, false, kAll, kAll},
    {"airfoil_clark_y", 0.0004, false, kAll, kAll},
    {"circle_r3", 0.001, false, kAll, kAll},
};

void PrintTo(DataFile const& file, std::ostream* out) { *out << file.name; }

std::vector<WPoint> Load(DataFile const& file) {
  std::vector<WPoint> points = ReadPoints(*SharedDataFolder() + '/' + file.name + ".csv");
  if (points.size() > file.maxPoints) points.resize(file.maxPoints);
  if (file.isPerPoint) {
    SetTolerancePerPoint(&points, file.tolerance);
  } else {
    SetTolerance(&points, file.tolerance);
  }
  return points;
}

struct Fitted {
  std::vector<WPoint> points;
  CurveFitOutput fit;
};

/// One line for the table of results; `measured` counts in tolerances.
void Report(DataFile const& file, Strategy strategy, Fitted const& run, double measured,
            double seconds) {
  std::size_t const pieces = run.fit.contour.empty() ? 0 : run.fit.contour.size() - 1;
  std::printf("%-22s strategy %d: code %d, %zu pieces, reported %.9g, re-measured %.9g, %.2f s\n",
              file.name, static_cast<int>(strategy), static_cast<int>(run.fit.code), pieces,
              run.fit.maxDeviation, measured, seconds);
}

double LargestOverWholeContour(Fitted const& run) {
  auto const measured = Remeasure(run.points, run.fit.contour);
  return measured ? measured->largest : -1.0;
}

Fitted FitFile(DataFile const& file, Strategy strategy) {
  Fitted run;
  run.points = Load(file);
  auto const begin = std::chrono::steady_clock::now();
  run.fit = FitCurve<GeometryUtils>(run.points, strategy);
  std::chrono::duration<double> const seconds = std::chrono::steady_clock::now() - begin;
  Report(file, strategy, run, LargestOverWholeContour(run), seconds.count());
  return run;
}

/// What holds for every contour, whatever it is worth as a fit.
void ExpectSoundContour(std::vector<Elem> const& contour, bool isEndOnCircle = true) {
  ASSERT_GE(contour.size(), 2U);
  EXPECT_EQ(contour[0].type, ElemType::Segment);
  for (std::size_t k = 1; k < contour.size(); ++k) {
    SCOPED_TRACE(testing::Message() << "element " << k);
    Elem const& e = contour[k];
    auto const& start = contour[k - 1].end;
    ASSERT_TRUE(std::isfinite(e.end.x) && std::isfinite(e.end.y));
    if (e.type == ElemType::Segment) continue;
    ASSERT_EQ(e.type, ElemType::Arc);
    EXPECT_GT(e.radius, 0.0);
    EXPECT_EQ(std::fabs(e.direction), 1.0);
    EXPECT_EQ(e.startAngle, std::atan2(start.y - e.center.y, start.x - e.center.x));
    EXPECT_EQ(e.endAngle, std::atan2(e.end.y - e.center.y, e.end.x - e.center.x));
    double const scale = e.radius + std::hypot(e.center.x, e.center.y);
    EXPECT_NEAR(std::hypot(start.x - e.center.x, start.y - e.center.y), e.radius, 1e-9 * scale);
    if (isEndOnCircle) {
      EXPECT_NEAR(std::hypot(e.end.x - e.center.x, e.end.y - e.center.y), e.radius, 1e-9 * scale);
    }
  }
}

/// The idealised rail head, exactly known: line, five arcs, line, all tangent.
void ExpectRailHead(std::vector<Elem> const& contour) {
  auto const truth = ReadCsvRows(*SharedDataFolder() + "/rail_head_known_arcs.truth.csv");
  ASSERT_EQ(truth.size(), 7U);
  ASSERT_EQ(contour.size(), truth.size() + 1);
  for (std::size_t k = 0; k < truth.size(); ++k) {
    SCOPED_TRACE(testing::Message() << "piece " << k);
    Elem const& e = contour[k + 1];
    EXPECT_EQ(e.type == ElemType::Arc, truth[k][0] == "arc");
    if (e.type != ElemType::Arc) continue;
    double const radius = std::stod(truth[k][7]);
    EXPECT_NEAR(e.radius, radius, 0.1 * radius);
    EXPECT_EQ(e.direction, truth[k][8] == "ccw" ? 1.0 : -1.0);
  }
}

class RealData : public testing::TestWithParam<DataFile> {
 protected:
  void SetUp() override {
    if (!SharedDataFolder()) GTEST_SKIP() << "VORN_DATA_DIR is not set";
  }
};

TEST_P(RealData, MixedFitKeepsEveryPointWithinItsTolerance) {
  Fitted const run = FitFile(GetParam(), Strategy::Mixed);
  ASSERT_EQ(run.fit.code, ErrorCode::Ok);
  ExpectSoundContour(run.fit.contour);
  auto const measured = Remeasure(run.points, run.fit.contour);
  ASSERT_TRUE(measured) << "a piece ends away from all points, or the last point is not reached";
  EXPECT_LE(measured->largest, kWithinTolerance) << "point " << measured->largestIndex;
  EXPECT_LE(run.fit.maxDeviation, 1.0);
  EXPECT_NEAR(run.fit.maxDeviation, measured->largest, 1e-6);
  EXPECT_LE(measured->largestFromDrawn, kWithinTolerance);

  std::int32_t sum = 0;
  for (std::int32_t count : PieceCounts(*measured)) sum += count;
  auto const pieces = static_cast<std::int32_t>(run.fit.contour.size()) - 1;
  EXPECT_EQ(sum, static_cast<std::int32_t>(run.points.size()) + pieces - 1);
  ASSERT_FALSE(run.fit.progress.empty());
  EXPECT_EQ(run.fit.progress.back(), 100);
  if (GetParam().name == std::string("rail_head_known_arcs")) ExpectRailHead(run.fit.contour);
}

TEST_P(RealData, MixedCellsComesToASoundAnswer) {
  Fitted const run = FitFile(GetParam(), Strategy::MixedCells);
  if (run.fit.code != ErrorCode::Ok) {
    EXPECT_EQ(run.fit.maxDeviation, kSentinel);
    EXPECT_EQ(run.fit.maxDeviationIndex, kIntSentinel);
    return;
  }
  ExpectSoundContour(run.fit.contour);
  EXPECT_TRUE(std::isfinite(run.fit.maxDeviation));
  EXPECT_GE(run.fit.maxDeviationIndex, 0);
  EXPECT_LT(run.fit.maxDeviationIndex, static_cast<std::int32_t>(run.points.size()));
}

TEST_P(RealData, SingleArcComesToASoundAnswer) {
  Fitted const run = FitFile(GetParam(), Strategy::SingleArc);
  if (run.fit.code != ErrorCode::Ok) {
    EXPECT_TRUE(run.fit.contour.empty() || run.fit.contour.size() == 2);
    return;
  }
  ASSERT_EQ(run.fit.contour.size(), 2U);
  // An arc that the search cut short keeps its end while the circle is refined.
  ExpectSoundContour(run.fit.contour, false);
  EXPECT_EQ(run.fit.contour[1].type, ElemType::Arc);
  EXPECT_EQ(run.fit.maxDeviationIndex, -1);
  // The deviation of this strategy is a distance, not a share of the tolerance.
  Elem const& arc = run.fit.contour[1];
  double largest = 0.0;
  for (WPoint const& p : run.points) {
    double const d = std::hypot(p.x - arc.center.x, p.y - arc.center.y);
    largest = std::max(largest, std::fabs(d - arc.radius));
  }
  EXPECT_NEAR(run.fit.maxDeviation, largest, 1e-9 * (1.0 + arc.radius));
}

TEST_P(RealData, AgreesWithTheReference) {
  std::vector<WPoint> points = Load(GetParam());
  // The reference saves nothing; the whole of the longest contours would take it minutes.
  bool const wantsWhole = std::getenv("VORN_WHOLE_CONTOURS") != nullptr;
  if (!wantsWhole) points.resize(std::min(points.size(), GetParam().referencePoints));
  for (Strategy strategy : {Strategy::Mixed, Strategy::SingleArc}) {
    EXPECT_EQ(Transcribe(FitCurve<GeometryUtils>(points, strategy)),
              Transcribe(FitCurve<ReferenceFitting>(points, strategy)));
  }
}

std::string NameOf(testing::TestParamInfo<DataFile> const& file) { return file.param.name; }

INSTANTIATE_TEST_SUITE_P(Files, RealData, testing::ValuesIn(kFiles), NameOf);

/// A whole turn is never one arc: its ends and its middle have no turning sense. The arc stops one
/// point short, and a segment closes it.
TEST(RealDataTruth, TheDrawnCircleComesBackAsAnArcAndItsLastChord) {
  if (!SharedDataFolder()) GTEST_SKIP() << "VORN_DATA_DIR is not set";
  Fitted const run = FitFile(kFiles[9], Strategy::Mixed);
  ASSERT_EQ(run.fit.code, ErrorCode::Ok);
  ASSERT_EQ(run.fit.contour.size(), 3U);
  Elem const& arc = run.fit.contour[1];
  ASSERT_EQ(arc.type, ElemType::Arc);
  EXPECT_NEAR(arc.center.x, 0.0, 0.001);
  EXPECT_NEAR(arc.center.y, 20.0, 0.001);
  EXPECT_NEAR(arc.radius, 3.0, 0.001);
  EXPECT_EQ(arc.direction, 1.0);
  EXPECT_EQ(run.fit.contour[2].type, ElemType::Segment);
  auto const measured = Remeasure(run.points, run.fit.contour);
  ASSERT_TRUE(measured);
  EXPECT_EQ(PieceCounts(*measured).back(), 2);
}

}  // namespace
}  // namespace Vorn::Testing
