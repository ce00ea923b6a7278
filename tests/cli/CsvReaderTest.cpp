#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <limits>

#include "cli/CsvReader.h"
#include "cli/Failure.h"

namespace Vorn::Cli {
namespace {

using Use = ToleranceColumn::Use;

PointFile Parse(std::string_view text, ToleranceColumn const& column = {Use::IfPresent, "w"}) {
  return ParsePoints(text, "p.csv", column);
}

/// The message of the refusal; empty when the text is accepted.
std::string Refusal(std::string_view text, ToleranceColumn const& column = {Use::IfPresent, "w"}) {
  try {
    Parse(text, column);
  } catch (Failure const& failure) {
    EXPECT_EQ(failure.Code(), ExitCode::File);
    return failure.what();
  }
  return "";
}

void ExpectPoint(PointFile const& file, std::size_t i, double x, double y, std::size_t line) {
  ASSERT_LT(i, file.points.size());
  EXPECT_EQ(file.points[i].x, x);
  EXPECT_EQ(file.points[i].y, y);
  EXPECT_EQ(file.lines[i], line);
}

struct GoodText {
  char const* name;
  char const* text;
  std::size_t secondLine;
};

class AcceptedLayouts : public testing::TestWithParam<GoodText> {};

TEST_P(AcceptedLayouts, GiveTheSamePoints) {
  PointFile const file = Parse(GetParam().text);
  ASSERT_EQ(file.points.size(), 2u);
  EXPECT_EQ(file.points[0].x, 1.5);
  EXPECT_EQ(file.points[0].y, -2.0);
  ExpectPoint(file, 1, 3.0, 4.25, GetParam().secondLine);
  EXPECT_FALSE(file.hasTolerances);
}

INSTANTIATE_TEST_SUITE_P(
    CsvReader, AcceptedLayouts,
    testing::Values(GoodText{"Header", "x,y\n1.5,-2\n3,4.25\n", 3},
                    GoodText{"NoHeader", "1.5,-2\n3,4.25\n", 2},
                    GoodText{"NoFinalLineEnd", "1.5,-2\n3,4.25", 2},
                    GoodText{"CarriageReturnLineFeed", "x,y\r\n1.5,-2\r\n3,4.25\r\n", 3},
                    GoodText{"CarriageReturnOnly", "x,y\r1.5,-2\r3,4.25\r", 3},
                    GoodText{"ByteOrderMark", "\xEF\xBB\xBFx,y\n1.5,-2\n3,4.25\n", 3},
                    GoodText{"ByteOrderMarkWithoutHeader",
                             "\xEF\xBB\xBF"
                             "1.5,-2\n3,4.25\n",
                             2},
                    GoodText{"BlankLines", "\n\nx,y\n\n1.5,-2\n  \n3,4.25\n\n", 7},
                    GoodText{"Comments", "# a\nx,y\n1.5,-2 # first\n#c\n3,4.25\n", 5},
                    GoodText{"Semicolons", "x;y\n1.5;-2\n3;4.25\n", 3},
                    GoodText{"Tabs", "x\ty\n1.5\t-2\n3\t4.25\n", 3},
                    GoodText{"Blanks", "x y\n 1.5   -2\n3 4.25 \n", 3},
                    GoodText{"BlanksAroundCommas", "x , y\n 1.5 , -2 \n3 ,4.25\n", 3},
                    GoodText{"SwappedColumns", "y,x\n-2,1.5\n4.25,3\n", 3},
                    GoodText{"CapitalsAndQuotes", "\"Y\",\"X\"\n-2,1.5\n4.25,3\n", 3},
                    GoodText{"OtherNames", "radius [mm],height [mm]\n1.5,-2\n3,4.25\n", 3},
                    GoodText{"MoreNamedColumns", "id,x,y,note\na,1.5,-2,bad\nb,3,4.25,\n", 3},
                    GoodText{"SignsAndExponents", "+.15e1,-2.\n+3,425e-2\n", 2}),
    [](auto const& instance) { return instance.param.name; });

TEST(CsvReader, NumbersKeepTheirExactBits) {
  PointFile const file = Parse("-.0005993,0.1\n1e-320,1.7976931348623157e308\n");
  EXPECT_EQ(file.points[0].x, -.0005993);
  EXPECT_EQ(file.points[0].y, 0.1);
  EXPECT_EQ(file.points[1].x, 1e-320);
  EXPECT_EQ(file.points[1].y, std::numeric_limits<double>::max());
}

struct BadText {
  char const* name;
  char const* text;
  char const* message;
};

class RefusedTexts : public testing::TestWithParam<BadText> {};

TEST_P(RefusedTexts, NameFileLineAndText) {
  EXPECT_EQ(Refusal(GetParam().text), GetParam().message);
}

INSTANTIATE_TEST_SUITE_P(
    CsvReader, RefusedTexts,
    testing::Values(
        BadText{"Empty", "", "p.csv: holds no points"},
        BadText{"OnlyComments", "# nothing\n\n", "p.csv: holds no points"},
        BadText{"OnlyHeader", "x,y\n", "p.csv: holds a header but no points"},
        BadText{"OnePoint", "x,y\n1,2\n", "p.csv: holds one point only; a fit needs two"},
        BadText{"NotANumber", "x,y\n1,2\n3,nan\n", "p.csv:3: y is not a finite number: 'nan'"},
        BadText{"NotANumberFirst", "nan,1\n3,4\n", "p.csv:1: x is not a finite number: 'nan'"},
        BadText{"Infinity", "1,2\n-inf,4\n", "p.csv:2: x is not a finite number: '-inf'"},
        BadText{"TooLarge", "1,2\n1e999,4\n", "p.csv:2: x is not a finite number: '1e999'"},
        BadText{"Word", "x,y\n1,2\nthree,4\n", "p.csv:3: x is not a number: 'three'"},
        BadText{"SecondHeader", "x,y\n1,2\nx,y\n", "p.csv:3: x is not a number: 'x'"},
        BadText{"UnitInNumber", "1,2\n3mm,4\n", "p.csv:2: x is not a number: '3mm'"},
        BadText{"TwoSigns", "1,2\n+-3,4\n", "p.csv:2: x is not a number: '+-3'"},
        BadText{"Hexadecimal", "1,2\n0x10,4\n", "p.csv:2: x is not a number: '0x10'"},
        BadText{"MissingValue", "x,y\n1,2\n3,\n", "p.csv:3: y is missing"},
        BadText{"MissingColumn", "x,y\n1,2\n3\n", "p.csv:3: expected 2 columns, found 1: '3'"},
        BadText{"TooManyColumns", "1,2\n3,4,5\n", "p.csv:2: expected 2 columns, found 3: '3,4,5'"},
        BadText{"OneColumn", "1\n2\n", "p.csv:1: only one column, '1'; expected x,y or x,y,w"},
        BadText{"OneColumnHeader", "x\n2\n",
                "p.csv:1: only one column, 'x'; expected x,y or x,y,w"},
        BadText{"FourColumnsWithoutHeader", "1,2,3,4\n1,2,3,4\n",
                "p.csv:1: 4 columns without a header; expected x,y or x,y,w"},
        BadText{"DecimalComma", "1,5;2,5\n2;3\n",
                "p.csv:1: x is not a number: '1,5' (write a decimal point, not a comma)"},
        BadText{"DecimalCommaLater", "1;2\n2,5;3\n",
                "p.csv:2: x is not a number: '2,5' (write a decimal point, not a comma)"},
        BadText{"NegativeTolerance", "x,y,w\n1,2,0.1\n3,4,-0.1\n",
                "p.csv:3: tolerance '-0.1' must be a finite number above 0"},
        BadText{"ZeroTolerance", "1,2,0.1\n3,4,0\n",
                "p.csv:2: tolerance '0' must be a finite number above 0"},
        BadText{"InfiniteTolerance", "1,2,inf\n3,4,0\n",
                "p.csv:1: w is not a finite number: 'inf'"},
        BadText{"NegativeToleranceInComment", "# tolerance -1\n1,2\n3,4\n",
                "p.csv:1: tolerance in the comment must be a finite number above 0"},
        BadText{"Utf16", "\xFF\xFEx", "p.csv: is UTF-16 text; save it as UTF-8"},
        BadText{"ControlCharacters", "1,2\n\x01\x02,4\n", "p.csv:2: x is not a number: '\?\?'"},
        BadText{"LongText", "1,2\n0123456789x0123456789x0123456789x0123456789x,4\n",
                "p.csv:2: x is not a number: '0123456789x0123456789x0123456789x0123456...'"}),
    [](auto const& instance) { return instance.param.name; });

TEST(CsvReader, HeaderNamesTheToleranceColumn) {
  PointFile const file = Parse("w,x,y\n0.5,1,2\n0.25,3,4\n");
  ASSERT_TRUE(file.hasTolerances);
  EXPECT_EQ(file.points[0].w, 0.5);
  EXPECT_EQ(file.points[1].w, 0.25);
  EXPECT_EQ(file.points[1].x, 3.0);
}

TEST(CsvReader, ThirdColumnWithoutHeaderIsTheTolerance) {
  PointFile const file = Parse("1,2,0.5\n3,4,0.25\n");
  ASSERT_TRUE(file.hasTolerances);
  EXPECT_EQ(file.points[1].w, 0.25);
}

TEST(CsvReader, ThirdColumnOfAnotherNameIsNoTolerance) {
  PointFile const file = Parse("x,y,z\n1,2,-7\n3,4,abc\n");
  EXPECT_FALSE(file.hasTolerances);
  EXPECT_EQ(file.points[1].w, 0.0);
}

TEST(CsvReader, IgnoredToleranceColumnIsNotEvenChecked) {
  PointFile const file = Parse("x,y,w\n1,2,none\n3,4,-1\n", {Use::Ignore, "w"});
  EXPECT_FALSE(file.hasTolerances);
  EXPECT_EQ(file.points[0].w, 0.0);
}

TEST(CsvReader, RequiredColumnIsFoundByItsNameInAnyCase) {
  PointFile const file = Parse("x,y,Tol\n1,2,0.5\n3,4,0.25\n", {Use::Required, "tol"});
  ASSERT_TRUE(file.hasTolerances);
  EXPECT_EQ(file.points[0].w, 0.5);
}

TEST(CsvReader, RequiredColumnThatIsMissingIsRefusedWithTheHeader) {
  EXPECT_EQ(Refusal("x,y,z\n1,2,3\n3,4,5\n", {Use::Required, "tol"}),
            "p.csv:1: no column 'tol'; the header has 'x', 'y', 'z'");
  EXPECT_EQ(Refusal("1,2\n3,4\n", {Use::Required, "w"}),
            "p.csv:1: no column 'w'; the file has no header");
}

TEST(CsvReader, CommentsStateToleranceAndUnits) {
  PointFile const file = Parse("#Tolerance: 0.02 mm\n#  units = mm\nx,y\n1,2\n3,4\n");
  ASSERT_TRUE(file.tolerance.has_value());
  EXPECT_EQ(*file.tolerance, 0.02);
  EXPECT_EQ(file.units, "mm");
}

TEST(CsvReader, SentenceAboutToleranceIsNoStatement) {
  EXPECT_FALSE(Parse("# tolerance is unknown\n1,2\n3,4\n").tolerance.has_value());
}

TEST(CsvReader, CommentAfterTheFirstPointIsNoStatement) {
  EXPECT_FALSE(Parse("1,2\n# tolerance 5\n3,4\n").tolerance.has_value());
}

TEST(CsvReader, PointsAreNamedByIndexAndLine) {
  EXPECT_EQ(Parse("x,y\n1,2\n\n3,4\n").NameOf(1), "point 1 (line 4)");
}

TEST(CsvReader, MissingFileAndDirectoryAreRefused) {
  auto refusal = [](std::string const& path) -> std::string {
    try {
      ReadPoints(path, {});
    } catch (Failure const& failure) {
      EXPECT_EQ(failure.Code(), ExitCode::File);
      return failure.what();
    }
    return "";
  };
  EXPECT_EQ(refusal("no/such/file.csv"), "no/such/file.csv: No such file or directory");
  EXPECT_EQ(refusal("."), ".: is a directory");
}

}  // namespace
}  // namespace Vorn::Cli
