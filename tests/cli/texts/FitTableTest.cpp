#include <gtest/gtest.h>

#include <utility>

#include "cli/texts/FitTable.h"
#include "io/Contours.h"
#include "vorn/io/FitContour.h"

namespace Vorn::Cli {
namespace {

TEST(Table, ShowsPiecesAndSummary) {
  EXPECT_EQ(
      ToTable(Contours::LineAndArcReport()),
      "part.csv, sweeps in degrees\n"
      "\n"
      "no  kind  start x  start y   end x    end y  centre x  centre y  radius  direction  "
      "  sweep  length  points\n"
      " 1  line   0.0000   0.0000  4.0000   0.0000         -         -       -  -          "
      "      -  4.0000       3\n"
      " 2  arc    4.0000   0.0000  3.0000  -1.0000    4.0000   -1.0000  1.0000  cw         "
      "270.000  4.7124       4\n"
      "\n"
      "Measured by least squares over the points of each piece, angles in degrees. A radius of "
      "the\n"
      "contour is one of those that the tolerance admits; the one here is that of the points.\n"
      "\n"
      "no  kind  points  radius  direction      +-  form error  deviation  turn to next\n"
      " 1  line       3       -      0.000    0.17     0.01000    0.00816         0.000\n"
      " 2  arc        4  1.0070          -  0.0039     0.00712    0.00557             -\n"
      "\n"
      "points      7\n"
      "tolerance   0.02 (given for all points)\n"
      "strategy    mixed\n"
      "closed      no\n"
      "pieces      2: 1 line, 1 arc\n"
      "compression 3.5 points a piece, 28.6 % of the points\n"
      "reported    0.500000 of the tolerance at point 1 (line 3)\n"
      "re-measured 0.750000 of the tolerance at point 3 (line 5), 0.015 from piece 2\n"
      "deviation   0.750000 of the tolerance at point 3 (line 5), the largest that was found\n"
      "scatter     root mean square 0.006814, mean 0.00357, none of 7 points outside\n"
      "result      within tolerance\n"
      "time        0.250 s\n");
}

TEST(Table, SaysThatTheSingleArcReportsALength) {
  FitReport report = Contours::LineAndArcReport();
  report.strategy = Strategy::Arc;
  report.fit.deviation = 0.0625;
  EXPECT_NE(ToTable(report).find("reported    0.0625 as a length (this strategy reports no "
                                 "relative deviation and no point)\n"),
            std::string::npos);
}

/// A square of side 4 with a point at every unit, from the middle of one on.
FitReport FitSquare(ClosedChoice closed) {
  std::vector<WPoint> points;
  for (int i = 0; i < 16; ++i) {
    int const k = (i + 2) % 16;
    int const side = k / 4;
    double const along = k % 4;
    points.push_back(side == 0   ? WPoint{along, 0.0, 0.0}
                     : side == 1 ? WPoint{4.0, along, 0.0}
                     : side == 2 ? WPoint{4.0 - along, 4.0, 0.0}
                                 : WPoint{0.0, 4.0 - along, 0.0});
  }
  FitChoice choice;
  choice.strategy = Strategy::Mixed;
  choice.tolerance.same = 0.01;
  choice.closed = closed;
  choice.start = closed == ClosedChoice::No ? std::optional<std::size_t>() : 2;
  return FitContour(Contours::FileWith(std::move(points)), choice, nullptr);
}

TEST(Table, TellsOfTheSeamAndTheGap) {
  std::string const closed = ToTable(FitSquare(ClosedChoice::Auto));
  EXPECT_NE(closed.find("closed      yes (the ends are as near as neighbours), joined exactly at "
                        "point 2 (line 4)\n"),
            std::string::npos)
      << closed;
  std::string const open = ToTable(FitSquare(ClosedChoice::No));
  EXPECT_NE(open.find("closed      no (as asked for)\n"), std::string::npos) << open;
}

}  // namespace
}  // namespace Vorn::Cli
