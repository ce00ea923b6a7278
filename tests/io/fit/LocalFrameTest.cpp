#include <gtest/gtest.h>

#include <bit>
#include <cmath>
#include <cstdint>
#include <fstream>
#include <limits>

#include "io/Contours.h"
#include "io/fit/LocalFrame.h"
#include "support/RandomGeometry.h"
#include "support/SharedData.h"
#include "vorn/io/FitContour.h"
#include "vorn/io/Points.h"
#include "vorn/io/Tolerances.h"

namespace Vorn::IO {
namespace {

std::vector<WPoint> Shifted(std::vector<WPoint> points, double x, double y) {
  for (WPoint& point : points) {
    point.x += x;
    point.y += y;
  }
  return points;
}

/// Coordinates that a double holds together with an offset of 1e8.
std::vector<WPoint> Rounded(std::vector<WPoint> points) {
  double const lastPlace = std::ldexp(1.0, -26);
  for (WPoint& point : points) {
    point.x = std::round(point.x / lastPlace) * lastPlace;
    point.y = std::round(point.y / lastPlace) * lastPlace;
  }
  return points;
}

/// Points exactly in a row along (0.8, 0.6), a unit apart.
std::vector<WPoint> Collinear(int count) {
  std::vector<WPoint> points;
  for (int i = 0; i < count; ++i) points.push_back({0.8 * i, 0.6 * i, 0.001});
  return points;
}

FitReport FitAt(std::vector<WPoint> points, double x, double y, FitChoice const& choice) {
  return FitContour(Contours::FileWith(Shifted(std::move(points), x, y)), choice, nullptr);
}

TEST(LocalOrigin, NearTheOriginNothingIsTakenOff) {
  for (double const shift : {0.0, 1.0, -10.0, 15.9 * 4.0}) {
    XY const origin = LocalOrigin({{shift, 0, 0}, {shift + 4, 1, 0}, {shift + 2, 3, 0}});
    EXPECT_EQ(origin.x, 0.0) << shift;
    EXPECT_EQ(origin.y, 0.0) << shift;
  }
}

TEST(LocalOrigin, IsARoundNumberNearTheMiddleOfTheFarAxis) {
  // 32 times the size of 4 is 128, and the power of ten above that is 1000.
  XY const origin = LocalOrigin({{1000456, 0, 0}, {1000460, 1, 0}});
  EXPECT_EQ(origin.x, 1000000.0);
  EXPECT_EQ(origin.y, 0.0);
  EXPECT_EQ(LocalOrigin({{-7.25, 0, 0}, {-7.24, 0.01, 0}}).x, -7.0) << "whole units at least";
}

TEST(LocalOrigin, TakesNothingOffWhatHasNoExtentOrIsNotFinite) {
  double const kInfinity = std::numeric_limits<double>::infinity();
  double const kNan = std::numeric_limits<double>::quiet_NaN();
  double const kLargest = std::numeric_limits<double>::max();
  std::vector<std::vector<WPoint>> const bad = {{},
                                                {{1e9, 1e9, 0}},
                                                {{1e9, 1e9, 0}, {1e9, 1e9, 0}},
                                                {{1e9, 1e9, 0}, {kNan, 1e9, 0}, {1e9, 1e9 + 1, 0}},
                                                {{1e9, kInfinity, 0}, {1e9, 1, 0}},
                                                {{-kLargest, 0, 0}, {kLargest, 1, 0}}};
  for (std::vector<WPoint> const& points : bad) {
    XY const origin = LocalOrigin(points);
    EXPECT_EQ(origin.x, 0.0);
    EXPECT_EQ(origin.y, 0.0);
  }
}

TEST(LocalOrigin, DifferencesAreExactForAnyCoordinates) {
  Testing::RandomGeometry random(71);
  for (int round = 0; round < 2000; ++round) {
    double const far = std::pow(10.0, random.Uniform(-3.0, 12.0)) * (random.Flip() ? 1.0 : -1.0);
    double const size = std::pow(10.0, random.Uniform(-3.0, 6.0));
    std::vector<WPoint> points;
    for (int i = 0; i < 8; ++i) {
      points.push_back({far + random.Uniform(-size, size), random.Uniform(-size, size) - far, 0});
    }
    XY const origin = LocalOrigin(points);
    for (WPoint const& point : points) {
      // A difference of doubles that the wider type holds is exact there.
      long double const exact = static_cast<long double>(point.x) - origin.x;
      ASSERT_EQ(static_cast<long double>(point.x - origin.x), exact) << "round " << round;
      ASSERT_EQ((point.y - origin.y) + origin.y, point.y) << "round " << round;
    }
  }
}

TEST(FitContour, CollinearPointsAreOnePieceWhereverTheyLie) {
  for (Strategy const strategy : {Strategy::Mixed, Strategy::Cells, Strategy::Fewest}) {
    FitChoice choice;
    choice.tolerance.same = 0.001;
    choice.strategy = strategy;
    for (double const offset : {0.0, 1e5, -5e6, 1e8}) {
      FitReport const report = FitAt(Collinear(200), offset, -offset, choice);
      EXPECT_EQ(report.pieces.size(), 1u) << offset;
      EXPECT_EQ(report.verdict, Verdict::WithinTolerance) << offset;
    }
  }
}

TEST(FitContour, ReportOfAFarContourHoldsThePointsAsTheyCame) {
  std::vector<WPoint> const points = Shifted(Collinear(20), 1e8 / 3.0, -7e7 / 9.0);
  FitChoice choice;
  choice.tolerance.same = 0.001;
  FitReport const report = FitContour(Contours::FileWith(points), choice, nullptr);
  for (std::size_t i = 0; i < points.size(); ++i) {
    EXPECT_EQ(report.file.points[i].x, points[i].x);
    EXPECT_EQ(report.file.points[i].y, points[i].y);
  }
  EXPECT_NEAR(report.pieces.front().start.x, points.front().x, 0.002);
  EXPECT_NEAR(report.fit.contour.back().end.y, points.back().y, 0.002);
}

struct FarContour {
  char const* name;
  std::optional<double> same;
  std::optional<double> cap;
};

class FarFromTheOrigin : public testing::TestWithParam<FarContour> {};

bool HaveSameBits(double a, double b) {
  return std::bit_cast<std::uint64_t>(a) == std::bit_cast<std::uint64_t>(b);
}

/// The pieces are the same; coordinates as far as a double holds them so far out.
void ExpectSamePieces(FitReport const& near, FitReport const& far, XY const& offset) {
  ASSERT_EQ(far.pieces.size(), near.pieces.size()) << "offset " << offset.x;
  EXPECT_EQ(far.verdict, near.verdict);
  EXPECT_TRUE(HaveSameBits(far.remeasured.Worst().relative, near.remeasured.Worst().relative));
  for (std::size_t i = 0; i < near.pieces.size(); ++i) {
    Piece const& a = near.pieces[i];
    Piece const& b = far.pieces[i];
    EXPECT_EQ(a.kind, b.kind) << i;
    EXPECT_TRUE(HaveSameBits(a.length, b.length) && HaveSameBits(a.radius, b.radius) &&
                HaveSameBits(a.sweep, b.sweep) && HaveSameBits(a.startAngle, b.startAngle))
        << "piece " << i;
    EXPECT_TRUE(HaveSameBits(a.start.x + offset.x, b.start.x) &&
                HaveSameBits(a.start.y + offset.y, b.start.y) &&
                HaveSameBits(a.end.x + offset.x, b.end.x) &&
                HaveSameBits(a.end.y + offset.y, b.end.y))
        << "piece " << i;
  }
}

TEST_P(FarFromTheOrigin, PiecesAreThoseAtTheOrigin) {
  std::optional<std::string> const folder = Testing::SharedDataFolder();
  if (!folder) GTEST_SKIP() << "VORN_DATA_DIR is not set";
  FitChoice choice;
  choice.tolerance.same = GetParam().same;
  choice.tolerance.cap = GetParam().cap;
  std::ifstream none;
  PointFile const file =
      ReadPoints(*folder + "/" + GetParam().name + ".csv", none, ColumnFor(choice.tolerance));
  // What is far already is brought to the origin first, by whole units.
  XY const home = {std::round(file.points.front().x), std::round(file.points.front().y)};
  std::vector<WPoint> const points = Rounded(Shifted(file.points, -home.x, -home.y));
  FitReport const near = FitAt(points, 0.0, 0.0, choice);
  for (double const offset : {1e5, 5e6, 1e8}) {
    XY const origin = LocalOrigin(Shifted(points, offset, -offset));
    bool const isNear = origin.x == 0.0 && origin.y == 0.0;
    if (offset > 1e6) {
      EXPECT_FALSE(isNear) << offset;
    }
    // A contour of kilometres is near the origin there, by its own measure.
    if (isNear) continue;
    ExpectSamePieces(near, FitAt(points, offset, -offset, choice), {offset, -offset});
  }
}

INSTANTIATE_TEST_SUITE_P(Shared, FarFromTheOrigin,
                         testing::ValuesIn(std::vector<FarContour>{
                             {"rail_head_known_arcs", 0.01, {}},
                             {"wheel_worn_a", 0.03, {}},
                             {"rail_worn_low", 0.025, {}},
                             {"mirror_sphere_83m", 0.00005, {}},
                             {"hatch_boundary", 0.002, {}},
                             {"glyph_five", {}, 2.0},
                             {"test_track_centreline", {}, 0.03},
                             {"gcode_letter_d", 0.015, {}},
                             {"airfoil_clark_y", 0.0004, {}},
                             {"circle_r3", 0.001, {}}}),
                         [](auto const& contour) { return std::string(contour.param.name); });

}  // namespace
}  // namespace Vorn::IO
