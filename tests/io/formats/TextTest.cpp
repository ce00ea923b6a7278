#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>

#include "io/FormatContours.h"
#include "io/formats/LengthUnits.h"
#include "io/formats/Text.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;

std::vector<std::string> AllLines(std::string const& text) {
  std::vector<std::string> all;
  Lines lines(text);
  std::string_view line;
  while (lines.Next(&line)) {
    all.emplace_back(line);
    EXPECT_EQ(lines.Number(), all.size());
  }
  return all;
}

TEST(Lines, EndsAreOfAnySystem) {
  EXPECT_EQ(AllLines("a\nb\r\nc\rd"), (std::vector<std::string>{"a", "b", "c", "d"}));
  EXPECT_EQ(AllLines("a\n\n\nb\n"), (std::vector<std::string>{"a", "", "", "b"}));
  EXPECT_TRUE(AllLines("").empty());
}

TEST(Lines, AByteOrderMarkIsSkippedAtTheBeginningOnly) {
  EXPECT_EQ(AllLines("\xEF\xBB\xBFx"), std::vector<std::string>{"x"});
  EXPECT_EQ(AllLines("\xEF\xBB"), std::vector<std::string>{"\xEF\xBB"});
  EXPECT_EQ(AllLines("x\n\xEF\xBB\xBFy")[1], "\xEF\xBB\xBFy");
  EXPECT_TRUE(AllLines("\xEF\xBB\xBF").empty());
}

TEST(RequireNumber, NamesWhatIsWrongWithTheText) {
  auto const complaint = [](std::string const& text) {
    return Refusal([&] { RequireNumber(text, "start_x", "p.csv", 7); });
  };
  EXPECT_EQ(RequireNumber("-1.5e3", "x", "p", 1), -1500.0);
  EXPECT_EQ(complaint("one"), "p.csv:7: start_x 'one' is not a number");
  EXPECT_EQ(complaint(""), "p.csv:7: start_x '' is not a number");
  EXPECT_EQ(complaint("nan"), "p.csv:7: start_x 'nan' is not finite");
  EXPECT_EQ(complaint("1e999"), "p.csv:7: start_x '1e999' is not finite");
  EXPECT_EQ(complaint("-inf"), "p.csv:7: start_x '-inf' is not finite");
}

TEST(RequireNumber, CoordinatesEndAt1e150) {
  EXPECT_EQ(RequireNumber("1e150", "x", "p", 1), 1e150);
  EXPECT_EQ(RequireNumber("-1e150", "x", "p", 1), -1e150);
  EXPECT_EQ(Refusal([] { RequireNumber("1.0000000000000002e150", "x", "p", 1); }),
            "p:1: x '1.0000000000000002e150' is too large");
}

TEST(FormatPlain, HasAPointAndNoExponent) {
  EXPECT_EQ(FormatPlain(5.0), "5.0");
  EXPECT_EQ(FormatPlain(0.00001), "0.00001");
  EXPECT_EQ(FormatPlain(-0.0), "-0.0");
  EXPECT_EQ(FormatPlain(1e21), "1000000000000000000000.0");
  EXPECT_EQ(FormatPlain(1.0 / 3.0), "0.3333333333333333");
}

TEST(FormatPlain, ReadsBackAsTheSameBitsAtEverySize) {
  std::mt19937_64 engine(21);
  std::uniform_real_distribution<double> exponent(-320.0, 308.0);
  for (int round = 0; round < 5000; ++round) {
    double const value = std::pow(10.0, exponent(engine)) * (engine() % 2 == 0 ? 1.0 : -1.0);
    std::string const text = FormatPlain(value);
    EXPECT_TRUE(SameBits(ParseNumber(text).value(), value)) << text;
    EXPECT_EQ(text.find_first_of("eE"), std::string::npos) << text;
    EXPECT_NE(text.find('.'), std::string::npos) << text;
  }
  EXPECT_EQ(ParseNumber(FormatPlain(std::numeric_limits<double>::max())),
            std::numeric_limits<double>::max());
  EXPECT_EQ(ParseNumber(FormatPlain(-std::numeric_limits<double>::denorm_min())),
            -std::numeric_limits<double>::denorm_min());
}

TEST(OneLine, TakesLineBreaksOutAndKeepsTheLength) {
  EXPECT_EQ(OneLine("a\nb\r\nc"), "a b  c");
  EXPECT_EQ(OneLine(""), "");
  EXPECT_EQ(OneLine("\t a"), "\t a");
}

TEST(PlaceIn, CountsLinesAndColumnsFromOne) {
  std::string const text = "ab\nc\n\nd";
  auto const place = [&](std::size_t offset) {
    Place const at = PlaceIn(text, offset, "p");
    EXPECT_EQ(at.file, "p");
    return std::pair(at.line, at.column);
  };
  using Pair = std::pair<std::size_t, std::size_t>;
  EXPECT_EQ(place(0), Pair(1, 1));
  EXPECT_EQ(place(1), Pair(1, 2));
  EXPECT_EQ(place(2), Pair(1, 3)) << "the line end belongs to its line";
  EXPECT_EQ(place(3), Pair(2, 1));
  EXPECT_EQ(place(5), Pair(3, 1));
  EXPECT_EQ(place(6), Pair(4, 1));
  EXPECT_EQ(place(7), Pair(4, 2)) << "behind the text";
  EXPECT_EQ(PlaceIn("", 0, "p").line, 1u);
}

TEST(LengthUnits, AreKnownInTheSpellingsOfFiles) {
  for (char const* name : {"in", "inch", "inches", "IN", "Inch"}) {
    EXPECT_TRUE(IsInch(name)) << name;
    EXPECT_FALSE(IsMillimetre(name)) << name;
  }
  for (char const* name : {"mm", "MM", "millimetre", "Millimeter"}) {
    EXPECT_TRUE(IsMillimetre(name)) << name;
    EXPECT_FALSE(IsInch(name)) << name;
  }
  for (char const* name : {"", "m", "cm", "\"", "mm ", " in", "min"}) {
    EXPECT_FALSE(IsInch(name) || IsMillimetre(name)) << name;
  }
}

}  // namespace
}  // namespace Vorn::IO
