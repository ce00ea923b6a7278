// The rotation matrices beside the plain loops that their header describes: bit for bit, on
// elements of every kind.

#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>
#include <cstdint>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/RandomGeometry.h"
#include "vorn/Matrix.h"

namespace Vorn::Testing {
namespace {

using Nine = std::array<double, 9>;
using Three = std::array<double, 3>;

constexpr int kRounds = 2000;

/// An element that a sum, a product or a comparison may treat in a way of its own.
double DrawElement(RandomGeometry* random) {
  constexpr double kHazards[] = {0.0, -0.0, 1.0, -1.0, kInf, -kInf, kNaN, 5e-324, 1e308, -1e308};
  switch (random->Integer(0, 9)) {
    case 0:
      return random->AnyDouble();
    case 1:
      return kHazards[random->Integer(0, 9)];
    case 2:
    case 3:
      return random->Integer(-2, 2);
    case 4:
      return random->Flip() ? 0.0 : -0.0;
    default:
      return random->Uniform(-1.0, 1.0);
  }
}

/// In turn matrices of every kind of element, of small whole numbers with both zeros, and of
/// ordinary numbers, so that not-a-numbers do not hide the rest.
Nine DrawMatrix(RandomGeometry* random, int round) {
  Nine elements;
  for (double& element : elements) {
    switch (round % 3) {
      case 0:
        element = DrawElement(random);
        break;
      case 1:
        element = random->Integer(-2, 2) * (random->Flip() ? 1.0 : -1.0);
        break;
      default:
        element = random->Uniform(-1.0, 1.0);
        break;
    }
  }
  return elements;
}

Matrix Make(Nine const& elements) {
  Mtrx mtrx;
  std::copy(elements.begin(), elements.end(), mtrx.m);
  return Matrix(mtrx);
}

Nine PlainProduct(Nine const& a, Nine const& b) {
  Nine product{};
  for (std::size_t row = 0; row < 3; ++row) {
    for (std::size_t column = 0; column < 3; ++column) {
      double sum = 0.0;
      for (std::size_t k = 0; k < 3; ++k) sum += a[3 * row + k] * b[3 * k + column];
      product[3 * row + column] = sum;
    }
  }
  return product;
}

Nine PlainTransposed(Nine const& a) {
  Nine transposed{};
  for (std::size_t row = 0; row < 3; ++row) {
    for (std::size_t column = 0; column < 3; ++column) {
      transposed[3 * column + row] = a[3 * row + column];
    }
  }
  return transposed;
}

/// binomial(2k, k) / 4^k with alternating signs: the series of (1 + x)^(-1/2).
constexpr double kExact[] = {
    1.0,         -1.0 / 2,     3.0 / 8,       -5.0 / 16,      35.0 / 128,
    -63.0 / 256, 231.0 / 1024, -429.0 / 2048, 6435.0 / 32768, -12155.0 / 65536};

/// The binomial series step by step, on whole arrays.
Nine PlainReorth(Nine const& elements, int terms) {
  constexpr Nine kIdentity{1, 0, 0, 0, 1, 0, 0, 0, 1};
  Nine drift = PlainProduct(PlainTransposed(elements), elements);
  for (std::size_t i = 0; i < 9; ++i) drift[i] -= kIdentity[i];
  Nine sum = kIdentity;
  Nine power = kIdentity;
  for (int k = 1; k < std::min(terms, 10); ++k) {
    power = PlainProduct(power, drift);
    for (std::size_t i = 0; i < 9; ++i) sum[i] += kExact[k] * power[i];
  }
  return PlainProduct(elements, sum);
}

Nine PlainX(double t) {
  return {1, 0, 0, 0, std::cos(t), std::sin(t), 0, -std::sin(t), std::cos(t)};
}
Nine PlainY(double t) {
  return {std::cos(t), 0, -std::sin(t), 0, 1, 0, std::sin(t), 0, std::cos(t)};
}
Nine PlainZ(double t) {
  return {std::cos(t), std::sin(t), 0, -std::sin(t), std::cos(t), 0, 0, 0, 1};
}

void ExpectSameBits(Nine const& expected, Matrix const& actual) {
  for (std::size_t i = 0; i < 9; ++i) EXPECT_SAME_BITS(expected[i], actual.m_[i]);
}

TEST(MatrixProduct, HasTheBitsOfThePlainSums) {
  RandomGeometry random(31);
  for (int round = 0; round < kRounds && !HasFailure(); ++round) {
    SCOPED_TRACE(testing::Message() << "seed 31, round " << round);
    Nine const a = DrawMatrix(&random, round);
    Nine const b = DrawMatrix(&random, round);
    Matrix first = Make(a);
    ExpectSameBits(PlainProduct(a, b), first * Make(b));
    ExpectSameBits(PlainProduct(a, a), first * first);
  }
}

TEST(MxV, HasTheBitsOfThePlainSums) {
  RandomGeometry random(32);
  for (int round = 0; round < kRounds && !HasFailure(); ++round) {
    SCOPED_TRACE(testing::Message() << "seed 32, round " << round);
    Nine const m = DrawMatrix(&random, round);
    SpatVector vector;
    for (double& entry : vector.v) entry = DrawMatrix(&random, round)[0];
    Matrix matrix = Make(m);
    SpatVector const column = matrix.MxV(vector);
    SpatVector const row = matrix.VxM(vector);
    double const* const v = vector.v;
    for (std::size_t i = 0; i < 3; ++i) {
      EXPECT_SAME_BITS(m[3 * i] * v[0] + m[3 * i + 1] * v[1] + m[3 * i + 2] * v[2], column.v[i]);
      EXPECT_SAME_BITS(v[0] * m[i] + v[1] * m[3 + i] + v[2] * m[6 + i], row.v[i]);
    }
  }
}

TEST(InitMxMyMz, HasTheBitsOfThePlainProductsForAnyAngles) {
  RandomGeometry random(33);
  for (int round = 0; round < kRounds && !HasFailure(); ++round) {
    SCOPED_TRACE(testing::Message() << "seed 33, round " << round);
    Three angles;
    for (double& angle : angles) angle = DrawElement(&random);
    auto const [x, y, z] = angles;
    Matrix matrix;
    matrix.InitMxMyMz(x, y, z);
    ExpectSameBits(PlainProduct(PlainProduct(PlainX(x), PlainY(y)), PlainZ(z)), matrix);
    matrix.InitMzMyMx(x, y, z);
    ExpectSameBits(PlainProduct(PlainProduct(PlainZ(z), PlainY(y)), PlainX(x)), matrix);
  }
}

TEST(Reorth, HasTheBitsOfThePlainSeries) {
  RandomGeometry random(34);
  for (int round = 0; round < kRounds && !HasFailure(); ++round) {
    SCOPED_TRACE(testing::Message() << "seed 34, round " << round);
    Nine const elements = DrawMatrix(&random, round);
    int const terms = random.Integer(-1, 12);
    Matrix matrix = Make(elements);
    ASSERT_TRUE(matrix.Reorth(terms));
    ExpectSameBits(PlainReorth(elements, terms), matrix);
  }
}

TEST(Transpose, KeepsEveryBit) {
  RandomGeometry random(35);
  for (int round = 0; round < kRounds && !HasFailure(); ++round) {
    Nine const elements = DrawMatrix(&random, round);
    Matrix matrix = Make(elements);
    matrix.Transpose();
    ExpectSameBits(PlainTransposed(elements), matrix);
  }
}

}  // namespace
}  // namespace Vorn::Testing
