// Memory runs out at every allocation in turn: what is promised is std::bad_alloc, outputs as they
// were, nothing leaked (the sanitizers look), and the same answer afterwards.
#include <cstdint>
#include <vector>

#include "determinism/Digest.h"
#include "gtest/gtest.h"
#include "support/Profiles.h"
#include "support/RefusedAllocations.h"
#include "vorn/FewestPieces.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {
namespace {

using Elem = GeometryUtils::Elem;
using Strategy = GeometryUtils::FittingStrategy;
using Triangle = GeometryUtils::Triangle;

std::vector<WPoint> SomeProfile(std::int32_t count) {
  RandomGeometry random(5);
  return MakeProfile(&random, count);
}

class FitWithoutMemory : public testing::TestWithParam<Strategy> {};

TEST_P(FitWithoutMemory, ThrowsAndLeavesWhatWasThere) {
  std::vector<WPoint> const points = GetParam() == Strategy::SingleArc
                                         ? MakeArcPoints({3, -2}, 25, 2, -2.5, 20, 0.05)
                                         : SomeProfile(40);
  Elem const before = [] {
    Elem elem;
    elem.end = {7.0, 8.0};
    return elem;
  }();
  std::vector<Elem> contour;
  double deviation = 0.0;
  std::int32_t index = 0;
  int const count = RefuseEachAllocation(
      [&] {
        contour.assign(1, before);
        GeometryUtils::CreateFittingCurve(points, GetParam(), &contour, &deviation, &index, nullptr,
                                          100);
      },
      [&] {
        // A single arc takes the place of what the contour held.
        if (GetParam() == Strategy::SingleArc || contour.empty()) {
          EXPECT_LE(contour.size(), 2u);
          return;
        }
        EXPECT_EQ(contour.front().end.x, 7.0);
        EXPECT_EQ(contour.front().end.y, 8.0);
      });
  EXPECT_GT(count, 3);
  Digest expected;
  Digest found;
  std::vector<Elem> again(1, before);
  EXPECT_EQ(GeometryUtils::CreateFittingCurve(points, GetParam(), &again, &deviation, &index,
                                              nullptr, 100),
            ErrorCode::Ok);
  expected.Add(again);
  found.Add(contour);
  EXPECT_EQ(found.Value(), expected.Value());
}

INSTANTIATE_TEST_SUITE_P(Strategies, FitWithoutMemory,
                         testing::Values(Strategy::Mixed, Strategy::MixedCells,
                                         Strategy::SingleArc));

class FewestWithoutMemory : public testing::TestWithParam<bool> {};

TEST_P(FewestWithoutMemory, ThrowsAndLeavesTheResultUntouched) {
  std::vector<WPoint> const points =
      GetParam() ? MakeArcPoints({3, -2}, 25, 2, 6.0, 24, 0.05) : SomeProfile(24);
  FewestPieces::Options options;
  options.closed = GetParam();
  FewestPieces::Result result;
  ErrorCode code = ErrorCode::Failed;
  int const count = RefuseEachAllocation(
      [&] { code = FewestPieces::Fit(points, options, &result, nullptr, 100); },
      [&] {
        EXPECT_TRUE(result.contour.empty());
        EXPECT_TRUE(result.ranges.empty());
        EXPECT_EQ(result.largestDeviationIndex, -1);
        EXPECT_EQ(result.fewestPossible, 0);
      });
  EXPECT_GT(count, 10);
  EXPECT_EQ(code, ErrorCode::Ok);
  EXPECT_FALSE(result.contour.empty());
}

INSTANTIATE_TEST_SUITE_P(OpenAndClosed, FewestWithoutMemory, testing::Bool());

TEST(WithoutMemory, ContoursStayAsLongAsTheyWere) {
  std::vector<Elem> contour;
  int const ofSegments = RefuseEachAllocation(
      [&] {
        std::vector<Elem> grown(2);
        grown.shrink_to_fit();
        contour.swap(grown);
        GeometryUtils::AddSegm(&contour, {1.0, 2.0});
      },
      [&] { EXPECT_LE(contour.size(), 2u); });
  EXPECT_EQ(ofSegments, 2);
  EXPECT_EQ(contour.size(), 3u);
}

TEST(WithoutMemory, SearchesForSelfIntersectionsThrow) {
  std::vector<Elem> contour;
  std::vector<double> coords;
  for (int i = 0; i < 400; ++i) {
    GeometryUtils::AddSegm(&contour, {0.25 * i, (i % 2) * 0.5});
    coords.insert(coords.end(), {0.25 * i, (i % 2) * 0.5});
  }
  ErrorCode code = ErrorCode::Failed;
  RefuseEachAllocation([&] { code = GeometryUtils::CheckPolySelfIntersection(contour); }, [] {});
  EXPECT_EQ(code, ErrorCode::Ok);
  double area = -1.0;
  RefuseEachAllocation([&] { code = GeometryUtils::GetArea(contour, &area); },
                       [&] { EXPECT_EQ(area, -1.0); });
  EXPECT_EQ(code, ErrorCode::Ok);
  std::vector<double> const before = coords;
  bool found = true;
  auto const last = static_cast<std::int32_t>(coords.size());
  int const count = RefuseEachAllocation(
      [&] { code = GeometryUtils::CheckPolySelfIntersection(coords, {last}, &found); },
      [&] { EXPECT_EQ(coords, before); });
  EXPECT_GT(count, 0);
}

TEST(WithoutMemory, CellsAreAppendedWholeOrThrow) {
  Triangle const first{{{0, 0}, {4, 0}, {0, 4}}};
  std::vector<Triangle> const cell(3, Triangle{{{1, -1}, {3, 3}, {-1, 2}}});
  std::vector<Triangle> result;
  EXPECT_GT(RefuseEachAllocation(
                [&] {
                  result.clear();
                  result.shrink_to_fit();
                  GeometryUtils::GetOverlapping(first, &cell, &result);
                },
                [] {}),
            0);
  EXPECT_FALSE(result.empty());
  std::vector<Triangle> line;
  bool isFixed = false;
  bool isSwapped = false;
  EXPECT_GT(
      RefuseEachAllocation(
          [&] {
            line.clear();
            line.shrink_to_fit();
            GeometryUtils::GetLineTriangles({0, 0, 0.1}, {5, 1, 0.2}, &isFixed, &isSwapped, &line);
          },
          [] {}),
      0);
  EXPECT_FALSE(line.empty());
}

}  // namespace
}  // namespace Vorn::Testing
