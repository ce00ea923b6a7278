#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "io/base/Fields.h"

namespace Vorn::IO {
namespace {

std::vector<std::string> Split(std::string_view line, char separator) {
  std::vector<std::string_view> fields;
  SplitFields(line, separator, &fields);
  return {fields.begin(), fields.end()};
}

using Strings = std::vector<std::string>;

TEST(FindSeparator, PrefersSemicolonThenTabThenCommaThenBlanks) {
  EXPECT_EQ(FindSeparator("1,5;2\t3 4"), ';');
  EXPECT_EQ(FindSeparator("1 2\t3"), '\t');
  EXPECT_EQ(FindSeparator("1 , 2"), ',');
  EXPECT_EQ(FindSeparator("1 2"), ' ');
  EXPECT_EQ(FindSeparator("1"), ' ');
}

TEST(FindSeparator, BlanksAndTabsBetweenDecimalCommasSeparate) {
  EXPECT_EQ(FindSeparator("1,5 2,5"), ' ');
  EXPECT_EQ(FindSeparator("1,5 2 -3,25e1"), ' ');
  EXPECT_EQ(FindSeparator("1,5\t2,5"), '\t');
}

TEST(FindSeparator, BlanksAndTabsBesideCommasDoNot) {
  EXPECT_EQ(FindSeparator("1, 2"), ',');
  EXPECT_EQ(FindSeparator("1,\t2"), ',');
  EXPECT_EQ(FindSeparator("1,5, 2,5"), ',');
  EXPECT_EQ(FindSeparator("1,a b"), ',');
  EXPECT_EQ(FindSeparator("radius [mm],height [mm]"), ',');
}

TEST(FindSeparator, DoesNotLookIntoQuotes) {
  EXPECT_EQ(FindSeparator("\"a;b\",\"c\""), ',');
  EXPECT_EQ(FindSeparator("3\";4"), ';') << "a single quote quotes nothing";
}

TEST(SplitFields, KeepsEmptyFieldsButNotBetweenBlanks) {
  EXPECT_EQ(Split("1,,2,", ','), (Strings{"1", "", "2", ""}));
  EXPECT_EQ(Split(" 1 \t 2 ", ' '), (Strings{"1", "2"}));
  EXPECT_EQ(Split("", ','), Strings{""});
  EXPECT_EQ(Split("", ' '), Strings{});
}

TEST(SplitFields, QuotedFieldsHoldSeparators) {
  EXPECT_EQ(Split(R"( "a,b" ,2)", ','), (Strings{R"("a,b")", "2"}));
  EXPECT_EQ(Split(R"("a b" 2)", ' '), (Strings{R"("a b")", "2"}));
  EXPECT_EQ(Split(R"("a,b)", ','), (Strings{R"("a)", "b"})) << "a quote that is never closed";
  EXPECT_EQ(Split(R"(a"b,c"d)", ','), (Strings{R"(a"b)", R"(c"d)"}));
}

TEST(Unquoted, TakesOnePairOff) {
  EXPECT_EQ(Unquoted("\" a \""), "a");
  EXPECT_EQ(Unquoted("\""), "\"");
  EXPECT_EQ(Unquoted("a"), "a");
}

}  // namespace
}  // namespace Vorn::IO
