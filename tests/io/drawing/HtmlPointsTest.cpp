#include <gtest/gtest.h>

#include <cmath>
#include <random>

#include "io/drawing/HtmlPoints.h"
#include "tests/io/drawing/Unpacked.h"

namespace Vorn::IO {
namespace {

using Json = nlohmann::ordered_json;

constexpr double kTolerance = 0.01;

/// Points along a segment of 500 and a quarter circle of radius 100, as a scanner writes them.
Drawing Scan(std::size_t count, bool hasOwnTolerances = false) {
  std::mt19937 random(17);
  std::normal_distribution<double> noise(0.0, 0.3 * kTolerance);
  std::vector<WPoint> points;
  for (std::size_t i = 0; i < count; ++i) {
    double const along = 657.0 * static_cast<double>(i) / static_cast<double>(count);
    double const aside = std::clamp(noise(random), -0.99 * kTolerance, 0.99 * kTolerance);
    double const turn = (along - 500.0) / 100.0;
    double const x = along < 500.0 ? along : 500.0 + (100.0 - aside) * std::sin(turn);
    double const y = along < 500.0 ? aside : 100.0 - (100.0 - aside) * std::cos(turn);
    double const w = hasOwnTolerances && i % 1000 > 500 ? 2.0 * kTolerance : kTolerance;
    points.push_back({1e-6 * std::round(1e6 * x), 1e-6 * std::round(1e6 * y), w});
  }
  Piece const line = MakeLine({0.0, 0.0}, {500.0, 0.0});
  Piece const arc = MakeArc({500.0, 0.0}, {600.0, 100.0}, {500.0, 100.0}, 100.0, true);
  return MakeDrawing(points, {line, arc});
}

std::vector<double> Numbers(Json const& column) {
  return Unpacked({column["decimals"], column["order"], column["count"], column["bytes"]});
}

TEST(PointsJson, SmallScansKeepTheirVeryNumbers) {
  Drawing const drawing = Scan(kMostExactPoints);
  Json const json = PointsJson(drawing);
  ASSERT_TRUE(json["x"].is_array());
  for (std::size_t i = 0; i < drawing.points.size(); ++i) {
    ASSERT_EQ(json["x"][i].get<double>(), drawing.points[i].x);
    ASSERT_EQ(json["y"][i].get<double>(), drawing.points[i].y);
  }
  EXPECT_EQ(json["w"], kTolerance);
  EXPECT_FALSE(DeviationsJson(drawing).contains("exact"));
}

TEST(PointsJson, LargeScansComeBackWithinAHundredThousandthOfTheTolerance) {
  Drawing const drawing = Scan(kMostExactPoints + 1, true);
  Json const points = PointsJson(drawing);
  Json const deviations = DeviationsJson(drawing);
  std::vector<double> const x = Numbers(points["x"]);
  std::vector<double> const y = Numbers(points["y"]);
  std::vector<double> const w = Numbers(points["w"]);
  std::vector<double> const distance = Numbers(deviations["signed"]);
  std::vector<double> const piece = Numbers(deviations["piece"]);
  ASSERT_EQ(x.size(), drawing.points.size());
  for (std::size_t i = 0; i < x.size(); ++i) {
    ASSERT_NEAR(x[i], drawing.points[i].x, 0.5e-5 * kTolerance);
    ASSERT_NEAR(y[i], drawing.points[i].y, 0.5e-5 * kTolerance);
    ASSERT_EQ(w[i], drawing.points[i].w);
    PointDeviation const& deviation = drawing.deviations[i];
    ASSERT_NEAR(distance[i], deviation.isLeft ? deviation.distance : -deviation.distance,
                0.5e-5 * kTolerance);
    ASSERT_EQ(piece[i], static_cast<double>(deviation.piece));
  }
}

TEST(DeviationsJson, KeepsWhatIsWorstOrNearItsToleranceExactly) {
  Drawing drawing = Scan(kMostExactPoints + 1);
  drawing.deviations[5] = {kTolerance * (1.0 - 1e-7), 1.0 - 1e-7, true, 0};
  drawing.deviations[9] = {kTolerance * (1.0 + 1e-7), 1.0 + 1e-7, false, 0};
  drawing.deviations[12] = {3.0 * kTolerance, 3.0, true, 0};
  Json const json = DeviationsJson(drawing);
  EXPECT_EQ(json["outside"], Json::array({12}));
  std::vector<std::size_t> const kept = json["exact"]["index"];
  ASSERT_EQ(kept.size(), 4U) << json["exact"];
  EXPECT_EQ(kept[0], 12U) << "the worst of the line";
  EXPECT_EQ(drawing.deviations[kept[1]].piece, 1U) << "and of the arc";
  EXPECT_EQ(kept[2], 5U);
  EXPECT_EQ(kept[3], 9U);
  EXPECT_EQ(json["exact"]["signed"][2].get<double>(), kTolerance * (1.0 - 1e-7));
  EXPECT_EQ(json["exact"]["signed"][3].get<double>(), -kTolerance * (1.0 + 1e-7));
}

TEST(DeviationsJson, WhatIsNotANumberIsOutsideAndKeptAsItIs) {
  Drawing drawing = Scan(kMostExactPoints + 1);
  drawing.deviations[3].distance = std::nan("");
  Json const json = DeviationsJson(drawing);
  EXPECT_TRUE(json["signed"].is_array()) << "no packed column holds it";
  EXPECT_TRUE(std::isnan(json["signed"][3].get<double>()));
  EXPECT_EQ(json["outside"], Json::array({3}));
}

TEST(BandJson, LargeScansDivideTheBandOnlySoFar) {
  Json const band = BandJson(Scan(60'000, true));
  EXPECT_GT(band["piece"].size(), 100U);
  EXPECT_LE(static_cast<double>(band["piece"].size()), kMostBandSections);
}

// A million points shall make a page below 15 MB.
TEST(ToHtml, TakesAtMostFifteenBytesAPoint) {
  for (bool const hasOwnTolerances : {false, true}) {
    constexpr std::size_t kCount = 100'000;
    std::size_t const more = ToHtml(Scan(kCount, hasOwnTolerances)).size();
    std::size_t const less = ToHtml(Scan(kMostExactPoints + 1, hasOwnTolerances)).size();
    EXPECT_LT(static_cast<double>(more - less) / (kCount - kMostExactPoints - 1), 15.0);
  }
}

TEST(ToHtml, TakesAtMostFifteenBytesAPointWithoutTolerances) {
  auto const sizeOf = [](std::size_t count) {
    Drawing drawing = Scan(count);
    for (WPoint& point : drawing.points) point.w = 0.0;
    return ToHtml(MakeDrawing(drawing.points, drawing.pieces)).size();
  };
  constexpr std::size_t kCount = 100'000;
  EXPECT_LT(static_cast<double>(sizeOf(kCount) - sizeOf(kMostExactPoints + 1)) /
                (kCount - kMostExactPoints - 1),
            15.0);
}

}  // namespace
}  // namespace Vorn::IO
