#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>
#include <limits>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/RandomGeometry.h"
#include "vorn/Matrix.h"

namespace Vorn::Testing {
namespace {

using Nine = std::array<double, 9>;

constexpr double kRightAngleLiteral = 1.570796326794895;
constexpr Nine kIdentity{1, 0, 0, 0, 1, 0, 0, 0, 1};
constexpr int kIntMin = std::numeric_limits<int>::min();
constexpr int kIntMax = std::numeric_limits<int>::max();

Matrix Make(Nine const& elements) {
  Mtrx mtrx;
  std::copy(elements.begin(), elements.end(), mtrx.m);
  return Matrix(mtrx);
}

Nine Read(Matrix const& matrix) {
  Nine elements;
  std::copy_n(matrix.m_, 9, elements.begin());
  return elements;
}

void ExpectSameBits(Nine const& expected, Nine const& actual) {
  for (std::size_t i = 0; i < 9; ++i) {
    SCOPED_TRACE(testing::Message() << "element " << i);
    EXPECT_SAME_BITS(expected[i], actual[i]);
  }
}

void ExpectNear(Nine const& expected, Nine const& actual, double tolerance) {
  for (std::size_t i = 0; i < 9; ++i)
    EXPECT_NEAR(expected[i], actual[i], tolerance) << "element " << i;
}

Nine Times(Nine const& a, Nine const& b) {
  Nine product{};
  for (std::size_t i = 0; i < 3; ++i) {
    for (std::size_t j = 0; j < 3; ++j) {
      product[3 * i + j] =
          ((0.0 + a[3 * i] * b[j]) + a[3 * i + 1] * b[3 + j]) + a[3 * i + 2] * b[6 + j];
    }
  }
  return product;
}

Nine Mx(double t) { return {1, 0, 0, 0, std::cos(t), std::sin(t), 0, -std::sin(t), std::cos(t)}; }
Nine My(double t) { return {std::cos(t), 0, -std::sin(t), 0, 1, 0, std::sin(t), 0, std::cos(t)}; }
Nine Mz(double t) { return {std::cos(t), std::sin(t), 0, -std::sin(t), std::cos(t), 0, 0, 0, 1}; }

/// The largest |element| of transpose(m) * m - I.
double Drift(Nine const& m) {
  double worst = 0.0;
  for (std::size_t i = 0; i < 3; ++i) {
    for (std::size_t j = 0; j < 3; ++j) {
      long double sum = i == j ? -1.0L : 0.0L;
      for (std::size_t k = 0; k < 3; ++k)
        sum += static_cast<long double>(m[3 * k + i]) * static_cast<long double>(m[3 * k + j]);
      worst = std::max(worst, static_cast<double>(std::fabs(sum)));
    }
  }
  return worst;
}

TEST(MatrixConstruction, DefaultIsTheIdentity) {
  Matrix const matrix;
  ExpectSameBits(kIdentity, Read(matrix));
  EXPECT_EQ(matrix.Det(), 1.0);
}

TEST(MatrixConstruction, MtrxIsCopiedRowMajor) {
  Mtrx mtrx;
  for (int i = 0; i < 9; ++i) mtrx.m[i] = i + 1.0;
  Matrix const matrix(mtrx);
  mtrx.m[0] = kSentinel;
  ExpectSameBits({1, 2, 3, 4, 5, 6, 7, 8, 9}, Read(matrix));
}

TEST(MatrixConstruction, KeepsEveryBitPattern) {
  Nine const odd{kNaN, kInf, -kInf, -0.0, 0.0, 5e-324, -5e-324, 1e308, -1e308};
  ExpectSameBits(odd, Read(Make(odd)));
  Matrix const copy(Make(odd));
  ExpectSameBits(odd, Read(copy));
}

TEST(MatrixAssignment, CopiesAndReturnsTheObject) {
  Matrix const source = Make({1, 2, 3, 4, 5, 6, 7, 8, 9});
  Matrix target;
  EXPECT_EQ(&(target = source), &target);
  ExpectSameBits(Read(source), Read(target));
}

TEST(MatrixAssignment, SelfAssignmentLeavesTheMatrixAsItIs) {
  Nine const elements{1, -2, 3, kNaN, 5, -0.0, 7, kInf, 9};
  Matrix matrix = Make(elements);
  Matrix& same = matrix;
  EXPECT_EQ(&(matrix = same), &matrix);
  ExpectSameBits(elements, Read(matrix));
}

TEST(MatrixProduct, RowsMeetColumns) {
  Matrix a = Make({1, 2, 3, 4, 5, 6, 7, 8, 10});
  Matrix b = Make({2, 0, 1, -1, 3, 5, 4, -2, 0});
  ExpectSameBits({12, 0, 11, 27, 3, 29, 46, 4, 47}, Read(a * b));
  ExpectSameBits({9, 12, 16, 46, 53, 65, -4, -2, 0}, Read(b * a));
}

TEST(MatrixProduct, SumsStartAtPositiveZero) {
  Matrix a = Make({-0.0, -0.0, -0.0, -0.0, -0.0, -0.0, -0.0, -0.0, -0.0});
  Matrix b = Make({1, 1, 1, 1, 1, 1, 1, 1, 1});
  ExpectSameBits({0, 0, 0, 0, 0, 0, 0, 0, 0}, Read(a * b));
}

TEST(MatrixProduct, SumsRunInColumnOrder) {
  // (2^53 + 1) + 1 rounds twice to 2^53; any other order gives 2^53 + 2.
  Matrix a = Make({0x1p53, 1, 1, 0, 0, 0, 0, 0, 0});
  Matrix b = Make({1, 0, 0, 1, 0, 0, 1, 0, 0});
  EXPECT_EQ(Read(a * b)[0], 0x1p53);
}

TEST(MatrixProduct, LeavesBothFactorsAsTheyAreAndTakesItselfAsFactor) {
  Nine const elements{1, 2, 3, 4, 5, 6, 7, 8, 10};
  Matrix a = Make(elements);
  ExpectSameBits({30, 36, 45, 66, 81, 102, 109, 134, 169}, Read(a * a));
  ExpectSameBits(elements, Read(a));
}

TEST(Det, IsExactOnWholeNumbers) {
  EXPECT_EQ(Make({1, 2, 3, 4, 5, 6, 7, 8, 10}).Det(), -3.0);
  EXPECT_EQ(Make({2, 0, 1, -1, 3, 5, 4, -2, 0}).Det(), 10.0);
  EXPECT_EQ(Make({1, 2, 3, 2, 4, 6, 7, 8, 9}).Det(), 0.0);
}

TEST(Det, TermsAreAddedInTheFixedOrder) {
  // 2^54 + (2 + 2) - 2^54 - 2 - 2: every other grouping or order rounds differently.
  Nine const elements{2, 0x1p-26, 0x1p27, 0x1p27, 1, 1, 0x1p27, 1, 1};
  EXPECT_EQ(Make(elements).Det(), 0.0);
}

TEST(Det, OfARotationIsOne) {
  RandomGeometry random(11);
  for (int i = 0; i < 200; ++i) {
    Matrix matrix;
    matrix.InitMxMyMz(random.Uniform(-9, 9), random.Uniform(-9, 9), random.Uniform(-9, 9));
    EXPECT_NEAR(matrix.Det(), 1.0, 1e-14);
  }
}

TEST(InitI, OverwritesEverything) {
  Matrix matrix = Make({kNaN, kInf, 3, 4, 5, 6, 7, 8, kNaN});
  matrix.InitI();
  ExpectSameBits(kIdentity, Read(matrix));
}

TEST(InitMxMyMz, TurnsTheFrameAboutSingleAxes) {
  double const c = std::cos(0.3);
  double const s = std::sin(0.3);
  for (bool const zFirst : {false, true}) {
    auto const init = [zFirst](double ax, double ay, double az) {
      Matrix matrix;
      zFirst ? matrix.InitMzMyMx(ax, ay, az) : matrix.InitMxMyMz(ax, ay, az);
      return Read(matrix);
    };
    EXPECT_EQ(init(0.3, 0, 0), (Nine{1, 0, 0, 0, c, s, 0, -s, c}));
    EXPECT_EQ(init(0, 0.3, 0), (Nine{c, 0, -s, 0, 1, 0, s, 0, c}));
    EXPECT_EQ(init(0, 0, 0.3), (Nine{c, s, 0, -s, c, 0, 0, 0, 1}));
    EXPECT_EQ(init(0, 0, 0), kIdentity);
  }
}

TEST(InitMxMyMz, IsTheProductFromLeftToRight) {
  RandomGeometry random(12);
  for (int i = 0; i < 200; ++i) {
    double const ax = random.Uniform(-4, 4);
    double const ay = random.Uniform(-4, 4);
    double const az = random.Uniform(-4, 4);
    Matrix matrix;
    matrix.InitMxMyMz(ax, ay, az);
    ExpectSameBits(Times(Times(Mx(ax), My(ay)), Mz(az)), Read(matrix));
  }
}

TEST(InitMzMyMx, IsTheProductFromLeftToRight) {
  RandomGeometry random(13);
  for (int i = 0; i < 200; ++i) {
    double const ax = random.Uniform(-4, 4);
    double const ay = random.Uniform(-4, 4);
    double const az = random.Uniform(-4, 4);
    Matrix matrix;
    matrix.InitMzMyMx(ax, ay, az);
    ExpectSameBits(Times(Times(Mz(az), My(ay)), Mx(ax)), Read(matrix));
  }
}

TEST(GetAnglesFromMxMyMz, GivesTheAnglesBack) {
  RandomGeometry random(14);
  for (int i = 0; i < 500; ++i) {
    double const ax = random.Uniform(-3.14, 3.14);
    double const ay = random.Uniform(-1.55, 1.55);
    double const az = random.Uniform(-3.14, 3.14);
    Matrix matrix;
    matrix.InitMxMyMz(ax, ay, az);
    double x = kSentinel;
    double y = kSentinel;
    double z = kSentinel;
    matrix.GetAnglesFromMxMyMz(&x, &y, &z);
    EXPECT_NEAR(x, ax, 1e-12);
    EXPECT_NEAR(y, ay, 1e-12);
    EXPECT_NEAR(z, az, 1e-12);
  }
}

TEST(GetAnglesFromMzMyMx, GivesTheAnglesBack) {
  RandomGeometry random(15);
  for (int i = 0; i < 500; ++i) {
    double const ax = random.Uniform(-3.14, 3.14);
    double const ay = random.Uniform(-1.55, 1.55);
    double const az = random.Uniform(-3.14, 3.14);
    Matrix matrix;
    matrix.InitMzMyMx(ax, ay, az);
    double x = kSentinel;
    double y = kSentinel;
    double z = kSentinel;
    matrix.GetAnglesFromMzMyMx(&x, &y, &z);
    EXPECT_NEAR(x, ax, 1e-12);
    EXPECT_NEAR(y, ay, 1e-12);
    EXPECT_NEAR(z, az, 1e-12);
  }
}

TEST(GetAnglesFromMxMyMz, GimbalLockPutsTheWholeRotationIntoX) {
  for (double const rightAngle : {kRightAngleLiteral, std::acos(0.0)}) {
    double x = kSentinel;
    double y = kSentinel;
    double z = kSentinel;
    Matrix matrix;
    matrix.InitMxMyMz(0.7, rightAngle, 0.4);
    matrix.GetAnglesFromMxMyMz(&x, &y, &z);
    EXPECT_NEAR(x, 0.7 - 0.4, 1e-14);
    EXPECT_SAME_BITS(y, kRightAngleLiteral);
    EXPECT_SAME_BITS(z, 0.0);
    matrix.InitMxMyMz(0.7, -rightAngle, 0.4);
    matrix.GetAnglesFromMxMyMz(&x, &y, &z);
    EXPECT_NEAR(x, 0.7 + 0.4, 1e-14);
    EXPECT_SAME_BITS(y, -kRightAngleLiteral);
    EXPECT_SAME_BITS(z, 0.0);
  }
}

TEST(GetAnglesFromMzMyMx, GimbalLockPutsTheWholeRotationIntoX) {
  for (double const rightAngle : {kRightAngleLiteral, std::acos(0.0)}) {
    double x = kSentinel;
    double y = kSentinel;
    double z = kSentinel;
    Matrix matrix;
    matrix.InitMzMyMx(0.7, rightAngle, 0.4);
    matrix.GetAnglesFromMzMyMx(&x, &y, &z);
    EXPECT_NEAR(x, 0.7 + 0.4, 1e-14);
    EXPECT_SAME_BITS(y, kRightAngleLiteral);
    EXPECT_SAME_BITS(z, 0.0);
    matrix.InitMzMyMx(0.7, -rightAngle, 0.4);
    matrix.GetAnglesFromMzMyMx(&x, &y, &z);
    EXPECT_NEAR(x, 0.7 - 0.4, 1e-14);
    EXPECT_SAME_BITS(y, -kRightAngleLiteral);
    EXPECT_SAME_BITS(z, 0.0);
  }
}

TEST(GetAnglesFromMxMyMz, EveryAngleComesFromItsOwnElements) {
  double x = kSentinel;
  double y = kSentinel;
  double z = kSentinel;
  Matrix regular = Make({0.8, 0.1, 0.5, 9, 9, 0.2, 9, 9, 0.9});
  regular.GetAnglesFromMxMyMz(&x, &y, &z);
  EXPECT_SAME_BITS(y, -std::asin(0.5));
  EXPECT_SAME_BITS(z, std::atan2(0.1, 0.8));
  EXPECT_SAME_BITS(x, std::atan2(0.2, 0.9));
  Matrix lockedUp = Make({9, 9, -1, 0.3, 0.6, 9, 9, 9, 9});
  lockedUp.GetAnglesFromMxMyMz(&x, &y, &z);
  EXPECT_SAME_BITS(x, std::atan2(0.3, 0.6));
  EXPECT_SAME_BITS(y, kRightAngleLiteral);
  Matrix lockedDown = Make({9, 9, 1, 0.3, 0.6, 9, 9, 9, 9});
  lockedDown.GetAnglesFromMxMyMz(&x, &y, &z);
  EXPECT_SAME_BITS(x, std::atan2(-0.3, 0.6));
  EXPECT_SAME_BITS(y, -kRightAngleLiteral);
}

TEST(GetAnglesFromMzMyMx, EveryAngleComesFromItsOwnElements) {
  double x = kSentinel;
  double y = kSentinel;
  double z = kSentinel;
  Matrix regular = Make({0.8, 9, 9, 0.1, 9, 9, 0.5, 0.2, 0.9});
  regular.GetAnglesFromMzMyMx(&x, &y, &z);
  EXPECT_SAME_BITS(y, std::asin(0.5));
  EXPECT_SAME_BITS(z, std::atan2(-0.1, 0.8));
  EXPECT_SAME_BITS(x, std::atan2(-0.2, 0.9));
  Matrix lockedUp = Make({9, 0.3, 9, 9, 0.6, 9, 1, 9, 9});
  lockedUp.GetAnglesFromMzMyMx(&x, &y, &z);
  EXPECT_SAME_BITS(x, std::atan2(0.3, 0.6));
  EXPECT_SAME_BITS(y, kRightAngleLiteral);
  Matrix lockedDown = Make({9, 0.3, 9, 9, 0.6, 9, -1, 9, 9});
  lockedDown.GetAnglesFromMzMyMx(&x, &y, &z);
  EXPECT_SAME_BITS(x, std::atan2(-0.3, 0.6));
  EXPECT_SAME_BITS(y, -kRightAngleLiteral);
}

TEST(GetAnglesFromMxMyMz, TheNextDoubleBelowOneIsNotLocked) {
  double x = kSentinel;
  double y = kSentinel;
  double z = kSentinel;
  Matrix xyz = Make({0.8, 0.1, Down(1.0), 9, 9, 0.2, 9, 9, 0.9});
  xyz.GetAnglesFromMxMyMz(&x, &y, &z);
  EXPECT_SAME_BITS(y, -std::asin(Down(1.0)));
  Matrix zyx = Make({0.8, 9, 9, 0.1, 9, 9, Down(1.0), 0.2, 0.9});
  zyx.GetAnglesFromMzMyMx(&x, &y, &z);
  EXPECT_SAME_BITS(y, std::asin(Down(1.0)));
}

TEST(GetAnglesFromMxMyMz, ASineOutOfRangeIsTakenForLockedDownwards) {
  for (double const sine : {2.0, -2.0, kInf, -kInf, kNaN}) {
    double x = kSentinel;
    double y = kSentinel;
    double z = kSentinel;
    Matrix xyz = Make({9, 9, sine, 0.3, 0.6, 9, 9, 9, 9});
    xyz.GetAnglesFromMxMyMz(&x, &y, &z);
    EXPECT_SAME_BITS(x, std::atan2(-0.3, 0.6));
    EXPECT_SAME_BITS(y, -kRightAngleLiteral);
    EXPECT_SAME_BITS(z, 0.0);
    Matrix zyx = Make({9, 0.3, 9, 9, 0.6, 9, sine, 9, 9});
    zyx.GetAnglesFromMzMyMx(&x, &y, &z);
    EXPECT_SAME_BITS(x, std::atan2(-0.3, 0.6));
    EXPECT_SAME_BITS(y, -kRightAngleLiteral);
    EXPECT_SAME_BITS(z, 0.0);
  }
}

TEST(SpatVector, HasFiveZeroEntries) {
  SpatVector const vector;
  EXPECT_EQ(vector.QuantityOfDataElements(), 5);
  for (double const entry : vector.v) EXPECT_SAME_BITS(entry, 0.0);
}

TEST(MxV, TakesTheVectorAsAColumn) {
  Matrix matrix = Make({1, 2, 3, 4, 5, 6, 7, 8, 10});
  SpatVector vector{{1, -2, 3, 44, 55}};
  SpatVector const result = matrix.MxV(vector);
  EXPECT_EQ(result.v[0], 6.0);
  EXPECT_EQ(result.v[1], 12.0);
  EXPECT_EQ(result.v[2], 21.0);
}

TEST(VxM, TakesTheVectorAsARow) {
  Matrix matrix = Make({1, 2, 3, 4, 5, 6, 7, 8, 10});
  SpatVector vector{{1, -2, 3, 44, 55}};
  SpatVector const result = matrix.VxM(vector);
  EXPECT_EQ(result.v[0], 14.0);
  EXPECT_EQ(result.v[1], 16.0);
  EXPECT_EQ(result.v[2], 21.0);
}

TEST(MxV, SumsRunFromLeftToRight) {
  Matrix rows = Make({0x1p53, 1, 1, 0, 0, 0, 0, 0, 0});
  Matrix columns = Make({0x1p53, 0, 0, 1, 0, 0, 1, 0, 0});
  SpatVector ones{{1, 1, 1, 0, 0}};
  EXPECT_EQ(rows.MxV(ones).v[0], 0x1p53);
  EXPECT_EQ(columns.VxM(ones).v[0], 0x1p53);
}

TEST(MxV, CarriesTheTrailingEntriesAndLeavesTheArgument) {
  RandomGeometry random(16);
  for (int i = 0; i < 200; ++i) {
    Matrix matrix = Make(Mx(random.Uniform(-3, 3)));
    SpatVector vector;
    for (double& entry : vector.v) entry = random.AnyDouble();
    SpatVector const before = vector;
    SpatVector const column = matrix.MxV(vector);
    SpatVector const row = matrix.VxM(vector);
    for (int k = 0; k < 5; ++k) EXPECT_SAME_BITS(vector.v[k], before.v[k]);
    for (int k = 3; k < 5; ++k) {
      EXPECT_SAME_BITS(column.v[k], before.v[k]);
      EXPECT_SAME_BITS(row.v[k], before.v[k]);
    }
  }
}

TEST(VxM, IsMxVOfTheTranspose) {
  RandomGeometry random(17);
  for (int i = 0; i < 200; ++i) {
    Nine elements;
    for (double& element : elements) element = random.Wide(-20, 20);
    Matrix matrix = Make(elements);
    Matrix transposed = Make(elements);
    transposed.Transpose();
    SpatVector vector;
    for (double& entry : vector.v) entry = random.Wide(-20, 20);
    SpatVector const row = matrix.VxM(vector);
    SpatVector const column = transposed.MxV(vector);
    for (int k = 0; k < 5; ++k) EXPECT_NEAR(row.v[k], column.v[k], std::fabs(row.v[k]) * 1e-9);
  }
}

TEST(QuantityOfDataElements, IsNine) { EXPECT_EQ(Matrix().QuantityOfDataElements(), 9); }

TEST(Transpose, SwapsAcrossTheDiagonal) {
  Matrix matrix = Make({1, 2, 3, 4, 5, 6, 7, 8, 9});
  matrix.Transpose();
  ExpectSameBits({1, 4, 7, 2, 5, 8, 3, 6, 9}, Read(matrix));
  matrix.Transpose();
  ExpectSameBits({1, 2, 3, 4, 5, 6, 7, 8, 9}, Read(matrix));
}

TEST(Reorth, RejectsEveryDimensionButThree) {
  for (int const dimension : {kIntMin, -3, -1, 0, 1, 2, 4, 9, kIntMax}) {
    Nine const before{2, kNaN, 3, -0.0, 5, 6, kInf, 8, 9};
    Nine elements = before;
    EXPECT_FALSE(Matrix::Reorth(dimension, elements.data(), 5));
    ExpectSameBits(before, elements);
  }
}

TEST(Reorth, WithFewerThanTwoTermsChangesNoValue) {
  for (int const terms : {kIntMin, -1, 0, 1}) {
    Nine const before{2, 0.1, 3, 4, 5, -6, 7, 8, 1e-300};
    Nine elements = before;
    EXPECT_TRUE(Matrix::Reorth(3, elements.data(), terms));
    ExpectSameBits(before, elements);
    Matrix matrix = Make(before);
    EXPECT_TRUE(matrix.Reorth(terms));
    ExpectSameBits(before, Read(matrix));
  }
}

TEST(Reorth, MultipliesByTheSeriesEvenWhenItIsTheIdentity) {
  Nine elements{-0.0, 1, 0, 1, 0, 0, 0, 0, 1};
  EXPECT_TRUE(Matrix::Reorth(3, elements.data(), 1));
  EXPECT_SAME_BITS(elements[0], 0.0);
  Nine infinite{kInf, 1, 1, 1, 1, 1, 1, 1, 1};
  EXPECT_TRUE(Matrix::Reorth(3, infinite.data(), 1));
  EXPECT_EQ(infinite[0], kInf);
  EXPECT_TRUE(std::isnan(infinite[1]));
}

TEST(Reorth, LeavesOrthogonalMatricesUnchanged) {
  Nine const signedPermutation{0, -1, 0, 0, 0, 1, -1, 0, 0};
  for (int const terms : {1, 2, 5, 10, 11, kIntMax}) {
    for (Nine const& before : {kIdentity, signedPermutation}) {
      Nine elements = before;
      EXPECT_TRUE(Matrix::Reorth(3, elements.data(), terms));
      EXPECT_EQ(elements, before);
    }
  }
}

TEST(Reorth, SumsTheBinomialSeriesUpToTenTerms) {
  // On a diagonal matrix the series is that of one number, with the coefficients
  // (-1)^k * binomial(2k, k) / 4^k.
  double const diagonal[3] = {1.0625, 0.90625, 1.25};
  for (int terms = 1; terms <= 13; ++terms) {
    Nine elements{};
    for (std::size_t i = 0; i < 3; ++i) elements[4 * i] = diagonal[i];
    ASSERT_TRUE(Matrix::Reorth(3, elements.data(), terms));
    for (std::size_t i = 0; i < 3; ++i) {
      double const drift = diagonal[i] * diagonal[i] - 1.0;
      double coefficient = 1.0;
      double power = 1.0;
      double sum = 1.0;
      for (int k = 1; k < std::min(terms, 10); ++k) {
        coefficient *= -(2.0 * k - 1.0);
        coefficient /= 2.0 * k;
        power *= drift;
        sum += coefficient * power;
      }
      EXPECT_DOUBLE_EQ(elements[4 * i], diagonal[i] * sum) << terms << " terms, entry " << i;
    }
    for (std::size_t const i : {1U, 2U, 3U, 5U, 6U, 7U}) EXPECT_EQ(elements[i], 0.0);
  }
}

TEST(Reorth, MoreTermsThanTenGiveTheBitsOfTen) {
  Nine const before{1.01, 0.02, -0.03, 0.01, 0.98, 0.02, 0.04, -0.01, 1.02};
  Nine ten = before;
  ASSERT_TRUE(Matrix::Reorth(3, ten.data(), 10));
  for (int const terms : {11, 12, 1000, kIntMax}) {
    Nine more = before;
    ASSERT_TRUE(Matrix::Reorth(3, more.data(), terms));
    ExpectSameBits(ten, more);
  }
  Nine nine = before;
  ASSERT_TRUE(Matrix::Reorth(3, nine.data(), 9));
  EXPECT_NE(nine, ten);
}

TEST(Reorth, PullsADriftedRotationBack) {
  RandomGeometry random(18);
  for (int i = 0; i < 200; ++i) {
    SCOPED_TRACE(testing::Message() << "seed 18, round " << i);
    Nine const rotation = Times(Times(Mx(random.Uniform(-3, 3)), My(random.Uniform(-3, 3))),
                                Mz(random.Uniform(-3, 3)));
    Nine drifted = rotation;
    for (double& element : drifted) element += random.Uniform(-1e-3, 1e-3);
    Matrix instance = Make(drifted);
    ASSERT_TRUE(instance.Reorth(10));
    EXPECT_LT(Drift(Read(instance)), 4e-15);
    ExpectNear(rotation, Read(instance), 5e-3);
    Nine plain = drifted;
    ASSERT_TRUE(Matrix::Reorth(3, plain.data(), 10));
    ExpectSameBits(plain, Read(instance));
    Matrix rough = Make(drifted);
    ASSERT_TRUE(rough.Reorth(2));
    EXPECT_LT(Drift(Read(rough)), Drift(drifted) * 0.1);
  }
}

TEST(Reorth, LetsNotANumberAndInfinityThrough) {
  for (double const odd : {kNaN, kInf, -kInf}) {
    Nine elements = kIdentity;
    elements[4] = odd;
    EXPECT_TRUE(Matrix::Reorth(3, elements.data(), 10));
    EXPECT_TRUE(std::isnan(elements[4]));
  }
}

}  // namespace
}  // namespace Vorn::Testing
