// Pieces without length: left out by every reader and writer alike.

#include <gtest/gtest.h>

#include "io/FormatContours.h"
#include "vorn/io/Formats.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;

constexpr Format kHolding[] = {Format::Json, Format::Csv, Format::Dxf, Format::GCode, Format::Wkt};

/// The wedge with a line, an arc and a line of no length ahead of, in and behind it.
ContourFile WithPoints() {
  ContourFile contour = Wedge();
  auto const at = [](XY const& point) { return MakeLine(point, point); };
  contour.pieces.insert(contour.pieces.begin(), at({0, 0}));
  contour.pieces.insert(contour.pieces.begin() + 2, MakeArc({4, 0}, {4, 0}, {4, -1}, 1, true));
  contour.pieces.push_back(at({0, 0}));
  return contour;
}

TEST(RemovePiecesWithoutLength, TakesPointsAndLeavesCirclesAndShortPieces) {
  std::vector<Piece> pieces = WithPoints().pieces;
  EXPECT_EQ(RemovePiecesWithoutLength(&pieces), 3u);
  EXPECT_EQ(pieces.size(), 3u);
  EXPECT_EQ(RemovePiecesWithoutLength(&pieces), 0u);

  std::vector<Piece> circle = MakeCircle({1, 0}, {0, 0}, 1, true);
  circle.push_back(MakeLine({1, 0}, {1, 5e-324}));
  EXPECT_EQ(RemovePiecesWithoutLength(&circle), 0u);
}

TEST(PiecesWithoutLength, EveryFormatIsWrittenAsWithoutThem) {
  for (Format const format : kHolding) {
    EXPECT_EQ(ToText(WithPoints(), format, {}), ToText(Wedge(), format, {})) << NameOf(format);
    ContourFile const back = ParseContour(ToText(WithPoints(), format, {}), "part", format);
    EXPECT_EQ(back.pieces.size(), 3u) << NameOf(format);
    EXPECT_EQ(back.leftOut, 0u) << NameOf(format);
  }
}

TEST(PiecesWithoutLength, SeparateDxfEntitiesAreWrittenWithoutThemToo) {
  WriteOptions options;
  options.dxfEntities = true;
  EXPECT_EQ(ToText(WithPoints(), Format::Dxf, options), ToText(Wedge(), Format::Dxf, options));
}

TEST(PiecesWithoutLength, AContourOfNothingElseIsRefusedByEveryWriter) {
  ContourFile contour = Wedge();
  contour.pieces = {MakeLine({3, 4}, {3, 4})};
  for (Format const format : kHolding) {
    EXPECT_EQ(Refusal([&] { ToText(contour, format, {}); }, FailureKind::BadArgument),
              "part.json: there is nothing to write: no piece has a length")
        << NameOf(format);
  }
}

TEST(PiecesWithoutLength, ReadersLeaveThemOutAndCountThem) {
  struct Case {
    char const* path;
    std::string text;
  };
  std::string const header = "type,start_x,start_y,end_x,end_y\n";
  std::string const polyline =
      "0\nSECTION\n2\nENTITIES\n0\nLWPOLYLINE\n10\n0\n20\n0\n10\n0\n20\n0\n10\n1\n20\n0\n"
      "0\nENDSEC\n0\nEOF\n";
  std::string const line =
      "0\nSECTION\n2\nENTITIES\n0\nLINE\n10\n0\n20\n0\n11\n0\n21\n0\n"
      "0\nLINE\n10\n0\n20\n0\n11\n1\n21\n0\n0\nENDSEC\n0\nEOF\n";
  for (Case const& one :
       {Case{"a.csv", header + "line,0,0,0,0\nline,0,0,1,0\n"}, Case{"a.dxf", polyline},
        Case{"b.dxf", line}, Case{"a.wkt", "LINESTRING (0 0, 0 0, 1 0)"}}) {
    ContourFile const contour = ParseContour(one.text, one.path);
    ASSERT_EQ(contour.pieces.size(), 1u) << one.path;
    EXPECT_EQ(contour.pieces[0].end.x, 1.0) << one.path;
    EXPECT_EQ(contour.leftOut, 1u) << one.path;
  }
}

TEST(PiecesWithoutLength, AFileOfNothingElseIsRefused) {
  EXPECT_EQ(Refusal([] { ParseContour("LINESTRING (0 0, 0 0)", "a.wkt"); }),
            "a.wkt: holds no contour: no piece has a length");
}

TEST(PiecesWithoutLength, AClosedPolylineMayRepeatItsFirstVertex) {
  std::string const polyline =
      "0\nSECTION\n2\nENTITIES\n0\nLWPOLYLINE\n70\n1\n10\n0\n20\n0\n10\n1\n20\n0\n10\n1\n20\n1\n"
      "10\n0\n20\n0\n0\nENDSEC\n0\nEOF\n";
  ContourFile const contour = ParseContour(polyline, "a.dxf");
  EXPECT_EQ(contour.pieces.size(), 3u);
  EXPECT_EQ(contour.leftOut, 0u);
  EXPECT_TRUE(contour.isClosed);
}

}  // namespace
}  // namespace Vorn::IO
