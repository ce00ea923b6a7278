#include <gtest/gtest.h>

#include <string>
#include <string_view>

#include "io/base/FirstLine.h"
#include "io/base/LongLines.h"
#include "vorn/io/Failure.h"

namespace Vorn::IO {
namespace {

constexpr std::size_t kMebibyte = std::size_t{1} << 20;
constexpr std::size_t kLongest = 16 * kMebibyte;

/// What is said of a text that comes in such blocks; nothing when every line passes.
std::string MessageOf(std::string_view text, std::size_t block) {
  LongLines lines("a.csv");
  try {
    for (std::size_t end = block; end < text.size() + block; end += block) {
      lines.Look(text.substr(0, end));
    }
  } catch (Failure const& failure) {
    return failure.what();
  }
  return {};
}

std::string const kRefusal =
    ": the line is longer than 16 MiB: no table and no tool path has such lines";

/// Rows of points of about so many bytes in all.
std::string Rows(std::size_t size, std::string const& end) {
  std::string rows;
  while (rows.size() < size) rows += "1.25,2.5" + end;
  return rows;
}

TEST(LongLines, PassUpToSixteenMebibytes) {
  std::string const longest(kLongest, '1');
  for (std::size_t const block : {kMebibyte, kLongest, 5 * kLongest}) {
    EXPECT_EQ(MessageOf(longest, block), "");
    EXPECT_EQ(MessageOf("x,y\n" + longest + "\n1,2\n", block), "");
    EXPECT_EQ(MessageOf("1" + longest, block), "a.csv:1" + kRefusal);
    EXPECT_EQ(MessageOf("x,y\n" + longest + "1\n1,2\n", block), "a.csv:2" + kRefusal);
  }
}

TEST(LongLines, AreNamedByTheirNumberWhateverEndsLines) {
  std::string const tooLong(kLongest + 1, '7');
  for (char const* end : {"\n", "\r\n", "\r"}) {
    std::string const rows = Rows(2 * kLongest, end);
    std::size_t const count = rows.size() / Rows(1, end).size();
    std::string const expected = "a.csv:" + std::to_string(count + 1) + kRefusal;
    EXPECT_EQ(MessageOf(rows + tooLong, kMebibyte), expected);
    EXPECT_EQ(MessageOf(rows + tooLong + end, 3 * kLongest), expected);
  }
}

TEST(LongLines, OfTwoBytesForEachCharacterPassUpToAsManyCharacters) {
  std::string text = "\xFF\xFE";
  auto const append = [&](std::string_view characters) {
    for (char const c : characters) text += {c, '\0'};
  };
  append("x,y\r\n");
  append(std::string(kLongest - 1, '1'));
  EXPECT_EQ(MessageOf(text, kLongest), "");
  append("11");
  EXPECT_EQ(MessageOf(text, kLongest), "a.csv:2" + kRefusal);
}

TEST(LongLines, OfFormatsInOneLinePassUpToWhatCanBeReadOfThem) {
  std::string const numbers = Rows(2 * kLongest, " ");
  for (char const* begin :
       {"{", "\n  {", "<svg ", "# a comment\nLINESTRING (", "SRID=1;POLYGON ((", "\xEF\xBB\xBF{"}) {
    EXPECT_EQ(MessageOf(begin + numbers, kLongest), "") << begin;
  }
  for (char const* begin : {"", "x,y", "[", "G1 X", "0 ", "(a comment) "}) {
    EXPECT_EQ(MessageOf(begin + numbers, kLongest), "a.csv:1" + kRefusal) << begin;
  }
  std::string const tooLong = "{\n" + std::string(256 * kMebibyte + 1, ' ');
  EXPECT_EQ(MessageOf(tooLong, 100 * kMebibyte),
            "a.csv:2: the line is longer than 256 MiB: too large for a contour in one line");
  EXPECT_EQ(MessageOf(std::string_view(tooLong).substr(0, tooLong.size() - 1), 100 * kMebibyte),
            "");
}

TEST(FirstLine, IsTheFirstThatSaysSomething) {
  EXPECT_EQ(FirstLine("\xEF\xBB\xBF\r\n # a comment\r\n  X;Y \r\n1;2\r\n"), "x;y");
  EXPECT_EQ(FirstLine("\n#\n"), "");
  EXPECT_EQ(FirstLine(""), "");
}

}  // namespace
}  // namespace Vorn::IO
