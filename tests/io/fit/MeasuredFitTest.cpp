// Fits of measured contours and of ovals: within tolerance, and closed where they are.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

#include "io/Contours.h"
#include "io/FitChoices.h"
#include "support/SharedData.h"
#include "vorn/io/FitReport.h"

namespace Vorn::IO {
namespace {

using namespace FitChoices;

/// An oval of 805 points, a step of 5 between neighbours but for the last one.
std::vector<WPoint> Oval(double ratio, double turn) {
  constexpr int kPoints = 805;
  constexpr double kStep = 5.0;
  constexpr int kFine = 200000;
  double const full = std::atan(1.0) * 8.0;
  auto const at = [&](int i) {
    double const angle = full * i / kFine;
    return WPoint{ratio * std::cos(angle), std::sin(angle), 0.0};
  };
  double around = 0.0;
  for (int i = 0; i < kFine; ++i) {
    around += std::hypot(at(i + 1).x - at(i).x, at(i + 1).y - at(i).y);
  }
  double const scale = kPoints * kStep / around;
  std::vector<WPoint> points;
  double length = 0.0;
  for (int i = 0; i < kFine && points.size() < kPoints; ++i) {
    if (length * scale >= static_cast<double>(points.size()) * kStep) {
      double const x = scale * at(i).x;
      double const y = scale * at(i).y;
      points.push_back(
          {x * std::cos(turn) - y * std::sin(turn), x * std::sin(turn) + y * std::cos(turn), 0.0});
    }
    length += std::hypot(at(i + 1).x - at(i).x, at(i + 1).y - at(i).y);
  }
  return points;
}

void ExpectClosed(std::vector<WPoint> const& points, FitChoice const& choice) {
  FitReport const report = FitContour(Contours::FileWith(points), choice, nullptr);
  EXPECT_TRUE(report.closure.isClosed);
  EXPECT_EQ(report.Gap(), 0.0);
  EXPECT_EQ(report.verdict, Verdict::WithinTolerance);
  EXPECT_LE(report.LargestDeviation().relative, kLargestRelative);
}

TEST(FitContour, OvalsClose) {
  for (double const ratio : {1.2, 1.5, 1.8, 2.0, 2.5, 3.0}) {
    for (int k = 0; k < 8; ++k) {
      SCOPED_TRACE(std::to_string(ratio) + " turned " + std::to_string(k));
      std::vector<WPoint> points = Oval(ratio, 0.3 * k);
      std::rotate(points.begin(), points.begin() + 97 * k, points.end());
      for (double const tolerance : {0.2, 0.5}) ExpectClosed(points, Same(tolerance));
    }
  }
}

TEST(FitContour, TurnedClosedContoursClose) {
  auto const folder = Testing::SharedDataFolder();
  if (!folder) GTEST_SKIP() << "VORN_DATA_DIR is not set";
  struct Closed {
    char const* name;
    FitChoice choice;
  };
  for (Closed const& closed :
       {Closed{"hatch_boundary", Same(0.002)}, Closed{"glyph_five", PerPoint(2.0)},
        Closed{"gcode_letter_d", Same(0.015)}, Closed{"circle_r3", Same(0.001)}}) {
    std::vector<WPoint> const points = Testing::ReadPoints(*folder + "/" + closed.name + ".csv");
    for (int k = 0; k < 48; ++k) {
      SCOPED_TRACE(std::string(closed.name) + " turned " + std::to_string(k));
      double const turn = std::atan(1.0) * k / 6.0;
      std::vector<WPoint> turned = points;
      for (WPoint& p : turned) {
        p = {p.x * std::cos(turn) - p.y * std::sin(turn),
             p.x * std::sin(turn) + p.y * std::cos(turn), p.w};
      }
      if (points.front().x == points.back().x && points.front().y == points.back().y) {
        turned.back() = turned.front();
      }
      ExpectClosed(turned, closed.choice);
    }
  }
}

struct Measured {
  char const* name;
  FitChoice choice;
  bool isClosed;
};

TEST(FitContour, MeasuredContoursStayWithinToleranceAndCloseExactly) {
  auto const folder = Testing::SharedDataFolder();
  if (!folder) GTEST_SKIP() << "VORN_DATA_DIR is not set";
  for (Measured const& measured :
       {Measured{"rail_head_known_arcs", Same(0.01), false},
        Measured{"wheel_worn_a", Same(0.03), false}, Measured{"rail_worn_low", Same(0.025), false},
        Measured{"mirror_sphere_83m", Same(0.00005), false},
        Measured{"hatch_boundary", Same(0.002), true}, Measured{"glyph_five", PerPoint(2.0), true},
        Measured{"test_track_centreline", PerPoint(0.03), false},
        Measured{"gcode_letter_d", Same(0.015), true},
        Measured{"airfoil_clark_y", Same(0.0004), false},
        Measured{"airfoil_clark_y", PerPoint(0.001), false},
        Measured{"circle_r3", Same(0.001), true}, Measured{"circle_r3", Same(0.0001), true}}) {
    SCOPED_TRACE(measured.name);
    std::vector<WPoint> const points = Testing::ReadPoints(*folder + "/" + measured.name + ".csv");
    FitReport const report = FitContour(Contours::FileWith(points), measured.choice, nullptr);
    EXPECT_EQ(report.verdict, Verdict::WithinTolerance);
    EXPECT_EQ(report.closure.isClosed, measured.isClosed);
    if (measured.isClosed) {
      EXPECT_EQ(report.Gap(), 0.0);
    } else {
      EXPECT_GT(report.Gap(), 0.0);
    }
    // The contour goes from piece to piece without a gap, and arcs end on their circles.
    for (std::size_t i = 0; i < report.pieces.size(); ++i) {
      Piece const& piece = report.pieces[i];
      if (i > 0) {
        EXPECT_EQ(piece.start.x, report.pieces[i - 1].end.x) << i;
        EXPECT_EQ(piece.start.y, report.pieces[i - 1].end.y) << i;
      }
      if (!piece.IsArc()) continue;
      double const w = report.SmallestTolerance();
      for (GeometryUtils::Point const& end : {piece.start, piece.end}) {
        EXPECT_NEAR(std::hypot(end.x - piece.center.x, end.y - piece.center.y), piece.radius,
                    1e-3 * w)
            << i;
      }
    }
  }
}

TEST(FitContour, KnownCircleIsFound) {
  auto const folder = Testing::SharedDataFolder();
  if (!folder) GTEST_SKIP() << "VORN_DATA_DIR is not set";
  std::vector<WPoint> const points = Testing::ReadPoints(*folder + "/circle_r3.csv");
  FitReport const report = FitContour(Contours::FileWith(points), Same(0.001), nullptr);
  ASSERT_EQ(report.pieces.size(), 2u);
  for (Piece const& arc : report.pieces) {
    EXPECT_NEAR(arc.center.x, 0.0, 6e-5);
    EXPECT_NEAR(arc.center.y, 20.0, 6e-5);
    EXPECT_NEAR(arc.radius, 3.0, 6e-5);
    EXPECT_TRUE(arc.counterClockwise);
  }
}

}  // namespace
}  // namespace Vorn::IO
