#include <gtest/gtest.h>

#include <bit>
#include <cmath>
#include <limits>
#include <random>

#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {
namespace {

TEST(ParseNumber, TakesTheWholeTextOrNothing) {
  EXPECT_EQ(ParseNumber("+1.5e3"), 1500.0);
  EXPECT_EQ(ParseNumber("-.0005993"), -.0005993);
  EXPECT_EQ(ParseNumber("2."), 2.0);
  for (char const* text :
       {"", "+", "-", ".", "e5", "1,5", "1 2", " 1", "1 ", "0x1", "+-1", "++1"}) {
    EXPECT_FALSE(ParseNumber(text).has_value()) << text;
  }
}

TEST(ParseNumber, ReadsADecimalCommaWhereAskedTo) {
  EXPECT_EQ(ParseNumber("1,5E+03", DecimalMark::Comma), 1500.0);
  EXPECT_EQ(ParseNumber("-,5", DecimalMark::Comma), -0.5);
  EXPECT_EQ(ParseNumber("7", DecimalMark::Comma), 7.0);
  for (char const* text : {"", ",", "1,", "1,e5", "1.5", "1,5,2", "1.000,5"}) {
    EXPECT_FALSE(ParseNumber(text, DecimalMark::Comma).has_value()) << text;
  }
}

TEST(ParseNumber, KeepsTheSignOfZero) { EXPECT_TRUE(std::signbit(ParseNumber("-0.0").value())); }

TEST(ParseNumber, LeavesJudgingNonFiniteValuesToTheCaller) {
  EXPECT_TRUE(std::isnan(ParseNumber("nan").value()));
  EXPECT_TRUE(std::isinf(ParseNumber("-inf").value()));
  EXPECT_TRUE(std::isinf(ParseNumber("1e999").value()));
}

TEST(FormatRelative, NeverReadsAsOneBesideIt) {
  EXPECT_EQ(FormatRelative(0.12345), "0.1235");
  EXPECT_EQ(FormatRelative(1.0), "1");
  EXPECT_EQ(FormatRelative(0.99996), "0.99996");
  EXPECT_EQ(FormatRelative(1.00004), "1.00004");
  EXPECT_EQ(FormatRelative(0.9999999999), "0.9999999999");
  EXPECT_EQ(FormatRelative(std::nextafter(1.0, 2.0)), "1.0000000000000002");
  EXPECT_EQ(FormatRelative(0.0), "0");
  EXPECT_EQ(FormatRelative(1575.4), "1575");
}

TEST(FormatExact, ReadsBackAsTheSameBits) {
  constexpr std::uint64_t kSeed = 7;
  SCOPED_TRACE(kSeed);
  std::mt19937_64 engine(kSeed);
  int finite = 0;
  for (int i = 0; i < 20000; ++i) {
    auto const value = std::bit_cast<double>(engine());
    if (!std::isfinite(value)) continue;
    ++finite;
    double const back = ParseNumber(FormatExact(value)).value();
    EXPECT_EQ(std::bit_cast<std::uint64_t>(back), std::bit_cast<std::uint64_t>(value));
  }
  EXPECT_GT(finite, 19000);
}

TEST(FormatShort, DropsTrailingZerosAndTheSignOfZero) {
  EXPECT_EQ(FormatShort(0.02), "0.02");
  EXPECT_EQ(FormatShort(1234567.0), "1.23457e+06");
  EXPECT_EQ(FormatShort(-0.0), "0");
}

TEST(FormatFixed, NeverWritesMinusZero) {
  EXPECT_EQ(FormatFixed(-0.0004, 3), "0.000");
  EXPECT_EQ(FormatFixed(-0.0006, 3), "-0.001");
  EXPECT_EQ(FormatFixed(-10.0, 0), "-10");
  EXPECT_EQ(FormatFixed(std::numeric_limits<double>::max(), 9).size(), 309u + 10u);
}

TEST(Quoted, CutsLongTextAndHidesControlCharacters) {
  EXPECT_EQ(Quoted("a\tb"), "'a?b'");
  EXPECT_EQ(Quoted(std::string(41, 'x')), "'" + std::string(40, 'x') + "...'");
  EXPECT_EQ(Quoted("\xC3\xA4"), "'\xC3\xA4'");
}

TEST(ShellQuoted, QuotesOnlyWhatAShellWouldTakeApart) {
  EXPECT_EQ(ShellQuoted("scans/part-1.csv"), "scans/part-1.csv");
  EXPECT_EQ(ShellQuoted("my part.csv"), "'my part.csv'");
  EXPECT_EQ(ShellQuoted("it's"), "'it'\\''s'");
  EXPECT_EQ(ShellQuoted("$HOME"), "'$HOME'");
  EXPECT_EQ(ShellQuoted(""), "''");
}

TEST(Counted, KnowsThePlural) {
  EXPECT_EQ(Counted(0, "arc"), "0 arcs");
  EXPECT_EQ(Counted(1, "arc"), "1 arc");
  EXPECT_EQ(Counted(2, "arc"), "2 arcs");
}

}  // namespace
}  // namespace Vorn::IO
