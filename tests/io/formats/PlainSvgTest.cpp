#include <gtest/gtest.h>

#include <cmath>

#include "io/FormatContours.h"
#include "io/formats/Svg.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;

ContourFile Of(std::vector<Piece> pieces, std::string units = "mm", bool isClosed = false) {
  ContourFile contour;
  contour.path = "p.json";
  contour.pieces = std::move(pieces);
  contour.units = std::move(units);
  contour.isClosed = isClosed;
  return contour;
}

/// What stands between the quotes behind `name="`, the first time.
std::string Attribute(std::string const& text, std::string const& name) {
  std::size_t const begin = text.find(name + "=\"") + name.size() + 2;
  return text.substr(begin, text.find('"', begin) - begin);
}

TEST(ToPlainSvg, LinesAndArcsAreAPathWithYDown) {
  std::string const text =
      ToPlainSvg(Of({MakeLine({0, 0}, {4, 0}), MakeArc({4, 0}, {5, -1}, {4, -1}, 1, false)}));
  EXPECT_NE(text.find("<path d=\"M 0.0 0.0 L 4.0 0.0 A 1.0 1.0 0 0 1 5.0 1.0\"/>"),
            std::string::npos)
      << text;
}

TEST(ToPlainSvg, ClosedOutlinesEndWithAZ) {
  EXPECT_NE(ToPlainSvg(Wedge()).find(" Z\"/>"), std::string::npos);
  EXPECT_EQ(ToPlainSvg(WithGap()).find('Z'), std::string::npos);
}

TEST(ToPlainSvg, ThePageIsAsLargeAsTheContourAndTheLinesAreWide) {
  std::string const text = ToPlainSvg(Of({MakeLine({10, 20}, {40, 35})}));
  EXPECT_EQ(std::stod(Attribute(text, "width")), 30.2);
  EXPECT_EQ(std::stod(Attribute(text, "height")), 15.2);
  EXPECT_TRUE(Attribute(text, "width").ends_with("mm"));
  EXPECT_EQ(Attribute(text, "viewBox"), "9.9 -35.1 30.2 15.2");
}

TEST(ToPlainSvg, ThePageOfInchesIsInInches) {
  std::string const text = ToPlainSvg(Of({MakeLine({0, 0}, {3, 4})}, "inch"));
  EXPECT_TRUE(Attribute(text, "width").ends_with("in"));
  EXPECT_NEAR(std::stod(Attribute(text, "width")), 3.0 + 2.0 * 0.1 / 25.4, 1e-12);
  EXPECT_EQ(ParseSvg(text, "p.svg", {}).units, "inch");
}

TEST(ToPlainSvg, WithoutUnitsMillimetresAreMeantAndOthersRefused) {
  EXPECT_TRUE(Attribute(ToPlainSvg(Of({MakeLine({0, 0}, {1, 0})}, "")), "width").ends_with("mm"));
  try {
    ToPlainSvg(Of({MakeLine({0, 0}, {1, 0})}, "ft"));
    ADD_FAILURE() << "feet";
  } catch (Failure const& failure) {
    EXPECT_EQ(failure.Kind(), FailureKind::BadArgument);
    EXPECT_EQ(failure.Help(), Remedy::ChooseUnits);
    EXPECT_STREQ(failure.what(), "p.json: a plain SVG is in mm or inch, and the units are 'ft'");
  }
}

TEST(ToPlainSvg, ArcsAreDividedSoThatNoneTurnsByMoreThanAThird) {
  std::string const text = ToPlainSvg(Of(MakeCircle({5, 0}, {0, 0}, 5, true)));
  std::size_t arcs = 0;
  for (char const c : text) arcs += c == 'A' ? 1 : 0;
  EXPECT_EQ(arcs, 4u) << "each half in two quarters";
  EXPECT_EQ(text.find(" 0 1 "), std::string::npos) << "no large arc";
}

TEST(ToPlainSvg, ReadsBackAsTheSameCurve) {
  for (std::string const units : {"mm", "inch", ""}) {
    for (std::uint64_t seed = 0; seed < 40; ++seed) {
      ContourFile contour = RandomContour(seed, 10.0);
      contour.units = units;
      ContourFile const read = ParseSvg(ToPlainSvg(contour), "p.svg", {});
      // An arc of up to 120 degrees is told by its ends and radius: half of its chord is not more
      // than 0.87 of the radius, so a rounding of either moves the centre by some of them.
      EXPECT_LE(Apart(contour.pieces, read.pieces), 1e-13 * ScaleOf(contour.pieces)) << seed;
      EXPECT_EQ(read.units, units.empty() ? "mm" : units);
    }
  }
}

TEST(ToPlainSvg, OutlinesStayApartAndClosed) {
  std::vector<Piece> pieces = MakeCircle({9, 0}, {0, 0}, 9, true);
  for (Piece const& half : MakeCircle({4, 0}, {0, 0}, 4, false)) pieces.push_back(half);
  std::string const text = ToPlainSvg(Of(pieces));
  std::size_t paths = 0;
  for (std::size_t at = text.find("<path"); at != std::string::npos;
       at = text.find("<path", at + 1))
    ++paths;
  EXPECT_EQ(paths, 2u);
  EXPECT_EQ(RunsOf(ParseSvg(text, "p.svg", {})).size(), 2u);
}

TEST(ToPlainSvg, ZeroIsWrittenWithoutASign) {
  EXPECT_EQ(ToPlainSvg(Of({MakeLine({0, 0}, {1, 0}), MakeLine({1, 0}, {1, -0.0})})).find("-0.0 "),
            std::string::npos);
}

}  // namespace
}  // namespace Vorn::IO
