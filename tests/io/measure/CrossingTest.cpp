#include <gtest/gtest.h>

#include <numbers>

#include "io/measure/Crossing.h"
#include "io/pieces/Shapes.h"

namespace Vorn::IO {
namespace {

using ElemType = GeometryUtils::ElemType;

ContourFile Polygon(std::vector<XY> const& corners, bool isClosed) {
  ContourFile contour;
  contour.isClosed = isClosed;
  for (std::size_t i = 1; i < corners.size(); ++i) {
    contour.pieces.push_back(MakeLine(corners[i - 1], corners[i]));
  }
  if (isClosed) contour.pieces.push_back(MakeLine(corners.back(), corners.front()));
  return contour;
}

Crossing CrossingOf(ContourFile const& contour) {
  return FindCrossing(ElementsOf(contour), contour.isClosed || ReturnsToStart(contour.pieces));
}

TEST(ElementsOf, HoldTheStartAndEveryPiece) {
  ContourFile contour;
  contour.pieces = {MakeLine({0, 0}, {2, 0}), MakeArc({2, 0}, {2, 2}, {2, 1}, 1.0, false)};
  auto const elements = ElementsOf(contour);
  ASSERT_EQ(elements.size(), 3u);
  EXPECT_EQ(elements[0].type, ElemType::Segment);
  EXPECT_EQ(elements[0].end.x, 0.0);
  EXPECT_EQ(elements[1].type, ElemType::Segment);
  EXPECT_EQ(elements[1].end.x, 2.0);
  EXPECT_EQ(elements[2].type, ElemType::Arc);
  EXPECT_EQ(elements[2].end.y, 2.0);
  EXPECT_EQ(elements[2].center.y, 1.0);
  EXPECT_EQ(elements[2].radius, 1.0);
  EXPECT_EQ(elements[2].direction, -1.0);
  // The pieces that come back are the ones that went in.
  std::vector<Piece> const back = PiecesOf(elements);
  ASSERT_EQ(back.size(), 2u);
  EXPECT_EQ(back[1].sweep, contour.pieces[1].sweep);
  EXPECT_EQ(back[1].length, contour.pieces[1].length);
}

TEST(ElementsOf, BridgeGapsAndTheOpenSeamOfAClosedContour) {
  ContourFile contour;
  contour.pieces = {MakeLine({0, 0}, {2, 0}), MakeLine({3, 0}, {3, 2})};
  EXPECT_EQ(ElementsOf(contour).size(), 4u);
  contour.isClosed = true;
  auto const elements = ElementsOf(contour);
  ASSERT_EQ(elements.size(), 5u);
  EXPECT_EQ(elements[2].end.x, 3.0);
  EXPECT_EQ(elements[4].end.x, 0.0);
  EXPECT_EQ(elements[4].end.y, 0.0);
}

TEST(ElementsOf, DoNotBridgeWhatRoundingExplains) {
  ContourFile contour;
  contour.pieces = {MakeLine({0, 0}, {2, 0}), MakeLine({2 + 1e-12, 0}, {3, 2})};
  EXPECT_EQ(ElementsOf(contour).size(), 3u);
}

TEST(FindCrossing, TellsCrossingContoursFromSimpleOnes) {
  EXPECT_EQ(CrossingOf(Polygon({{0, 0}, {4, 0}, {4, 3}, {0, 3}}, true)), Crossing::None);
  EXPECT_EQ(CrossingOf(Polygon({{0, 0}, {4, 3}, {4, 0}, {0, 3}}, true)), Crossing::Found);
  EXPECT_EQ(CrossingOf(Polygon({{0, 0}, {4, 0}, {4, 3}, {2, -1}}, false)), Crossing::Found);
}

TEST(FindCrossing, TakesArcs) {
  ContourFile contour;
  contour.pieces = {MakeLine({0, 0}, {4, 0}), MakeArc({4, 0}, {4, 2}, {4, 1}, 1.0, true),
                    MakeLine({4, 2}, {0, 2})};
  EXPECT_EQ(CrossingOf(contour), Crossing::None);
  contour.pieces.push_back(MakeLine({0, 2}, {6, 0.9}));
  EXPECT_EQ(CrossingOf(contour), Crossing::Found);
}

TEST(FindCrossing, ACrossingOfTheFirstAndTheLastPieceOfAnOpenContourCounts) {
  EXPECT_EQ(CrossingOf(Polygon({{0, 0}, {4, 0}, {4, 3}, {2, 0.01}}, false)), Crossing::None);
  EXPECT_EQ(CrossingOf(Polygon({{0, 0}, {4, 0}, {4, 3}, {2, -0.01}}, false)), Crossing::Found);
  ContourFile arcs;
  arcs.pieces = {MakeArc({0, 0}, {4, 0}, {2, 0}, 2.0, true), MakeLine({4, 0}, {4, -5})};
  arcs.pieces.push_back(MakeLine({4, -5}, {2, -2.01}));
  EXPECT_EQ(CrossingOf(arcs), Crossing::None);
  arcs.pieces.back() = MakeLine({4, -5}, {2, -1.99});
  EXPECT_EQ(CrossingOf(arcs), Crossing::Found);
}

TEST(FindCrossing, AnOpenContourMayEndAtItsStart) {
  EXPECT_EQ(CrossingOf(Polygon({{0, 0}, {4, 0}, {4, 3}, {0, 0}}, false)), Crossing::None);
}

TEST(FindCrossing, CrossingsOfABridgedGapCount) {
  ContourFile contour;
  contour.pieces = {MakeLine({0, 0}, {4, 0}), MakeLine({4, 0}, {4, 2}), MakeLine({2, -2}, {1, -2})};
  EXPECT_EQ(CrossingOf(contour), Crossing::Found);
}

TEST(FindCrossing, SaysWhatCannotBeTested) {
  ContourFile one;
  one.pieces = {MakeLine({0, 0}, {1, 0})};
  EXPECT_EQ(CrossingOf(one), Crossing::NotTestable);
  ContourFile two = one;
  two.pieces.push_back(MakeLine({1, 0}, {1, 1}));
  EXPECT_EQ(CrossingOf(two), Crossing::NotTestable);
  two.pieces.push_back(MakeLine({1, 1}, {1, 1}));
  EXPECT_EQ(CrossingOf(two), Crossing::NotTestable) << "a piece without length is no third one";
}

TEST(EnclosedBy, SaysAreaAndSense) {
  auto const enclosed = [](ContourFile const& contour) {
    return EnclosedBy(contour, ElementsOf(contour));
  };
  auto const ccw = enclosed(Polygon({{0, 0}, {4, 0}, {4, 3}, {0, 3}}, true));
  ASSERT_TRUE(ccw.has_value());
  EXPECT_EQ(ccw->area, 12.0);
  EXPECT_TRUE(ccw->isCounterClockwise);
  auto const cw = enclosed(Polygon({{0, 0}, {0, 3}, {4, 3}, {4, 0}}, true));
  ASSERT_TRUE(cw.has_value());
  EXPECT_EQ(cw->area, 12.0);
  EXPECT_FALSE(cw->isCounterClockwise);
  EXPECT_FALSE(enclosed(Polygon({{0, 0}, {4, 0}, {4, 3}}, false)).has_value());
  EXPECT_FALSE(enclosed(Polygon({{0, 0}, {4, 3}, {4, 0}, {0, 3}}, true)).has_value());
}

TEST(EnclosedBy, TakesACircleOfTwoHalves) {
  ContourFile circle;
  circle.isClosed = true;
  circle.pieces = MakeCircle({3, 0}, {0, 0}, 3.0, true);
  auto const enclosed = EnclosedBy(circle, ElementsOf(circle));
  ASSERT_TRUE(enclosed.has_value());
  EXPECT_NEAR(enclosed->area, 9.0 * std::numbers::pi, 1e-9);
  EXPECT_TRUE(enclosed->isCounterClockwise);
}

}  // namespace
}  // namespace Vorn::IO
