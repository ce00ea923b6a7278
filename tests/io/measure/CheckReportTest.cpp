#include <gtest/gtest.h>

#include <cmath>
#include <nlohmann/json.hpp>

#include "io/Contours.h"
#include "io/FormatContours.h"
#include "vorn/io/CheckReport.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;
using Json = nlohmann::json;

/// Four points against the Wedge: on it, 0.25 left, 0.5 right and 0.25 right of its first side.
PointFile PointsAtWedge(double w) {
  PointFile file = Contours::FileWith({{0, 0, w}, {1, 0.25, w}, {2, 0.5, w}, {3, 0.25, w}});
  file.points[2].y = 0.5;
  return file;
}

TEST(MakeCheckReport, FindsTheLargestDistanceAndWhatIsOutside) {
  CheckReport const report = MakeCheckReport(PointsAtWedge(0.3), "by hand", Wedge());
  ASSERT_EQ(report.deviations.size(), 4u);
  EXPECT_EQ(report.deviations[0].distance, 0.0);
  EXPECT_EQ(report.deviations[2].distance, 0.5);
  EXPECT_EQ(report.furthest, 2u);
  EXPECT_EQ(report.worst, 2u);
  EXPECT_EQ(report.outside, std::vector<std::size_t>{2});
  EXPECT_TRUE(report.HasTolerances());
}

TEST(MakeCheckReport, FurthestAndWorstArePointsOfTheirOwn) {
  PointFile file = PointsAtWedge(1.0);
  file.points[1].w = 0.3;
  CheckReport const report = MakeCheckReport(file, "by hand", Wedge());
  EXPECT_EQ(report.furthest, 2u);
  EXPECT_EQ(report.worst, 1u);
  EXPECT_NEAR(report.deviations[1].relative, 0.25 / 0.3, 1e-15);
  EXPECT_EQ(report.WorstFirst(), (std::vector<std::size_t>{1, 2, 3, 0}));
}

TEST(MakeCheckReport, WithoutASourceTolerancesMeanNothing) {
  CheckReport const report = MakeCheckReport(PointsAtWedge(1e-9), "", Wedge());
  EXPECT_FALSE(report.HasTolerances());
  EXPECT_TRUE(report.outside.empty());
  EXPECT_EQ(report.WorstFirst(), (std::vector<std::size_t>{2, 1, 3, 0})) << "by distance";
}

TEST(MakeCheckReport, TellsGapsMeetingsAndTheAreaOfASoundContour) {
  CheckReport const sound = MakeCheckReport(PointsAtWedge(1), "t", Wedge());
  EXPECT_TRUE(sound.gaps.empty());
  EXPECT_TRUE(sound.meetings.empty());
  // A trapezium of 4 and 5 wide at its ends, less its corner, and a quarter disc in the corner:
  // the triangle (0,0) (4,0) (5,-1) and the segment of the quarter beyond its chord.
  ASSERT_TRUE(sound.signedArea);
  EXPECT_NEAR(*sound.signedArea, -(2.0 + M_PI / 4.0 - 0.5), 1e-12);

  CheckReport const gapped = MakeCheckReport(PointsAtWedge(1), "t", WithGap());
  ASSERT_EQ(gapped.gaps.size(), 1u);
  EXPECT_EQ(gapped.gaps[0].size, 0.5);
  EXPECT_FALSE(gapped.signedArea) << "it is open";
}

TEST(MakeCheckReport, AContourThatCrossesItselfHasNoArea) {
  ContourFile bow;
  bow.isClosed = true;
  bow.pieces = {MakeLine({0, 0}, {2, 2}), MakeLine({2, 2}, {2, 0}), MakeLine({2, 0}, {0, 2}),
                MakeLine({0, 2}, {0, 0})};
  CheckReport const report = MakeCheckReport(PointsAtWedge(1), "t", bow);
  ASSERT_EQ(report.meetings.size(), 1u);
  EXPECT_EQ(report.meetings[0].kind, Intersection::Kind::Crossing);
  EXPECT_FALSE(report.signedArea);
}

TEST(SignedDistance, IsPositiveOnTheLeftAndNeverMinusZero) {
  EXPECT_EQ(SignedDistance({2.0, 0.0, true, 0}), 2.0);
  EXPECT_EQ(SignedDistance({2.0, 0.0, false, 0}), -2.0);
  EXPECT_FALSE(std::signbit(SignedDistance({0.0, 0.0, false, 0})));
}

TEST(CheckCsv, HasALineForEveryPoint) {
  CheckReport report = MakeCheckReport(PointsAtWedge(0.5), "t", Wedge());
  EXPECT_EQ(ToCsv(report),
            "point,line,x,y,deviation,piece,tolerance,relative\n"
            "0,2,0,0,0,1,0.5,0\n"
            "1,3,1,0.25,0.25,1,0.5,0.5\n"
            "2,4,2,0.5,0.5,1,0.5,1\n"
            "3,5,3,0.25,0.25,1,0.5,0.5\n");
  report.toleranceSource.clear();
  report.file.lines.clear();
  std::string const plain = ToCsv(report);
  EXPECT_TRUE(plain.starts_with("point,line,x,y,deviation,piece\n0,,0,0,0,1\n")) << plain;
}

TEST(CheckCsv, NumbersReadBackAsTheSameBits) {
  Testing::RandomGeometry random(3);
  PointFile file = Contours::FileWith({});
  for (int i = 0; i < 200; ++i) {
    file.points.push_back({random.Uniform(-1e9, 1e9), random.Uniform(-1e-9, 1e-9), 0.125});
  }
  CheckReport const report = MakeCheckReport(file, "t", Wedge());
  std::string const csv = ToCsv(report);
  std::size_t at = csv.find('\n') + 1;
  for (std::size_t i = 0; i < file.points.size(); ++i) {
    double x = 0.0;
    double y = 0.0;
    double deviation = 0.0;
    ASSERT_EQ(std::sscanf(csv.c_str() + at, "%*u,,%lf,%lf,%lf", &x, &y, &deviation), 3);
    EXPECT_EQ(x, file.points[i].x);
    EXPECT_EQ(y, file.points[i].y);
    EXPECT_EQ(deviation, SignedDistance(report.deviations[i]));
    at = csv.find('\n', at) + 1;
  }
}

TEST(CheckJson, HoldsEveryFact) {
  PointFile file = PointsAtWedge(0.3);
  file.units = "mm";
  CheckReport const report = MakeCheckReport(file, "by hand", Wedge());
  Json const json = Json::parse(ToJson(report));
  EXPECT_EQ(json.at("schemaVersion"), 1);
  EXPECT_EQ(json.at("points"), Json({{"file", "part.csv"}, {"count", 4}, {"units", "mm"}}));
  EXPECT_EQ(json.at("contour").at("pieces"), 3);
  EXPECT_EQ(json.at("contour").at("lines"), 2);
  EXPECT_EQ(json.at("contour").at("arcs"), 1);
  EXPECT_NEAR(json.at("contour").at("length").get<double>(), 4.0 + M_PI / 2.0 + std::sqrt(26.0),
              1e-12);
  EXPECT_EQ(json.at("tolerance"),
            Json({{"source", "by hand"}, {"smallest", 0.3}, {"largest", 0.3}}));
  EXPECT_EQ(json.at("result"), "outside tolerance");
  EXPECT_EQ(json.at("outside"), Json::array({2}));
  EXPECT_EQ(json.at("largest").at("point"), 2);
  EXPECT_EQ(json.at("largest").at("line"), 4);
  EXPECT_EQ(json.at("largest").at("deviation"), 0.5);
  EXPECT_EQ(json.at("relative").at("point"), 2);
  EXPECT_EQ(json.at("deviations").size(), 4u);
  EXPECT_EQ(json.at("area").at("direction"), "cw");
  EXPECT_EQ(json.at("crosses"), false);
}

TEST(CheckJson, WhatIsNotKnownIsNull) {
  PointFile file = PointsAtWedge(0.3);
  file.lines.clear();
  ContourFile contour = WithGap();
  Json const json = Json::parse(ToJson(MakeCheckReport(file, "", contour)));
  EXPECT_TRUE(json.at("points").at("units").is_null());
  EXPECT_TRUE(json.at("tolerance").is_null());
  EXPECT_TRUE(json.at("relative").is_null());
  EXPECT_TRUE(json.at("outside").is_null());
  EXPECT_TRUE(json.at("area").is_null());
  EXPECT_TRUE(json.at("largest").at("line").is_null());
  EXPECT_FALSE(json.at("largest").contains("tolerance"));
  EXPECT_EQ(json.at("result"), "measured");
  EXPECT_EQ(json.at("gaps"), Json::array({{{"before", 1}, {"after", 2}, {"size", 0.5}}}));
}

TEST(CheckJson, ANameThatIsNotUtf8StillGivesADocument) {
  PointFile file = PointsAtWedge(0.3);
  file.path = "\xff\xfe.csv";
  EXPECT_TRUE(Json::accept(ToJson(MakeCheckReport(file, "t", Wedge()))));
}

}  // namespace
}  // namespace Vorn::IO
