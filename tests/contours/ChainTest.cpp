#include <array>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <numbers>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/RandomGeometry.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {
namespace {

using Elem = GeometryUtils::Elem;
using ElemType = GeometryUtils::ElemType;
using Point = GeometryUtils::Point;
using Contour = std::vector<Elem>;
using Iterator = Contour::const_iterator;

constexpr double kPi = 3.14159265358979;
constexpr double kTwoPi = 6.28318530717958;
constexpr double kSmallestNormal = 2.2250738585072014e-308;
constexpr std::array<std::int32_t, 6> kInvalidTypes{2,
                                                    -1,
                                                    3,
                                                    256,
                                                    std::numeric_limits<std::int32_t>::max(),
                                                    std::numeric_limits<std::int32_t>::min()};

Elem Segment(Point const& end) {
  Elem elem;
  elem.type = ElemType::Segment;
  elem.end = end;
  return elem;
}

/// A segment whose unused fields hold marks, to see that they are carried along.
Elem MarkedSegment(Point const& end) {
  Elem elem = Segment(end);
  elem.center = {101.0, 102.0};
  elem.radius = 103.0;
  elem.direction = 104.0;
  elem.startAngle = 105.0;
  elem.endAngle = 106.0;
  return elem;
}

Elem ArcElem(Point const& center, double radius, double direction, double startAngle,
             double endAngle) {
  Elem elem;
  elem.type = ElemType::Arc;
  elem.end = {center.x + radius * std::cos(endAngle), center.y + radius * std::sin(endAngle)};
  elem.center = center;
  elem.radius = radius;
  elem.direction = direction;
  elem.startAngle = startAngle;
  elem.endAngle = endAngle;
  return elem;
}

Elem Invalid(std::int32_t type) {
  Elem elem = MarkedSegment({1.0, 2.0});
  elem.type = static_cast<ElemType>(type);
  return elem;
}

Elem Sentinel() {
  Elem elem;
  elem.type = static_cast<ElemType>(kIntSentinel);
  elem.end = elem.center = kPointSentinel;
  elem.radius = elem.direction = elem.startAngle = elem.endAngle = kSentinel;
  return elem;
}

void ExpectSameElem(Elem const& actual, Elem const& expected) {
  EXPECT_EQ(static_cast<std::int32_t>(actual.type), static_cast<std::int32_t>(expected.type));
  EXPECT_SAME_POINT(actual.end, expected.end);
  EXPECT_SAME_POINT(actual.center, expected.center);
  EXPECT_SAME_BITS(actual.radius, expected.radius);
  EXPECT_SAME_BITS(actual.direction, expected.direction);
  EXPECT_SAME_BITS(actual.startAngle, expected.startAngle);
  EXPECT_SAME_BITS(actual.endAngle, expected.endAngle);
}

void ExpectSameContour(Contour const& actual, Contour const& expected) {
  ASSERT_EQ(actual.size(), expected.size());
  for (std::size_t i = 0; i < actual.size(); ++i) {
    SCOPED_TRACE(i);
    ExpectSameElem(actual[i], expected[i]);
  }
}

Contour SmallContour() {
  return {Segment({0.0, 0.0}), MarkedSegment({4.0, 0.0}), ArcElem({4.0, 1.0}, 1.0, 1.0, -1.5, 1.5)};
}

// --- AddSegm ----------------------------------------------------------------------------------

TEST(AddSegm, AppendsASegmentWithItsEnd) {
  Contour contour;
  EXPECT_TRUE(GeometryUtils::AddSegm(&contour, {1.0, 2.0}));
  EXPECT_TRUE(GeometryUtils::AddSegm(&contour, {3.0, -0.0}));
  ASSERT_EQ(contour.size(), 2U);
  EXPECT_EQ(contour[0].type, ElemType::Segment);
  EXPECT_SAME_POINT(contour[0].end, (Point{1.0, 2.0}));
  EXPECT_EQ(contour[1].type, ElemType::Segment);
  EXPECT_SAME_POINT(contour[1].end, (Point{3.0, -0.0}));
}

TEST(AddSegm, KeepsWhatIsThereAndAcceptsAnyPoint) {
  Contour contour = SmallContour();
  EXPECT_TRUE(GeometryUtils::AddSegm(&contour, {kNaN, kInf}));
  ASSERT_EQ(contour.size(), 4U);
  EXPECT_SAME_POINT(contour[3].end, (Point{kNaN, kInf}));
  contour.pop_back();
  ExpectSameContour(contour, SmallContour());
}

// --- AddArc -----------------------------------------------------------------------------------

TEST(AddArc, AppendsAnArcWithBothPolarAngles) {
  Contour contour;
  EXPECT_TRUE(GeometryUtils::AddArc(&contour, {2.0, 1.0}, {1.0, 2.0}, {1.0, 1.0}, 1.0, false));
  ASSERT_EQ(contour.size(), 1U);
  Elem const& arc = contour[0];
  EXPECT_EQ(arc.type, ElemType::Arc);
  EXPECT_SAME_POINT(arc.end, (Point{1.0, 2.0}));
  EXPECT_SAME_POINT(arc.center, (Point{1.0, 1.0}));
  EXPECT_SAME_BITS(arc.radius, 1.0);
  EXPECT_SAME_BITS(arc.direction, 1.0);
  EXPECT_SAME_BITS(arc.startAngle, 0.0);
  EXPECT_SAME_BITS(arc.endAngle, std::numbers::pi / 2);
}

TEST(AddArc, ClockwiseIsDirectionMinusOne) {
  Contour contour;
  EXPECT_TRUE(GeometryUtils::AddArc(&contour, {-1.0, 0.0}, {0.0, -1.0}, {0.0, 0.0}, 1.0, true));
  EXPECT_SAME_BITS(contour[0].direction, -1.0);
  EXPECT_SAME_BITS(contour[0].startAngle, std::numbers::pi);
  EXPECT_SAME_BITS(contour[0].endAngle, -std::numbers::pi / 2);
}

TEST(AddArc, AnglesKeepTheSignOfZero) {
  Contour contour;
  EXPECT_TRUE(GeometryUtils::AddArc(&contour, {-1.0, -0.0}, {1.0, -0.0}, {0.0, 0.0}, 1.0, false));
  EXPECT_SAME_BITS(contour[0].startAngle, -std::numbers::pi);
  EXPECT_SAME_BITS(contour[0].endAngle, -0.0);
}

TEST(AddArc, ChecksNoGeometry) {
  Contour contour{Segment({100.0, 100.0})};
  EXPECT_TRUE(GeometryUtils::AddArc(&contour, {0.0, 0.0}, {0.0, 0.0}, {0.0, 0.0}, -7.0, false));
  EXPECT_TRUE(GeometryUtils::AddArc(&contour, {kNaN, 0.0}, {kInf, 0.0}, {0.0, 0.0}, kNaN, true));
  ASSERT_EQ(contour.size(), 3U);
  EXPECT_SAME_BITS(contour[1].radius, -7.0);
  EXPECT_SAME_BITS(contour[1].startAngle, 0.0);
  EXPECT_TRUE(std::isnan(contour[2].startAngle));
  EXPECT_TRUE(std::isnan(contour[2].radius));
}

TEST(AddArc, TakesPointsThatLieInTheContourItself) {
  Contour contour{Segment({5.0, 0.0}), Segment({0.0, 5.0}), Segment({0.0, 0.0})};
  for (int i = 0; i < 40; ++i) {
    // Every growth of the vector moves the points that the arguments refer to.
    contour.shrink_to_fit();
    ASSERT_TRUE(GeometryUtils::AddArc(&contour, contour[0].end, contour[1].end, contour[2].end, 5.0,
                                      false));
    ASSERT_TRUE(SameBits(contour.back().end, Point{0.0, 5.0}));
    ASSERT_TRUE(SameBits(contour.back().center, Point{0.0, 0.0}));
    ASSERT_EQ(contour.back().startAngle, 0.0);
    ASSERT_EQ(contour.back().endAngle, std::numbers::pi / 2);
  }
}

// --- RemoveElem -------------------------------------------------------------------------------

TEST(RemoveElem, HandsOutTheLastElement) {
  Contour contour = SmallContour();
  Elem removed = Sentinel();
  EXPECT_TRUE(GeometryUtils::RemoveElem(&contour, &removed));
  ExpectSameElem(removed, SmallContour()[2]);
  EXPECT_TRUE(GeometryUtils::RemoveElem(&contour, &removed));
  ExpectSameElem(removed, SmallContour()[1]);
  EXPECT_TRUE(GeometryUtils::RemoveElem(&contour, &removed));
  EXPECT_TRUE(contour.empty());
}

TEST(RemoveElem, OfAnEmptyContourFailsAndWritesNothing) {
  Contour contour;
  Elem removed = Sentinel();
  EXPECT_FALSE(GeometryUtils::RemoveElem(&contour, &removed));
  ExpectSameElem(removed, Sentinel());
}

TEST(RemoveElem, DoesNotInspectTheElement) {
  for (std::int32_t const type : kInvalidTypes) {
    Contour contour{Segment({0.0, 0.0}), Invalid(type)};
    Elem removed = Sentinel();
    EXPECT_TRUE(GeometryUtils::RemoveElem(&contour, &removed));
    ExpectSameElem(removed, Invalid(type));
    EXPECT_EQ(contour.size(), 1U);
  }
}

// --- ReplaceElem ------------------------------------------------------------------------------

TEST(ReplaceElem, OfAnEmptyContourFails) {
  Contour contour;
  EXPECT_FALSE(GeometryUtils::ReplaceElem(&contour, Segment({1.0, 1.0})));
  EXPECT_FALSE(GeometryUtils::ReplaceElem(&contour, ArcElem({0, 0}, 1, 1, 0, 1)));
  EXPECT_TRUE(contour.empty());
}

TEST(ReplaceElem, ASegmentTakesThePlaceOfTheLastElement) {
  Contour contour = SmallContour();
  EXPECT_TRUE(GeometryUtils::ReplaceElem(&contour, Segment({9.0, 8.0})));
  ASSERT_EQ(contour.size(), 3U);
  EXPECT_EQ(contour[2].type, ElemType::Segment);
  EXPECT_SAME_POINT(contour[2].end, (Point{9.0, 8.0}));
  ExpectSameElem(contour[1], SmallContour()[1]);
}

TEST(ReplaceElem, ASegmentMayReplaceTheOnlyElement) {
  Contour contour{ArcElem({0, 0}, 1, 1, 0, 1)};
  EXPECT_TRUE(GeometryUtils::ReplaceElem(&contour, Segment({9.0, 8.0})));
  ASSERT_EQ(contour.size(), 1U);
  EXPECT_EQ(contour[0].type, ElemType::Segment);
  EXPECT_SAME_POINT(contour[0].end, (Point{9.0, 8.0}));
}

TEST(ReplaceElem, AnArcOnAOneElementContourFailsAndPutsTheElementBack) {
  Contour contour{MarkedSegment({3.0, 4.0})};
  EXPECT_FALSE(GeometryUtils::ReplaceElem(&contour, ArcElem({0, 0}, 1, 1, 0, 1)));
  ExpectSameContour(contour, {MarkedSegment({3.0, 4.0})});
}

TEST(ReplaceElem, AnArcAfterAnInvalidElementFailsAndPutsTheElementBack) {
  for (std::int32_t const type : kInvalidTypes) {
    Contour const before{Segment({0.0, 0.0}), Invalid(type), MarkedSegment({3.0, 4.0})};
    Contour contour = before;
    EXPECT_FALSE(GeometryUtils::ReplaceElem(&contour, ArcElem({0, 0}, 1, 1, 0, 1)));
    ExpectSameContour(contour, before);
  }
}

TEST(ReplaceElem, AnArcGetsItsAnglesFromThePoints) {
  Contour contour{Segment({2.0, 0.0}), Segment({7.0, 7.0})};
  Elem arc = ArcElem({0.0, 0.0}, 2.0, 1.0, 0.75, 1.25);  // angles that fit nothing
  arc.end = {0.0, 2.0};
  EXPECT_TRUE(GeometryUtils::ReplaceElem(&contour, arc));
  ASSERT_EQ(contour.size(), 2U);
  EXPECT_EQ(contour[1].type, ElemType::Arc);
  EXPECT_SAME_POINT(contour[1].end, (Point{0.0, 2.0}));
  EXPECT_SAME_POINT(contour[1].center, (Point{0.0, 0.0}));
  EXPECT_SAME_BITS(contour[1].radius, 2.0);
  EXPECT_SAME_BITS(contour[1].direction, 1.0);
  EXPECT_SAME_BITS(contour[1].startAngle, 0.0);
  EXPECT_SAME_BITS(contour[1].endAngle, std::numbers::pi / 2);
}

TEST(ReplaceElem, TheArcStartsWhereTheElementBeforeItEnds) {
  Contour contour{Segment({0.0, 0.0}), ArcElem({0.0, 0.0}, 3.0, -1.0, 1.0, 0.0), Segment({9, 9})};
  Elem arc = ArcElem({2.0, 0.0}, 1.0, -1.0, 0.0, 0.0);
  arc.end = {2.0, -1.0};
  EXPECT_TRUE(GeometryUtils::ReplaceElem(&contour, arc));
  EXPECT_SAME_BITS(contour[2].startAngle, 0.0);
  EXPECT_SAME_BITS(contour[2].endAngle, -std::numbers::pi / 2);
  EXPECT_SAME_BITS(contour[2].direction, -1.0);
}

TEST(ReplaceElem, OnlyADirectionBelowZeroIsClockwise) {
  for (double const direction : {1.0, 0.25, 0.0, -0.0, kNaN, kInf}) {
    Contour contour{Segment({2.0, 0.0}), Segment({7.0, 7.0})};
    EXPECT_TRUE(GeometryUtils::ReplaceElem(&contour, ArcElem({0, 0}, 2, direction, 0, 1)));
    EXPECT_SAME_BITS(contour[1].direction, 1.0);
  }
  for (double const direction : {-1.0, -0.25, -std::numeric_limits<double>::denorm_min()}) {
    Contour contour{Segment({2.0, 0.0}), Segment({7.0, 7.0})};
    EXPECT_TRUE(GeometryUtils::ReplaceElem(&contour, ArcElem({0, 0}, 2, direction, 0, 1)));
    EXPECT_SAME_BITS(contour[1].direction, -1.0);
  }
}

TEST(ReplaceElem, AnInvalidTypeLeavesTheContourUnchanged) {
  for (std::int32_t const type : kInvalidTypes) {
    Contour contour = SmallContour();
    EXPECT_FALSE(GeometryUtils::ReplaceElem(&contour, Invalid(type))) << type;
    ExpectSameContour(contour, SmallContour());
  }
}

TEST(ReplaceElem, TheReplacedElementItselfMayBeInvalid) {
  for (std::int32_t const type : kInvalidTypes) {
    Contour contour{Segment({2.0, 0.0}), Invalid(type)};
    EXPECT_TRUE(GeometryUtils::ReplaceElem(&contour, ArcElem({0, 0}, 2, 1, 0, 1)));
    EXPECT_EQ(contour[1].type, ElemType::Arc);
  }
}

TEST(ReplaceElem, WorksWithTheLastElementOfTheSameContour) {
  Contour contour{Segment({2.0, 0.0}), ArcElem({0.0, 0.0}, 2.0, -1.0, 0.5, 1.5)};
  contour[1].end = {0.0, 2.0};
  EXPECT_TRUE(GeometryUtils::ReplaceElem(&contour, contour.back()));
  ASSERT_EQ(contour.size(), 2U);
  EXPECT_EQ(contour[1].type, ElemType::Arc);
  EXPECT_SAME_POINT(contour[1].end, (Point{0.0, 2.0}));
  EXPECT_SAME_POINT(contour[1].center, (Point{0.0, 0.0}));
  EXPECT_SAME_BITS(contour[1].radius, 2.0);
  EXPECT_SAME_BITS(contour[1].direction, -1.0);
  EXPECT_SAME_BITS(contour[1].startAngle, 0.0);
  EXPECT_SAME_BITS(contour[1].endAngle, std::numbers::pi / 2);
  Contour segments{Segment({1.0, 1.0}), Segment({2.0, 3.0})};
  EXPECT_TRUE(GeometryUtils::ReplaceElem(&segments, segments.back()));
  EXPECT_SAME_POINT(segments[1].end, (Point{2.0, 3.0}));
}

TEST(ReplaceElem, WorksWithAnEarlierElementOfTheSameContour) {
  Contour contour{Segment({1.0, 1.0}), Segment({2.0, 3.0}), Segment({4.0, 4.0})};
  EXPECT_TRUE(GeometryUtils::ReplaceElem(&contour, contour.front()));
  ASSERT_EQ(contour.size(), 3U);
  EXPECT_SAME_POINT(contour[2].end, (Point{1.0, 1.0}));
}

// --- GetElemPoint -----------------------------------------------------------------------------

TEST(GetElemPointOfContour, IsTheEndOfTheLastElement) {
  Contour contour = SmallContour();
  Point point = kPointSentinel;
  EXPECT_TRUE(GeometryUtils::GetElemPoint(&contour, &point));
  EXPECT_SAME_POINT(point, contour[2].end);
  contour.pop_back();
  EXPECT_TRUE(GeometryUtils::GetElemPoint(&contour, &point));
  EXPECT_SAME_POINT(point, (Point{4.0, 0.0}));
}

TEST(GetElemPointOfContour, EmptyOrInvalidFailsAndWritesNothing) {
  Contour contour;
  Point point = kPointSentinel;
  EXPECT_FALSE(GeometryUtils::GetElemPoint(&contour, &point));
  for (std::int32_t const type : kInvalidTypes) {
    contour = {Segment({0.0, 0.0}), Invalid(type)};
    EXPECT_FALSE(GeometryUtils::GetElemPoint(&contour, &point)) << type;
  }
  EXPECT_SAME_POINT(point, kPointSentinel);
}

TEST(GetElemPointOfIterator, IsTheEndOfItsElement) {
  Contour const contour = SmallContour();
  for (Iterator it = contour.begin(); it != contour.end(); ++it) {
    Point2D<double> point{kSentinel, kSentinel};
    EXPECT_EQ(GeometryUtils::GetElemPoint(it, &point), ErrorCode::Ok);
    EXPECT_SAME_BITS(point.x, it->end.x);
    EXPECT_SAME_BITS(point.y, it->end.y);
  }
}

TEST(GetElemPointOfIterator, InvalidTypeFailsAndWritesNothing) {
  for (std::int32_t const type : kInvalidTypes) {
    Contour const contour{Invalid(type)};
    Iterator it = contour.begin();
    Point2D<double> point{kSentinel, kSentinel};
    EXPECT_EQ(GeometryUtils::GetElemPoint(it, &point), ErrorCode::Failed);
    EXPECT_SAME_BITS(point.x, kSentinel);
    EXPECT_SAME_BITS(point.y, kSentinel);
    EXPECT_EQ(it, contour.begin());
  }
}

// --- ShiftElem --------------------------------------------------------------------------------

TEST(ShiftElem, MovesTheEndOfASegmentOnly) {
  Elem shifted = Sentinel();
  EXPECT_TRUE(GeometryUtils::ShiftElem(MarkedSegment({1.0, 2.0}), {0.5, -3.0}, &shifted));
  ExpectSameElem(shifted, MarkedSegment({1.5, -1.0}));
}

TEST(ShiftElem, MovesEndAndCentreOfAnArc) {
  Elem const arc = ArcElem({1.0, 2.0}, 2.0, -1.0, 0.5, -0.5);
  Elem expected = arc;
  expected.end = {arc.end.x + 0.25, arc.end.y - 4.0};
  expected.center = {1.25, -2.0};
  Elem shifted = Sentinel();
  EXPECT_TRUE(GeometryUtils::ShiftElem(arc, {0.25, -4.0}, &shifted));
  ExpectSameElem(shifted, expected);
}

TEST(ShiftElem, InvalidTypeFailsAndWritesNothing) {
  for (std::int32_t const type : kInvalidTypes) {
    Elem shifted = Sentinel();
    EXPECT_FALSE(GeometryUtils::ShiftElem(Invalid(type), {1.0, 1.0}, &shifted)) << type;
    ExpectSameElem(shifted, Sentinel());
  }
}

TEST(ShiftElem, ShiftsInPlace) {
  Elem elem = ArcElem({1.0, 2.0}, 2.0, 1.0, 0.0, 1.0);
  Elem const before = elem;
  EXPECT_TRUE(GeometryUtils::ShiftElem(elem, {1.0, 1.0}, &elem));
  EXPECT_SAME_BITS(elem.end.x, before.end.x + 1.0);
  EXPECT_SAME_POINT(elem.center, (Point{2.0, 3.0}));
}

TEST(ShiftElem, PropagatesNotANumber) {
  Elem shifted = Sentinel();
  EXPECT_TRUE(GeometryUtils::ShiftElem(Segment({1.0, 2.0}), {kNaN, kInf}, &shifted));
  EXPECT_SAME_POINT(shifted.end, (Point{kNaN, kInf}));
}

// --- SplitElem --------------------------------------------------------------------------------

struct Split {
  bool ok = false;
  std::vector<Elem> pieces;
};

Split SplitInto(Elem const& elem, int parts, Point const& start = {0.0, 0.0}) {
  Split split;
  split.pieces.assign(static_cast<std::size_t>(parts > 0 ? parts : 0) + 1, Sentinel());
  split.ok = GeometryUtils::SplitElem(elem, parts, {start.x, start.y}, split.pieces.data());
  ExpectSameElem(split.pieces.back(), Sentinel());  // one past the caller's array
  split.pieces.pop_back();
  return split;
}

TEST(SplitElem, CutsASegmentIntoEqualParts) {
  Split const split = SplitInto(Segment({3.0, 0.0}), 3);
  ASSERT_TRUE(split.ok);
  EXPECT_SAME_POINT(split.pieces[0].end, (Point{1.0, 0.0}));
  EXPECT_SAME_POINT(split.pieces[1].end, (Point{2.0, 0.0}));
  EXPECT_SAME_POINT(split.pieces[2].end, (Point{3.0, 0.0}));
}

TEST(SplitElem, SegmentPiecesAreTheElementWithAnotherEnd) {
  Elem const elem = MarkedSegment({5.0, 9.0});
  Split const split = SplitInto(elem, 4, {1.0, 1.0});
  ASSERT_TRUE(split.ok);
  ExpectSameElem(split.pieces[0], MarkedSegment({2.0, 3.0}));
  ExpectSameElem(split.pieces[1], MarkedSegment({3.0, 5.0}));
  ExpectSameElem(split.pieces[2], MarkedSegment({4.0, 7.0}));
  ExpectSameElem(split.pieces[3], elem);
}

TEST(SplitElem, SegmentCutsAreMultiplesOfTheStepAndTheLastEndIsKept) {
  constexpr std::uint64_t kSeed = 3101;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 500; ++i) {
    Point const start = random.PointIn(-10, 10);
    Point const end = random.PointIn(-10, 10);
    int const parts = random.Integer(2, 40);
    Split const split = SplitInto(Segment(end), parts, start);
    ASSERT_TRUE(split.ok);
    double const stepX = (end.x - start.x) / parts;
    double const stepY = (end.y - start.y) / parts;
    for (int k = 1; k < parts; ++k) {
      double const offsetX = k * stepX;
      double const offsetY = k * stepY;
      Point const expected{start.x + offsetX, start.y + offsetY};
      ASSERT_TRUE(SameBits(split.pieces[static_cast<std::size_t>(k - 1)].end, expected));
    }
    ASSERT_TRUE(SameBits(split.pieces.back().end, end));
  }
}

TEST(SplitElem, FewerThanTwoPartsFailAndWriteNothing) {
  for (int const parts : {1, 0, -1, std::numeric_limits<int>::min()}) {
    for (Elem const& elem : {Segment({3.0, 0.0}), ArcElem({0, 0}, 1, 1, 0, 1)}) {
      std::array<Elem, 2> pieces{Sentinel(), Sentinel()};
      EXPECT_FALSE(GeometryUtils::SplitElem(elem, parts, {0.0, 0.0}, pieces.data())) << parts;
      ExpectSameElem(pieces[0], Sentinel());
      ExpectSameElem(pieces[1], Sentinel());
    }
  }
}

TEST(SplitElem, InvalidTypeFailsAndWritesNothing) {
  for (std::int32_t const type : kInvalidTypes) {
    Split const split = SplitInto(Invalid(type), 2);
    EXPECT_FALSE(split.ok) << type;
    ExpectSameElem(split.pieces[0], Sentinel());
    ExpectSameElem(split.pieces[1], Sentinel());
  }
}

TEST(SplitElem, AnArcWithEqualAnglesIsAWholeCircle) {
  Elem const circle = ArcElem({1.0, 2.0}, 3.0, 1.0, 0.5, 0.5);
  Split const split = SplitInto(circle, 4);
  ASSERT_TRUE(split.ok);
  double const step = kTwoPi / 4;
  std::array<double, 3> const cuts{0.5 + step, 0.5 + 2.0 * step, (0.5 + 3.0 * step) - kTwoPi};
  EXPECT_SAME_BITS(split.pieces[0].startAngle, 0.5);
  for (std::size_t k = 0; k < 3; ++k) {
    SCOPED_TRACE(k);
    double const cut = k == 1 ? cuts[1] - kTwoPi : cuts[k];
    EXPECT_SAME_BITS(split.pieces[k].endAngle, cut);
    EXPECT_SAME_BITS(split.pieces[k + 1].startAngle, cut);
    EXPECT_SAME_BITS(split.pieces[k].end.x, 1.0 + 3.0 * std::cos(cut));
    EXPECT_SAME_BITS(split.pieces[k].end.y, 2.0 + 3.0 * std::sin(cut));
    EXPECT_NEAR(GeometryUtils::GetArcAngleRad(split.pieces[k]), step, 1e-14);
  }
  EXPECT_NEAR(GeometryUtils::GetArcAngleRad(split.pieces[3]), step, 1e-14);
  EXPECT_SAME_BITS(split.pieces[3].endAngle, 0.5);
  EXPECT_SAME_POINT(split.pieces[3].end, circle.end);
}

TEST(SplitElem, AClockwiseWholeCircleRunsBackwards) {
  Split const split = SplitInto(ArcElem({0.0, 0.0}, 1.0, -1.0, 0.0, 0.0), 4);
  ASSERT_TRUE(split.ok);
  double const step = kTwoPi / 4;
  EXPECT_SAME_BITS(split.pieces[0].endAngle, -step);
  // Exactly minus the cut pi: not below it, so it is not wrapped.
  EXPECT_SAME_BITS(split.pieces[1].endAngle, -kPi);
  EXPECT_SAME_BITS(split.pieces[2].endAngle, (0.0 - 3.0 * step) + kTwoPi);
}

TEST(SplitElem, ACutExactlyAtPiIsNotWrapped) {
  Split const split = SplitInto(ArcElem({0.0, 0.0}, 1.0, 1.0, 0.0, 0.0), 2);
  ASSERT_TRUE(split.ok);
  EXPECT_SAME_BITS(split.pieces[0].endAngle, kPi);
  EXPECT_SAME_BITS(split.pieces[1].startAngle, kPi);
}

TEST(SplitElem, AClockwiseCutBeyondMinusPiWrapsToNearPi) {
  // From 0.1 clockwise to 2.5 the arc sweeps 0.1 - 2.5 + 2*pi.
  Elem const arc = ArcElem({0.0, 0.0}, 2.0, -1.0, 0.1, 2.5);
  Split const split = SplitInto(arc, 8);
  ASSERT_TRUE(split.ok);
  double const sweep = ((0.1 - (2.5 - kTwoPi)) * 2.0) / 2.0;
  double const step = sweep / 8;
  int wrapped = 0;
  for (int k = 1; k < 8; ++k) {
    double const offset = k * step;
    double cut = 0.1 - offset;
    if (cut < -kPi) {
      cut += kTwoPi;
      ++wrapped;
      EXPECT_GT(cut, 2.5);
    }
    EXPECT_SAME_BITS(split.pieces[static_cast<std::size_t>(k - 1)].endAngle, cut);
  }
  EXPECT_EQ(wrapped, 1);
}

TEST(SplitElem, ArcPiecesKeepWhatIsNotCut) {
  Elem const arc = ArcElem({1.0, -2.0}, 2.5, 1.0, -1.0, 1.0);
  Split const split = SplitInto(arc, 3, {777.0, 888.0});  // the start point is not used
  ASSERT_TRUE(split.ok);
  EXPECT_SAME_BITS(split.pieces[0].startAngle, -1.0);
  EXPECT_SAME_BITS(split.pieces[2].endAngle, 1.0);
  EXPECT_SAME_POINT(split.pieces[2].end, arc.end);
  for (Elem const& piece : split.pieces) {
    EXPECT_EQ(piece.type, ElemType::Arc);
    EXPECT_SAME_POINT(piece.center, arc.center);
    EXPECT_SAME_BITS(piece.radius, 2.5);
    EXPECT_SAME_BITS(piece.direction, 1.0);
  }
  for (std::size_t k = 0; k + 1 < 3; ++k) {
    EXPECT_SAME_BITS(split.pieces[k].endAngle, split.pieces[k + 1].startAngle);
  }
}

TEST(SplitElem, AnArcWithoutRadiusIsCutAtItsStart) {
  // No sweep can be measured, so every cut lies at the start angle.
  Elem const arc = ArcElem({1.0, 2.0}, 0.0, 1.0, 0.5, 1.5);
  Split const split = SplitInto(arc, 3);
  ASSERT_TRUE(split.ok);
  EXPECT_SAME_BITS(split.pieces[0].endAngle, 0.5);
  EXPECT_SAME_BITS(split.pieces[1].endAngle, 0.5);
  EXPECT_SAME_POINT(split.pieces[0].end, (Point{1.0, 2.0}));
}

TEST(SplitElem, OnlyADirectionAboveZeroIsCounterClockwise) {
  for (double const direction : {0.0, -0.0, -1.0, kNaN}) {
    Split const split = SplitInto(ArcElem({0.0, 0.0}, 1.0, direction, 1.0, 0.0), 2);
    ASSERT_TRUE(split.ok);
    EXPECT_SAME_BITS(split.pieces[0].endAngle, 0.5) << direction;
  }
}

TEST(SplitElem, NotANumberAnglesPassThrough) {
  Split const split = SplitInto(ArcElem({0.0, 0.0}, 1.0, 1.0, kNaN, 1.0), 2);
  EXPECT_TRUE(split.ok);
  EXPECT_TRUE(std::isnan(split.pieces[0].endAngle));
  EXPECT_SAME_BITS(split.pieces[1].endAngle, 1.0);
}

TEST(SplitElem, FollowsTheCutFormulaBitForBit) {
  constexpr std::uint64_t kSeed = 3102;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  int wrapped = 0;
  for (int i = 0; i < 2000; ++i) {
    Point const center = random.PointIn(-5, 5);
    double const radius = random.Uniform(0.1, 10.0);
    bool const ccw = random.Flip();
    double const from = random.Uniform(-3.14, 3.14);
    double const to = random.Uniform(-3.14, 3.14);
    Elem const arc = ArcElem(center, radius, ccw ? 1.0 : -1.0, from, to);
    int const parts = random.Integer(2, 12);
    Split const split = SplitInto(arc, parts);
    ASSERT_TRUE(split.ok);
    double length = 0.0;
    if (ccw) {
      length = ((from > to ? to + kTwoPi : to) - from) * radius;
    } else {
      length = (from - (to > from ? to - kTwoPi : to)) * radius;
    }
    double const step = length / radius / parts;
    double previous = from;
    for (int k = 1; k < parts; ++k) {
      double const offset = k * step;
      double cut = ccw ? from + offset : from - offset;
      if (cut > kPi) {
        cut -= kTwoPi;
        ++wrapped;
      } else if (cut < -kPi) {
        cut += kTwoPi;
        ++wrapped;
      }
      Elem const& piece = split.pieces[static_cast<std::size_t>(k - 1)];
      double const x = radius * std::cos(cut);
      double const y = radius * std::sin(cut);
      ASSERT_EQ(Bits(piece.startAngle), Bits(previous));
      ASSERT_EQ(Bits(piece.endAngle), Bits(cut));
      ASSERT_TRUE(SameBits(piece.end, Point{center.x + x, center.y + y}));
      previous = cut;
    }
    ASSERT_EQ(Bits(split.pieces.back().startAngle), Bits(previous));
    ASSERT_EQ(Bits(split.pieces.back().endAngle), Bits(to));
  }
  EXPECT_GT(wrapped, 500);
}

// --- DeleteFittingCurve -----------------------------------------------------------------------

TEST(DeleteFittingCurve, EmptiesTheContourAndKeepsItsCapacity) {
  Contour contour = SmallContour();
  contour.reserve(50);
  std::size_t const capacity = contour.capacity();
  GeometryUtils::DeleteFittingCurve(&contour);
  EXPECT_TRUE(contour.empty());
  EXPECT_EQ(contour.capacity(), capacity);
  GeometryUtils::DeleteFittingCurve(&contour);
  EXPECT_TRUE(contour.empty());
}

// --- CheckLength ------------------------------------------------------------------------------

struct LengthCheck {
  ErrorCode code = ErrorCode::OutOfMemory;
  bool zero = false;
};

LengthCheck Check(Elem const& prev, Elem const& elem, bool preset) {
  Contour const contour{prev, elem};
  Iterator first = contour.begin();
  Iterator second = contour.begin() + 1;
  LengthCheck check;
  check.zero = preset;
  check.code = GeometryUtils::CheckLength(first, second, &check.zero);
  EXPECT_EQ(first, contour.begin());
  EXPECT_EQ(second, contour.begin() + 1);
  return check;
}

void ExpectZeroLength(Point const& p, Point const& q, bool expected) {
  LengthCheck const check = Check(Segment(p), Segment(q), !expected);
  EXPECT_EQ(check.code, ErrorCode::Ok);
  EXPECT_EQ(check.zero, expected);
}

TEST(CheckLength, IsZeroUpToTheSmallestNormalInBothCoordinates) {
  double const m = kSmallestNormal;
  ExpectZeroLength({1.0, 2.0}, {1.0, 2.0}, true);
  ExpectZeroLength({0.0, 0.0}, {m, -m}, true);
  ExpectZeroLength({0.0, 0.0}, {Up(m), 0.0}, false);
  ExpectZeroLength({0.0, 0.0}, {0.0, -Up(m)}, false);
  ExpectZeroLength({0.0, 0.0}, {m, Up(m)}, false);
  ExpectZeroLength({1.0, 2.0}, {Up(1.0), 2.0}, false);
}

TEST(CheckLength, AnArcBackToItsStartHasZeroLength) {
  Elem arc = ArcElem({0.0, 0.0}, 1.0, 1.0, 0.0, 0.0);
  LengthCheck const check = Check(Segment(arc.end), arc, false);
  EXPECT_EQ(check.code, ErrorCode::Ok);
  EXPECT_TRUE(check.zero);
}

TEST(CheckLength, NotANumberIsNotZero) {
  ExpectZeroLength({kNaN, 0.0}, {0.0, 0.0}, false);
  ExpectZeroLength({0.0, 0.0}, {0.0, kNaN}, false);
  ExpectZeroLength({kInf, 0.0}, {kInf, 0.0}, false);
}

TEST(CheckLength, InvalidTypeOnEitherSideFailsAndWritesNothing) {
  for (std::int32_t const type : kInvalidTypes) {
    for (bool const preset : {false, true}) {
      LengthCheck const first = Check(Invalid(type), Segment({1.0, 2.0}), preset);
      EXPECT_EQ(first.code, ErrorCode::Failed);
      EXPECT_EQ(first.zero, preset);
      LengthCheck const second = Check(Segment({1.0, 2.0}), Invalid(type), preset);
      EXPECT_EQ(second.code, ErrorCode::Failed);
      EXPECT_EQ(second.zero, preset);
    }
  }
}

// --- GetNextIter ------------------------------------------------------------------------------

struct Next {
  ErrorCode code = ErrorCode::OutOfMemory;
  std::ptrdiff_t position = -1;  // of the element found; -1 when nothing was written
};

Next NextAfter(Contour const& contour, std::ptrdiff_t position) {
  Contour const elsewhere(1);
  Iterator it = contour.begin() + position;
  Iterator next = elsewhere.begin();
  Next result;
  result.code = GeometryUtils::GetNextIter(contour, it, &next);
  EXPECT_EQ(it, contour.begin() + position);
  if (next != elsewhere.begin()) result.position = next - contour.begin();
  return result;
}

TEST(GetNextIter, IsTheFollowingElement) {
  Contour const contour = SmallContour();
  for (std::ptrdiff_t i = 0; i < 2; ++i) {
    Next const next = NextAfter(contour, i);
    EXPECT_EQ(next.code, ErrorCode::Ok);
    EXPECT_EQ(next.position, i + 1);
  }
}

TEST(GetNextIter, SkipsElementsOfZeroLength) {
  Contour const contour{Segment({1, 1}), Segment({1, 1}), Segment({1, 1}), Segment({2, 1})};
  Next const next = NextAfter(contour, 0);
  EXPECT_EQ(next.code, ErrorCode::Ok);
  EXPECT_EQ(next.position, 3);
}

TEST(GetNextIter, MeasuresEachCandidateFromTheStartingElement) {
  double const m = kSmallestNormal;
  // Each step is too short by itself; seen from the first element the third is not.
  Contour const contour{Segment({0, 0}), Segment({0.75 * m, 0}), Segment({1.5 * m, 0})};
  Next const next = NextAfter(contour, 0);
  EXPECT_EQ(next.code, ErrorCode::Ok);
  EXPECT_EQ(next.position, 2);
}

TEST(GetNextIter, FailsAtTheEndOfTheContour) {
  Contour const contour = SmallContour();
  for (std::ptrdiff_t const position : {2, 3}) {
    Next const next = NextAfter(contour, position);
    EXPECT_EQ(next.code, ErrorCode::Failed) << position;
    EXPECT_EQ(next.position, -1);
  }
  Next const ofEmpty = NextAfter({}, 0);
  EXPECT_EQ(ofEmpty.code, ErrorCode::Failed);
}

TEST(GetNextIter, FailsWhenAllRemainingElementsEndAtTheSamePoint) {
  Contour const contour{Segment({0, 0}), Segment({1, 1}), Segment({1, 1}), Segment({1, 1})};
  Next const next = NextAfter(contour, 1);
  EXPECT_EQ(next.code, ErrorCode::Failed);
  EXPECT_EQ(next.position, -1);
}

TEST(GetNextIter, FailsOnAnInvalidElementInItsWay) {
  for (std::int32_t const type : kInvalidTypes) {
    Contour const candidate{Segment({1, 2}), Segment({1, 2}), Invalid(type), Segment({5, 5})};
    EXPECT_EQ(NextAfter(candidate, 0).code, ErrorCode::Failed);
    EXPECT_EQ(NextAfter(candidate, 0).position, -1);
    Contour const start{Invalid(type), Segment({5, 5})};
    EXPECT_EQ(NextAfter(start, 0).code, ErrorCode::Failed);
    EXPECT_EQ(NextAfter(start, 0).position, -1);
    Contour const behind{Segment({1, 2}), Segment({5, 5}), Invalid(type)};
    EXPECT_EQ(NextAfter(behind, 0).code, ErrorCode::Ok);
  }
}

TEST(GetNextIter, WalksAContourWithoutTheZeroLengthElements) {
  constexpr std::uint64_t kSeed = 3103;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  Contour contour{Segment({0, 0})};
  std::vector<std::ptrdiff_t> expected;
  for (int i = 1; i < 500; ++i) {
    Point end = contour.back().end;
    if (random.Flip()) end.x += 1.0;
    if (end.x != contour.back().end.x) expected.push_back(i);
    contour.push_back(Segment(end));
  }
  std::vector<std::ptrdiff_t> walked;
  Iterator it = contour.begin();
  Iterator next;
  while (GeometryUtils::GetNextIter(contour, it, &next) == ErrorCode::Ok) {
    walked.push_back(next - contour.cbegin());
    it = next;
  }
  EXPECT_EQ(walked, expected);
}

}  // namespace
}  // namespace Vorn::Testing
