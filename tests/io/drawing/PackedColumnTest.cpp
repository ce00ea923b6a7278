#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <random>
#include <string>
#include <vector>

#include "io/drawing/PackedColumn.h"
#include "tests/io/drawing/Unpacked.h"

namespace Vorn::IO {
namespace {

using ::testing::ElementsAreArray;

TEST(DecimalsOfStep, LastDigitIsWorthNoMoreThanTheStep) {
  EXPECT_EQ(DecimalsOfStep(1e-7), 7);
  EXPECT_EQ(DecimalsOfStep(2e-7), 7);
  EXPECT_EQ(DecimalsOfStep(0.9e-7), 8);
  EXPECT_EQ(DecimalsOfStep(1.0), 0);
  EXPECT_EQ(DecimalsOfStep(250.0), -2);
}

TEST(MostDecimals, KeepMultiplesBelowTwoToTheFiftieth) {
  EXPECT_EQ(MostDecimals(1.0), 15);
  EXPECT_EQ(MostDecimals(1000.0), 12);
  EXPECT_EQ(MostDecimals(1e30), -15);
  EXPECT_EQ(MostDecimals(0.0), 22) << "the largest exact power of ten";
}

// 150, -1, 0, 0 by hand: 300 is 0xAC 0x02, -1 is 0x01, the zeros are 0x00 and one more.
TEST(Pack, IsTheColumnThatThePageReads) {
  PackedColumn const column = Pack({1.5, -0.01, 0.0, 0.0}, 2);
  EXPECT_EQ(column.decimals, 2);
  EXPECT_EQ(column.order, 0);
  EXPECT_EQ(column.count, 4U);
  EXPECT_EQ(column.bytes, "rAIBAAE=");
}

TEST(Pack, NumbersWithSoManyDecimalsComeBackExactly) {
  std::mt19937 random(5);
  std::uniform_int_distribution<int> digit(0, 9);
  std::vector<double> numbers;
  for (int i = 0; i < 3000; ++i) {
    std::string text = i % 2 == 0 ? "-" : "";
    for (int k = 0; k < 3; ++k) text += std::to_string(digit(random));
    text += '.';
    for (int k = 0; k < 7; ++k) text += std::to_string(digit(random));
    numbers.push_back(std::stod(text));
  }
  EXPECT_THAT(Unpacked(Pack(numbers, 7)), ElementsAreArray(numbers));
}

TEST(Pack, OtherNumbersComeBackWithinHalfAStep) {
  std::mt19937 random(6);
  for (double const size : {1e-3, 1.0, 1e6, 1e20}) {
    std::uniform_real_distribution<double> uniform(-size, size);
    std::vector<double> numbers(1000);
    for (double& number : numbers) number = uniform(random);
    int const decimals = std::min(6, MostDecimals(size));
    std::vector<double> const unpacked = Unpacked(Pack(numbers, decimals));
    ASSERT_EQ(unpacked.size(), numbers.size());
    for (std::size_t i = 0; i < numbers.size(); ++i) {
      double const rounding = std::fabs(numbers[i]) * 4.5e-16;
      EXPECT_LE(std::fabs(unpacked[i] - numbers[i]), 0.5 * std::pow(10.0, -decimals) + rounding);
    }
  }
}

TEST(Pack, LargestMultiplesKeepTheirSigns) {
  std::vector<double> const numbers = {1125899906842623.0, -1125899906842623.0, 1125899906842622.0};
  EXPECT_THAT(Unpacked(Pack(numbers, 0)), ElementsAreArray(numbers));
}

TEST(Pack, TakesTheOrderWithTheLeastRoom) {
  std::vector<double> even;
  std::vector<double> constant(5000, 12345.0);
  for (int i = 0; i < 5000; ++i) even.push_back(1e6 + 700.0 * i);
  EXPECT_EQ(Pack(even, 0).order, 2);
  EXPECT_LT(Pack(even, 0).bytes.size(), 20U) << "a run of zeros is told once";
  EXPECT_EQ(Pack(constant, 0).order, 1);
  EXPECT_LT(Pack(constant, 0).bytes.size(), 20U);
  EXPECT_EQ(Pack({5.0, -5.0, 5.0, -5.0}, 0).order, 0);
}

TEST(Pack, TakesAnEmptyColumn) {
  PackedColumn const column = Pack({}, 3);
  EXPECT_EQ(column.count, 0U);
  EXPECT_EQ(column.bytes, "");
}

}  // namespace
}  // namespace Vorn::IO
