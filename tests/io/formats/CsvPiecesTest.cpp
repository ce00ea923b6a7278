#include <gtest/gtest.h>

#include "io/FormatContours.h"
#include "io/formats/CsvPieces.h"
#include "support/SharedData.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;

constexpr char const* kHeader =
    "type,start_x,start_y,end_x,end_y,center_x,center_y,radius,direction\n";

std::string Complaint(std::string const& rows) {
  return Refusal([&] { ParseCsvPieces(kHeader + rows, "p.csv"); });
}

TEST(ToCsv, WritesAPieceALine) {
  EXPECT_EQ(ToCsv(Wedge()), std::string("# units mm\n# closed yes\n") + kHeader +
                                "line,0,0,4,0,,,,\n"
                                "arc,4,0,5,-1,4,-1,1,cw\n"
                                "line,5,-1,0,0,,,,\n");
}

TEST(ToCsv, ALineBreakInTheUnitsBreaksNothing) {
  ContourFile contour = Wedge();
  contour.units = "mm\nspline";
  EXPECT_EQ(ParseCsvPieces(ToCsv(contour), "p.csv").units, "mm spline");
}

TEST(ParseCsvPieces, FindsColumnsByNameInAnyOrder) {
  ContourFile const contour = ParseCsvPieces(
      "\xEF\xBB\xBF# units: mm\r\n"
      "Radius;note;direction;CENTRE_X;centre_y;type;start_x;start_y;end_x;end_y\r\n"
      ";;;;;line;0;0;4;0\r\n"
      "\r\n"
      "1;round;CW;4;-1;Arc;4;0;5;-1\r\n"
      ";;;;;line;5;-1;0;0",
      "p.csv");
  EXPECT_TRUE(SameBits(contour, Wedge()));
}

TEST(ParseCsvPieces, AnArcThatEndsWhereItStartsIsAFullCircle) {
  ContourFile const contour =
      ParseCsvPieces(std::string(kHeader) + "arc,3,0,3,0,1,0,2,ccw\n", "p.csv");
  ASSERT_EQ(contour.pieces.size(), 2u);
  EXPECT_TRUE(SameBits(contour.pieces[0], MakeCircle({3, 0}, {1, 0}, 2, true)[0]));
  EXPECT_TRUE(contour.isClosed);
}

TEST(ParseCsvPieces, TheCommentDecidesAboutClosed) {
  std::string const rows = std::string(kHeader) + "line,0,0,1,0,,,,\nline,1,0,0,0,,,,\n";
  EXPECT_TRUE(ParseCsvPieces(rows, "p.csv").isClosed);
  EXPECT_FALSE(ParseCsvPieces("# closed no\n" + rows, "p.csv").isClosed);
  EXPECT_EQ(Refusal([&] { ParseCsvPieces("# closed perhaps\n" + rows, "p.csv"); }),
            "p.csv:1: closed 'perhaps' is neither yes nor no");
}

TEST(ParseCsvPieces, NamesLineColumnAndText) {
  EXPECT_EQ(Complaint("line,0,zero,1,1,,,,\n"), "p.csv:2: start_y 'zero' is not a number");
  EXPECT_EQ(Complaint("line,0,0,1,1,,,,\nline,0,0,nan,1\n"), "p.csv:3: end_x 'nan' is not finite");
  EXPECT_EQ(Complaint("line,0,0,1e999,1\n"), "p.csv:2: end_x '1e999' is not finite");
  EXPECT_EQ(Complaint("line,0,0,1e200,1\n"), "p.csv:2: end_x '1e200' is too large");
  EXPECT_EQ(Complaint("line,0,0,1\n"), "p.csv:2: end_y is missing");
  EXPECT_EQ(Complaint("spline,0,0,1,1\n"), "p.csv:2: type 'spline' is neither line nor arc");
  EXPECT_EQ(Complaint("arc,4,0,5,-1,4,-1,1,\n"), "p.csv:2: direction '' is neither ccw nor cw");
  EXPECT_EQ(Complaint("arc,4,0,5,-1,4,-1,2,cw\n"),
            "p.csv:2: is no arc: the start is 1 off the circle");
  EXPECT_EQ(Refusal([] { ParseCsvPieces("type,start_x,start_y,end_x\n", "p.csv"); }),
            "p.csv:1: the header has no column 'end_y': 'type,start_x,start_y,end_x'");
}

TEST(ParseCsvPieces, ReadsTheTruthOfSharedContours) {
  auto const folder = Testing::SharedDataFolder();
  if (!folder) GTEST_SKIP() << "VORN_DATA_DIR is not set";
  for (char const* name : {"circle_r3", "hatch_boundary", "rail_head_known_arcs"}) {
    std::string const path = *folder + "/" + name + ".truth.csv";
    std::ifstream file(path);
    std::string const text(std::istreambuf_iterator<char>(file), {});
    EXPECT_FALSE(ParseCsvPieces(text, path).pieces.empty());
  }
}

}  // namespace
}  // namespace Vorn::IO
