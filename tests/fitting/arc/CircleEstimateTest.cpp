#include <cmath>
#include <string>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/Profiles.h"
#include "support/ReferenceFitting.h"
#include "support/Transcript.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;
using Indices = std::vector<std::int32_t>;

// --- GetEstimatedCircle -------------------------------------------------------------------------

struct Estimate {
  bool ok = false;
  Point first = kPointSentinel;
  Point middle = kPointSentinel;
  Point last = kPointSentinel;
  Point center = kPointSentinel;
  double radius = kSentinel;
  double minSpacing = kSentinel;
};

template <class Library = GeometryUtils>
Estimate EstimateCircle(std::vector<WPoint> const& points) {
  Estimate e;
  e.ok = Library::GetEstimatedCircle(points, &e.first, &e.middle, &e.last, &e.center, &e.radius,
                                     &e.minSpacing);
  return e;
}

std::string Transcribe(Estimate const& e) {
  Transcript transcript;
  transcript.Add("ok", e.ok);
  transcript.Add("first", e.first);
  transcript.Add("middle", e.middle);
  transcript.Add("last", e.last);
  transcript.Add("center", e.center);
  transcript.Add("radius", e.radius);
  transcript.Add("minSpacing", e.minSpacing);
  return transcript.Text();
}

TEST(GetEstimatedCircle, ThreePointsGiveTheirCircle) {
  Estimate const e = EstimateCircle({{-4, 0, 1}, {0, 4, 1}, {4, 0, 1}});
  EXPECT_TRUE(e.ok);
  EXPECT_SAME_POINT(e.first, (Point{-4, 0}));
  EXPECT_SAME_POINT(e.middle, (Point{0, 4}));
  EXPECT_SAME_POINT(e.last, (Point{4, 0}));
  EXPECT_EQ(e.center.x, 0.0);
  EXPECT_EQ(e.center.y, 0.0);
  EXPECT_EQ(e.radius, 4.0);
  EXPECT_EQ(e.minSpacing, std::sqrt(32.0));
}

TEST(GetEstimatedCircle, TheFarthestPairNeedNotBeTheEnds) {
  Estimate const e = EstimateCircle({{0, 5, 1}, {-5, 0, 1}, {0, -1, 1}, {5, 0, 1}});
  EXPECT_TRUE(e.ok);
  EXPECT_SAME_POINT(e.first, (Point{-5, 0}));
  EXPECT_SAME_POINT(e.last, (Point{5, 0}));
  EXPECT_SAME_POINT(e.middle, (Point{0, 5}));  // both others lie on the bisector; the first stands
}

TEST(GetEstimatedCircle, FirstOfEqualPairsStands) {
  Estimate const e = EstimateCircle({{0, 0, 1}, {1, 0, 1}, {1, 1, 1}, {0, 1, 1}});
  EXPECT_SAME_POINT(e.first, (Point{0, 0}));
  EXPECT_SAME_POINT(e.last, (Point{1, 1}));
  EXPECT_SAME_POINT(e.middle, (Point{1, 0}));
  EXPECT_EQ(e.minSpacing, 1.0);
}

TEST(GetEstimatedCircle, FailsUntouchedBelowThreePointsOrWithoutACircle) {
  EXPECT_EQ(Transcribe(EstimateCircle({})), Transcribe(Estimate{}));
  EXPECT_EQ(Transcribe(EstimateCircle({{0, 0, 1}, {1, 0, 1}})), Transcribe(Estimate{}));
  // The solver gives up on a column of zeros only.
  EXPECT_EQ(Transcribe(EstimateCircle({{2, 0, 1}, {2, 1, 1}, {2, 5, 1}})), Transcribe(Estimate{}));
}

TEST(GetEstimatedCircle, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5503;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 500; ++i) {
    std::vector<WPoint> points;
    for (int k = random.Integer(0, 12); k > 0; --k) {
      points.push_back(Weighted(random.Flip() ? random.GridPoint(3) : random.PointIn(-9, 9), 1));
    }
    ASSERT_EQ(Transcribe(EstimateCircle(points)),
              Transcribe(EstimateCircle<ReferenceFitting>(points)));
  }
}

// --- GetEstimatedMaxDeviationForCircle ----------------------------------------------------------

double Allowance(Point const& first, Point const& middle, Point const& last, double radius) {
  double deviation = kSentinel;
  EXPECT_TRUE(
      GeometryUtils::GetEstimatedMaxDeviationForCircle(first, middle, last, radius, &deviation));
  return deviation;
}

TEST(GetEstimatedMaxDeviationForCircle, IsTheSagittaOfTheShorterHalf) {
  EXPECT_EQ(Allowance({0, 0}, {3, 0}, {3, 5}, 100), 9.0 / 400.0);
  EXPECT_EQ(Allowance({0, 5}, {3, 0}, {3, 2}, 100), 4.0 / 400.0);
}

TEST(GetEstimatedMaxDeviationForCircle, IsAtMostAQuarterOfTheRadius) {
  EXPECT_EQ(Allowance({-1, 0}, {0, 1}, {1, 0}, 1), 0.25);
}

// --- GetEstimatedDeviationForCircle -------------------------------------------------------------

struct Deviation {
  bool ok = false;
  double tolerance = kSentinel;
  Indices excluded = {kIntSentinel};
  Point center = kPointSentinel;
  double radius = kSentinel;
};

template <class Library = GeometryUtils>
Deviation EstimateDeviation(std::vector<WPoint> const& points) {
  Deviation d;
  d.ok = Library::GetEstimatedDeviationForCircle(points, &d.tolerance, &d.excluded, &d.center,
                                                 &d.radius);
  return d;
}

std::string Transcribe(Deviation const& d) {
  Transcript transcript;
  transcript.Add("ok", d.ok);
  transcript.Add("tolerance", d.tolerance);
  transcript.Add("excluded", d.excluded);
  transcript.Add("center", d.center);
  transcript.Add("radius", d.radius);
  return transcript.Text();
}

/// Points of a circle of radius 40 at these angles in degrees. Over a half turn the allowance is
/// capped at 10, so neighbours closer than 30, about 44 degrees, are too close.
std::vector<WPoint> OnCircle(std::vector<double> const& degrees) {
  std::vector<WPoint> points;
  for (double d : degrees) {
    double const angle = d * std::acos(-1.0) / 180.0;
    points.push_back({40 * std::cos(angle), 40 * std::sin(angle), 0.1});
  }
  return points;
}

TEST(GetEstimatedDeviationForCircle, WideSpacingExcludesNothing) {
  Deviation const d = EstimateDeviation(OnCircle({0, 45, 90, 135, 180}));
  EXPECT_TRUE(d.ok);
  EXPECT_TRUE(d.excluded.empty());
  EXPECT_NEAR(d.tolerance, 10.0, 1e-9);
  EXPECT_NEAR(d.radius, 40.0, 1e-9);
  EXPECT_NEAR(d.center.x, 0.0, 1e-9);
  EXPECT_NEAR(d.center.y, 0.0, 1e-9);
}

TEST(GetEstimatedDeviationForCircle, ThinsPointsTooCloseToTheLastKeptOne) {
  Deviation const d = EstimateDeviation(OnCircle({0, 20, 45, 60, 90, 135, 180}));
  EXPECT_TRUE(d.ok);
  EXPECT_EQ(d.excluded, (Indices{1, 3}));
}

TEST(GetEstimatedDeviationForCircle, ALastPointTooCloseDropsTheOneBeforeIt) {
  Deviation const d = EstimateDeviation(OnCircle({0, 45, 90, 150, 180}));
  EXPECT_TRUE(d.ok);
  EXPECT_EQ(d.excluded, Indices{3});
}

TEST(GetEstimatedDeviationForCircle, OneRunOfExcludedPointsLeavesTheLastPointAsItIs) {
  Deviation const d = EstimateDeviation(OnCircle({0, 20, 45, 90, 150, 180}));
  EXPECT_TRUE(d.ok);
  EXPECT_EQ(d.excluded, Indices{1});
}

/// Excluded 1, 3, 5 and 7 with the last point too close to point 8. Backwards, the gaps before 7
/// and before 5 note the kept points 6 and 4; point 4 is far from the last one, so it is dropped.
TEST(GetEstimatedDeviationForCircle, TheSecondNotedPointIsDroppedWhenItIsFarFromTheLast) {
  Deviation const d = EstimateDeviation(OnCircle({0, 20, 45, 60, 90, 92, 136, 140, 181, 200}));
  EXPECT_TRUE(d.ok);
  EXPECT_EQ(d.excluded, (Indices{1, 3, 4, 5, 7}));
}

/// More than a whole turn: the gaps before 5 and 3 note the kept points 4 and 2, and the last point
/// comes close to point 2 again.
TEST(GetEstimatedDeviationForCircle, TheLastPointIsDroppedWhenItIsCloseToTheSecondNotedPoint) {
  Deviation const d =
      EstimateDeviation(OnCircle({0, 20, 45, 60, 90, 100, 135, 180, 225, 270, 318, 361.5}));
  EXPECT_TRUE(d.ok);
  EXPECT_EQ(d.excluded, (Indices{1, 3, 5, 11}));
}

/// The first point lies between the next two, which are far enough from each other but too close to
/// it: only the first and the last point stay.
TEST(GetEstimatedDeviationForCircle, FewerThanThreePointsLeftFailWithExclusionsEmptied) {
  Deviation expected;
  expected.excluded.clear();
  EXPECT_EQ(Transcribe(EstimateDeviation(OnCircle({30, 0, 60, 180}))), Transcribe(expected));
}

TEST(GetEstimatedDeviationForCircle, CoincidingPointsFailUntouched) {
  EXPECT_EQ(Transcribe(EstimateDeviation(OnCircle({0, 45, 45, 90, 180}))), Transcribe(Deviation{}));
}

TEST(GetEstimatedDeviationForCircle, FewerThanThreePointsFailUntouched) {
  EXPECT_EQ(Transcribe(EstimateDeviation({})), Transcribe(Deviation{}));
  EXPECT_EQ(Transcribe(EstimateDeviation({{0, 0, 1}, {1, 1, 1}})), Transcribe(Deviation{}));
}

TEST(GetEstimatedDeviationForCircle, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5504;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int thinned = 0;
  for (int i = 0; i < 3000; ++i) {
    std::vector<double> degrees;
    double angle = 0;
    for (int k = random.Integer(0, 16); k > 0; --k) {
      degrees.push_back(angle);
      angle += random.Flip() ? random.Uniform(1, 25) : random.Uniform(30, 60);
    }
    Deviation const expected = EstimateDeviation<ReferenceFitting>(OnCircle(degrees));
    thinned += expected.ok && expected.excluded.size() > 2 ? 1 : 0;
    ASSERT_EQ(Transcribe(EstimateDeviation(OnCircle(degrees))), Transcribe(expected));
    for (std::size_t k = 1; k < expected.excluded.size(); ++k) {
      ASSERT_LT(expected.excluded[k - 1], expected.excluded[k]);
    }
  }
  EXPECT_GT(thinned, 300);
}

// --- CalcDeviationCurve -------------------------------------------------------------------------

TEST(CalcDeviationCurve, GivesOffsetsDeviationsAndMeanFreeWeights) {
  std::vector<WPoint> const points = {{9, 9, 9}, {4, 6, 1}, {1, -2, 3}};
  std::vector<WPoint2> curve;
  EXPECT_TRUE(GeometryUtils::CalcDeviationCurve(points, 1, 2, {1, 2}, 4.5, &curve));
  ASSERT_EQ(curve.size(), 2U);
  EXPECT_EQ(curve[0].dx, 3.0);
  EXPECT_EQ(curve[0].dy, 4.0);
  EXPECT_EQ(curve[0].dev, 0.5);
  EXPECT_EQ(curve[0].weight, 0.5);
  EXPECT_EQ(curve[1].dx, 0.0);
  EXPECT_EQ(curve[1].dy, -4.0);
  EXPECT_EQ(curve[1].dev, -0.5);
  EXPECT_EQ(curve[1].weight, 1.5);
}

TEST(CalcDeviationCurve, AppendsAndDividesEverySampleFromTheBeginning) {
  std::vector<WPoint2> curve = {{1, 2, 3, 8}};
  EXPECT_TRUE(GeometryUtils::CalcDeviationCurve({{3, 4, 2}}, 0, 1, {0, 0}, 5, &curve));
  ASSERT_EQ(curve.size(), 2U);
  EXPECT_EQ(curve[0].dev, 3.0);
  EXPECT_EQ(curve[0].weight, 4.0);
  EXPECT_EQ(curve[1].weight, 1.0);
}

TEST(CalcDeviationCurve, WithoutWeightTheSamplesStayAppended) {
  std::vector<WPoint2> curve;
  EXPECT_FALSE(GeometryUtils::CalcDeviationCurve({{3, 4, 0}, {0, 1, 0}}, 0, 2, {0, 0}, 5, &curve));
  ASSERT_EQ(curve.size(), 2U);
  EXPECT_EQ(curve[1].dev, -4.0);
  EXPECT_EQ(curve[1].weight, 0.0);
}

TEST(CalcDeviationCurve, RefusesEmptyRunsAndRunsThatLeaveTheVector) {
  std::vector<WPoint> const points = {{3, 4, 1}, {0, 1, 1}};
  std::vector<WPoint2> curve;
  for (auto const& [first, count] : std::vector<std::pair<std::int32_t, std::int32_t>>{
           {0, 0}, {0, -1}, {0, 3}, {-1, 2}, {2147483647, 2147483647}}) {
    EXPECT_FALSE(GeometryUtils::CalcDeviationCurve(points, first, count, {0, 0}, 5, &curve));
  }
  EXPECT_TRUE(curve.empty());
}

TEST(CalcDeviationCurve, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5505;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 300; ++i) {
    std::vector<WPoint> const points = MakeProfile(&random, random.Integer(1, 20));
    auto const count = static_cast<std::int32_t>(points.size());
    Point const center = random.PointIn(-20, 20);
    Transcript result;
    Transcript expected;
    std::vector<WPoint2> curve;
    std::vector<WPoint2> expectedCurve;
    result.Add("ok", GeometryUtils::CalcDeviationCurve(points, 0, count, center, 7, &curve));
    expected.Add("ok",
                 ReferenceFitting::CalcDeviationCurve(points, 0, count, center, 7, &expectedCurve));
    result.Add("curve", curve);
    expected.Add("curve", expectedCurve);
    ASSERT_EQ(result.Text(), expected.Text());
  }
}

// --- CalcCorrectionShiftForCircle ---------------------------------------------------------------

struct Shift {
  bool ok = false;
  Point value = kPointSentinel;
};

Shift FindShift(std::vector<WPoint2> const& curve) {
  Shift s;
  s.ok = GeometryUtils::CalcCorrectionShiftForCircle(curve, &s.value);
  return s;
}

std::vector<WPoint2> CurveOf(std::vector<WPoint> const& points, Point const& center,
                             double radius) {
  std::vector<WPoint2> curve;
  ReferenceFitting::CalcDeviationCurve(points, 0, static_cast<std::int32_t>(points.size()), center,
                                       radius, &curve);
  return curve;
}

TEST(CalcCorrectionShiftForCircle, PointsOnTheCircleGiveNoShift) {
  std::vector<WPoint> const points = {{3, 4, 1}, {-3, 4, 1}, {-4, -3, 1}, {5, 0, 1}, {0, -5, 1}};
  Shift const s = FindShift(CurveOf(points, {0, 0}, 5));
  EXPECT_TRUE(s.ok);
  EXPECT_EQ(s.value.x, 0.0);
  EXPECT_EQ(s.value.y, 0.0);
}

TEST(CalcCorrectionShiftForCircle, PointsTowardTheTrueCentre) {
  std::vector<WPoint> const points = MakeArcPoints({0.003, -0.001}, 10, 0.3, 4.0, 25, 0.1);
  Shift const s = FindShift(CurveOf(points, {0, 0}, 10));
  EXPECT_TRUE(s.ok);
  EXPECT_NEAR(s.value.x, 0.003, 1e-6);
  EXPECT_NEAR(s.value.y, -0.001, 1e-6);
}

TEST(CalcCorrectionShiftForCircle, FailsUntouchedForFewSamplesOrASampleAtTheCentre) {
  std::vector<WPoint2> curve = {{1, 0, 0.1, 1}, {0, 1, 0.1, 1}};
  for (Shift const& s : {FindShift({}), FindShift(curve)}) {
    EXPECT_FALSE(s.ok);
    EXPECT_SAME_POINT(s.value, kPointSentinel);
  }
  curve.push_back({0, 0, 0.1, 1});
  EXPECT_FALSE(FindShift(curve).ok);
  curve.back() = {1e-170, 0, 0.1, 1};  // its square is no normal number
  EXPECT_FALSE(FindShift(curve).ok);
  curve.back() = {-1, 0, 0.1, 1};
  EXPECT_TRUE(FindShift(curve).ok);
}

TEST(CalcCorrectionShiftForCircle, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5506;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 1000; ++i) {
    std::vector<WPoint2> curve;
    for (int k = random.Integer(0, 12); k > 0; --k) {
      Point const d = random.Flip() ? random.GridPoint(2) : random.PointIn(-9, 9);
      curve.push_back({d.x, d.y, random.Uniform(-0.1, 0.1), random.Uniform(0, 2)});
    }
    Shift const s = FindShift(curve);
    Shift e;
    e.ok = ReferenceFitting::CalcCorrectionShiftForCircle(curve, &e.value);
    EXPECT_EQ(s.ok, e.ok);
    EXPECT_SAME_POINT(s.value, e.value);
  }
}

// --- GetMaxObtainedDeviation --------------------------------------------------------------------

/// Distances 5, 10 and 13 from the origin.
std::vector<WPoint> const kPoints = {{3, 4, 4}, {-6, 8, 2}, {5, -12, 4}};

struct Largest {
  double value = kSentinel;
  std::int32_t index = kIntSentinel;
};

Largest FindLargest(std::vector<WPoint> const& points, std::int32_t first, std::int32_t count,
                    double radius) {
  Largest l;
  l.value = GeometryUtils::GetMaxObtainedDeviation(points, first, count, {0, 0}, radius, &l.index);
  return l;
}

TEST(GetMaxObtainedDeviation, IndexIsThePositionInTheRun) {
  Largest const l = FindLargest(kPoints, 1, 2, 11);
  EXPECT_EQ(l.value, 2.0);
  EXPECT_EQ(l.index, 1);
}

TEST(GetMaxObtainedDeviation, FirstOfEqualDeviationsStands) {
  Largest const l = FindLargest(kPoints, 0, 3, 9);  // 4, 1, 4
  EXPECT_EQ(l.value, 4.0);
  EXPECT_EQ(l.index, 0);
}

TEST(GetMaxObtainedDeviation, TheFirstPointAlwaysCounts) {
  Largest const exact = FindLargest(kPoints, 1, 1, 10);
  EXPECT_EQ(exact.value, 0.0);
  EXPECT_EQ(exact.index, 0);
  Largest const bad = FindLargest({{kNaN, 0, 1}, {3, 4, 1}}, 0, 2, 10);
  EXPECT_TRUE(std::isnan(bad.value));
  EXPECT_EQ(bad.index, 0);
}

TEST(GetMaxObtainedDeviation, EmptyRunsGiveMinusOne) {
  for (auto const& [first, count] :
       std::vector<std::pair<std::int32_t, std::int32_t>>{{0, 0}, {1, -3}}) {
    Largest const l = FindLargest(kPoints, first, count, 10);
    EXPECT_EQ(l.value, -1.0);
    EXPECT_EQ(l.index, -1);
  }
}

TEST(GetMaxObtainedDeviation, RunsThatLeaveTheVectorGiveMinusOne) {
  for (auto const& [first, count] : std::vector<std::pair<std::int32_t, std::int32_t>>{
           {0, 4}, {-1, 2}, {2147483647, 2147483647}}) {
    Largest const l = FindLargest(kPoints, first, count, 10);
    EXPECT_EQ(l.value, -1.0);
    EXPECT_EQ(l.index, -1);
  }
}

TEST(GetMaxObtainedDeviation, EveryPlaceInTheUnrolledLoopCounts) {
  for (std::int32_t count = 1; count < 14; ++count) {
    for (std::int32_t at = 0; at < count; ++at) {
      std::vector<WPoint> points(static_cast<std::size_t>(count), WPoint{3, 4, 1});
      points[static_cast<std::size_t>(at)] = {6, 8, 1};
      Largest const l = FindLargest(points, 0, count, 5);
      EXPECT_EQ(l.value, 5.0);
      EXPECT_EQ(l.index, at);
    }
  }
}

struct Signed {
  double lowest = kSentinel;
  double highest = kSentinel;
};

Signed FindSigned(std::vector<WPoint> const& points, std::int32_t first, std::int32_t count,
                  double radius) {
  Signed s;
  EXPECT_TRUE(GeometryUtils::GetMaxObtainedDeviation(points, first, count, {0, 0}, radius,
                                                     &s.lowest, &s.highest));
  return s;
}

TEST(GetMaxObtainedDeviationSigned, InsideIsPositive) {
  Signed const s = FindSigned(kPoints, 0, 3, 11);
  EXPECT_EQ(s.highest, 6.0);
  EXPECT_EQ(s.lowest, -2.0);
}

TEST(GetMaxObtainedDeviationSigned, OnePointGivesBothAndNoneMinusOne) {
  Signed const one = FindSigned(kPoints, 1, 1, 17);
  EXPECT_EQ(one.highest, 7.0);
  EXPECT_EQ(one.lowest, 7.0);
  for (std::int32_t count : {0, -2}) {
    Signed const none = FindSigned(kPoints, 1, count, 17);
    EXPECT_EQ(none.highest, -1.0);
    EXPECT_EQ(none.lowest, -1.0);
  }
}

TEST(GetMaxObtainedDeviationSigned, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5507;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 300; ++i) {
    std::vector<WPoint> const points = MakeProfile(&random, random.Integer(1, 20));
    auto const count = static_cast<std::int32_t>(points.size());
    double const radius = random.Uniform(0, 60);
    Signed const s = FindSigned(points, 0, count, radius);
    Signed e;
    ReferenceFitting::GetMaxObtainedDeviation(points, 0, count, {0, 0}, radius, &e.lowest,
                                              &e.highest);
    EXPECT_SAME_BITS(s.lowest, e.lowest);
    EXPECT_SAME_BITS(s.highest, e.highest);
    Largest const l = FindLargest(points, 0, count, radius);
    std::int32_t index = kIntSentinel;
    EXPECT_SAME_BITS(l.value, ReferenceFitting::GetMaxObtainedDeviation(points, 0, count, {0, 0},
                                                                        radius, &index));
    EXPECT_EQ(l.index, index);
  }
}

}  // namespace
}  // namespace Vorn::Testing
