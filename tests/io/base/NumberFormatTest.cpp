// Numbers as text: what is written reads back, and bad arguments do no harm.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <limits>
#include <random>

#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kLargest = std::numeric_limits<double>::max();
constexpr double kSmallest = std::numeric_limits<double>::denorm_min();

/// Of any size that a double can have.
double AnySize(std::mt19937_64* engine) {
  std::uniform_real_distribution<double> exponent(-300.0, 300.0);
  double const value = std::pow(10.0, exponent(*engine));
  return (*engine)() % 2 == 0 ? value : -value;
}

TEST(ParseNumber, AgreesWithTheConversionOfTheLanguage) {
  std::mt19937_64 engine(5);
  for (int round = 0; round < 5000; ++round) {
    std::string text = engine() % 2 == 0 ? "-" : "";
    for (std::uint64_t i = 1 + engine() % 20; i > 0; --i) {
      text += static_cast<char>('0' + engine() % 10);
    }
    if (engine() % 2 == 0) text.insert(text.size() - engine() % 2, ".");
    if (engine() % 2 == 0) text += "e" + std::to_string(static_cast<int>(engine() % 600) - 300);
    EXPECT_EQ(ParseNumber(text), std::strtod(text.c_str(), nullptr)) << text;
  }
}

TEST(ParseNumber, TheOtherMarkGivesTheSameNumber) {
  std::mt19937_64 engine(6);
  for (int round = 0; round < 2000; ++round) {
    std::string text = FormatExact(AnySize(&engine));
    std::optional<double> const withPoint = ParseNumber(text);
    std::size_t const point = text.find('.');
    if (point != std::string::npos) text[point] = ',';
    EXPECT_EQ(ParseNumber(text, DecimalMark::Comma), withPoint) << text;
    EXPECT_EQ(ParseNumber(text).has_value(), point == std::string::npos) << text;
  }
}

TEST(ParseNumber, ReadsTheBordersOfTheRange) {
  EXPECT_EQ(ParseNumber("1.7976931348623157e308"), kLargest);
  EXPECT_EQ(ParseNumber("4.9406564584124654e-324"), kSmallest);
  EXPECT_EQ(ParseNumber("1e-400"), 0.0);
  EXPECT_EQ(ParseNumber("-1e400"), -kInfinity);
  EXPECT_EQ(ParseNumber(std::string(400, '0') + "7"), 7.0);
}

TEST(ParseNumber, BytesThatAreNoDigitsAreNone) {
  for (int byte = 0; byte < 256; ++byte) {
    std::string const text = std::string("1") + static_cast<char>(byte) + "2";
    bool const isNumber = (byte >= '0' && byte <= '9') || byte == '.' || byte == 'e' || byte == 'E';
    EXPECT_EQ(ParseNumber(text).has_value(), isNumber) << byte;
  }
}

TEST(FormatShort, SaysTheNearestNumberOfSoManyDigits) {
  std::mt19937_64 engine(8);
  for (int round = 0; round < 5000; ++round) {
    double const value = AnySize(&engine);
    int const digits = 1 + static_cast<int>(engine() % 17);
    double const back = ParseNumber(FormatShort(value, digits)).value();
    // Half of the last digit, which is at most 10^(1 - digits) of the value.
    EXPECT_LE(std::fabs(back - value), 0.5000001 * std::pow(10.0, 1 - digits) * std::fabs(value))
        << value << " in " << digits;
  }
}

TEST(FormatShort, WritesNoDigitInVain) {
  std::mt19937_64 engine(9);
  for (int round = 0; round < 5000; ++round) {
    int const digits = 1 + static_cast<int>(engine() % 17);
    std::string const text = FormatShort(AnySize(&engine), digits);
    std::string const mantissa = text.substr(0, text.find('e'));
    auto const isDigit = [](char c) { return c >= '0' && c <= '9'; };
    EXPECT_LE(std::count_if(mantissa.begin(), mantissa.end(), isDigit), digits + 5) << text;
    if (mantissa.find('.') != std::string::npos) {
      EXPECT_NE(mantissa.back(), '0') << text;
      EXPECT_NE(mantissa.back(), '.') << text;
    }
  }
}

TEST(FormatShort, SeventeenDigitsReadBackAsTheSameNumber) {
  std::mt19937_64 engine(10);
  for (int round = 0; round < 5000; ++round) {
    double const value = AnySize(&engine);
    EXPECT_EQ(ParseNumber(FormatShort(value, 17)), value);
  }
}

TEST(FormatShort, NumbersOfDigitsThatMakeNoSenseAreTakenForTheNearestThatDo) {
  EXPECT_EQ(FormatShort(2.6, 0), "3");
  EXPECT_EQ(FormatShort(2.6, -7), "3");
  EXPECT_EQ(FormatShort(0.1, 60), "0.1000000000000000055511151231257827021181583404541015625");
  EXPECT_EQ(ParseNumber(FormatShort(kLargest, 1 << 30)), kLargest);
  EXPECT_EQ(ParseNumber(FormatShort(kSmallest, 1 << 30)), kSmallest);
}

TEST(FormatShort, WhatIsNoNumberSaysSo) {
  EXPECT_EQ(FormatShort(kInfinity), "inf");
  EXPECT_EQ(FormatShort(-kInfinity), "-inf");
  EXPECT_NE(FormatShort(std::nan("")).find("nan"), std::string::npos);
}

TEST(FormatFixed, HasAlwaysSoManyDecimals) {
  std::mt19937_64 engine(11);
  for (int round = 0; round < 5000; ++round) {
    double const value = AnySize(&engine);
    int const decimals = static_cast<int>(engine() % 40);
    std::string const text = FormatFixed(value, decimals);
    std::size_t const point = text.find('.');
    if (decimals == 0) {
      EXPECT_EQ(point, std::string::npos) << text;
    } else {
      EXPECT_EQ(text.size() - point - 1, static_cast<std::size_t>(decimals)) << text;
    }
    double const back = ParseNumber(text).value();
    EXPECT_LE(std::fabs(back - value),
              0.5000001 * std::pow(10.0, -decimals) + 1e-15 * std::fabs(value));
  }
}

TEST(FormatFixed, TheLargestNumberWithManyDecimalsIsWhole) {
  std::string const text = FormatFixed(-kLargest, 300);
  EXPECT_EQ(text.size(), 1u + 309u + 1u + 300u);
  EXPECT_EQ(ParseNumber(text), -kLargest);
}

TEST(FormatFixed, NumbersOfDecimalsThatMakeNoSenseAreTakenForTheNearestThatDo) {
  EXPECT_EQ(FormatFixed(2.6, -3), "3");
  EXPECT_EQ(FormatFixed(0.5, 1 << 30).size(), 2u + 1074u);
  EXPECT_EQ(ParseNumber(FormatFixed(kSmallest, 1 << 30)), kSmallest);
}

TEST(FormatRelative, HasFourDigitsAwayFromOne) {
  EXPECT_EQ(FormatRelative(0.9994), "0.9994");
  EXPECT_EQ(FormatRelative(1.0006), "1.001");
  EXPECT_EQ(FormatRelative(123456.0), "1.235e+05");
  EXPECT_EQ(FormatRelative(kInfinity), "inf");
}

TEST(FormatRelative, OnlyOneReadsAsOne) {
  double below = 1.0;
  double above = 1.0;
  for (int i = 0; i < 60; ++i) {
    below = std::nextafter(below, 0.0);
    above = std::nextafter(above, 2.0);
    EXPECT_LT(ParseNumber(FormatRelative(below)).value(), 1.0);
    EXPECT_GT(ParseNumber(FormatRelative(above)).value(), 1.0);
  }
}

TEST(FormatExact, IsTheShortestThatReadsBack) {
  std::mt19937_64 engine(12);
  for (int round = 0; round < 3000; ++round) {
    double const value = AnySize(&engine);
    std::string const text = FormatExact(value);
    for (int digits = 1; digits < 17; ++digits) {
      if (ParseNumber(FormatShort(value, digits)) != value) continue;
      EXPECT_LE(text.size(), FormatShort(value, digits).size()) << text;
      break;
    }
  }
  EXPECT_EQ(FormatExact(0.1), "0.1");
  EXPECT_EQ(FormatExact(-0.0), "-0");
  EXPECT_EQ(FormatExact(1e22), "1e+22");
}

TEST(LowerCase, ChangesLettersOfTheAlphabetAndNothingElse) {
  for (int byte = 0; byte < 256; ++byte) {
    char const c = static_cast<char>(byte);
    bool const isCapital = byte >= 'A' && byte <= 'Z';
    EXPECT_EQ(LowerCase(std::string(1, c)),
              std::string(1, isCapital ? static_cast<char>(byte + 32) : c));
  }
}

TEST(Counted, OneIsSingular) {
  EXPECT_EQ(Counted(0, "line"), "0 lines");
  EXPECT_EQ(Counted(1, "line"), "1 line");
  EXPECT_EQ(Counted(2, "line"), "2 lines");
}

}  // namespace
}  // namespace Vorn::IO
