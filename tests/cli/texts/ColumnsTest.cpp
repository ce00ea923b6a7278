#include <gtest/gtest.h>

#include "cli/texts/Columns.h"

namespace Vorn::Cli {
namespace {

TEST(Aligned, NumbersToTheRightAndWordsToTheLeft) {
  EXPECT_EQ(Aligned({{"no", "kind", "x"}, {"1", "a", "-2.50"}}, {"kind"}),
            "no  kind      x\n"
            " 1  a     -2.50\n");
  EXPECT_EQ(Aligned({{"no", "kind"}, {"1", "a"}}),
            "no  kind\n"
            " 1     a\n");
}

TEST(Aligned, NoLineEndsWithABlank) {
  EXPECT_EQ(Aligned({{"no", "kind"}, {"1", "a"}}, {"kind"}), "no  kind\n 1  a\n");
}

TEST(Aligned, RowsMayBeShorterThanTheFirst) {
  EXPECT_EQ(Aligned({{"a", "b"}, {"100"}}), "  a  b\n100\n");
}

TEST(Fact, TextsBeginBelowEachOther) {
  EXPECT_EQ(Fact("area", "12"), "area        12\n");
  EXPECT_EQ(Fact("", "12"), "            12\n");
  EXPECT_EQ(Fact("a name too long", "12"), "a name too long12\n") << "nothing is cut off";
}

}  // namespace
}  // namespace Vorn::Cli
