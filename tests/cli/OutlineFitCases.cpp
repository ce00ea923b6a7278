#include <gtest/gtest.h>

#include <algorithm>
#include <nlohmann/json.hpp>

#include "cli/ProgramFixture.h"

// Points from drawings, and contours in the formats of cutters and of maps.
namespace Vorn::Cli::Testing {
namespace {

/// A square of 20 by 20 with a point every 5, and a bend of two lines beside it.
constexpr char const* kTwoOutlines =
    "<svg xmlns='http://www.w3.org/2000/svg' width='100mm' height='100mm' viewBox='0 0 100 100'>\n"
    "<polygon points='0,0 5,0 10,0 15,0 20,0 20,5 20,10 20,15 20,20 15,20 10,20 5,20 0,20 0,15 "
    "0,10 0,5'/>\n"
    "<polyline points='40,0 45,0 50,0 50,5 50,10'/>\n</svg>\n";

class OutlineFit : public Program {};

TEST_F(OutlineFit, SeveralOutlinesGoIntoEveryFile) {
  Write("two.svg", kTwoOutlines);
  for (char const* name : {"a.dxf", "a.nc", "a.json", "a.csv", "a.wkt", "a.geojson"}) {
    Ended const ended = Run("fit two.svg -t 0.1 --feed 100 -o " + std::string(name));
    EXPECT_EQ(ended.code, 0) << name << ended.err;
    EXPECT_NE(ended.out.find("outlines    2: 22 points, "), std::string::npos) << ended.out;
    EXPECT_NE(ended.out.find("result      within tolerance\n"), std::string::npos) << ended.out;
    Ended const first = Run("area --outline 1 " + std::string(name));
    EXPECT_EQ(first.code, 0) << name << first.err;
    EXPECT_EQ(Run("area --outline 2 " + std::string(name)).code, 2) << "the second is open";
    EXPECT_EQ(Run("check two.svg " + std::string(name) + " -t 0.1").code, 0) << name;
  }
}

TEST_F(OutlineFit, JsonHasARecordOfEachOutline) {
  Write("two.svg", kTwoOutlines);
  ASSERT_EQ(Run("fit two.svg -t 0.1 --strategy fewest -o a.json").code, 0);
  nlohmann::json const all = nlohmann::json::parse(Contents(folder_ / "a.json"));
  nlohmann::json const& outlines = all.at("outlines");
  ASSERT_EQ(outlines.size(), 2U);
  EXPECT_EQ(outlines[0].at("points").at("count").get<int>() +
                outlines[1].at("points").at("count").get<int>(),
            22);
  EXPECT_EQ(outlines[1].at("points").at("first"), outlines[0].at("points").at("count"));
  EXPECT_EQ(outlines[0].at("elements").at("count").get<std::size_t>() + 1,
            outlines[1].at("elements").at("first").get<std::size_t>());
  EXPECT_EQ(outlines[0].at("closed"), true);
  EXPECT_EQ(outlines[1].at("closed"), false);
  EXPECT_EQ(outlines[1].at("counts").at("elements"), 2);
  EXPECT_EQ(outlines[1].at("counts").at("fewestPossible"), 2);
  double largest = 0.0;
  int bound = 0;
  for (nlohmann::json const& outline : outlines) {
    bound += outline.at("counts").at("fewestPossible").get<int>();
    largest = std::max(largest, outline.at("deviation").at("largest").at("value").get<double>());
  }
  EXPECT_EQ(all.at("counts").at("fewestPossible"), bound);
  EXPECT_EQ(all.at("deviation").at("largest").at("value"), largest);
}

TEST_F(OutlineFit, OneOutlineCanBeChosen) {
  Write("two.svg", kTwoOutlines);
  Ended const ended = Run("fit two.svg -t 0.1 --outline 2 -o b.json");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_NE(ended.out.find("pieces      2 (proven the fewest): 2 lines, 0 arcs"), std::string::npos)
      << ended.out;
  ExpectRefusal("fit two.svg -t 0.1 --outline 3", 2,
                "two.svg: there is no outline 3, the file has 2 outlines");
  ExpectRefusal("info two.svg", 2, "two.svg: holds 2 outlines: --outline N takes one of them");
}

TEST_F(OutlineFit, ASeamIsForOneOutline) {
  Write("two.svg", kTwoOutlines);
  ExpectRefusal("fit two.svg -t 0.1 --strategy mixed --start 3", 2,
                "--start is for one outline, and there are 2: --outline N takes one of them");
}

TEST_F(OutlineFit, ManyFilesMayHoldSeveralOutlinesEach) {
  Write("two.svg", kTwoOutlines);
  Write("corner.csv", Corner());
  Ended const ended = Run("fit two.svg corner.csv -t 0.1 --out-dir out --no-time");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_NE(ended.out.find("two.svg            22"), std::string::npos) << ended.out;
}

TEST_F(OutlineFit, ArcsBecomePointsWhenAskedFor) {
  Write("slot.dxf",
        "0\nSECTION\n2\nENTITIES\n0\nLWPOLYLINE\n8\n0\n90\n4\n70\n1\n10\n0\n20\n0\n10\n20\n20\n0\n"
        "42\n1\n10\n20\n20\n10\n10\n0\n20\n10\n42\n1\n0\nENDSEC\n0\nEOF\n");
  ExpectRefusal("fit slot.dxf -t 0.01", 3,
                "slot.dxf:5: entity 1 (LWPOLYLINE): an arc from (20, 0) to (20, 10); --flatten T "
                "takes chords of arcs and curves");
  Ended const ended = Run("fit slot.dxf -t 0.01 --flatten 0.002 -o slot.json");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_EQ(Run("check slot.dxf slot.json -t 0.01 --flatten 0.0001").code, 0);
}

TEST_F(OutlineFit, TheFormatOfPointsCanBeSaid) {
  Write("path.txt", "G21\nG0 X0 Y0\nG1 X5\nX10\nY5\nY10\nM2\n");
  Ended const ended = Run("fit path.txt --points-from gcode -t 0.1 --strategy mixed");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_NE(ended.out.find("pieces      2: 2 lines"), std::string::npos) << ended.out;
}

TEST_F(OutlineFit, PlainSvgIsReadBackAndMeasured) {
  Write("part.csv", "# units mm\n" + Corner());
  Ended const ended = Run("fit part.csv -t 0.1 --svg-plain -o part.svg");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_NE(ended.out.find("of the tolerance at "), std::string::npos);
  EXPECT_NE(ended.out.find(" in part.svg\n"), std::string::npos) << ended.out;
  EXPECT_EQ(Run("check part.csv part.svg -t 0.1").code, 0);
  EXPECT_NE(Contents(folder_ / "part.svg").find("mm\" viewBox="), std::string::npos);
}

TEST_F(OutlineFit, PlainSvgRefusesOtherUnits) {
  Write("part.csv", "# units m\n" + Corner());
  Ended const ended = Run("fit part.csv -t 0.1 --svg-plain -o part.svg");
  EXPECT_EQ(ended.code, 2) << ended.err;
  EXPECT_NE(ended.err.find("a plain SVG is in mm or inch, and the units are 'm'"),
            std::string::npos);
}

TEST_F(OutlineFit, GeoJsonNeedsToKnowHowFarChordsMayBe) {
  Write("half.wkt", "CIRCULARSTRING (1 0, 0 1, -1 0)\n");
  ExpectRefusal("convert half.wkt -o half.geojson", 2,
                "half.wkt: GeoJSON has no arcs; --chords T says how far chords may be from them");
  Ended const ended = Run("convert half.wkt -o half.geojson --chords 0.01");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_NE(Contents(folder_ / "half.geojson").find("\"chordTolerance\":0.01"), std::string::npos);
  EXPECT_EQ(Run("convert half.wkt -o half.geojson -t 0.01").code, 0);
  EXPECT_EQ(Run("convert half.wkt -o half.geojson -t 0.01 --chords 0.5").code, 1);
}

TEST_F(OutlineFit, BrokenDrawingsNameThePlace) {
  Write("a.svg", "<svg>\n<path d='M0 0 Q'/></svg>");
  ExpectRefusal("fit a.svg -t 1", 3, "a.svg:2:1: path: the text of an attribute stops early");
  Write("b.geojson", "{\"type\":\"LineString\",\"coordinates\":[[0,0],[NaN,1]]}");
  EXPECT_EQ(Run("fit b.geojson -t 1").code, 3);
  Write("c.dxf", "0\nSECTION\n2\nENTITIES\n0\nSPLINE\n71\n3\n0\nENDSEC\n0\nEOF\n");
  ExpectRefusal("convert c.dxf -o - --to wkt --flatten 1", 3,
                "c.dxf:5: entity 1 (SPLINE): has no control points, only fit points or none");
}

}  // namespace
}  // namespace Vorn::Cli::Testing
