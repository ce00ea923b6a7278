// Pieces of no length. Whether such a piece lies on a segment is judged by the segment's line,
// whose constant is rounded far from the origin: the answer may be yes for a point well beside it.
// The search must give the answers of the plain walk there too.

#include <cstddef>
#include <cstdint>
#include <limits>
#include <vector>

#include "geometry/contours/FlatSelfIntersection.h"
#include "geometry/contours/near/BoxTree.h"
#include "gtest/gtest.h"
#include "support/RandomGeometry.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;

constexpr double kGrid = 0x1p-14;
constexpr Point kFarAway{0x1p20, 0.75 * 0x1p20};

/// Leaning needles side by side on a grid far from the origin, as one run of vertices. They do not
/// cross; the last vertex, the tip of a short needle in the boxes of the longer ones before it, is
/// there twice. Anywhere else a vertex that is there twice would be a touch.
std::vector<double> MakeNeedles(RandomGeometry* random, std::int32_t count) {
  std::vector<double> coords;
  auto const add = [&](double x, double y) {
    coords.insert(coords.end(), {kFarAway.x + kGrid * x, kFarAway.y + kGrid * y});
  };
  double const offset = random->Integer(0, 4096);
  for (std::int32_t i = 0; i <= count; ++i) {
    double const x = offset + 4.0 * i;
    double const length = i < count ? random->Integer(40, 64) : random->Integer(5, 30);
    add(x, 0.0);
    add(x + length, length);
  }
  coords.insert(coords.end(), {coords[coords.size() - 2], coords[coords.size() - 1]});
  return coords;
}

bool IsCrossing(std::vector<double> const& coords, std::size_t plainSize) {
  std::vector<std::int32_t> const indices = {static_cast<std::int32_t>(coords.size()) - 2};
  Flat::Verdict const verdict =
      Flat::CheckRuns(Flat::Data(coords), Flat::RunsOf(indices), plainSize);
  EXPECT_EQ(verdict.code, ErrorCode::Ok);
  return verdict.isCrossing;
}

TEST(SearchOfFlatPolylines, AgreesOnPiecesOfNoLengthFarFromTheOrigin) {
  RandomGeometry random(71);
  int crossings = 0;
  constexpr int kRounds = 3000;
  for (int round = 0; round < kRounds; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 71, round " << round);
    std::vector<double> const coords = MakeNeedles(&random, 24);
    bool const expected = IsCrossing(coords, std::numeric_limits<std::size_t>::max());
    ASSERT_EQ(IsCrossing(coords, 0), expected);
    if (expected) ++crossings;
  }
  EXPECT_GT(crossings, 0);
}

TEST(BoxTree, TellsPointsApartByTheirBoxesOnly) {
  // Eight parallel diagonals, and a point that is in the boxes of all but on none of them.
  std::vector<Contours::Extent> extents;
  for (int i = 0; i < 8; ++i) extents.push_back({{0.0 + i, 10.0 + i, 0.0, 10.0}, true, true});
  std::vector<Contours::Extent> const points(8, {{9.0, 9.0, 0.5, 0.5}, true, true});
  Contours::BoxTree tree(extents, 1e-9);
  Contours::BoxTree other(points, 1e-9);
  int tests = 0;
  EXPECT_FALSE(tree.AnyPair(other, [&](std::size_t, std::size_t) {
    ++tests;
    return false;
  }));
  EXPECT_EQ(tests, 64);
}

}  // namespace
}  // namespace Vorn::Testing
