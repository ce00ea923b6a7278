#include <gtest/gtest.h>

#include "io/FormatContours.h"
#include "io/formats/CsvPieces.h"
#include "io/formats/Dxf.h"
#include "io/formats/GCode.h"
#include "io/formats/JsonPieces.h"
#include "io/formats/Wkt.h"
#include "vorn/io/Formats.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;

constexpr Format kContourFormats[] = {Format::Json, Format::Csv, Format::Dxf, Format::GCode,
                                      Format::Wkt};

TEST(FindGaps, NamesPiecesAndSize) {
  std::vector<Gap> const gaps = FindGaps(WithGap());
  ASSERT_EQ(gaps.size(), 1u);
  EXPECT_EQ(gaps[0].before, 0u);
  EXPECT_EQ(gaps[0].after, 1u);
  EXPECT_EQ(gaps[0].size, 0.5);
  EXPECT_EQ(Describe(gaps[0]), "pieces 1 and 2 do not meet: the gap is 0.5");
}

TEST(FindGaps, LooksAtTheSeamOfClosedContoursOnly) {
  ContourFile contour = WithGap();
  contour.pieces[1] = MakeLine({1, 0}, {0, 2});
  EXPECT_TRUE(FindGaps(contour).empty());
  contour.isClosed = true;
  ASSERT_EQ(FindGaps(contour).size(), 1u);
  EXPECT_EQ(Describe(FindGaps(contour)[0]),
            "the contour is closed, but its ends do not meet: the gap is 2");
}

TEST(FindGaps, RoundingIsNoGap) {
  ContourFile contour = WithGap();
  contour.pieces[1].start = {1 + 1e-10, 0};
  EXPECT_TRUE(FindGaps(contour).empty());
  contour.pieces[1].start = {1 + 1e-8, 0};
  EXPECT_EQ(FindGaps(contour).size(), 1u);
}

TEST(ReturnsToStart, ComparesTheEnds) {
  EXPECT_TRUE(ReturnsToStart(Wedge().pieces));
  EXPECT_FALSE(ReturnsToStart(WithGap().pieces));
  EXPECT_FALSE(ReturnsToStart({}));
}

TEST(FormatOf, GoesByTheEndingInAnyCase) {
  EXPECT_EQ(FormatOf("a/b.json"), Format::Json);
  EXPECT_EQ(FormatOf("PART.NC"), Format::GCode);
  EXPECT_EQ(FormatOf("p.gcode"), Format::GCode);
  EXPECT_EQ(FormatOf("p.x.Dxf"), Format::Dxf);
  EXPECT_EQ(FormatOf("p.html"), Format::Html);
  for (char const* path : {"-", "p", "p.txt", "dxf", ".csv/p", ""}) {
    EXPECT_FALSE(FormatOf(path)) << path;
  }
}

TEST(FormatOf, AgreesWithTheNames) {
  for (Format const format : {Format::Json, Format::Csv, Format::Dxf, Format::GCode, Format::Wkt,
                              Format::Svg, Format::Html, Format::Png}) {
    EXPECT_EQ(FormatNamed(NameOf(format)), format);
    EXPECT_EQ(FormatOf("p." + NameOf(format)), format);
  }
}

TEST(FormatOfContent, RecognisesWhatTheProgramWrites) {
  for (ContourFile const& contour : {Wedge(), WithGap()}) {
    for (Format const format : kContourFormats) {
      EXPECT_EQ(FormatOfContent(ToText(contour, format, {})), format) << NameOf(format);
    }
  }
}

TEST(FormatOfContent, RecognisesWhatOthersWrite) {
  EXPECT_EQ(FormatOfContent("  0\r\nSECTION\r\n"), Format::Dxf);
  EXPECT_EQ(FormatOfContent("%\nO1234\n"), Format::GCode);
  EXPECT_EQ(FormatOfContent("N10 G90"), Format::GCode);
  EXPECT_EQ(FormatOfContent("SRID=0;LineString(0 0,1 1)"), Format::Wkt);
  EXPECT_EQ(FormatOfContent("# made by hand\nradius;TYPE;start_x"), Format::Csv);
  EXPECT_FALSE(FormatOfContent("x,y\n1,2\n"));
  EXPECT_FALSE(FormatOfContent(""));
}

TEST(ParseContour, RefusesBrokenTextInEveryFormat) {
  for (std::string const& text : BrokenTexts()) {
    for (Format const format : kContourFormats) {
      std::string const message = Refusal([&] { ParseContour(text, "p", format); });
      EXPECT_TRUE(message.starts_with("p:")) << NameOf(format) << ": " << message;
      EXPECT_LT(message.size(), 200u);
    }
  }
}

TEST(ParseContour, RefusesTextCutAnywhereOrReadsAShorterContour) {
  for (Format const format : kContourFormats) {
    std::string const text = ToText(Wedge(), format, {});
    int refused = 0;
    for (std::size_t length = 0; length < text.size(); ++length) {
      try {
        EXPECT_LE(ParseContour(text.substr(0, length), "p", format).pieces.size(), 3u);
      } catch (Failure const& failure) {
        EXPECT_EQ(failure.Kind(), FailureKind::File) << failure.what();
        ++refused;
      }
    }
    EXPECT_GT(refused, 20) << NameOf(format);
  }
}

TEST(ParseContour, SurvivesRandomChangesOfTheText) {
  Testing::RandomGeometry random(7);
  for (Format const format : kContourFormats) {
    std::string const text = ToText(Wedge(), format, {});
    for (int i = 0; i < 2000; ++i) {
      std::string changed = text;
      for (int k = random.Integer(1, 4); k > 0; --k) {
        auto const at = static_cast<std::size_t>(
            random.Integer(0, static_cast<std::int32_t>(changed.size()) - 1));
        changed[at] = static_cast<char>(random.Integer(0, 255));
      }
      try {
        EXPECT_FALSE(ParseContour(changed, "p", format).pieces.empty());
      } catch (Failure const& failure) {
        EXPECT_EQ(failure.Kind(), FailureKind::File) << failure.what() << "\n" << changed;
      }
    }
  }
}

TEST(ParseContour, SaysWhereBinaryDataBegin) {
  EXPECT_EQ(Refusal([] { ParseContour(std::string("ab\nc\0d", 6), "p.csv"); }),
            "p.csv:2:2: is binary, not text");
}

TEST(ParseContour, SaysWhenNothingIsRecognised) {
  EXPECT_EQ(Refusal([] { ParseContour("x,y\n1,2\n", "p.txt"); }),
            "p.txt: holds no contour: it looks like none of JSON, CSV, DXF, G-code, WKT and SVG");
  EXPECT_EQ(Refusal([] { ParseContour("\n", "p.txt"); }), "p.txt: is empty");
}

TEST(ParseContour, ADrawingIsNoContour) {
  EXPECT_EQ(Refusal([] { ParseContour("<html/>", "p.html"); }, FailureKind::BadArgument),
            "p.html: a contour cannot be read from html");
}

TEST(ToText, KeepsGapsInEveryFormat) {
  for (Format const format : kContourFormats) {
    ContourFile const read = ParseContour(ToText(WithGap(), format, {}), "p", format);
    ASSERT_EQ(read.pieces.size(), 2u) << NameOf(format);
    ASSERT_EQ(FindGaps(read).size(), 1u) << NameOf(format);
    EXPECT_EQ(FindGaps(read)[0].size, 0.5) << NameOf(format);
    EXPECT_FALSE(read.isClosed);
  }
}

TEST(ToText, KeepsClosedContoursClosedInEveryFormat) {
  for (Format const format : kContourFormats) {
    ContourFile const read = ParseContour(ToText(Wedge(), format, {}), "p", format);
    EXPECT_TRUE(read.isClosed) << NameOf(format);
    EXPECT_EQ(read.pieces.size(), 3u) << NameOf(format);
    EXPECT_EQ(read.units, format == Format::Wkt ? "" : "mm") << NameOf(format);
  }
}

}  // namespace
}  // namespace Vorn::IO
