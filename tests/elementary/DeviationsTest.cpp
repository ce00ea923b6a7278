#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <limits>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/RandomGeometry.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;

constexpr double kSmallestNormal = 2.2250738585072014e-308;
/// Its square is exactly the smallest normal double.
constexpr double kRootOfSmallestNormal = 0x1p-511;
constexpr double kDenormMin = std::numeric_limits<double>::denorm_min();

// --- GetDist2 ---------------------------------------------------------------------------------

TEST(GetDist2, IsTheSquaredDistance) {
  EXPECT_SAME_BITS(GeometryUtils::GetDist2({1.0, 2.0}, {4.0, 6.0}), 25.0);
  EXPECT_SAME_BITS(GeometryUtils::GetDist2({-1.0, 0.0}, {-1.0, -0.0}), 0.0);
}

TEST(GetDist2, OverflowsAndUnderflowsLikeAnyProduct) {
  EXPECT_SAME_BITS(GeometryUtils::GetDist2({1e200, 0.0}, {0.0, 0.0}), kInf);
  EXPECT_SAME_BITS(GeometryUtils::GetDist2({1e-200, 0.0}, {0.0, 0.0}), 0.0);
  EXPECT_TRUE(std::isnan(GeometryUtils::GetDist2({kInf, 0.0}, {kInf, 0.0})));
  EXPECT_TRUE(std::isnan(GeometryUtils::GetDist2({0.0, kNaN}, {0.0, 0.0})));
}

TEST(GetDist2, IsUnchangedBySwapAndQuarterTurnAndScalesByPowersOfTwo) {
  constexpr std::uint64_t kSeed = 1210;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 2000; ++i) {
    Point const p = random.PointIn(-100.0, 100.0);
    Point const q = random.PointIn(-100.0, 100.0);
    double const dist2 = GeometryUtils::GetDist2(p, q);
    double const dx = p.x - q.x;
    double const dy = p.y - q.y;
    double const dx2 = dx * dx;
    double const dy2 = dy * dy;
    ASSERT_EQ(dist2, dy2 + dx2);
    ASSERT_EQ(GeometryUtils::GetDist2(q, p), dist2);
    ASSERT_EQ(GeometryUtils::GetDist2(QuarterTurn(p), QuarterTurn(q)), dist2);
    ASSERT_EQ(GeometryUtils::GetDist2(Scale(p, 0x1p-9), Scale(q, 0x1p-9)), dist2 * 0x1p-18);
  }
}

// --- GetLineParameters ------------------------------------------------------------------------

struct Line {
  double a = kSentinel;
  double b = kSentinel;
  double c = kSentinel;
  bool ok = false;
};

Line LineThrough(double x1, double y1, double x2, double y2) {
  Line line;
  line.ok = GeometryUtils::GetLineParameters(x1, y1, x2, y2, &line.a, &line.b, &line.c);
  return line;
}

void ExpectUntouched(Line const& line) {
  EXPECT_FALSE(line.ok);
  EXPECT_SAME_BITS(line.a, kSentinel);
  EXPECT_SAME_BITS(line.b, kSentinel);
  EXPECT_SAME_BITS(line.c, kSentinel);
}

TEST(GetLineParameters, GivesTheUnscaledCoefficients) {
  Line const line = LineThrough(1.0, 2.0, 4.0, 8.0);
  EXPECT_TRUE(line.ok);
  EXPECT_SAME_BITS(line.a, -6.0);
  EXPECT_SAME_BITS(line.b, 3.0);
  EXPECT_SAME_BITS(line.c, 0.0);
  Line const other = LineThrough(3.0, 1.0, 5.0, -2.0);
  EXPECT_SAME_BITS(other.a, 3.0);
  EXPECT_SAME_BITS(other.b, 2.0);
  EXPECT_SAME_BITS(other.c, -11.0);
}

TEST(GetLineParameters, EqualPointsFailAndWriteNothing) {
  ExpectUntouched(LineThrough(1.0, 2.0, 1.0, 2.0));
  ExpectUntouched(LineThrough(0.0, 0.0, -0.0, -0.0));
}

TEST(GetLineParameters, PointsCloserThanTheSmallestNormalInBothCoordinatesFail) {
  double const near = kSmallestNormal;
  ExpectUntouched(LineThrough(0.0, 0.0, near, near));
  ExpectUntouched(LineThrough(0.0, 0.0, -near, near));
  ExpectUntouched(LineThrough(0.0, 0.0, Down(near), 0.0));
  EXPECT_TRUE(LineThrough(0.0, 0.0, Up(near), 0.0).ok);
  EXPECT_TRUE(LineThrough(0.0, 0.0, 0.0, -Up(near)).ok);
  EXPECT_TRUE(LineThrough(0.0, 0.0, near, Up(near)).ok);
}

TEST(GetLineParameters, PointsAHairApartInOneCoordinateDoNotFail) {
  Line const line = LineThrough(0.0, 1.0, 1e-300, 1.0);
  EXPECT_TRUE(line.ok);
  EXPECT_SAME_BITS(line.a, 0.0);
  EXPECT_SAME_BITS(line.b, 1e-300);
  EXPECT_SAME_BITS(line.c, -1e-300);
}

TEST(GetLineParameters, NotANumberIsNotRejected) {
  Line const line = LineThrough(kNaN, 1.0, 1.0, 1.0);
  EXPECT_TRUE(line.ok);
  EXPECT_SAME_BITS(line.a, 0.0);
  EXPECT_TRUE(std::isnan(line.b));
  EXPECT_TRUE(std::isnan(line.c));
}

TEST(GetLineParameters, ReversingThePointsNegatesTheLine) {
  constexpr std::uint64_t kSeed = 1211;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 2000; ++i) {
    Point const p = random.PointIn(-10.0, 10.0);
    Point const q = random.PointIn(-10.0, 10.0);
    Line const line = LineThrough(p.x, p.y, q.x, q.y);
    Line const reversed = LineThrough(q.x, q.y, p.x, p.y);
    ASSERT_EQ(line.a, -reversed.a);
    ASSERT_EQ(line.b, -reversed.b);
    ASSERT_EQ(line.c, -reversed.c);
    double const first = p.x * q.y;
    double const second = p.y * q.x;
    ASSERT_EQ(line.c, first - second);
    ASSERT_EQ(line.a, p.y - q.y);
    ASSERT_EQ(line.b, q.x - p.x);
  }
}

// --- GetDeviation and GetSignedDeviation from an implicit line ----------------------------------

double Deviation(double a, double b, double c, double x, double y) {
  double dev = kSentinel;
  EXPECT_TRUE(GeometryUtils::GetDeviation(a, b, c, x, y, &dev));
  return dev;
}

double SignedDeviation(double a, double b, double c, double x, double y) {
  double dev = kSentinel;
  EXPECT_TRUE(GeometryUtils::GetSignedDeviation(a, b, c, x, y, &dev));
  return dev;
}

TEST(GetDeviationFromLine, DividesByTheLengthOfTheNormal) {
  EXPECT_SAME_BITS(Deviation(3.0, 4.0, -10.0, 6.0, 8.0), 8.0);
  EXPECT_SAME_BITS(Deviation(3.0, 4.0, -10.0, 0.0, 0.0), 2.0);
  EXPECT_SAME_BITS(Deviation(3.0, 4.0, 0.0, 4.0, -3.0), 0.0);
}

TEST(GetSignedDeviation, IsPositiveAwayFromTheOrigin) {
  EXPECT_SAME_BITS(SignedDeviation(3.0, 4.0, -10.0, 6.0, 8.0), 8.0);
  EXPECT_SAME_BITS(SignedDeviation(-3.0, -4.0, 10.0, 6.0, 8.0), 8.0);
  EXPECT_SAME_BITS(SignedDeviation(3.0, 4.0, -10.0, 0.0, 0.0), -2.0);
  EXPECT_SAME_BITS(SignedDeviation(-3.0, -4.0, 10.0, 0.0, 0.0), -2.0);
}

TEST(GetSignedDeviation, OfALineThroughTheOriginHasTheSignOfItsForm) {
  EXPECT_SAME_BITS(SignedDeviation(3.0, 4.0, 0.0, 3.0, 4.0), 5.0);
  EXPECT_SAME_BITS(SignedDeviation(-3.0, -4.0, 0.0, 3.0, 4.0), -5.0);
  EXPECT_SAME_BITS(SignedDeviation(3.0, 4.0, -0.0, 3.0, 4.0), 5.0);
  EXPECT_SAME_BITS(SignedDeviation(3.0, 4.0, kDenormMin, 3.0, 4.0), -5.0);
  EXPECT_SAME_BITS(SignedDeviation(3.0, 4.0, -kDenormMin, 3.0, 4.0), 5.0);
}

TEST(GetSignedDeviation, OfAPointOnTheLineIsAZeroWithTheSignOfTheDivisor) {
  EXPECT_SAME_BITS(SignedDeviation(1.0, 0.0, -2.0, 2.0, 7.0), 0.0);
  EXPECT_SAME_BITS(SignedDeviation(-1.0, 0.0, 2.0, 2.0, 7.0), -0.0);
}

TEST(GetSignedDeviation, FailureLeavesOutputUntouched) {
  // a*a underflows to zero below the square root of half the smallest subnormal.
  for (double const a : {0.0, 0x1p-538, 1e-170, -1e-170}) {
    double dev = kSentinel;
    EXPECT_FALSE(GeometryUtils::GetSignedDeviation(a, 0.0, 1.0, 1.0, 1.0, &dev)) << a;
    EXPECT_FALSE(GeometryUtils::GetSignedDeviation(0.0, a, 1.0, 1.0, 1.0, &dev)) << a;
    EXPECT_SAME_BITS(dev, kSentinel);
  }
}

TEST(GetDeviationFromLine, FailureLeavesOutputUntouched) {
  for (double const a : {0.0, 0x1p-538, 1e-170, -1e-170}) {
    double dev = kSentinel;
    EXPECT_FALSE(GeometryUtils::GetDeviation(a, 0.0, 1.0, 1.0, 1.0, &dev)) << a;
    EXPECT_FALSE(GeometryUtils::GetDeviation(0.0, a, 1.0, 1.0, 1.0, &dev)) << a;
    EXPECT_SAME_BITS(dev, kSentinel);
  }
}

TEST(GetDeviationFromLine, SmallestNormalWhoseSquareSurvivesSucceeds) {
  EXPECT_SAME_BITS(Deviation(0x1p-537, 0.0, 0.0, 1.0, 0.0), 1.0);
  EXPECT_SAME_BITS(SignedDeviation(0x1p-537, 0.0, 0.0, -1.0, 0.0), -1.0);
}

TEST(GetSignedDeviation, NotANumberIsNotRejected) {
  EXPECT_TRUE(std::isnan(SignedDeviation(kNaN, 1.0, 1.0, 1.0, 1.0)));
  EXPECT_TRUE(std::isnan(SignedDeviation(1.0, 1.0, kNaN, 1.0, 1.0)));
  EXPECT_TRUE(std::isnan(Deviation(1.0, 1.0, 1.0, kNaN, 1.0)));
  EXPECT_TRUE(std::isnan(Deviation(kInf, 1.0, 1.0, 1.0, 1.0)));
  EXPECT_SAME_BITS(Deviation(1.0, 0.0, 0.0, -kInf, 1.0), kInf);
  EXPECT_SAME_BITS(SignedDeviation(1.0, 0.0, 1.0, kInf, 1.0), -kInf);
}

TEST(GetSignedDeviation, NegatingTheLineChangesNothingUnlessItPassesTheOrigin) {
  constexpr std::uint64_t kSeed = 1212;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 3000; ++i) {
    double const a = random.Uniform(-10.0, 10.0);
    double const b = random.Uniform(-10.0, 10.0);
    double const c = random.Uniform(-10.0, 10.0);
    Point const p = random.PointIn(-10.0, 10.0);
    double const ax = a * p.x;
    double const by = b * p.y;
    double const a2 = a * a;
    double const b2 = b * b;
    double const length = std::sqrt(a2 + b2);
    double const form = ax + by + c;
    double const signedDev = SignedDeviation(a, b, c, p.x, p.y);
    ASSERT_EQ(signedDev, c > 0.0 ? form / -length : form / length);
    ASSERT_EQ(SignedDeviation(-a, -b, -c, p.x, p.y), signedDev);
    ASSERT_EQ(Deviation(a, b, c, p.x, p.y), std::fabs(form) / length);
    ASSERT_EQ(std::fabs(signedDev), Deviation(a, b, c, p.x, p.y));
    ASSERT_LE(SignedDeviation(a, b, c, 0.0, 0.0), 0.0);
    ASSERT_EQ(SignedDeviation(a, b, 0.0, p.x, p.y), -SignedDeviation(-a, -b, 0.0, p.x, p.y));
  }
}

TEST(GetDeviationFromLine, SumsFromLeftToRight) {
  // (1e16 - 1e16) + 1 is 1; 1e16 + (-1e16 + 1) would be 0 or 2.
  EXPECT_SAME_BITS(Deviation(1e16, -1e16, 1.0, 1.0, 1.0) * std::sqrt(2e32), 1.0);
  EXPECT_GT(Deviation(1e16, -1e16, 1.0, 1.0, 1.0), 0.0);
}

// --- GetDeviation from coordinates
// ----------------------------------------------------------------

struct CoordDeviation {
  bool ok = false;
  double dev = kSentinel;
};

CoordDeviation FromCoords(std::array<double, 6> const& coords) {
  CoordDeviation result;
  result.ok = GeometryUtils::GetDeviation(coords.data(), &result.dev);
  return result;
}

struct SquaredLengths {
  double difference = 0.0;  // squared distance from the line, before the root
  double sum = 0.0;
};

SquaredLengths Lengths(std::array<double, 6> const& p) {
  auto const square = [](double dx, double dy) {
    double const dx2 = dx * dx;
    double const dy2 = dy * dy;
    return dx2 + dy2;
  };
  double const base = square(p[2] - p[0], p[3] - p[1]);
  double const toFirst = square(p[4] - p[0], p[5] - p[1]);
  double const toSecond = square(p[4] - p[2], p[5] - p[3]);
  double const numerator = toFirst + base - toSecond;
  double const squared = numerator * numerator;
  double const along = squared / (4.0 * base);
  return {toFirst - along, toFirst + along};
}

TEST(GetDeviationFromCoords, IsTheDistanceFromTheLineThroughTwoPoints) {
  CoordDeviation const result = FromCoords({0.0, 0.0, 4.0, 0.0, 2.0, 3.0});
  EXPECT_TRUE(result.ok);
  EXPECT_SAME_BITS(result.dev, 3.0);
  EXPECT_SAME_BITS(FromCoords({1.0, 1.0, 1.0, 5.0, -4.0, 9.0}).dev, 5.0);
}

TEST(GetDeviationFromCoords, IsMeasuredFromTheLineNotTheSegment) {
  EXPECT_SAME_BITS(FromCoords({0.0, 0.0, 4.0, 0.0, 12.0, 3.0}).dev, 3.0);
}

TEST(GetDeviationFromCoords, OfAPointOnTheLineIsExactlyZeroWhenTheSquaresAgree) {
  EXPECT_SAME_BITS(FromCoords({0.0, 0.0, 4.0, 0.0, 1.0, 0.0}).dev, 0.0);
  EXPECT_SAME_BITS(FromCoords({0.0, 0.0, 4.0, 0.0, -3.0, 0.0}).dev, 0.0);
  EXPECT_SAME_BITS(FromCoords({1.0, 2.0, 4.0, 6.0, 1.0, 2.0}).dev, 0.0);
  EXPECT_SAME_BITS(FromCoords({1.0, 2.0, 4.0, 6.0, 4.0, 6.0}).dev, 0.0);
}

TEST(GetDeviationFromCoords, EqualBasePointsFailAndWriteNothing) {
  CoordDeviation const result = FromCoords({1.0, 2.0, 1.0, 2.0, 5.0, 5.0});
  EXPECT_FALSE(result.ok);
  EXPECT_SAME_BITS(result.dev, kSentinel);
}

TEST(GetDeviationFromCoords, BaseMustBeLongerThanTheSmallestNormalSquared) {
  double const root = kRootOfSmallestNormal;
  EXPECT_FALSE(FromCoords({0.0, 0.0, root, 0.0, 5.0, 5.0}).ok);
  EXPECT_FALSE(FromCoords({0.0, 0.0, Down(root), 0.0, 5.0, 5.0}).ok);
  EXPECT_TRUE(FromCoords({0.0, 0.0, Up(root), 0.0, 5.0, 5.0}).ok);
  EXPECT_FALSE(FromCoords({0.0, 0.0, 1e-200, 1e-200, 5.0, 5.0}).ok);
}

TEST(GetDeviationFromCoords, ThirdPointNextToTheFirstIsOnTheLineBelowTheSmallestNormalSquared) {
  double const root = kRootOfSmallestNormal;
  EXPECT_SAME_BITS(FromCoords({0.0, 0.0, 1.0, 0.0, 0.0, root}).dev, root);
  EXPECT_SAME_BITS(FromCoords({0.0, 0.0, 1.0, 0.0, 0.0, Down(root)}).dev, 0.0);
}

TEST(GetDeviationFromCoords, IsNotClampedWhenRoundingTurnsTheSquareNegative) {
  constexpr std::uint64_t kSeed = 1213;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int negative = 0;
  int zero = 0;
  for (int i = 0; i < 5000; ++i) {
    Point const p = random.PointIn(-10.0, 10.0);
    Point const q = random.PointIn(-10.0, 10.0);
    double const t = random.Uniform(-1.0, 2.0);
    std::array<double, 6> const coords{
        p.x, p.y, q.x, q.y, p.x + t * (q.x - p.x), p.y + t * (q.y - p.y)};
    CoordDeviation const result = FromCoords(coords);
    ASSERT_TRUE(result.ok);
    SquaredLengths const lengths = Lengths(coords);
    if (lengths.difference < 0.0) {
      ++negative;
      ASSERT_TRUE(std::isnan(result.dev));
    } else if (lengths.difference == 0.0) {
      ++zero;
      ASSERT_EQ(Bits(result.dev), Bits(0.0));
    } else {
      ASSERT_EQ(Bits(result.dev), Bits(std::sqrt(lengths.difference)));
    }
  }
  EXPECT_GT(negative, 100);
  EXPECT_GT(zero, 100);
}

TEST(GetDeviationFromCoords, AgreesWithTheCrossProductAwayFromTheLine) {
  constexpr std::uint64_t kSeed = 1214;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int measured = 0;
  for (int i = 0; i < 3000; ++i) {
    Point const p = random.PointIn(-10.0, 10.0);
    Point const q = random.PointIn(-10.0, 10.0);
    Point const r = random.PointIn(-10.0, 10.0);
    std::array<double, 6> const coords{p.x, p.y, q.x, q.y, r.x, r.y};
    CoordDeviation const result = FromCoords(coords);
    ASSERT_TRUE(result.ok);
    ASSERT_TRUE(SameBits(result.dev, std::sqrt(Lengths(coords).difference)));
    long double const dx = Extended(q.x) - Extended(p.x);
    long double const dy = Extended(q.y) - Extended(p.y);
    long double const cross =
        dx * (Extended(r.y) - Extended(p.y)) - dy * (Extended(r.x) - Extended(p.x));
    long double const length = std::sqrt(dx * dx + dy * dy);
    if (length < 1.0L) continue;
    double const distance = static_cast<double>(std::fabs(cross) / length);
    if (distance < 0.1) continue;
    ++measured;
    ASSERT_NEAR(result.dev, distance, 1e-9);
  }
  EXPECT_GT(measured, 2000);
}

TEST(GetDeviationFromCoords, ScalesExactlyByPowersOfTwoAndIgnoresAQuarterTurn) {
  constexpr std::uint64_t kSeed = 1215;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 2000; ++i) {
    Point const p = random.PointIn(-10.0, 10.0);
    Point const q = random.PointIn(-10.0, 10.0);
    Point const r = random.PointIn(-10.0, 10.0);
    double const dev = FromCoords({p.x, p.y, q.x, q.y, r.x, r.y}).dev;
    double const scaled =
        FromCoords({p.x * 0x1p8, p.y * 0x1p8, q.x * 0x1p8, q.y * 0x1p8, r.x * 0x1p8, r.y * 0x1p8})
            .dev;
    ASSERT_TRUE(SameBits(scaled, dev * 0x1p8));
    ASSERT_TRUE(SameBits(FromCoords({-p.y, p.x, -q.y, q.x, -r.y, r.x}).dev, dev));
  }
}

TEST(GetDeviationFromCoords, NotANumberIsNotRejected) {
  for (std::size_t i = 0; i < 6; ++i) {
    std::array<double, 6> coords{0.0, 0.0, 4.0, 0.0, 2.0, 3.0};
    coords[i] = kNaN;
    CoordDeviation const result = FromCoords(coords);
    EXPECT_TRUE(result.ok) << i;
    EXPECT_TRUE(std::isnan(result.dev)) << i;
  }
}

// --- GetNormal --------------------------------------------------------------------------------

TEST(GetNormal, PassesThroughThePointPerpendicularToTheLine) {
  Line normal;
  GeometryUtils::GetNormal(3.0, 4.0, 100.0, {2.0, 5.0}, &normal.a, &normal.b, &normal.c);
  EXPECT_SAME_BITS(normal.a, 4.0);
  EXPECT_SAME_BITS(normal.b, -3.0);
  EXPECT_SAME_BITS(normal.c, 7.0);
  EXPECT_EQ(normal.a * 2.0 + normal.b * 5.0 + normal.c, 0.0);
}

TEST(GetNormal, DoesNotUseTheConstant) {
  Line normal;
  GeometryUtils::GetNormal(3.0, 4.0, kNaN, {2.0, 5.0}, &normal.a, &normal.b, &normal.c);
  EXPECT_SAME_BITS(normal.a, 4.0);
  EXPECT_SAME_BITS(normal.b, -3.0);
  EXPECT_SAME_BITS(normal.c, 7.0);
}

TEST(GetNormal, NegatesTheSignOfAZeroCoefficient) {
  Line normal;
  GeometryUtils::GetNormal(0.0, 2.0, 0.0, {3.0, 4.0}, &normal.a, &normal.b, &normal.c);
  EXPECT_SAME_BITS(normal.a, 2.0);
  EXPECT_SAME_BITS(normal.b, -0.0);
  EXPECT_SAME_BITS(normal.c, -6.0);
}

// --- GetXyminXymax ----------------------------------------------------------------------------

std::array<double, 4> Box(double x1, double y1, double x2, double y2) {
  std::array<double, 4> box{kSentinel, kSentinel, kSentinel, kSentinel};
  GeometryUtils::GetXyminXymax(x1, y1, x2, y2, box.data());
  return box;
}

TEST(GetXyminXymax, WritesMinimaThenMaxima) {
  std::array<double, 4> const expected{-1.0, 2.0, 3.0, 7.0};
  EXPECT_EQ(Box(3.0, 2.0, -1.0, 7.0), expected);
  EXPECT_EQ(Box(-1.0, 7.0, 3.0, 2.0), expected);
  EXPECT_EQ(Box(-1.0, 2.0, 3.0, 7.0), expected);
}

TEST(GetXyminXymax, KeepsTheFirstOfEqualValues) {
  std::array<double, 4> const box = Box(0.0, -0.0, -0.0, 0.0);
  EXPECT_SAME_BITS(box[0], 0.0);
  EXPECT_SAME_BITS(box[1], -0.0);
  EXPECT_SAME_BITS(box[2], 0.0);
  EXPECT_SAME_BITS(box[3], -0.0);
}

TEST(GetXyminXymax, KeepsANotANumberOnlyInFirstPlace) {
  std::array<double, 4> const box = Box(kNaN, 1.0, 2.0, kNaN);
  EXPECT_TRUE(std::isnan(box[0]));
  EXPECT_SAME_BITS(box[1], 1.0);
  EXPECT_TRUE(std::isnan(box[2]));
  EXPECT_SAME_BITS(box[3], 1.0);
}

// --- IsPointValidToFit --------------------------------------------------------------------------

TEST(IsPointValidToFit, NeedsMoreThanOneAndAHalfTimesTheToleranceSum) {
  WPoint const a{0.0, 0.0, 1.0};
  EXPECT_FALSE(GeometryUtils::IsPointValidToFit(a, {3.0, 0.0, 1.0}));
  EXPECT_TRUE(GeometryUtils::IsPointValidToFit(a, {Up(3.0), 0.0, 1.0}));
  EXPECT_FALSE(GeometryUtils::IsPointValidToFit(a, {Down(3.0), 0.0, 1.0}));
  EXPECT_FALSE(GeometryUtils::IsPointValidToFit(a, {0.0, -3.0, 1.0}));
  EXPECT_TRUE(GeometryUtils::IsPointValidToFit(a, {0.0, -Up(3.0), 1.0}));
  EXPECT_FALSE(GeometryUtils::IsPointValidToFit({0.0, 0.0, 3.0}, {3.0, 4.0, 1.0 / 3.0}));
}

TEST(IsPointValidToFit, ZeroTolerancesNeedOnlyDifferentPoints) {
  EXPECT_FALSE(GeometryUtils::IsPointValidToFit({1.0, 1.0, 0.0}, {1.0, 1.0, 0.0}));
  EXPECT_TRUE(GeometryUtils::IsPointValidToFit({1.0, 1.0, 0.0}, {Up(1.0), 1.0, 0.0}));
  // The squared distance underflows to zero.
  EXPECT_FALSE(GeometryUtils::IsPointValidToFit({0.0, 0.0, 0.0}, {1e-200, 0.0, 0.0}));
}

TEST(IsPointValidToFit, NegativeSumCountsByItsMagnitude) {
  EXPECT_FALSE(GeometryUtils::IsPointValidToFit({0.0, 0.0, -1.0}, {3.0, 0.0, -1.0}));
  EXPECT_TRUE(GeometryUtils::IsPointValidToFit({0.0, 0.0, -1.0}, {Up(3.0), 0.0, -1.0}));
  EXPECT_TRUE(GeometryUtils::IsPointValidToFit({0.0, 0.0, -1.0}, {0.5, 0.0, 1.0}));
}

TEST(IsPointValidToFit, NotANumberAnywhereIsValid) {
  for (int i = 0; i < 6; ++i) {
    std::array<double, 6> v{0.0, 0.0, 1.0, 0.5, 0.0, 1.0};
    EXPECT_FALSE(GeometryUtils::IsPointValidToFit({v[0], v[1], v[2]}, {v[3], v[4], v[5]}));
    v[static_cast<std::size_t>(i)] = kNaN;
    EXPECT_TRUE(GeometryUtils::IsPointValidToFit({v[0], v[1], v[2]}, {v[3], v[4], v[5]})) << i;
  }
}

TEST(IsPointValidToFit, TakesInfinities) {
  EXPECT_TRUE(GeometryUtils::IsPointValidToFit({0.0, 0.0, 1.0}, {kInf, 0.0, 1.0}));
  EXPECT_FALSE(GeometryUtils::IsPointValidToFit({0.0, 0.0, kInf}, {5.0, 0.0, 1.0}));
  EXPECT_FALSE(GeometryUtils::IsPointValidToFit({0.0, 0.0, kInf}, {kInf, 0.0, 1.0}));
}

TEST(IsPointValidToFit, DoesNotDependOnTheOrderOfThePoints) {
  constexpr std::uint64_t kSeed = 1216;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int valid = 0;
  for (int i = 0; i < 3000; ++i) {
    WPoint const a = Weighted(random.GridPoint(5), random.Integer(0, 4) * 0.5);
    WPoint const b = Weighted(random.GridPoint(5), random.Integer(0, 4) * 0.5);
    // Everything is a multiple of a quarter: exact in whole numbers.
    auto const dx = static_cast<std::int64_t>(4.0 * (a.x - b.x));
    auto const dy = static_cast<std::int64_t>(4.0 * (a.y - b.y));
    auto const needed = static_cast<std::int64_t>(6.0 * (a.w + b.w));
    bool const expected = dx * dx + dy * dy > needed * needed;
    ASSERT_EQ(GeometryUtils::IsPointValidToFit(a, b), expected);
    ASSERT_EQ(GeometryUtils::IsPointValidToFit(b, a), expected);
    valid += expected ? 1 : 0;
  }
  EXPECT_GT(valid, 300);
  EXPECT_LT(valid, 2700);
}

}  // namespace
}  // namespace Vorn::Testing
