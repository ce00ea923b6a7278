#include <gtest/gtest.h>

#include "io/PointTables.h"

namespace Vorn::IO {
namespace {

using namespace PointTables;

struct ColumnCase {
  char const* name;
  char const* text;
  char const* columns;
};

class ChosenColumns : public testing::TestWithParam<ColumnCase> {};

TEST_P(ChosenColumns, AreReadInTheOrderAskedFor) {
  std::optional<ColumnChoice> const choice = ParseColumnChoice(GetParam().columns);
  ASSERT_TRUE(choice.has_value());
  PointFile const file = ParsePoints(GetParam().text, "p.csv", {Use::IfPresent, "w"}, *choice);
  ASSERT_EQ(file.points.size(), 2u);
  EXPECT_EQ(file.points[0].x, 1.5);
  EXPECT_EQ(file.points[0].y, -2.0);
  EXPECT_EQ(file.points[1].x, 3.0);
  EXPECT_EQ(file.points[1].y, 4.25);
  EXPECT_EQ(file.hasTolerances, !choice->w.empty());
  if (file.hasTolerances) {
    EXPECT_EQ(file.points[0].w, 0.5);
    EXPECT_EQ(file.points[1].w, 0.25);
    EXPECT_EQ(file.toleranceColumn, choice->w);
  }
}

INSTANTIATE_TEST_SUITE_P(
    CsvReader, ChosenColumns,
    testing::Values(
        ColumnCase{"NamesInAnyCase", "n,Height,Radius\n7,-2,1.5\n8,4.25,3\n", "radius,HEIGHT"},
        ColumnCase{"NamesWithTolerance", "tol,b,a\n.5,-2,1.5\n.25,4.25,3\n", "a,b,tol"},
        ColumnCase{"NumbersWithHeader", "n,b,a\n7,-2,1.5\n8,4.25,3\n", "3,2"},
        ColumnCase{"NumbersWithoutHeader", "7,-2,.5,1.5\n8,4.25,.25,3\n", "4,2,3"},
        ColumnCase{"OtherColumnsNeedNoNumbers", "a 1.5 -2 b c\nd 3 4.25 e f\n", "2,3"},
        ColumnCase{"ANameThatLooksLikeANumberIsAName", "a,b,\"x1\"\n-2,7,1.5\n4.25,8,3\n", "x1,1"},
        ColumnCase{"ThirdColumnIsNoToleranceUnlessAskedFor", "1.5,-2,9\n3,4.25,9\n", "1,2"},
        ColumnCase{"BlanksInTheChoice", "u v\n1.5 -2\n3 4.25\n", " u , v "}),
    [](auto const& instance) { return std::string(instance.param.name); });

TEST(CsvReader, ChosenColumnsThatAreMissingAreRefused) {
  auto const refusal = [](std::string_view text, ColumnChoice const& choice) -> std::string {
    try {
      ParsePoints(text, "p.csv", {Use::Ignore, "w"}, choice);
    } catch (Failure const& failure) {
      EXPECT_EQ(failure.Kind(), FailureKind::File);
      return failure.what();
    }
    return "";
  };
  EXPECT_EQ(refusal("a,b\n1,2\n3,4\n", {"a", "c", ""}),
            "p.csv:1:1: no column 'c'; the header has 'a', 'b'");
  EXPECT_EQ(refusal("a,b\n1,2\n3,4\n", {"a", "3", ""}), "p.csv:1:1: no column '3'; there are 2");
  EXPECT_EQ(refusal("1,2\n3,4\n", {"a", "2", ""}),
            "p.csv:1:1: no column 'a'; the file has no header");
  EXPECT_EQ(refusal("1,2\n3,4\n", {"0", "2", ""}),
            "p.csv:1:1: no column '0'; the file has no header");
  EXPECT_EQ(refusal("1,2\n3,4\n", {"1", "99999999999999999999", ""}),
            "p.csv:1:1: no column '99999999999999999999'; the file has no header");
}

TEST(CsvReader, TwoColumnsForTheToleranceAreRefused) {
  try {
    ParsePoints("1,2,3,4\n", "p.csv", {Use::Required, "t"}, {"1", "2", "3"});
    FAIL() << "accepted";
  } catch (Failure const& failure) {
    EXPECT_EQ(failure.Kind(), FailureKind::BadArgument);
    EXPECT_STREQ(failure.what(), "two columns for the tolerance: '3' and 't'");
  }
}

TEST(CsvReader, ToleranceColumnMayBeANumber) {
  PointFile const file = Parse("x,y,a,b\n1,2,7,.5\n3,4,8,.25\n", {Use::Required, "4"});
  EXPECT_EQ(file.points[1].w, 0.25);
  EXPECT_EQ(file.toleranceColumn, "4");
}

TEST(ParseColumnChoice, TakesTwoOrThreeDifferentColumns) {
  ASSERT_TRUE(ParseColumnChoice("x,y").has_value());
  EXPECT_EQ(ParseColumnChoice("x,y")->w, "");
  EXPECT_EQ(ParseColumnChoice("3,1,2")->w, "2");
  for (char const* text : {"", "x", "x,", ",y", "x,y,", "x,x", "x,y,x", "x,y,w,z"}) {
    EXPECT_FALSE(ParseColumnChoice(text).has_value()) << text;
  }
}

}  // namespace
}  // namespace Vorn::IO
