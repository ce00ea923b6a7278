// Memory runs out at every allocation of the readers and writers in turn: std::bad_alloc comes out,
// nothing leaks, and the next call answers as ever.
#include <string>

#include "gtest/gtest.h"
#include "support/RefusedAllocations.h"
#include "vorn/io/ContourFile.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Pieces.h"
#include "vorn/io/Points.h"

namespace Vorn::IO {
namespace {

using Vorn::Testing::RefuseEachAllocation;

ContourFile LineAndArc() {
  ContourFile contour;
  contour.path = "a contour with a name that needs memory";
  contour.pieces = {MakeLine({0, 0}, {4, 0}), MakeArc({4, 0}, {6, 2}, {4, 2}, 2.0, true)};
  return contour;
}

class FormatWithoutMemory : public testing::TestWithParam<Format> {};

TEST_P(FormatWithoutMemory, ThrowsFromWriterAndReader) {
  ContourFile const contour = LineAndArc();
  WriteOptions options;
  options.svgPlain = true;
  std::string text;
  EXPECT_GT(RefuseEachAllocation([&] { text = ToText(contour, GetParam(), options); },
                                 [&] { EXPECT_TRUE(text.empty()); }),
            3);
  ContourFile back;
  EXPECT_GT(RefuseEachAllocation(
                [&] { back = ParseContour(text, "a name that needs memory as well", GetParam()); },
                [&] { EXPECT_TRUE(back.pieces.empty()); }),
            3);
  ASSERT_EQ(back.pieces.size(), 2u);
  EXPECT_EQ(back.pieces.back().end.x, 6.0);
}

// JSON is not among them: the JSON library takes memory to free a document, and ends the program
// where it gets none.
INSTANTIATE_TEST_SUITE_P(Formats, FormatWithoutMemory,
                         testing::Values(Format::Csv, Format::Dxf, Format::GCode, Format::Wkt,
                                         Format::Svg),
                         [](auto const& named) { return NameOf(named.param); });

TEST(PointsWithoutMemory, Throw) {
  std::string const text = "# units mm\nNr;X [mm];Z [mm]\n1;0,5;1,25\n2;1,5;1,5\n3;2,5;-1,75\n";
  PointFile file;
  EXPECT_GT(RefuseEachAllocation([&] { file = ParsePoints(text, "a name that needs memory", {}); },
                                 [&] { EXPECT_TRUE(file.points.empty()); }),
            3);
  ASSERT_EQ(file.points.size(), 3u);
  EXPECT_EQ(file.points[2].y, -1.75);
}

}  // namespace
}  // namespace Vorn::IO
