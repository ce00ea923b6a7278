// What readers refuse, and rare shapes that they take, beside the cases of each format.
#include <gtest/gtest.h>

#include <cmath>

#include "io/FormatContours.h"
#include "vorn/io/Formats.h"
#include "vorn/io/PointOutlines.h"

namespace Vorn::IO {
namespace {

using FormatContours::Refusal;

std::string Complaint(std::string const& text, Format format) {
  return Refusal([&] { ParseContour(text, "p", format); });
}

/// A file of DXF with these groups between blanks.
std::string Dxf(std::string const& entities) {
  std::string text = "0 SECTION 2 ENTITIES " + entities + " 0 ENDSEC 0 EOF ";
  for (char& c : text) {
    if (c == ' ') c = '\n';
  }
  return text;
}

std::string Svg(std::string const& shapes) {
  return "<svg xmlns=\"http://www.w3.org/2000/svg\">" + shapes + "</svg>";
}

TEST(ParseDxf, MissingGroupsAreNamed) {
  EXPECT_EQ(Complaint(Dxf("0 LINE 10 0 20 0 11 1"), Format::Dxf),
            "p:5: entity 1 (LINE): group 21 is missing");
  EXPECT_EQ(Complaint(Dxf("0 CIRCLE 10 0 20 0"), Format::Dxf),
            "p:5: entity 1 (CIRCLE): group 40 is missing");
}

TEST(ParseDxf, FlagsAreWholeNumbersOfSixteenBits) {
  for (std::string const flags : {"1.5", "-1", "32768"}) {
    EXPECT_EQ(Complaint(Dxf("0 LWPOLYLINE 70 " + flags + " 10 0 20 0 10 1 20 0"), Format::Dxf),
              "p:5: entity 1 (LWPOLYLINE): group 70 holds no flags but " + flags);
  }
  EXPECT_EQ(ParseContour(Dxf("0 LWPOLYLINE 70 32766 10 0 20 0 10 1 20 0"), "p").pieces.size(), 1u);
}

TEST(ParseDxf, APolylineOnTheBackOfThePlaneIsMirrored) {
  std::string const vertices = "10 1 20 0 10 3 20 0 42 1 10 3 20 2";
  std::vector<Piece> const front =
      ParseContour(Dxf("0 LWPOLYLINE 70 0 " + vertices), "p.dxf").pieces;
  std::vector<Piece> const back =
      ParseContour(Dxf("0 LWPOLYLINE 70 0 230 -1 " + vertices), "p.dxf").pieces;
  ASSERT_EQ(front.size(), 2u);
  ASSERT_EQ(back.size(), 2u);
  for (std::size_t i = 0; i < 2; ++i) {
    EXPECT_EQ(back[i].start.x, -front[i].start.x);
    EXPECT_EQ(back[i].start.y, front[i].start.y);
    EXPECT_EQ(back[i].end.x, -front[i].end.x);
    EXPECT_NEAR(back[i].length, front[i].length, 1e-15);
  }
  EXPECT_TRUE(front[1].counterClockwise);
  EXPECT_FALSE(back[1].counterClockwise);
  EXPECT_EQ(back[1].sweep, front[1].sweep);
}

TEST(ParseWkt, AMemberThatIsNoCurveIsNamed) {
  EXPECT_EQ(Complaint("MULTICURVE (POINT (0 0))", Format::Wkt),
            "p:1:13: 'POINT' is no curve that holds a contour");
}

TEST(ParseGCode, ThePlaneAndTheUnitsStayWithinAContour) {
  std::string const begin = "G17 G21 G90\nG0 X0 Y0\nG1 X5\n";
  EXPECT_NE(Complaint(begin + "G18\n", Format::GCode).find("the plane changes within the contour"),
            std::string::npos);
  EXPECT_NE(Complaint(begin + "G20\n", Format::GCode).find("the units change within the contour"),
            std::string::npos);
  EXPECT_TRUE(Complaint(begin + "G20\n", Format::GCode).starts_with("p:4:"));
  EXPECT_EQ(ParseContour(begin + "G17\nG21\nG1 Y5\n", "p.nc").pieces.size(), 2u)
      << "the same again";
  EXPECT_EQ(ParseContour("G20\n" + begin, "p.nc").units, "mm") << "before the first piece";
}

TEST(ParseSvg, ALetterThatIsNoCommandIsNamed) {
  EXPECT_NE(Complaint(Svg("<path d='M0 0 K 1 1'/>"), Format::Svg)
                .find("stands behind 'K', which is no command"),
            std::string::npos);
  EXPECT_NE(Complaint(Svg("<path d='L 1 1'/>"), Format::Svg).find("is drawn before the first move"),
            std::string::npos);
}

TEST(ParseSvg, ATransformWithinAStyleIsRefused) {
  EXPECT_NE(Complaint(Svg("<line style='fill:red; transform : scale(2)' x2='1'/>"), Format::Svg)
                .find("a transform within a style is not supported"),
            std::string::npos);
  EXPECT_EQ(Complaint(Svg("<line style='display : none' x2='1'/>"), Format::Svg),
            "p: holds no contour: there are no pieces");
}

TEST(ParseSvg, HalfAxesTooShortForTheEndsGrow) {
  // From (0, 0) to (10, 0) the half axes 1 and 0.5 become 5 and 2.5.
  ContourFile const contour =
      ParseContour(Svg("<path d='M0 0 A 1 0.5 0 0 1 10 0'/>"), "p.svg", ReadOptions{{}, 1e-4});
  Extent const extent = ExtentOf(contour.pieces);
  EXPECT_NEAR(extent.low.x, 0.0, 1e-3);
  EXPECT_NEAR(extent.high.x, 10.0, 1e-3);
  EXPECT_NEAR(std::max(std::fabs(extent.low.y), std::fabs(extent.high.y)), 2.5, 1e-3);
}

TEST(ParsePointOutlines, RunsThatMeetEndToEndAreTurned) {
  std::vector<PointFile> const outlines =
      ParsePointOutlines("MULTILINESTRING ((0 0, 1 0, 2 0), (4 0, 3 0, 2 0))", "p.wkt", {});
  ASSERT_EQ(outlines.size(), 1u);
  ASSERT_EQ(outlines[0].points.size(), 5u);
  for (std::size_t i = 0; i < 5; ++i) {
    EXPECT_EQ(outlines[0].points[i].x, static_cast<double>(i));
  }
}

TEST(ToText, AFormatThatIsNoneHoldsNoContour) {
  auto const none = static_cast<Format>(99);
  EXPECT_EQ(NameOf(none), "unknown");
  EXPECT_EQ(Refusal([&] { ToText(FormatContours::Wedge(), none, {}); }, FailureKind::BadArgument),
            "unknown holds no contour");
}

}  // namespace
}  // namespace Vorn::IO
