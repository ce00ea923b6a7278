#include <gtest/gtest.h>

#include <limits>

#include "io/PointTables.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {
namespace {

using namespace PointTables;

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
    testing::Values(
        GoodText{"Header", "x,y\n1.5,-2\n3,4.25\n", 3}, GoodText{"NoHeader", "1.5,-2\n3,4.25\n", 2},
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
        GoodText{"SignsAndExponents", "+.15e1,-2.\n+3,425e-2\n", 2},
        GoodText{"DecimalCommas", "x;y\n1,5;-2\n3;4,25\n", 3},
        GoodText{"DecimalCommasInExponentForm", "1,5E+00;-0,2e1\n3E0;42,5E-01\n", 2},
        GoodText{"DecimalCommasBetweenTabs", "x\ty\n1,5\t-2,0\n3\t4,25\n", 3},
        GoodText{"DecimalCommasBetweenBlanks", "1,5 -2,0\n3 4,25\n", 2},
        GoodText{"DecimalCommasBetweenBlanksBelowAHeader", "x y\n1,5 -2,0\n3 4,25\n", 3},
        GoodText{"DecimalCommasInQuotes", "\"1,5\",\"-2,0\"\n\"3\",\"4,25\"\n", 2},
        GoodText{"TabsBesideCommas", "1.5,\t-2\n3,\t4.25\n", 2},
        GoodText{"TabAtTheEnd", "x\ty\t\n1.5\t-2\t\n3\t4.25\n", 3},
        GoodText{"EmptyFieldBetweenTabsAtTheEnd", "x\ty\tnote\n1.5\t-2\t\n3\t4.25\tb\n", 3},
        GoodText{"CommaAtTheEnd", "1.5,-2,\n3,4.25,\n", 2},
        GoodText{"SeparatorInQuotes", "\"x\",\"note, long\",\"y\"\n1.5,\"a, b\",-2\n3,c,4.25\n", 3},
        GoodText{"HeaderWithAnotherSeparator", "x;y\n1.5,-2\n3,4.25\n", 3},
        GoodText{"HeaderWithCommasOverDecimalCommas", "x,y\n1,5;-2\n3;4,25\n", 3},
        GoodText{"InchesInTheHeader", "x 3\",y\n1.5,-2\n3,4.25\n", 3},
        GoodText{"SlashComments", "// a\nx,y\n1.5,-2 // first\n  //c\n3,4.25\n", 5},
        GoodText{"AddressIsNoComment", "url,x,y\nhttp://a.b,1.5,-2\nfile://c,3,4.25\n", 3},
        GoodText{"MixedLineEnds", "x,y\r\n\r\n1.5,-2\r\n\n3,4.25\r", 5}),
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
  EXPECT_EQ(TableRefusal(GetParam().text), GetParam().message);
}

INSTANTIATE_TEST_SUITE_P(
    CsvReader, RefusedTexts,
    testing::Values(
        BadText{"Empty", "", "p.csv: holds no points"},
        BadText{"OnlyComments", "# nothing\n\n", "p.csv: holds no points"},
        BadText{"OnlyHeader", "x,y\n", "p.csv: holds a header but no points"},
        BadText{"OnePoint", "x,y\n1,2\n", "p.csv: holds one point only; a contour needs two"},
        BadText{"NotANumber", "x,y\n1,2\n3,nan\n", "p.csv:3:3: y is not a finite number: 'nan'"},
        BadText{"NotANumberFirst", "nan,1\n3,4\n", "p.csv:1:1: x is not a finite number: 'nan'"},
        BadText{"Infinity", "1,2\n-inf,4\n", "p.csv:2:1: x is not a finite number: '-inf'"},
        BadText{"TooLarge", "1,2\n1e999,4\n", "p.csv:2:1: x is not a finite number: '1e999'"},
        BadText{"Word", "x,y\n1,2\nthree,4\n", "p.csv:3:1: x is not a number: 'three'"},
        BadText{"SecondHeader", "x,y\n1,2\nx,y\n", "p.csv:3:1: x is not a number: 'x'"},
        BadText{"UnitInNumber", "1,2\n3mm,4\n", "p.csv:2:1: x is not a number: '3mm'"},
        BadText{"TwoSigns", "1,2\n+-3,4\n", "p.csv:2:1: x is not a number: '+-3'"},
        BadText{"Hexadecimal", "1,2\n0x10,4\n", "p.csv:2:1: x is not a number: '0x10'"},
        BadText{"MissingValue", "x,y\n1,2\n3,\n", "p.csv:3:3: y is missing"},
        BadText{"MissingColumn", "x,y\n1,2\n3\n", "p.csv:3:1: expected 2 columns, found 1: '3'"},
        BadText{"TooManyColumns", "1,2\n3,4,5\n",
                "p.csv:2:5: expected 2 columns, found 3: '3,4,5'"},
        BadText{"OneColumn", "1\n2\n", "p.csv:1:1: only one column, '1'; expected x,y or x,y,w"},
        BadText{"OneColumnHeader", "x\n2\n",
                "p.csv:1:1: only one column, 'x'; expected x,y or x,y,w"},
        BadText{"FourColumnsWithoutHeader", "1,2,3,4\n1,2,3,4\n",
                "p.csv:1:7: 4 columns without a header; expected x,y or x,y,w"},
        BadText{"PointAfterDecimalCommas", "1,5;2,5\n2;1.234\n",
                "p.csv:2:3: y is not a number: '1.234' (line 1 has a decimal comma)"},
        BadText{"CommaAfterDecimalPoints", "1.5;2.5\n1,234;3\n",
                "p.csv:2:1: x is not a number: '1,234' (line 1 has a decimal point)"},
        BadText{"GroupsOfThousands", "1.234,5;2\n2;3\n", "p.csv:1:1: x is not a number: '1.234,5'"},
        BadText{"CommaWithNothingBehind", "1,;2\n2;3\n", "p.csv:1:1: x is not a number: '1,'"},
        BadText{"ColumnsAreCountedInCharacters", "x,y,\xC3\xA4\n\xC3\xA4,2,3\n",
                "p.csv:2:1: x is not a number: '\xC3\xA4'"},
        BadText{"ColumnBehindManyBytesPerCharacter", "id;x;y\n\xC3\xA4\xC3\xB6;one;2\n",
                "p.csv:2:4: x is not a number: 'one'"},
        BadText{"ColumnBehindTheByteOrderMark",
                "\xEF\xBB\xBF"
                "1;two\n",
                "p.csv:1:3: y is not a number: 'two'"},
        BadText{"ColumnBehindBlanks", "  1   2\n  3   four\n",
                "p.csv:2:7: y is not a number: 'four'"},
        BadText{"TruncatedLine", "x,y,q\n1,2,3\n4,5\n6",
                "p.csv:3:1: expected 3 columns, found 2: '4,5'"},
        BadText{"NegativeTolerance", "x,y,w\n1,2,0.1\n3,4,-0.1\n",
                "p.csv:3:5: tolerance '-0.1' must be a finite number above 0"},
        BadText{"ZeroTolerance", "1,2,0.1\n3,4,0\n",
                "p.csv:2:5: tolerance '0' must be a finite number above 0"},
        BadText{"InfiniteTolerance", "1,2,inf\n3,4,0\n",
                "p.csv:1:5: w is not a finite number: 'inf'"},
        BadText{"NegativeToleranceInComment", "# tolerance -1\n1,2\n3,4\n",
                "p.csv:1:13: tolerance in the comment must be a finite number above 0"},
        BadText{"ControlCharacters", "1,2\n\x01\x02,4\n", "p.csv:2:1: x is not a number: '\?\?'"},
        BadText{"LongText", "1,2\n0123456789x0123456789x0123456789x0123456789x,4\n",
                "p.csv:2:1: x is not a number: '0123456789x0123456789x0123456789x0123456...'"}),
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
  PointFile const file = Parse("x,y,q\n1,2,-7\n3,4,abc\n");
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
  EXPECT_EQ(TableRefusal("x,y,z\n1,2,3\n3,4,5\n", {Use::Required, "tol"}),
            "p.csv:1:1: no column 'tol'; the header has 'x', 'y', 'z'");
  EXPECT_EQ(TableRefusal("1,2\n3,4\n", {Use::Required, "w"}),
            "p.csv:1:1: no column 'w'; the file has no header");
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

TEST(CsvReader, SlashCommentsStateToleranceAndUnits) {
  PointFile const file = Parse("// tolerance 0.02\n//units mm\n1,2\n3,4\n");
  EXPECT_EQ(file.tolerance, 0.02);
  EXPECT_EQ(file.units, "mm");
}

TEST(CsvReader, NumbersWithADecimalCommaKeepTheirExactBits) {
  PointFile const file = Parse("-,0005993;0,1\n1e-320;1,7976931348623157E+308\n");
  EXPECT_EQ(file.points[0].x, -.0005993);
  EXPECT_EQ(file.points[0].y, 0.1);
  EXPECT_EQ(file.points[1].x, 1e-320);
  EXPECT_EQ(file.points[1].y, std::numeric_limits<double>::max());
}

TEST(CsvReader, CommasAndBlanksAreCommasWhereBlanksAloneMakeNoSense) {
  // Four fields and not two numbers with a decimal comma: a blank follows only some commas.
  EXPECT_EQ(TableRefusal("1,5, 2,5\n"), TableRefusal("1,5,2,5\n").replace(8, 1, "8"));
}

}  // namespace
}  // namespace Vorn::IO
