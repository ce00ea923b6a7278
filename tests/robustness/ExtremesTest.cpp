// Inputs at the ends of what can be passed: more points than indices count, a million points in one
// place, coordinates whose squares are infinite or vanish, tolerances of nothing or beyond all
// size.
#include <sys/mman.h>

#include <cmath>
#include <cstdint>
#include <cstring>
#include <limits>
#include <new>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "vorn/FewestPieces.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {
namespace {

using Elem = GeometryUtils::Elem;
using Strategy = GeometryUtils::FittingStrategy;

constexpr Strategy kStrategies[] = {Strategy::Mixed, Strategy::MixedCells, Strategy::SingleArc};

/// What a fit says, and whether it wrote anything.
struct FitAnswer {
  ErrorCode code;
  std::vector<Elem> contour;
  bool isWritten;
};

FitAnswer Fit(std::vector<WPoint> const& points, Strategy strategy) {
  FitAnswer answer{};
  double deviation = kSentinel;
  std::int32_t index = kIntSentinel;
  answer.code = GeometryUtils::CreateFittingCurve(points, strategy, &answer.contour, &deviation,
                                                  &index, nullptr, 100);
  answer.isWritten = !SameBits(deviation, kSentinel) || index != kIntSentinel;
  return answer;
}

/// A vector of more points than there is memory for. Reading one of them ends the program, unless
/// they are readable: then they all are zero.
class PointsWithoutMemory {
 public:
  explicit PointsWithoutMemory(std::size_t count, int protection = PROT_NONE)
      : bytes_(count * sizeof(WPoint)) {
    begin_ = mmap(nullptr, bytes_, protection, MAP_PRIVATE | MAP_ANONYMOUS | MAP_NORESERVE, -1, 0);
    auto* const end = static_cast<char*>(begin_) + bytes_;
    // Three pointers: the beginning, and twice the end.
    void* const parts[] = {begin_, end, end};
    static_assert(sizeof(parts) == sizeof(std::vector<WPoint>));
    std::memcpy(vector_, parts, sizeof(parts));
  }
  PointsWithoutMemory(PointsWithoutMemory const&) = delete;
  PointsWithoutMemory& operator=(PointsWithoutMemory const&) = delete;
  ~PointsWithoutMemory() {
    if (IsThere()) munmap(begin_, bytes_);
  }

  bool IsThere() const { return begin_ != MAP_FAILED; }
  std::vector<WPoint> const& Vector() const {
    return *std::launder(reinterpret_cast<std::vector<WPoint> const*>(vector_));
  }

 private:
  std::size_t bytes_;
  void* begin_;
  alignas(std::vector<WPoint>) unsigned char vector_[sizeof(std::vector<WPoint>)];
};

/// As many as wrap to less than nothing, and to five.
class MorePointsThanIndices : public testing::TestWithParam<std::size_t> {};

TEST_P(MorePointsThanIndices, AreRefusedByEveryFitBeforeOneIsRead) {
  PointsWithoutMemory const points(GetParam());
  if (!points.IsThere()) GTEST_SKIP() << "no room for addresses";
  ASSERT_EQ(points.Vector().size(), GetParam());
  for (Strategy const strategy : kStrategies) {
    FitAnswer const answer = Fit(points.Vector(), strategy);
    EXPECT_EQ(answer.code, ErrorCode::Failed);
    EXPECT_TRUE(answer.contour.empty());
    EXPECT_FALSE(answer.isWritten);
  }
  FewestPieces::Result result;
  EXPECT_EQ(FewestPieces::Fit(points.Vector(), {}, &result, nullptr, 100), ErrorCode::Failed);
  EXPECT_TRUE(result.contour.empty());
}

INSTANTIATE_TEST_SUITE_P(Counts, MorePointsThanIndices,
                         testing::Values((std::size_t{1} << 31U), (std::size_t{1} << 32U) + 5));

TEST(AsManyPointsAsIndices, AreReadByTheFits) {
  PointsWithoutMemory const points((std::size_t{1} << 31U) - 1, PROT_READ);
  if (!points.IsThere()) GTEST_SKIP() << "no room for addresses";
  // The first two end the search, so that the others need no memory.
  EXPECT_EQ(Fit(points.Vector(), Strategy::Mixed).code, ErrorCode::PointsTooClose);
  EXPECT_EQ(Fit(points.Vector(), Strategy::MixedCells).code, ErrorCode::PointsTooClose);
}

constexpr std::size_t kMillion = 1'000'000;

TEST(AMillionPointsInOnePlace, HaveNoFit) {
  std::vector<WPoint> const points(kMillion, WPoint{3.0, -4.0, 0.5});
  EXPECT_EQ(Fit(points, Strategy::Mixed).code, ErrorCode::PointsTooClose);
  EXPECT_EQ(Fit(points, Strategy::MixedCells).code, ErrorCode::PointsTooClose);
  EXPECT_NE(Fit(points, Strategy::SingleArc).code, ErrorCode::Ok);
  FewestPieces::Result result;
  EXPECT_EQ(FewestPieces::Fit(points, {}, &result, nullptr, 100), ErrorCode::NoFit);
  EXPECT_TRUE(DoPointsCoincide(points));
}

/// Each of 1,000 places of a line is measured a thousand times.
TEST(AMillionPointsInAThousandPlaces, AreOnePieceOfTheFewest) {
  std::vector<WPoint> points;
  for (std::size_t i = 0; i < kMillion; ++i) {
    points.push_back({static_cast<double>(i / 1000), 0.0, 0.25});
  }
  FewestPieces::Result result;
  ASSERT_EQ(FewestPieces::Fit(points, {}, &result, nullptr, 100), ErrorCode::Ok);
  EXPECT_EQ(result.contour.size(), 2u);
  EXPECT_TRUE(result.isFewest);
  EXPECT_EQ(Fit(points, Strategy::Mixed).code, ErrorCode::PointsTooClose);
}

TEST(AMillionPointsInOnePlace, AreNoContour) {
  std::vector<Elem> contour;
  for (std::size_t i = 0; i < kMillion; ++i) GeometryUtils::AddSegm(&contour, {3.0, -4.0});
  double area = kSentinel;
  EXPECT_EQ(GeometryUtils::CheckPolySelfIntersection(contour), ErrorCode::Failed);
  EXPECT_EQ(GeometryUtils::GetArea(contour, &area), ErrorCode::Failed);
  EXPECT_SAME_BITS(area, kSentinel);
}

TEST(AMillionPointsInOnePlace, HaveNoArea) {
  std::vector<double> coords;
  for (std::size_t i = 0; i < kMillion; ++i) coords.insert(coords.end(), {3.0, -4.0});
  double area = kSentinel;
  auto const last = static_cast<std::int32_t>(coords.size()) - 2;
  EXPECT_EQ(GeometryUtils::GetArea(coords, {last}, &area), ErrorCode::Ok);
  EXPECT_EQ(area, 0.0);
}

constexpr double kHuge = 1e300;

/// Points of two lines that meet at the origin, with a hundredth of their step for a tolerance.
std::vector<WPoint> Corner(double step) {
  std::vector<WPoint> points;
  for (int i = -5; i <= 5; ++i) {
    points.push_back({step * i, step * (i < 0 ? 0.0 : 0.5 * i), 0.01 * step});
  }
  return points;
}

void ExpectAnAnswerInEveryStrategy(std::vector<WPoint> const& points) {
  for (Strategy const strategy : kStrategies) {
    FitAnswer const answer = Fit(points, strategy);
    for (Elem const& elem : answer.contour) {
      EXPECT_TRUE(elem.type == GeometryUtils::ElemType::Segment ||
                  elem.type == GeometryUtils::ElemType::Arc);
    }
    EXPECT_EQ(answer.code == ErrorCode::Ok, answer.isWritten);
  }
}

void ExpectTwoPiecesOfTheFewest(std::vector<WPoint> const& points) {
  FewestPieces::Result result;
  ASSERT_EQ(FewestPieces::Fit(points, {}, &result, nullptr, 100), ErrorCode::Ok);
  EXPECT_LE(result.largestDeviation, 1.0);
  EXPECT_EQ(result.fewestPossible, 2);
  for (Elem const& elem : result.contour) {
    EXPECT_TRUE(std::isfinite(elem.end.x) && std::isfinite(elem.end.y));
  }
}

TEST(CoordinatesWithInfiniteSquares, EndWithAnAnswerInEveryStrategy) {
  ExpectAnAnswerInEveryStrategy(Corner(kHuge));
}

TEST(CoordinatesWithInfiniteSquares, AreFittedByTheFewest) {
  ExpectTwoPiecesOfTheFewest(Corner(kHuge));
}

TEST(CoordinatesWithVanishingSquares, EndWithAnAnswerInEveryStrategy) {
  for (double const step : {1e-160, 1e-300, 1e-310, 0x1p-1074}) {
    SCOPED_TRACE(step);
    ExpectAnAnswerInEveryStrategy(Corner(step));
  }
}

TEST(CoordinatesWithVanishingSquares, AreFittedByTheFewest) {
  ExpectTwoPiecesOfTheFewest(Corner(1e-300));
}

TEST(CoordinatesWithVanishingSquares, EndWithAnAnswerOfTheFewestWhenTheyAreDenormal) {
  for (double const step : {1e-310, 0x1p-1074}) {
    FewestPieces::Result result;
    ErrorCode const code = FewestPieces::Fit(Corner(step), {}, &result, nullptr, 100);
    EXPECT_EQ(code == ErrorCode::Ok, !result.contour.empty());
  }
}

/// A corner in steps of 1 whose points have this tolerance.
std::vector<WPoint> CornerOfTolerance(double tolerance) {
  std::vector<WPoint> points = Corner(1.0);
  for (WPoint& p : points) p.w = tolerance;
  return points;
}

TEST(ExtremeTolerances, EndWithAnAnswerInEveryStrategy) {
  constexpr double kLargest = std::numeric_limits<double>::max();
  for (double const tolerance : {0.0, 0x1p-1074, 1e-300, 1e-17, 1e17, 1e300, kLargest}) {
    SCOPED_TRACE(tolerance);
    ExpectAnAnswerInEveryStrategy(CornerOfTolerance(tolerance));
  }
}

TEST(ExtremeTolerances, BelowAllRoundingAreKeptByTheFewest) {
  for (double const tolerance : {0x1p-1074, 1e-300, 1e-17}) {
    SCOPED_TRACE(tolerance);
    FewestPieces::Result result;
    ASSERT_EQ(FewestPieces::Fit(CornerOfTolerance(tolerance), {}, &result, nullptr, 100),
              ErrorCode::Ok);
    EXPECT_LE(result.largestDeviation, 1.0);
    EXPECT_EQ(result.ranges.size(), 2U);
  }
}

TEST(ExtremeTolerances, OfNothingAreRefusedByTheFewestAndThoseBeyondAllPointsHaveNoFit) {
  FewestPieces::Result result;
  EXPECT_EQ(FewestPieces::Fit(CornerOfTolerance(0.0), {}, &result, nullptr, 100),
            ErrorCode::Failed);
  for (double const tolerance : {1e17, 1e300, std::numeric_limits<double>::max()}) {
    EXPECT_EQ(FewestPieces::Fit(CornerOfTolerance(tolerance), {}, &result, nullptr, 100),
              ErrorCode::NoFit);
  }
  EXPECT_TRUE(result.contour.empty());
}

/// Every product of two coordinates is 0, so lines that cross count as parallel ones.
TEST(CoordinatesWithVanishingSquares, HaveNoAreaAndCrossAsIfOnOneLine) {
  constexpr double kTiny = 1e-300;
  std::vector<Elem> contour;
  for (auto const& [x, y] : {std::pair{0.0, 0.0}, {kTiny, 0.0}, {kTiny, kTiny}, {0.0, 0.0}}) {
    GeometryUtils::AddSegm(&contour, {x, y});
  }
  double area = kSentinel;
  EXPECT_EQ(GeometryUtils::GetArea(contour, &area), ErrorCode::Ok);
  EXPECT_EQ(area, 0.0);
  double x = kSentinel;
  double y = kSentinel;
  EXPECT_EQ(GeometryUtils::GetLineSegmentsIntersection(-kTiny, -kTiny, kTiny, kTiny, -kTiny, kTiny,
                                                       kTiny, -kTiny, &x, &y),
            SegmentsRelPosition::Collinear);
  EXPECT_EQ(x, 0.0);
  EXPECT_EQ(y, 0.0);
}

TEST(CoordinatesWithInfiniteSquares, LeaveContoursAndTheirAreasAnswered) {
  std::vector<Elem> contour;
  for (auto const& [x, y] : {std::pair{0.0, 0.0}, {kHuge, 0.0}, {kHuge, kHuge}, {0.0, 0.0}}) {
    GeometryUtils::AddSegm(&contour, {x, y});
  }
  double area = 0.0;
  EXPECT_EQ(GeometryUtils::GetArea(contour, &area), ErrorCode::Ok);
  EXPECT_TRUE(std::isinf(area)) << area;
  double x = kSentinel;
  double y = kSentinel;
  SegmentsRelPosition const position = GeometryUtils::GetLineSegmentsIntersection(
      -kHuge, -kHuge, kHuge, kHuge, -kHuge, kHuge, kHuge, -kHuge, &x, &y);
  EXPECT_EQ(
      position == SegmentsRelPosition::Intersecting || position == SegmentsRelPosition::Collinear,
      !SameBits(x, kSentinel));
  double deviation = kSentinel;
  EXPECT_TRUE(GeometryUtils::GetDeviation(1.0, 0.0, -kHuge, kHuge, kHuge, &deviation));
  EXPECT_EQ(deviation, 0.0);
}

}  // namespace
}  // namespace Vorn::Testing
