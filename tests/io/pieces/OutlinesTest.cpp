#include <gtest/gtest.h>

#include "io/pieces/Shapes.h"
#include "vorn/io/Outlines.h"

namespace Vorn::IO {
namespace {

ContourFile Of(std::vector<Piece> pieces) {
  ContourFile contour;
  contour.path = "p.dxf";
  contour.pieces = std::move(pieces);
  return contour;
}

void Add(std::vector<Piece> const& more, std::vector<Piece>* pieces) {
  pieces->insert(pieces->end(), more.begin(), more.end());
}

TEST(OutlinesOf, ChainsLinesInAnyOrderAndSense) {
  auto const outlines = OutlinesOf(Of({MakeLine({0, 0}, {10, 0}), MakeLine({10, 10}, {0, 10}),
                                       MakeLine({10, 10}, {10, 0}), MakeLine({0, 10}, {0, 0})}));
  ASSERT_EQ(outlines.size(), 1u);
  EXPECT_TRUE(outlines[0].isClosed);
  ASSERT_EQ(outlines[0].pieces.size(), 4u);
  for (std::size_t i = 0; i < 4; ++i) {
    EXPECT_TRUE(AreEqual(outlines[0].pieces[i].end, outlines[0].pieces[(i + 1) % 4].start)) << i;
  }
}

TEST(OutlinesOf, GrowsAChainAtBothEnds) {
  auto const outlines = OutlinesOf(
      Of({MakeLine({1, 0}, {2, 0}), MakeLine({3, 0}, {2, 0}), MakeLine({1, 0}, {0, 0})}));
  ASSERT_EQ(outlines.size(), 1u);
  EXPECT_FALSE(outlines[0].isClosed);
  EXPECT_TRUE(AreEqual(outlines[0].pieces.front().start, {0, 0}));
  EXPECT_TRUE(AreEqual(outlines[0].pieces.back().end, {3, 0}));
}

TEST(OutlinesOf, KeepsWhatIsInOrder) {
  std::vector<Piece> const pieces = {MakeLine({0, 0}, {1, 0}), MakeLine({1, 0}, {2, 3}),
                                     MakeLine({5, 5}, {6, 6})};
  auto const outlines = OutlinesOf(Of(pieces));
  ASSERT_EQ(outlines.size(), 2u);
  EXPECT_TRUE(AreEqual(outlines[0].pieces[1].end, {2, 3}));
  EXPECT_TRUE(AreEqual(outlines[1].pieces[0].start, {5, 5}));
}

TEST(OutlinesOf, AClosedContourIsOneWithItsGaps) {
  ContourFile contour = Of({MakeLine({0, 0}, {1, 0}), MakeLine({1.5, 0}, {0, 3})});
  contour.isClosed = true;
  EXPECT_EQ(OutlinesOf(contour).size(), 1u);
}

TEST(OutlinesOf, EndsAreOnePointUpToAMillionthOfTheSize) {
  auto const count = [](double gap) {
    return OutlinesOf(Of({MakeLine({0, 0}, {100, 0}), MakeLine({100 + gap, 0}, {100, 50})})).size();
  };
  EXPECT_EQ(count(0.9e-4), 1u);
  EXPECT_EQ(count(1.2e-4), 2u);
}

TEST(DepthsOf, CountsTheOutlinesAround) {
  std::vector<Piece> pieces = MakeCircle({10, 0}, {0, 0}, 10, true);
  Add(MakeCircle({3, 0}, {0, 0}, 3, true), &pieces);
  Add(MakeCircle({1, 0}, {0, 0}, 1, false), &pieces);
  Add(MakeCircle({22, 0}, {20, 0}, 2, true), &pieces);
  pieces.push_back(MakeLine({0, 0}, {0.5, 0}));
  EXPECT_EQ(DepthsOf(OutlinesOf(Of(pieces))), (std::vector<std::size_t>{0, 1, 2, 0, 0}));
}

}  // namespace
}  // namespace Vorn::IO
