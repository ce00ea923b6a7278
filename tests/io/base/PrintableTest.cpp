#include <gtest/gtest.h>

#include "vorn/io/Messages.h"

namespace Vorn::IO {
namespace {

std::string const kSign = "\xEF\xBF\xBD";

TEST(Printable, KeepsGoodText) {
  for (char const* text : {"", "part.csv",
                           "Stra\xC3\x9F"
                           "e \xC2\xB5m",
                           "\xF0\x9F\x93\x90 \xE2\x80\x94", "\xEF\xBF\xBD"}) {
    EXPECT_EQ(Printable(text), text);
  }
}

TEST(Printable, ReplacesControlCharacters) {
  EXPECT_EQ(Printable("a\x1b[31mb"), "a" + kSign + "[31mb");
  EXPECT_EQ(Printable("a\nb\tc\x7f"), "a" + kSign + "b" + kSign + "c" + kSign);
  EXPECT_EQ(Printable(std::string("\0", 1)), kSign);
  EXPECT_EQ(Printable("\xC2\x9B"), kSign) << "a control character of two bytes";
}

TEST(Printable, ReplacesEachByteThatIsNoUtf8) {
  EXPECT_EQ(Printable("\xff"), kSign);
  EXPECT_EQ(Printable("a\xC3"), "a" + kSign) << "cut short";
  EXPECT_EQ(Printable("\xC0\x80"), kSign + kSign) << "longer than needed";
  EXPECT_EQ(Printable("\xE0\x80\x80"), kSign + kSign + kSign);
  EXPECT_EQ(Printable("\xED\xA0\x80"), kSign + kSign + kSign) << "half of a pair";
  EXPECT_EQ(Printable("\xF4\x90\x80\x80"), kSign + kSign + kSign + kSign) << "beyond the last one";
  EXPECT_EQ(Printable("\x80z"), kSign + "z");
}

}  // namespace
}  // namespace Vorn::IO
