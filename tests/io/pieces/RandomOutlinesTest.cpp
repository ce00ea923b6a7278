// Outlines of lines and arcs in any order and sense of their pieces, one in another.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <random>

#include "io/pieces/Nesting.h"
#include "vorn/io/ContourArea.h"
#include "vorn/io/Outlines.h"

namespace Vorn::IO {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();

/// A rounded rectangle of eight pieces around a middle; corners have a third of the half height.
std::vector<Piece> Rounded(XY const& middle, double halfWidth, double halfHeight) {
  double const r = halfHeight / 3.0;
  double const x = halfWidth - r;
  double const y = halfHeight - r;
  auto const at = [&](double dx, double dy) { return XY{middle.x + dx, middle.y + dy}; };
  return {MakeLine(at(-x, -halfHeight), at(x, -halfHeight)),
          MakeArc(at(x, -halfHeight), at(halfWidth, -y), at(x, -y), r, true),
          MakeLine(at(halfWidth, -y), at(halfWidth, y)),
          MakeArc(at(halfWidth, y), at(x, halfHeight), at(x, y), r, true),
          MakeLine(at(x, halfHeight), at(-x, halfHeight)),
          MakeArc(at(-x, halfHeight), at(-halfWidth, y), at(-x, y), r, true),
          MakeLine(at(-halfWidth, y), at(-halfWidth, -y)),
          MakeArc(at(-halfWidth, -y), at(-x, -halfHeight), at(-x, -y), r, true)};
}

double AreaOfRounded(double halfWidth, double halfHeight) {
  double const r = halfHeight / 3.0;
  return 4.0 * halfWidth * halfHeight - (4.0 - M_PI) * r * r;
}

ContourFile Shuffled(std::vector<Piece> pieces, std::mt19937_64* engine) {
  std::shuffle(pieces.begin(), pieces.end(), *engine);
  for (Piece& piece : pieces) {
    if ((*engine)() % 2 == 0) piece = Reversed(piece);
  }
  ContourFile contour;
  contour.path = "p.dxf";
  contour.pieces = std::move(pieces);
  return contour;
}

TEST(OutlinesOf, ShuffledPiecesComeBackAsTheirOutlines) {
  for (std::uint64_t seed = 1; seed <= 40; ++seed) {
    SCOPED_TRACE(seed);
    std::mt19937_64 engine(seed);
    std::size_t const count = 1 + engine() % 6;
    std::vector<Piece> pieces;
    double expected = 0.0;
    for (std::size_t i = 0; i < count; ++i) {
      double const width = 3.0 + static_cast<double>(engine() % 5);
      for (Piece const& piece : Rounded({20.0 * static_cast<double>(i), 0}, width, 2.0)) {
        pieces.push_back(piece);
      }
      expected += AreaOfRounded(width, 2.0);
    }
    std::vector<ContourFile> const outlines = OutlinesOf(Shuffled(pieces, &engine));
    ASSERT_EQ(outlines.size(), count);
    double area = 0.0;
    for (ContourFile const& outline : outlines) {
      EXPECT_TRUE(outline.isClosed);
      ASSERT_EQ(outline.pieces.size(), 8u);
      for (std::size_t i = 0; i < 8; ++i) {
        EXPECT_LE(Distance(outline.pieces[i].end, outline.pieces[(i + 1) % 8].start), 1e-12);
      }
      area += std::fabs(SignedAreaOf(outline));
    }
    EXPECT_NEAR(area, expected, 1e-9 * expected);
  }
}

TEST(OutlinesOf, NestedOutlinesAddUpToTheirNetArea) {
  for (std::uint64_t seed = 1; seed <= 20; ++seed) {
    SCOPED_TRACE(seed);
    std::mt19937_64 engine(seed);
    std::size_t const depth = 1 + engine() % 6;
    std::vector<Piece> pieces;
    double expected = 0.0;
    for (std::size_t i = 0; i < depth; ++i) {
      double const half = 2.0 * static_cast<double>(depth - i);
      for (Piece const& piece : Rounded({5, -3}, half + 1, half)) pieces.push_back(piece);
      expected += (i % 2 == 0 ? 1.0 : -1.0) * AreaOfRounded(half + 1, half);
    }
    std::vector<ContourFile> const outlines = OutlinesOf(Shuffled(pieces, &engine));
    EXPECT_NEAR(NetArea(MeasureOutlines(outlines)), expected, 1e-9 * std::fabs(expected));
    std::vector<std::size_t> depths = DepthsOf(outlines);
    std::sort(depths.begin(), depths.end());
    for (std::size_t i = 0; i < depth; ++i) EXPECT_EQ(depths[i], i);
    EXPECT_EQ(FacesOf(outlines).size(), (depth + 1) / 2);
  }
}

TEST(OutlinesOf, KeepsWhatTheFileSays) {
  ContourFile contour;
  contour.path = "p.dxf";
  contour.units = "inch";
  contour.leftOut = 2;
  contour.hadHeights = true;
  contour.pieces = {MakeLine({0, 0}, {1, 0}), MakeLine({5, 5}, {6, 5})};
  for (ContourFile const& outline : OutlinesOf(contour)) {
    EXPECT_EQ(outline.path, "p.dxf");
    EXPECT_EQ(outline.units, "inch");
    EXPECT_EQ(outline.leftOut, 2u);
    EXPECT_TRUE(outline.hadHeights);
  }
}

TEST(Chained, JoinsWhatTheFileHasInPartsAndLeavesTheRest) {
  ContourFile parts;
  parts.pieces = {MakeLine({0, 0}, {1, 0}), MakeLine({2, 0}, {3, 0}), MakeLine({2, 0}, {1, 0})};
  ContourFile const chained = Chained(parts);
  ASSERT_EQ(chained.pieces.size(), 3u);
  EXPECT_EQ(chained.pieces[1].end.x, 2.0);
  EXPECT_EQ(chained.pieces[2].end.x, 3.0);
  EXPECT_TRUE(FindGaps(chained).empty());

  ContourFile const twice = Chained(chained);
  EXPECT_EQ(twice.pieces.size(), 3u);
  EXPECT_EQ(twice.pieces[2].end.x, 3.0);
}

TEST(Chained, ASingleOutlineIsClosedWhereItsEndsMeet) {
  std::mt19937_64 engine(9);
  EXPECT_TRUE(Chained(Shuffled(Rounded({0, 0}, 5, 3), &engine)).isClosed);
}

TEST(OutlinesOf, PlacesThatAreNoneLeaveTheContourAsItIs) {
  for (double const bad : {kInfinity, -kInfinity}) {
    ContourFile contour;
    contour.pieces = {MakeLine({0, 0}, {bad, 0}), MakeLine({bad, 0}, {1, 1})};
    std::vector<ContourFile> const outlines = OutlinesOf(contour);
    ASSERT_EQ(outlines.size(), 1u);
    EXPECT_EQ(outlines[0].pieces.size(), 2u);
  }
}

TEST(ChainTolerance, IsAMillionthOfTheSizeAndNeverBelowTheRounding) {
  EXPECT_DOUBLE_EQ(ChainTolerance({MakeLine({0, 0}, {40, 30})}), 40e-6);
  std::vector<Piece> const tiny = {MakeLine({1e9, 0}, {1e9 + 1e-6, 0})};
  EXPECT_EQ(ChainTolerance(tiny), JointTolerance(tiny));
}

}  // namespace
}  // namespace Vorn::IO
