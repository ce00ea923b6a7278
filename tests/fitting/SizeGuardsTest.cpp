// Runs whose cells come to exactly the size above which a fit thins them, and to one triangle more.
// The sizes are counted here triangle by triangle; the fit beside it is the plain one, which has
// guards of its own.
#include <algorithm>
#include <cstddef>
#include <vector>

#include "gtest/gtest.h"
#include "support/FittingCalls.h"
#include "support/ReferenceFitting.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {
namespace {

using Triangle = GeometryUtils::Triangle;
using Cell = std::vector<Triangle>;

/// Coordinates and tolerances of the runs are written in parts of this size.
constexpr double kPart = 1.0 / 64;

std::vector<WPoint> Scaled(std::vector<WPoint> points) {
  for (WPoint& p : points) p = {p.x * kPart, p.y * kPart, p.w * kPart};
  return points;
}

/// As Scaled, but for the steps along x, which are whole.
std::vector<WPoint> ScaledLine(std::vector<WPoint> points) {
  for (WPoint& p : points) p = {p.x, p.y * kPart, p.w * kPart};
  return points;
}

Cell Narrowed(Cell const& cell, Cell const& other) {
  Cell common;
  for (Triangle const& first : cell) {
    for (Triangle const& second : other) GeometryUtils::GetOverlapping(first, second, &common);
  }
  return common;
}

/// The sizes of the cell of an arc with free ends after each triple, up to the first size above a
/// limit.
std::vector<std::size_t> ArcCellSizes(std::vector<WPoint> const& points, std::size_t limit) {
  auto const size = static_cast<int>(points.size());
  std::vector<bool> used(points.size());
  std::vector<std::size_t> sizes;
  Cell cell;
  for (int i = 0; i < 2 * ((size - 1) / 2); ++i) {
    int at[3] = {};
    GeometryUtils::GetTriPointIndices(1 + i / 2, size, i % 2, &at[0], &at[1], &at[2]);
    if (used[at[0]] && used[at[1]] && used[at[2]]) continue;
    for (int position : at) used[position] = true;
    Cell triple;
    EXPECT_EQ(GeometryUtils::GetCircleTriangles(points[at[0]], points[at[1]], points[at[2]], false,
                                                false, 0, &triple),
              ErrorCode::Ok);
    cell = sizes.empty() ? triple : Narrowed(cell, triple);
    sizes.push_back(cell.size());
    if (cell.size() > limit) break;
  }
  return sizes;
}

/// The size of the cell of a run of points that one line follows, without its last point.
std::size_t LineCellSize(std::vector<WPoint> const& points) {
  bool isFixed = false;
  bool isSwapped = false;
  Cell cell;
  for (std::size_t i = 0; i + 2 < points.size(); ++i) {
    Cell pair;
    EXPECT_EQ(
        GeometryUtils::GetLineTriangles(points[i], points[i + 1], &isFixed, &isSwapped, &pair),
        ErrorCode::Ok);
    cell = i == 0 ? pair : Narrowed(cell, pair);
  }
  return cell.size();
}

bool Holds(std::vector<std::size_t> const& sizes, std::size_t size) {
  return std::find(sizes.begin(), sizes.end(), size) != sizes.end();
}

void ExpectFitOfArcAsPlain(std::vector<WPoint> points) {
  ArcFitInput in;
  in.points = std::move(points);
  in.maxCount = static_cast<std::int32_t>(in.points.size());
  EXPECT_EQ(Transcribe(FitArcRun<GeometryUtils>(in)), Transcribe(FitArcRun<ReferenceFitting>(in)));
}

void ExpectFitOfLineAsPlain(std::vector<WPoint> points) {
  LineFitInput in;
  in.points = std::move(points);
  in.count = static_cast<std::int32_t>(in.points.size());
  LineFitOutput const out = FitLine<GeometryUtils>(in);
  EXPECT_EQ(out.count, in.count);
  EXPECT_EQ(Transcribe(out), Transcribe(FitLine<ReferenceFitting>(in)));
}

TEST(SizeGuards, ALineCellOf78125TrianglesIsNarrowedFurther) {
  std::vector<WPoint> const points = ScaledLine({{16, -6, 28},
                                                 {20, 3, 42},
                                                 {27, -6, 42},
                                                 {32, 9, 49},
                                                 {37, 0, 19},
                                                 {41, -4, 36},
                                                 {55, 7, 40},
                                                 {64, 3, 58},
                                                 {79, -10, 24},
                                                 {94, -11, 20},
                                                 {110, -8, 17},
                                                 {126, -8, 58},
                                                 {142, -4, 31},
                                                 {156, 3, 32},
                                                 {168, -2, 20}});
  ASSERT_EQ(LineCellSize(points), 78125u);
  ExpectFitOfLineAsPlain(points);
}

TEST(SizeGuards, ALineCellOf78126TrianglesIsRebuilt) {
  std::vector<WPoint> const points = ScaledLine({{5, 5, 61},
                                                 {9, -10, 22},
                                                 {14, 13, 55},
                                                 {21, 4, 55},
                                                 {35, 1, 57},
                                                 {50, -6, 36},
                                                 {63, -3, 39},
                                                 {77, 4, 40},
                                                 {86, 8, 40},
                                                 {101, -8, 58},
                                                 {107, 4, 21},
                                                 {116, -14, 37},
                                                 {130, 14, 60},
                                                 {135, -4, 31},
                                                 {147, -2, 20}});
  ASSERT_EQ(LineCellSize(points), 78126u);
  ExpectFitOfLineAsPlain(points);
}

TEST(SizeGuards, AnArcCellOf19531TrianglesIsNarrowedFurther) {
  std::vector<WPoint> const points = Scaled({{1274, -2, 44},
                                             {1270, 159, 45},
                                             {1236, 318, 16},
                                             {1187, 469, 7},
                                             {1121, 611, 7},
                                             {1043, 751, 5},
                                             {934, 879, 7},
                                             {817, 979, 30},
                                             {693, 1084, 10},
                                             {553, 1158, 34},
                                             {404, 1214, 55},
                                             {248, 1258, 56},
                                             {90, 1275, 32},
                                             {-72, 1280, 24},
                                             {-232, 1252, 40},
                                             {-377, 1220, 52},
                                             {-530, 1164, 59}});
  ASSERT_TRUE(Holds(ArcCellSizes(points, 19531), 19531));
  ExpectFitOfArcAsPlain(points);
}

TEST(SizeGuards, AnArcCellOf19532TrianglesIsRebuilt) {
  std::vector<WPoint> const points = Scaled({{1281, 0, 15},
                                             {1278, 105, 33},
                                             {1256, 207, 29},
                                             {1256, 314, 58},
                                             {1219, 413, 50},
                                             {1172, 507, 32},
                                             {1126, 601, 25},
                                             {1086, 699, 48},
                                             {1006, 770, 40},
                                             {943, 853, 29},
                                             {876, 933, 33},
                                             {792, 995, 48},
                                             {711, 1062, 19},
                                             {624, 1119, 24},
                                             {528, 1161, 24},
                                             {432, 1202, 21}});
  ASSERT_EQ(ArcCellSizes(points, 19531).back(), 19532u);
  ExpectFitOfArcAsPlain(points);
}

}  // namespace
}  // namespace Vorn::Testing
