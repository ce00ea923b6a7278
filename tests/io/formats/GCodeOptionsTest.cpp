#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "io/FormatContours.h"
#include "io/formats/NamedFields.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;

constexpr double kInfinity = std::numeric_limits<double>::infinity();

std::vector<std::string> LinesOf(std::string const& text) {
  std::vector<std::string> lines;
  std::size_t at = 0;
  while (at < text.size()) {
    std::size_t const end = text.find('\n', at);
    lines.push_back(text.substr(at, end - at));
    at = end + 1;
  }
  return lines;
}

std::string RefusalOf(ContourFile const& contour, GCodeOptions const& options) {
  return Refusal([&] { ToGCode(contour, options); }, FailureKind::BadArgument);
}

TEST(GCodeDecimals, MillimetresHaveFourAndInchesFive) {
  for (char const* units : {"mm", "", "MM", "millimetre", "parsec"}) {
    EXPECT_EQ(GCodeDecimals(units, {}), 4) << units;
  }
  for (char const* units : {"in", "Inch", "INCHES"}) EXPECT_EQ(GCodeDecimals(units, {}), 5);
}

TEST(GCodeDecimals, TheLastDigitIsAHundredthOfTheToleranceOrLess) {
  for (double tolerance = 1.0; tolerance > 1e-12; tolerance *= 0.37) {
    int const decimals = GCodeDecimals("mm", tolerance);
    EXPECT_LE(std::pow(10.0, -decimals), 0.01 * tolerance * (1.0 + 1e-12)) << tolerance;
    if (decimals > 4) {
      EXPECT_GT(std::pow(10.0, 1 - decimals), 0.01 * tolerance) << "one digit less would do";
    }
  }
  EXPECT_EQ(GCodeDecimals("mm", 0.01), 4);
  EXPECT_EQ(GCodeDecimals("mm", 0.0099), 5);
}

TEST(GCodeDecimals, NeverMoreThanADoubleHolds) {
  EXPECT_EQ(GCodeDecimals("mm", 1e-13), kMostGCodeDecimals);
  EXPECT_EQ(GCodeDecimals("mm", 1e-300), kMostGCodeDecimals);
  EXPECT_EQ(GCodeDecimals("mm", 0.0), kMostGCodeDecimals);
}

TEST(GCodeDecimals, WhatIsNoToleranceAsksForNothing) {
  for (double const tolerance : {std::nan(""), -0.001, -kInfinity, kInfinity, 1e300}) {
    EXPECT_EQ(GCodeDecimals("mm", tolerance), 4) << tolerance;
    EXPECT_EQ(GCodeDecimals("inch", tolerance), 5) << tolerance;
  }
}

TEST(ToGCode, DecimalsAreFromNoneToFifteen) {
  EXPECT_EQ(RefusalOf(Wedge(), WithDecimals(-1)),
            "part.json: G-code has from 0 to 15 decimals, not -1");
  EXPECT_EQ(RefusalOf(Wedge(), WithDecimals(16)),
            "part.json: G-code has from 0 to 15 decimals, not 16");
  EXPECT_EQ(RefusalOf(Wedge(), WithDecimals(1000000)),
            "part.json: G-code has from 0 to 15 decimals, not 1000000");
  EXPECT_NE(ToGCode(Wedge(), WithDecimals(0)).find("G1 X4 Y0\n"), std::string::npos);
  EXPECT_EQ(RefusalOf(Wedge(), WithDecimals(15)),
            "part.json: G-code with 15 decimals cannot hold 4");
  EXPECT_NE(ToGCode(Wedge(), WithDecimals(14)).find("G1 X4.00000000000000"), std::string::npos);
}

TEST(ToGCode, EndsAsAsked) {
  GCodeOptions options;
  EXPECT_EQ(LinesOf(ToGCode(Wedge(), options)).back(), "M2");
  options.end = GCodeOptions::End::M30;
  EXPECT_EQ(LinesOf(ToGCode(Wedge(), options)).back(), "M30");
  options.end = GCodeOptions::End::None;
  EXPECT_EQ(LinesOf(ToGCode(Wedge(), options)).back().substr(0, 2), "G1");
}

TEST(ToGCode, HeaderAndFooterStandAroundThePathWithTheirFieldsFilledIn) {
  GCodeOptions options;
  options.feed = 250.0;
  options.tolerance = 0.02;
  options.header = "(file {name}, {units}, within {tolerance})\nS1000 M3";
  options.footer = "(feed {feed}, {pieces} pieces)\nM5\n";
  std::vector<std::string> const lines = LinesOf(ToGCode(Wedge(), options));
  EXPECT_EQ(lines[0], "(file part.json, mm, within 0.02)");
  EXPECT_EQ(lines[1], "S1000 M3");
  EXPECT_EQ(lines[2], "G21");
  EXPECT_EQ(lines[lines.size() - 3], "(feed 250, 3 pieces)");
  EXPECT_EQ(lines[lines.size() - 2], "M5");
  EXPECT_EQ(lines.back(), "M2");
}

TEST(ToGCode, FieldsThatAreNotKnownAreEmptyAndUnknownOnesRefused) {
  GCodeOptions options;
  options.header = "({tolerance}|{feed}|{units})";
  ContourFile contour = Wedge();
  contour.units.clear();
  EXPECT_EQ(LinesOf(ToGCode(contour, options)).front(), "(||)");
  options.header = "({speed})";
  EXPECT_EQ(RefusalOf(Wedge(), options),
            "'{speed}' is none of the fields {name}, {units}, {tolerance}, {feed}, {pieces}, "
            "{length}, {date}");
}

TEST(ToGCode, HeightsLiftTheToolOverGapsAndPlungeBeforeCuts) {
  GCodeOptions options;
  options.safeHeight = 5.0;
  options.cutHeight = -1.0;
  options.feed = 300.0;
  options.plungeFeed = 80.0;
  std::vector<std::string> const expected = {"G0 Z5.0000",      "G0 X0.0000 Y0.0000",
                                             "G1 Z-1.0000 F80", "G1 X1.0000 Y0.0000 F300",
                                             "G0 Z5.0000",      "G0 X1.5000 Y0.0000",
                                             "G1 Z-1.0000 F80", "G1 X2.0000 Y3.0000 F300",
                                             "G0 Z5.0000",      "M2"};
  std::vector<std::string> const lines = LinesOf(ToGCode(WithGap(), options));
  ASSERT_GE(lines.size(), expected.size());
  EXPECT_EQ(std::vector<std::string>(lines.end() - 10, lines.end()), expected);
}

TEST(ToGCode, ThePlungeTakesTheFeedOfTheCutWhereItHasNone) {
  GCodeOptions options;
  options.safeHeight = 5.0;
  options.cutHeight = 0.0;
  options.feed = 300.0;
  std::string const text = ToGCode(WithGap(), options);
  EXPECT_NE(text.find("G1 Z0.0000 F300\nG1 X1.0000 Y0.0000\n"), std::string::npos) << text;
  EXPECT_EQ(text.find("F300", text.find("F300") + 1), std::string::npos) << "said once";
}

TEST(ToGCode, ThePlaneOfALatheHasXAndZAndMirroredArcs) {
  GCodeOptions options;
  options.plane = GCodeOptions::Plane::G18;
  std::string const text = ToGCode(Wedge(), options);
  EXPECT_NE(text.find("G18 G90 G91.1\n"), std::string::npos);
  EXPECT_NE(text.find("G1 X4.0000 Z0.0000\n"), std::string::npos);
  // The quarter is clockwise in X and Y, and so G3 where Z turns into X.
  EXPECT_NE(text.find("G3 X5.0000 Z-1.0000 I0.0000 K-1.0000\n"), std::string::npos) << text;
  options.safeHeight = 1.0;
  EXPECT_EQ(RefusalOf(Wedge(), options),
            "part.json: heights are for the plane of X and Y, not for X and Z");
}

TEST(ToGCode, TheWrittenPlaneReadsBackAsTheSameCurve) {
  for (std::uint64_t seed = 0; seed < 30; ++seed) {
    ContourFile const contour = RandomContour(seed, 10.0);
    for (bool const useRadiusWords : {false, true}) {
      for (auto const plane : {GCodeOptions::Plane::G17, GCodeOptions::Plane::G18}) {
        GCodeOptions options = WithDecimals(6);
        options.plane = plane;
        options.useRadiusWords = useRadiusWords;
        std::string const text = ToGCode(contour, options);
        double const apart = Apart(contour.pieces, ParseGCode(text, "p.nc").pieces);
        // With R the centre moves by up to twice the rounding of R.
        EXPECT_LE(apart, 1e-5) << seed << (useRadiusWords ? " with R" : " with I and J");
      }
    }
  }
}

TEST(ToGCode, RadiusWordsAreForArcsOfAThirdOfACircleAtMost) {
  ContourFile contour;
  contour.units = "mm";
  contour.pieces = {MakeArc({1, 0}, {-1, 0}, {0, 0}, 1.0, true)};
  GCodeOptions options;
  options.useRadiusWords = true;
  std::string const text = ToGCode(contour, options);
  EXPECT_EQ(text.find(" I"), std::string::npos);
  // Half a circle is two quarters.
  EXPECT_NE(text.find("G3 X0.0000 Y1.0000 R1.0000\nG3 X-1.0000 Y0.0000 R1.0000\n"),
            std::string::npos)
      << text;
}

TEST(ToGCode, UnitsThatNoMachineKnowsAreRefusedWithHelp) {
  ContourFile contour = Wedge();
  contour.units = "ft";
  try {
    ToGCode(contour);
    ADD_FAILURE() << "feet";
  } catch (Failure const& failure) {
    EXPECT_EQ(failure.Help(), Remedy::ChooseUnits);
    EXPECT_EQ(failure.Message(), "G-code is in mm or inch, and the contour is in 'ft'");
  }
}

TEST(FilledIn, ReplacesWordsInBracesAndNothingElse) {
  std::vector<NamedField> const fields = {{"a", "{b}"}, {"b", "two"}};
  EXPECT_EQ(FilledIn("", fields), "");
  EXPECT_EQ(FilledIn("{a}{b}", fields), "{b}two") << "what is put in is not looked at again";
  for (char const* text : {"{", "}", "{}", "{ a}", "{a", "{a b}", "{1}", "{{1}}", "{a-b}"}) {
    EXPECT_EQ(FilledIn(text, fields), text);
  }
  EXPECT_EQ(FilledIn("{{a}}", fields), "{{b}}");
}

TEST(Today, IsADate) {
  std::string const today = Today();
  ASSERT_EQ(today.size(), 10u);
  EXPECT_EQ(today[4], '-');
  EXPECT_EQ(today[7], '-');
  EXPECT_GE(today.substr(0, 4), "2024");
}

}  // namespace
}  // namespace Vorn::IO
