#include <cmath>
#include <nlohmann/json.hpp>
#include <numbers>

#include "cli/ProgramFixture.h"

namespace Vorn::Cli::Testing {
namespace {

std::string Circle(double x, double radius) {
  return "0\nCIRCLE\n8\n0\n10\n" + std::to_string(x) + "\n20\n0\n40\n" + std::to_string(radius) +
         "\n";
}

std::string Line(int x1, int y1, int x2, int y2) {
  return "0\nLINE\n8\n0\n10\n" + std::to_string(x1) + "\n20\n" + std::to_string(y1) + "\n11\n" +
         std::to_string(x2) + "\n21\n" + std::to_string(y2) + "\n";
}

std::string Drawing(std::string const& entities) {
  return "0\nSECTION\n2\nENTITIES\n" + entities + "0\nENDSEC\n0\nEOF\n";
}

TEST_F(Program, TheAreaOfTwoCirclesHasTheHoleTakenOff) {
  Write("ring.dxf", Drawing(Circle(0, 10) + Circle(0, 3)));
  Ended const ended = Run("area ring.dxf");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_NE(ended.out.find("ring.dxf, outline 2 (a hole): 2 pieces"), std::string::npos)
      << ended.out;
  EXPECT_NE(
      ended.out.find("ring.dxf: 2 outlines, 1 hole\narea        285.8849315, holes taken off"),
      std::string::npos)
      << ended.out;
  auto const document = nlohmann::json::parse(Run("area ring.dxf --json").out);
  EXPECT_NEAR(document.at("netArea").get<double>(), 91.0 * std::numbers::pi, 1e-10);
  EXPECT_EQ(document.at("contours").at(1).at("isHole"), true);
  auto const one = nlohmann::json::parse(Run("area ring.dxf --json --outline 2").out);
  EXPECT_NEAR(one.at("netArea").get<double>(), 9.0 * std::numbers::pi, 1e-12);
}

TEST_F(Program, UnsortedLinesAreChained) {
  Write("square.dxf",
        Drawing(Line(0, 0, 10, 0) + Line(10, 10, 0, 10) + Line(10, 0, 10, 10) + Line(0, 10, 0, 0)));
  auto const document = nlohmann::json::parse(Run("area square.dxf --json").out);
  EXPECT_EQ(document.at("netArea"), 100.0);
  EXPECT_TRUE(document.at("contours").at(0).at("gaps").empty());
  Ended const ended = Run("convert square.dxf -o square.json");
  EXPECT_EQ(ended.err, "");
  EXPECT_EQ(nlohmann::json::parse(Contents(folder_ / "square.json")).at("closed"), true);
}

TEST_F(Program, OneOutlineCanBeChosen) {
  Write("two.dxf", Drawing(Circle(0, 1) + Circle(10, 2)));
  EXPECT_EQ(Run("convert two.dxf -o one.json --outline 2").code, 0);
  auto const document = nlohmann::json::parse(Contents(folder_ / "one.json"));
  EXPECT_EQ(document.at("elements").at(0).at("radius"), 2.0);
  Write("p.csv", "12,0\n8,0\n");
  EXPECT_EQ(Run("check p.csv two.dxf -t 0.1 --outline 2").code, 0);
  EXPECT_EQ(Run("check p.csv two.dxf -t 0.1 --outline 1").code, 1);
  ExpectRefusal("convert two.dxf -o one.json --outline 3", 2,
                "two.dxf: there is no outline 3, the file has 2 outlines");
}

TEST_F(Program, IntersectTakesAnOutlineOfEitherFile) {
  Write("two.dxf", Drawing(Circle(0, 2) + Circle(3, 2)));
  auto const meetings = [&](std::string const& arguments) {
    return nlohmann::json::parse(Run("intersect two.dxf two.dxf --json " + arguments).out)
        .at("intersections")
        .size();
  };
  // Circles of radius 2 about (0, 0) and (3, 0) cross in two points.
  EXPECT_EQ(meetings("--outline 1 --outline-b 2"), 2u);
  EXPECT_EQ(meetings("--outline 2 --outline-b 1"), 2u);
  ExpectRefusal("intersect two.dxf two.dxf --outline-b 3", 2,
                "two.dxf: there is no outline 3, the file has 2 outlines");
  EXPECT_EQ(Run("intersect two.dxf --outline-b 1").code, 2);
}

TEST_F(Program, HeightsOfAFileAreToldAsDropped) {
  Write("p.wkt", "LINESTRING Z (0 0 1, 3 4 1)");
  Ended const ended = Run("convert p.wkt -o p.json");
  EXPECT_EQ(ended.code, 0);
  std::string const told = "contour: p.wkt: dropped the coordinates beside x and y\n";
  EXPECT_EQ(ended.err, told);
  for (char const* line : {"fit p.wkt -t 0.1", "info p.wkt", "check p.wkt p.json -t 0.1",
                           "plot p.wkt -o p.svg", "simplify p.wkt --spacing 1 -o p.csv"}) {
    EXPECT_TRUE(Run(line).err.starts_with(told)) << line;
  }
}

TEST_F(Program, HeightsOfEachOfManyFilesAreToldAsDropped) {
  Write("flat.wkt", "LINESTRING (0 0, 3 4)");
  Write("p.wkt", "LINESTRING Z (0 0 1, 3 4 1)");
  Ended const ended = Run("fit flat.wkt p.wkt -t 0.1 --out-dir out");
  EXPECT_EQ(ended.code, 0);
  EXPECT_EQ(ended.err, "contour: p.wkt: dropped the coordinates beside x and y\n");
}

}  // namespace
}  // namespace Vorn::Cli::Testing
