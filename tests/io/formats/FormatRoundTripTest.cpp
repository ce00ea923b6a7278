// Every format: written, read back and measured again.
#include <gtest/gtest.h>

#include <cstdio>
#include <sstream>

#include "io/FormatContours.h"
#include "io/fit/Fit.h"
#include "io/formats/CsvPieces.h"
#include "io/formats/Dxf.h"
#include "io/formats/GCode.h"
#include "io/formats/JsonPieces.h"
#include "io/formats/Wkt.h"
#include "support/SharedData.h"
#include "vorn/io/Formats.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;

constexpr std::uint64_t kSeeds = 100;

/// Calls the check with contours whose radii are far larger than their coordinates, and with
/// others whose radii are not.
void ForRandomContours(std::function<void(ContourFile const&)> const& check) {
  for (double const largestRadius : {1e5, 10.0}) {
    for (std::uint64_t seed = 0; seed < kSeeds; ++seed) {
      SCOPED_TRACE("seed " + std::to_string(seed) + ", radii up to " +
                   std::to_string(largestRadius));
      check(RandomContour(seed, largestRadius));
    }
  }
}

/// Bounds are parts of the largest coordinate or radius, about ten roundings.
constexpr double kRoundings = 2e-15;

void ExpectSameCurve(ContourFile const& contour, ContourFile const& read, double bound) {
  EXPECT_LE(Apart(contour.pieces, read.pieces), bound);
  EXPECT_LE(Distance(contour.pieces.front().start, read.pieces.front().start), bound);
  EXPECT_LE(Distance(contour.pieces.back().end, read.pieces.back().end), bound);
  EXPECT_TRUE(FindGaps(read).empty());
}

/// Whether a circle through the ends and the middle of the arc says less than a line, by the
/// rounding of its radius.
bool IsFlat(Piece const& arc) {
  double const rise = arc.radius * (1.0 - std::cos(arc.sweep / 2.0));
  return rise < 1e-15 * arc.radius;
}

/// The pieces have the same kinds and senses, but for wide arcs in two halves.
void ExpectSameKinds(ContourFile const& contour, ContourFile const& read) {
  std::vector<Piece> const expected = WithoutWideArcs(contour.pieces);
  ASSERT_EQ(expected.size(), read.pieces.size());
  for (std::size_t i = 0; i < expected.size(); ++i) {
    if (expected[i].IsArc() && IsFlat(expected[i]) && !read.pieces[i].IsArc()) continue;
    EXPECT_EQ(expected[i].kind, read.pieces[i].kind) << "piece " << i;
    EXPECT_EQ(expected[i].counterClockwise, read.pieces[i].counterClockwise) << "piece " << i;
  }
}

TEST(ToJson, ReadsBackAsTheSameBits) {
  ForRandomContours([](ContourFile contour) {
    for (bool const isClosed : {false, true}) {
      contour.isClosed = isClosed;
      EXPECT_TRUE(SameBits(contour, ParseJsonPieces(ToJson(contour), "p.json")));
    }
  });
}

TEST(ToCsv, ReadsBackAsTheSameBits) {
  ForRandomContours([](ContourFile contour) {
    for (bool const isClosed : {false, true}) {
      contour.isClosed = isClosed;
      EXPECT_TRUE(SameBits(contour, ParseCsvPieces(ToCsv(contour), "p.csv")));
    }
  });
}

TEST(ToDxf, PolylineReadsBackAsTheSameCurve) {
  ForRandomContours([](ContourFile const& contour) {
    ContourFile const read = ParseDxf(ToDxf(contour), "p.dxf");
    ExpectSameCurve(contour, read, kRoundings * ScaleOf(contour.pieces));
    ExpectSameKinds(contour, read);
    EXPECT_EQ(read.units, "mm");
  });
}

TEST(ToDxf, EntitiesReadBackAsTheSameCurve) {
  ForRandomContours([](ContourFile const& contour) {
    ContourFile const read = ParseDxf(ToDxf(contour, DxfStyle::Entities), "p.dxf");
    ExpectSameCurve(contour, read, kRoundings * ScaleOf(contour.pieces));
    ExpectSameKinds(contour, read);
  });
}

TEST(ToWkt, ReadsBackAsTheSameCurve) {
  ForRandomContours([](ContourFile const& contour) {
    ContourFile const read = ParseWkt(ToWkt(contour), "p.wkt");
    ExpectSameCurve(contour, read, kRoundings * ScaleOf(contour.pieces));
    ExpectSameKinds(contour, read);
  });
}

/// The largest difference of the radii at the two ends of an arc that a machine would find in the
/// text, by a reader of its own; -1 without arcs, infinite when an arc has no chord.
double LargestRadiusDifference(std::string const& gcode) {
  std::istringstream lines(gcode);
  double largest = -1.0;
  XY at;
  for (std::string line; std::getline(lines, line);) {
    int code = 0;
    XY to;
    XY way;
    int const words =
        std::sscanf(line.c_str(), "G%d X%lf Y%lf I%lf J%lf", &code, &to.x, &to.y, &way.x, &way.y);
    if (words == 5) {
      double const atStart = std::hypot(way.x, way.y);
      double const atEnd = std::hypot(at.x + way.x - to.x, at.y + way.y - to.y);
      double const difference = AreEqual(at, to) ? HUGE_VAL : std::fabs(atStart - atEnd);
      largest = std::max(largest, difference);
    }
    if (words >= 3) at = to;
  }
  return largest;
}

TEST(ToGCode, StaysWithinThreeUnitsOfItsLastDigit) {
  ForRandomContours([](ContourFile const& contour) {
    for (int const decimals : {4, 6}) {
      std::string const text = ToGCode(contour, WithDecimals(decimals));
      ExpectSameCurve(contour, ParseGCode(text, "p.nc"), 3.0 * std::pow(10.0, -decimals));
    }
  });
}

TEST(ToGCode, RadiiAtBothEndsAgreeForTheMachine) {
  int contoursWithArcs = 0;
  ForRandomContours([&](ContourFile const& contour) {
    double const difference = LargestRadiusDifference(ToGCode(contour));
    if (difference >= 0.0) ++contoursWithArcs;
    EXPECT_LE(difference, 0.0002);  // a tenth of what machines bear
    EXPECT_LE(LargestRadiusDifference(ToGCode(contour, WithDecimals(6))), 0.000002);
  });
  EXPECT_GT(contoursWithArcs, 190);
}

struct SharedContour {
  char const* name;
  std::optional<double> tolerance;
  double cap;
};

constexpr SharedContour kShared[] = {
    {"airfoil_clark_y", {}, 0.001},      {"circle_r3", 0.001, 0},
    {"gcode_letter_d", 0.015, 0},        {"glyph_five", {}, 2.0},
    {"hatch_boundary", 0.002, 0},        {"mirror_sphere_83m", 0.00005, 0},
    {"rail_head_known_arcs", 0.01, 0},   {"rail_worn_low", 0.025, 0},
    {"test_track_centreline", {}, 0.03}, {"wheel_worn_a", 0.03, 0},
};

class FormatsOfSharedContours : public testing::TestWithParam<SharedContour> {};

ContourFile FittedContour(SharedContour const& shared, std::string const& folder) {
  std::vector<WPoint> points = Testing::ReadPoints(folder + "/" + shared.name + ".csv");
  if (shared.tolerance) {
    Testing::SetTolerance(&points, *shared.tolerance);
  } else {
    Testing::SetTolerancePerPoint(&points, shared.cap);
  }
  FitAnswer const answer = Fit(points, Strategy::Mixed, nullptr);
  ContourFile contour;
  contour.path = shared.name;
  contour.units = "mm";
  contour.pieces = PiecesOf(answer.contour);
  return contour;
}

TEST_P(FormatsOfSharedContours, EveryFormatReadsBackAsTheFit) {
  auto const folder = Testing::SharedDataFolder();
  if (!folder) GTEST_SKIP() << "VORN_DATA_DIR is not set";
  ContourFile const contour = FittedContour(GetParam(), *folder);
  ASSERT_FALSE(contour.pieces.empty());
  EXPECT_TRUE(SameBits(contour.pieces[0], ParseContour(ToJson(contour), "p.json").pieces[0]));
  double const bound = kRoundings * ScaleOf(contour.pieces);
  ExpectSameCurve(contour, ParseContour(ToCsv(contour), "p.csv"), bound);
  ExpectSameCurve(contour, ParseContour(ToDxf(contour), "p.dxf"), bound);
  ExpectSameCurve(contour, ParseContour(ToDxf(contour, DxfStyle::Entities), "p.dxf"), bound);
  ExpectSameCurve(contour, ParseContour(ToWkt(contour), "p.wkt"), bound);
  std::string const gcode = ToGCode(contour);
  ExpectSameCurve(contour, ParseContour(gcode, "p.nc"), 3e-4);
  EXPECT_LE(LargestRadiusDifference(gcode), 0.0002);
}

INSTANTIATE_TEST_SUITE_P(Shared, FormatsOfSharedContours, testing::ValuesIn(kShared),
                         [](auto const& test) { return std::string(test.param.name); });

}  // namespace
}  // namespace Vorn::IO
