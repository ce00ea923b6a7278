#include <gtest/gtest.h>

#include <cmath>

#include "io/Contours.h"
#include "io/drawing/Band.h"
#include "io/drawing/Feet.h"

namespace Vorn::IO::Svg {
namespace {

TEST(FootOn, IsTheNearestPlaceOfALineAndItsLengthFromTheStart) {
  Piece const line = Contours::LineAndQuarter()[0];
  Foot const inside = FootOn(line, 4.0, 3.0);
  EXPECT_EQ(inside.at.x, 4.0);
  EXPECT_EQ(inside.at.y, 0.0);
  EXPECT_EQ(inside.along, 4.0);
  EXPECT_EQ(FootOn(line, -2.0, 3.0).along, 0.0);
  EXPECT_EQ(FootOn(line, 12.0, 3.0).at.x, 10.0);
  EXPECT_EQ(FootOn(line, 12.0, 3.0).along, 10.0);
}

TEST(FootOn, IsTheNearestPlaceOfAnArcAndItsLengthFromTheStart) {
  Piece const arc = Contours::LineAndQuarter()[1];
  Foot const inside = FootOn(arc, 13.0, 1.0);
  EXPECT_DOUBLE_EQ(inside.at.x, 13.0);
  EXPECT_DOUBLE_EQ(inside.at.y, 1.0);
  EXPECT_DOUBLE_EQ(inside.along, 5.0 * std::atan2(3.0, 4.0));
  EXPECT_EQ(FootOn(arc, 0.0, -1.0).along, 0.0);
  EXPECT_EQ(FootOn(arc, 15.0, 9.0).along, arc.length);
  EXPECT_EQ(FootOn(arc, 10.0, 5.0).along, 0.0) << "every place is as near to the centre";
}

TEST(Magnified, MovesThePointAwayFromItsFoot) {
  std::vector<Piece> const pieces = Contours::LineAndQuarter();
  WPoint const above{4.0, 0.25, 0.5};
  GeometryUtils::Point const moved = Magnified(above, FootOn(pieces[0], 4.0, 0.25), 8.0);
  EXPECT_EQ(moved.x, 4.0);
  EXPECT_EQ(moved.y, 2.0);
  // 1 inside the arc along its radius of slope -4/3.
  WPoint const inner{12.4, 1.8, 0.5};
  GeometryUtils::Point const far = Magnified(inner, FootOn(pieces[1], 12.4, 1.8), 3.0);
  EXPECT_NEAR(far.x, 13.0 - 3.0 * 0.6, 1e-12);
  EXPECT_NEAR(far.y, 1.0 + 3.0 * 0.8, 1e-12);
}

TEST(Magnified, OnceIsThePointItself) {
  WPoint const point{0.1, 0.2, 0.5};
  Foot const foot{{0.3, 0.7}, 0.0};
  EXPECT_EQ(Magnified(point, foot, 1.0).x, 0.1);
  EXPECT_EQ(Magnified(point, foot, 1.0).y, 0.2);
}

TEST(PlaceOn, IsThatFarFromTheStartAlongThePiece) {
  Piece const line = MakeLine({1, 1}, {4, 5});
  EXPECT_DOUBLE_EQ(PlaceOn(line, 2.5).x, 2.5);
  EXPECT_DOUBLE_EQ(PlaceOn(line, 2.5).y, 3.0);
  Piece const arc = MakeArc({2, 0}, {-2, 0}, {0, 0}, 2, true);
  EXPECT_NEAR(PlaceOn(arc, 0.5 * arc.length).y, 2.0, 1e-15);
  EXPECT_EQ(PlaceOn(line, line.length).x, 4.0);
  EXPECT_EQ(PlaceOn(MakeLine({3, 7}, {3, 7}), 0.0).y, 7.0) << "a piece without length";
}

TEST(PieceStarts, AddUpTheLengths) {
  EXPECT_EQ(PieceStarts({}), std::vector<double>{0.0});
  EXPECT_EQ(PieceStarts({MakeLine({0, 0}, {3, 4}), MakeLine({9, 9}, {9, 11})}),
            (std::vector<double>{0.0, 5.0, 7.0}));
}

TEST(BandSections, ChangeWidthAtTheFeet) {
  std::vector<WPoint> const points = {{0, 0, .1}, {3, 0, .1}, {6, 0, .3}, {10, 0, .3}};
  Drawing const drawing = MakeDrawing(points, {Contours::LineAndQuarter()[0]});
  std::vector<BandSection> const sections = BandSections(drawing, FeetOf(drawing), 0.0);
  ASSERT_EQ(sections.size(), 2u);
  EXPECT_EQ(sections[0].tolerance, 0.1);
  EXPECT_EQ(sections[0].from, 0.0);
  EXPECT_EQ(sections[0].to, 3.0);
  EXPECT_EQ(sections[1].tolerance, 0.3);
  EXPECT_EQ(sections[1].from, 3.0);
  EXPECT_EQ(sections[1].to, 10.0);
}

TEST(BandSections, CoverPiecesWithoutPoints) {
  Drawing const drawing = MakeDrawing({{0, 0, .1}, {3, 0, .1}}, Contours::LineAndQuarter());
  std::vector<BandSection> const sections = BandSections(drawing, FeetOf(drawing), 0.0);
  ASSERT_EQ(sections.size(), 2u);
  EXPECT_EQ(sections[1].piece, 1u);
  EXPECT_EQ(sections[1].tolerance, 0.1);
  EXPECT_EQ(sections[1].to, Contours::LineAndQuarter()[1].length);
}

}  // namespace
}  // namespace Vorn::IO::Svg
