#include <cstddef>
#include <cstdint>
#include <cstring>
#include <type_traits>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "vorn/GeometryUtils.h"
#include "vorn/MathUtils.h"
#include "vorn/Matrix.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;
using Arc = GeometryUtils::Arc;
using Elem = GeometryUtils::Elem;
using ElemType = GeometryUtils::ElemType;
using Triangle = GeometryUtils::Triangle;
using IndexedPoint = GeometryUtils::IndexedPoint;
using CrossingPoint = GeometryUtils::CrossingPoint;
using ProgressBase = GeometryUtils::ProgressBase;
using OverlappingStatus = GeometryUtils::OverlappingStatus;
using PointStatus = GeometryUtils::PointStatus;
using FittingStrategy = GeometryUtils::FittingStrategy;
using RadiusStrategy = GeometryUtils::CircleRadiusFindingStrategy;
using Long = std::int32_t;
using UnsignedLong = std::uint32_t;
using Iterator = std::vector<Elem>::const_iterator;
using Points = std::vector<WPoint>;
using Cell = std::vector<Triangle>;

/// The bytes of a record at an offset, read as another type: what a caller built with another
/// compiler sees.
template <typename T, typename Record>
T ReadAt(Record const& record, std::size_t offset) {
  T value;
  std::memcpy(&value, reinterpret_cast<unsigned char const*>(&record) + offset, sizeof value);
  return value;
}

// --- Enums: numeric values, width, scope ------------------------------------------------------

template <typename Enum>
constexpr bool IsScopedLong =
    std::is_same_v<std::underlying_type_t<Enum>, Long> && !std::is_convertible_v<Enum, int>;

static_assert(IsScopedLong<ErrorCode>);
static_assert(IsScopedLong<SegmentsRelPosition>);
static_assert(IsScopedLong<PolyOrientation>);
static_assert(IsScopedLong<ElemType>);
static_assert(IsScopedLong<FittingStrategy>);
static_assert(IsScopedLong<RadiusStrategy>);
static_assert(IsScopedLong<OverlappingStatus>);
static_assert(IsScopedLong<PointStatus>);

template <typename Enum>
Long Number(Enum value) {
  return static_cast<Long>(value);
}

TEST(ErrorCode, ValuesAreTheOnesCallersStore) {
  EXPECT_EQ(Number(ErrorCode::Ok), 0);
  EXPECT_EQ(Number(ErrorCode::InvalidArcRadius), 1);
  EXPECT_EQ(Number(ErrorCode::Failed), 2);
  EXPECT_EQ(Number(ErrorCode::OutOfMemory), 4);
  EXPECT_EQ(Number(ErrorCode::IntersectionUndefined), 6);
  EXPECT_EQ(Number(ErrorCode::SelfIntersection), 19);
  EXPECT_EQ(Number(ErrorCode::PointsTooClose), 20);
  EXPECT_EQ(Number(ErrorCode::OrientationMismatch), 21);
  EXPECT_EQ(Number(ErrorCode::NoFit), 23);
  EXPECT_EQ(Number(ErrorCode::InvalidLineCell), 24);
}

TEST(SegmentsRelPosition, ValuesAreTheOnesCallersStore) {
  EXPECT_EQ(Number(SegmentsRelPosition::Disjoint), -1);
  EXPECT_EQ(Number(SegmentsRelPosition::Parallel), 0);
  EXPECT_EQ(Number(SegmentsRelPosition::Collinear), 1);
  EXPECT_EQ(Number(SegmentsRelPosition::Intersecting), 2);
}

TEST(PolyOrientation, ValuesAreTheOnesCallersStore) {
  EXPECT_EQ(Number(PolyOrientation::Cw), 0);
  EXPECT_EQ(Number(PolyOrientation::Ccw), 1);
  EXPECT_EQ(Number(PolyOrientation::OrientationUnknown), 2);
  EXPECT_EQ(Number(PolyOrientation::OrientationDegenerate), 3);
}

TEST(ElemType, ValuesAreTheOnesCallersStore) {
  EXPECT_EQ(Number(ElemType::Segment), 0);
  EXPECT_EQ(Number(ElemType::Arc), 1);
}

TEST(PointStatus, ValuesAreTheOnesCallersStore) {
  EXPECT_EQ(Number(PointStatus::Undefined), 0);
  EXPECT_EQ(Number(PointStatus::Outside), 1);
  EXPECT_EQ(Number(PointStatus::Inside), 2);
  EXPECT_EQ(Number(PointStatus::OnSide), 3);
  EXPECT_EQ(Number(PointStatus::OnVertex), 4);
  EXPECT_EQ(Number(PointStatus::OnDegenerate), 5);
}

TEST(OverlappingStatus, ValuesAreTheOnesCallersStore) {
  EXPECT_EQ(Number(OverlappingStatus::Overlap), 0);
  EXPECT_EQ(Number(OverlappingStatus::NoOverlap), 1);
  EXPECT_EQ(Number(OverlappingStatus::OverlapFailed), 2);
}

TEST(FittingStrategy, ValuesAreTheOnesCallersStore) {
  EXPECT_EQ(Number(FittingStrategy::Mixed), 0);
  EXPECT_EQ(Number(FittingStrategy::MixedCells), 1);
  EXPECT_EQ(Number(FittingStrategy::SingleArc), 2);
}

TEST(CircleRadiusFindingStrategy, ValuesAreTheOnesCallersStore) {
  EXPECT_EQ(Number(RadiusStrategy::MidRange), 0);
  EXPECT_EQ(Number(RadiusStrategy::MeanDistance), 1);
}

// --- Records: layout, zero initialisation, copies ---------------------------------------------

template <typename Record>
constexpr bool IsPlain = std::is_trivially_copyable_v<Record>&& std::is_aggregate_v<Record>&&
    std::is_trivially_destructible_v<Record>;

static_assert(IsPlain<Point>);
static_assert(IsPlain<Arc>);
static_assert(IsPlain<Elem>);
static_assert(IsPlain<Triangle>);
static_assert(IsPlain<IndexedPoint>);
static_assert(IsPlain<CrossingPoint>);
static_assert(IsPlain<ProgressBase>);
static_assert(IsPlain<WPoint>);
static_assert(IsPlain<WPoint2>);
static_assert(IsPlain<Point2D<double>>);
static_assert(IsPlain<PolylineParam>);

static_assert(std::is_same_v<decltype(Elem::type), ElemType>);
static_assert(std::is_same_v<decltype(Triangle::pts), Point[3]>);
static_assert(std::is_same_v<decltype(IndexedPoint::index), Long>);
static_assert(std::is_same_v<decltype(CrossingPoint::side1), int>);
static_assert(std::is_same_v<decltype(CrossingPoint::side2), int>);
static_assert(std::is_same_v<decltype(ProgressBase::state), ExecutionState*>);
static_assert(std::is_same_v<decltype(ProgressBase::maxPercent), Long>);
static_assert(std::is_same_v<decltype(ProgressBase::total), Long>);
static_assert(std::is_same_v<decltype(PolylineParam::kind), Long>);
static_assert(std::is_same_v<decltype(PolylineParam::stride), Long>);

TEST(Point, IsTwoDoubles) {
  Point const p{1.5, -2.5};
  ASSERT_EQ(sizeof p, 16U);
  EXPECT_EQ(ReadAt<double>(p, 0), 1.5);
  EXPECT_EQ(ReadAt<double>(p, 8), -2.5);
}

TEST(Point2D, IsTwoDoubles) {
  Point2D<double> const p{1.5, -2.5};
  ASSERT_EQ(sizeof p, 16U);
  EXPECT_EQ(ReadAt<double>(p, 0), 1.5);
  EXPECT_EQ(ReadAt<double>(p, 8), -2.5);
}

TEST(WPoint, IsThreeDoubles) {
  WPoint const p{1.5, -2.5, 0.25};
  ASSERT_EQ(sizeof p, 24U);
  EXPECT_EQ(ReadAt<double>(p, 0), 1.5);
  EXPECT_EQ(ReadAt<double>(p, 8), -2.5);
  EXPECT_EQ(ReadAt<double>(p, 16), 0.25);
}

TEST(WPoint2, IsFourDoublesInOrder) {
  WPoint2 p;
  p.dx = 1.0;
  p.dy = 2.0;
  p.dev = 3.0;
  p.weight = 4.0;
  ASSERT_EQ(sizeof p, 32U);
  for (int i = 0; i < 4; ++i) EXPECT_EQ(ReadAt<double>(p, 8U * static_cast<unsigned>(i)), i + 1.0);
}

TEST(Arc, IsEightDoublesInOrder) {
  Arc arc;
  arc.end = {1.0, 2.0};
  arc.center = {3.0, 4.0};
  arc.radius = 5.0;
  arc.direction = 6.0;
  arc.startAngle = 7.0;
  arc.endAngle = 8.0;
  ASSERT_EQ(sizeof arc, 64U);
  for (int i = 0; i < 8; ++i) {
    EXPECT_EQ(ReadAt<double>(arc, 8U * static_cast<unsigned>(i)), i + 1.0);
  }
}

TEST(Elem, HoldsItsTypeAtOffset0AndTheArcFromOffset8) {
  Elem elem;
  elem.type = ElemType::Arc;
  elem.end = {1.0, 2.0};
  elem.center = {3.0, 4.0};
  elem.radius = 5.0;
  elem.direction = 6.0;
  elem.startAngle = 7.0;
  elem.endAngle = 8.0;
  ASSERT_EQ(sizeof elem, 72U);
  EXPECT_EQ(ReadAt<Long>(elem, 0), 1);
  for (int i = 0; i < 8; ++i) {
    EXPECT_EQ(ReadAt<double>(elem, 8U + 8U * static_cast<unsigned>(i)), i + 1.0);
  }
}

TEST(Elem, IsPassedAsTheArcThatItHolds) {
  static_assert(std::is_convertible_v<Elem const&, Arc const&>);
  Elem elem;
  elem.radius = 2.5;
  Arc const& arc = elem;
  EXPECT_EQ(
      reinterpret_cast<unsigned char const*>(&arc) - reinterpret_cast<unsigned char const*>(&elem),
      8);
  EXPECT_EQ(arc.radius, 2.5);
}

TEST(Elem, VectorsAreContiguousRecordsOf72Bytes) {
  std::vector<Elem> const contour(3);
  EXPECT_EQ(reinterpret_cast<unsigned char const*>(&contour[2]) -
                reinterpret_cast<unsigned char const*>(&contour[0]),
            144);
}

TEST(Triangle, IsThreePointsInOrder) {
  Triangle const triangle{{{1.0, 2.0}, {3.0, 4.0}, {5.0, 6.0}}};
  ASSERT_EQ(sizeof triangle, 48U);
  for (int i = 0; i < 6; ++i) {
    EXPECT_EQ(ReadAt<double>(triangle, 8U * static_cast<unsigned>(i)), i + 1.0);
  }
}

TEST(IndexedPoint, HoldsPointToleranceAndIndex) {
  IndexedPoint p;
  p.pt = {1.0, 2.0};
  p.w = 3.0;
  p.index = 4;
  ASSERT_EQ(sizeof p, 32U);
  EXPECT_EQ(ReadAt<double>(p, 0), 1.0);
  EXPECT_EQ(ReadAt<double>(p, 8), 2.0);
  EXPECT_EQ(ReadAt<double>(p, 16), 3.0);
  EXPECT_EQ(ReadAt<Long>(p, 24), 4);
}

TEST(CrossingPoint, HoldsPointAndBothSides) {
  CrossingPoint p;
  p.pt = {1.0, 2.0};
  p.side1 = 3;
  p.side2 = 4;
  ASSERT_EQ(sizeof p, 24U);
  EXPECT_EQ(ReadAt<double>(p, 0), 1.0);
  EXPECT_EQ(ReadAt<double>(p, 8), 2.0);
  EXPECT_EQ(ReadAt<Long>(p, 16), 3);
  EXPECT_EQ(ReadAt<Long>(p, 20), 4);
}

TEST(PolylineParam, HoldsKindAndStride) {
  PolylineParam param;
  param.kind = 1;
  param.stride = 8;
  ASSERT_EQ(sizeof param, 8U);
  EXPECT_EQ(ReadAt<Long>(param, 0), 1);
  EXPECT_EQ(ReadAt<Long>(param, 4), 8);
}

TEST(GetPolylineParam, AnEntryOfOneOrMoreMeansPlainVertices) {
  for (Long const entry : {1, 2, 40, 2147483647}) {
    PolylineParam param{kIntSentinel, kIntSentinel};
    EXPECT_TRUE(GeometryUtils::GetPolylineParam(entry, &param));
    EXPECT_EQ(param.kind, 0) << entry;
    EXPECT_EQ(param.stride, 2) << entry;
    EXPECT_EQ(GeometryUtils::GetIncrement(entry), 2U) << entry;
  }
}

TEST(GetPolylineParam, ZeroCountsWithTheNegativeEntriesAsVertexRecords) {
  for (Long const entry : {0, -1, -40, -2147483647 - 1}) {
    PolylineParam param{kIntSentinel, kIntSentinel};
    EXPECT_TRUE(GeometryUtils::GetPolylineParam(entry, &param));
    EXPECT_EQ(param.kind, 1) << entry;
    EXPECT_EQ(param.stride, 8) << entry;
    EXPECT_EQ(GeometryUtils::GetIncrement(entry), 8U) << entry;
  }
}

TEST(ProgressBase, HoldsStateThenPercentThenTotal) {
  ProgressBase progress;
  progress.maxPercent = 100;
  progress.total = 7;
  ASSERT_EQ(sizeof progress, sizeof(void*) + 8);
  EXPECT_EQ(ReadAt<ExecutionState*>(progress, 0), nullptr);
  EXPECT_EQ(ReadAt<Long>(progress, sizeof(void*)), 100);
  EXPECT_EQ(ReadAt<Long>(progress, sizeof(void*) + 4), 7);
}

TEST(Records, StartAsZero) {
  Elem const elem{};
  EXPECT_EQ(elem.type, ElemType::Segment);
  EXPECT_SAME_POINT(elem.end, (Point{0.0, 0.0}));
  EXPECT_SAME_POINT(elem.center, (Point{0.0, 0.0}));
  for (double const value : {elem.radius, elem.direction, elem.startAngle, elem.endAngle}) {
    EXPECT_SAME_BITS(value, 0.0);
  }
  for (Point const& pt : Triangle{}.pts) EXPECT_SAME_POINT(pt, (Point{0.0, 0.0}));
  WPoint const measured{};
  for (double const value : {measured.x, measured.y, measured.w}) EXPECT_SAME_BITS(value, 0.0);
  WPoint2 const sample{};
  for (double const value : {sample.dx, sample.dy, sample.dev, sample.weight}) {
    EXPECT_SAME_BITS(value, 0.0);
  }
  Point2D<double> const vertex{};
  for (double const value : {vertex.x, vertex.y}) EXPECT_SAME_BITS(value, 0.0);
  IndexedPoint const indexed{};
  EXPECT_SAME_POINT(indexed.pt, (Point{0.0, 0.0}));
  EXPECT_SAME_BITS(indexed.w, 0.0);
  EXPECT_EQ(indexed.index, 0);
  CrossingPoint const crossing{};
  EXPECT_SAME_POINT(crossing.pt, (Point{0.0, 0.0}));
  EXPECT_EQ(crossing.side1, 0);
  EXPECT_EQ(crossing.side2, 0);
  ProgressBase const progress{};
  EXPECT_EQ(progress.state, nullptr);
  EXPECT_EQ(progress.maxPercent, 0);
  EXPECT_EQ(progress.total, 0);
  PolylineParam const param{};
  EXPECT_EQ(param.kind, 0);
  EXPECT_EQ(param.stride, 0);
}

TEST(SpatVector, IsFiveDoubles) {
  SpatVector vector;
  ASSERT_EQ(sizeof vector, 40U);
  for (double const entry : vector.v) EXPECT_SAME_BITS(entry, 0.0);
  EXPECT_EQ(vector.QuantityOfDataElements(), 5);
}

TEST(Mtrx, ItsFirstMemberIsNineDoubles) {
  static_assert(std::is_union_v<Mtrx>);
  static_assert(std::is_same_v<decltype(Mtrx::m), double[9]>);
  ASSERT_EQ(sizeof(Mtrx), 72U);
  Mtrx const elements{{1.0, 2.0, 3.0, 4.0, 5.0, 6.0, 7.0, 8.0, 9.0}};
  for (int i = 0; i < 9; ++i) {
    EXPECT_EQ(ReadAt<double>(elements, 8U * static_cast<unsigned>(i)), i + 1.0);
  }
}

TEST(Matrix, IsExactlyNineDoublesWithoutVirtualOperations) {
  EXPECT_EQ(sizeof(Matrix), 72U);
  EXPECT_FALSE(std::is_polymorphic_v<Matrix>);
}

TEST(Classes, AreNeverInstantiated) {
  EXPECT_FALSE(std::is_default_constructible_v<GeometryUtils>);
  EXPECT_FALSE(std::is_default_constructible_v<MathUtils>);
}

// --- ExecutionState ---------------------------------------------------------------------------

class Recorder final : public ExecutionState {
 public:
  void SetProgress(Long percent) override { percents.push_back(percent); }

  std::vector<Long> percents;
};

static_assert(std::is_abstract_v<ExecutionState>);
static_assert(!std::has_virtual_destructor_v<ExecutionState>);
static_assert(
    std::is_same_v<decltype(&ExecutionState::SetProgress), void (ExecutionState::*)(Long)>);

TEST(ExecutionState, CallsThroughTheBaseReachTheCaller) {
  Recorder recorder;
  ExecutionState& state = recorder;
  state.SetProgress(42);
  EXPECT_EQ(recorder.percents, std::vector<Long>{42});
}

#if defined(__GXX_ABI_VERSION)
TEST(ExecutionState, SetProgressIsTheSecondSlotOfTheVirtualTable) {
  using Slot = void (*)(ExecutionState*, Long);
  Recorder recorder;
  ExecutionState* const state = &recorder;
  Slot const* table = nullptr;
  static_assert(sizeof(Slot) == sizeof(void*));
  std::memcpy(&table, static_cast<void const*>(state), sizeof table);
  table[1](state, 55);
  table[1](state, -2147483647 - 1);
  EXPECT_EQ(recorder.percents, (std::vector<Long>{55, -2147483647 - 1}));
}

TEST(ExecutionState, BeginsWithItsVirtualTablePointerAndHoldsNothingElse) {
  EXPECT_EQ(sizeof(ExecutionState), sizeof(void*));
}
#endif

// --- Signatures: what another program links against ---------------------------------------------

/// Compiles only when an overload with exactly this signature exists.
template <typename Signature>
constexpr bool Is(Signature*) {
  return true;
}

using G = GeometryUtils;

// Angles, distances and deviations.
static_assert(Is<double(double, double)>(&G::GetNaturalAngle));
static_assert(Is<double(double)>(&G::NaturalAngleToAzimuthRad));
static_assert(Is<double(double, bool)>(&G::NaturalAngleToTangentialAzimuthRad));
static_assert(Is<double(double, double)>(&G::SubtrAng));
static_assert(Is<double(Arc const&)>(&G::GetArcLength));
static_assert(Is<double(Arc const&)>(&G::GetArcAngleRad));
static_assert(Is<double(Point const&, Point const&)>(&G::GetDist2));
static_assert(
    Is<bool(double, double, double, double, double*, double*, double*)>(&G::GetLineParameters));
static_assert(Is<bool(double, double, double, double, double, double*)>(&G::GetDeviation));
static_assert(Is<bool(double, double, double, double, double, double*)>(&G::GetSignedDeviation));
static_assert(Is<bool(double const*, double*)>(&G::GetDeviation));
static_assert(
    Is<void(double, double, double, Point const&, double*, double*, double*)>(&G::GetNormal));
static_assert(Is<void(double, double, double, double, double*)>(&G::GetXyminXymax));
static_assert(Is<bool(WPoint const&, WPoint const&)>(&G::IsPointValidToFit));
static_assert(Is<Long(double)>(&MathUtils::GetOutsideMax));
static_assert(Is<Long(double)>(&MathUtils::GetOutsideMin));

// Circles through points.
static_assert(Is<ErrorCode(double, double, double, double, double, double, double*, double*,
                           double*)>(&G::GetCircle));
static_assert(Is<bool(Point const&, Point const&, Point const&, Point*, double*)>(&G::GetCircle));
static_assert(Is<bool(WPoint const&, WPoint const&, WPoint const&, WPoint*, Point*, Point*, Point*,
                      bool*)>(&G::GetCircle));
static_assert(Is<ErrorCode(Point const&, Point const&, Point const&, bool*)>(&G::IsCcw));

// Straight-line intersections.
static_assert(Is<SegmentsRelPosition(double, double, double, double, double, double, double*,
                                     double*)>(&G::GetLinesIntersection));
static_assert(Is<bool(double, double, double, double, double, double, double, double*, double*)>(
    &G::GetLineAndSegmentIntersection));
static_assert(Is<SegmentsRelPosition(double, double, double, double, double, double, double, double,
                                     double*, double*)>(&G::GetLineSegmentsIntersection));
static_assert(Is<bool(double, double, double, double, double, double, double, double)>(
    &G::AreLineSegmentsIntersect));
static_assert(
    Is<bool(double, double, double, double, double&, double&)>(&MathUtils::GetLinesIntersection));
static_assert(Is<bool(double, double, double, Point const&, Point*)>(&G::GetNearestPointOnLine));

// Circle and arc intersections.
static_assert(Is<int(double, double, double, double, double, double, double, double*, double*,
                     double*, double*)>(&G::GetLineSegmentAndCircleIntersection));
static_assert(Is<int(double, double, double, double, double, double, double*, double*, double*,
                     double*)>(&G::GetLineAndCircleIntersection));
static_assert(
    Is<int(double, double, double, double, double, double, double, double, double, double, double*,
           double*, double*, double*)>(&G::GetLineSegmentAndCircleArcIntersection));
static_assert(
    Is<int(double, double, double, double, double, double, double, double, double, double, double,
           double, double*, double*, double*, double*)>(&G::GetCircleArcAndCircleArcIntersection));
static_assert(Is<bool(Point const&, double, Point const&, Point*)>(&G::GetNearestPointOnCircle));

// Contour chains.
static_assert(Is<bool(std::vector<Elem>*, Point)>(&G::AddSegm));
static_assert(Is<bool(std::vector<Elem>*, Point const&, Point const&, Point const&, double, bool)>(
    &G::AddArc));
static_assert(Is<bool(std::vector<Elem>*, Elem*)>(&G::RemoveElem));
static_assert(Is<bool(std::vector<Elem>*, Elem const&)>(&G::ReplaceElem));
static_assert(Is<bool(std::vector<Elem>*, Point*)>(&G::GetElemPoint));
static_assert(Is<ErrorCode(Iterator&, Point2D<double>*)>(&G::GetElemPoint));
static_assert(Is<bool(Elem const&, Point2D<double> const&, Elem*)>(&G::ShiftElem));
static_assert(Is<bool(Elem const&, int, Point2D<double> const&, Elem*)>(&G::SplitElem));
static_assert(Is<void(std::vector<Elem>*)>(&G::DeleteFittingCurve));
static_assert(Is<ErrorCode(Iterator&, Iterator&, bool*)>(&G::CheckLength));
static_assert(Is<ErrorCode(std::vector<Elem> const&, Iterator&, Iterator*)>(&G::GetNextIter));

// Contour area and self-intersection, flat polylines.
static_assert(Is<ErrorCode(std::vector<Elem> const&)>(&G::CheckPolySelfIntersection));
static_assert(Is<ErrorCode(std::vector<Elem> const&, double*)>(&G::GetArea));
static_assert(
    Is<ErrorCode(std::vector<double> const&, std::vector<Long> const&, double*)>(&G::GetArea));
static_assert(Is<ErrorCode(std::vector<double>&, std::vector<Long> const&, bool*)>(
    &G::CheckPolySelfIntersection));
static_assert(Is<PolyOrientation(std::vector<double> const&, std::vector<Long> const&)>(
    &G::GetPolyOrientation));
static_assert(Is<bool(Long, PolylineParam*)>(&G::GetPolylineParam));
static_assert(Is<UnsignedLong(Long)>(&G::GetIncrement));
static_assert(Is<bool(std::vector<Long> const&, UnsignedLong, UnsignedLong*)>(&G::GetIndicesIndex));

// Triangles and crossing points.
static_assert(Is<double(Triangle const&)>(&G::GetArea));
static_assert(Is<bool(Triangle const&)>(&G::IsValidTriangle));
static_assert(Is<bool(Triangle const&, Point*)>(&G::CalcCenter));
static_assert(Is<PointStatus(Point const&, Triangle const&)>(&G::GetPointStatus));
static_assert(
    Is<bool(Triangle const&, int, Triangle const&, std::vector<Point>*)>(&G::GetCrossingPoints));
static_assert(
    Is<void(Triangle const&, Triangle const&, std::vector<CrossingPoint>*)>(&G::GetCrossingPoints));

// Convex overlap and polygon division.
static_assert(Is<OverlappingStatus(Triangle const&, Triangle const&, Cell*)>(&G::GetOverlapping));
static_assert(Is<OverlappingStatus(Triangle const&, Cell const*, Cell*)>(&G::GetOverlapping));
static_assert(Is<bool(std::vector<Point> const&, int, int, Cell*)>(&G::ConvexPolygonDivide));
static_assert(Is<bool(std::vector<Point> const&, int, int, int)>(&G::SimplePolygonIsValid));
static_assert(
    Is<bool(Point const&, std::vector<Point> const&, int, int)>(&G::PointIsInsideOfPolygon));

// Line tolerance cells.
static_assert(Is<bool(WPoint, WPoint, double*)>(&G::GetPermissibleRect));
static_assert(Is<bool(double, double, double, double, double, double*)>(&G::GetPermissibleRect));
static_assert(Is<bool(double const*, double const*, int)>(&G::IsValidBunch));
static_assert(Is<ErrorCode(WPoint, WPoint, bool*, bool*, Point2D<double>*)>(&G::GetLinePolygon));
static_assert(Is<ErrorCode(WPoint, WPoint, bool*, bool*, Cell*)>(&G::GetLineTriangles));
static_assert(Is<ErrorCode(double, double, double, double, double, bool*, bool*, Cell*)>(
    &G::GetLineTriangles));
static_assert(
    Is<bool(Point const&, Point const&, Point const&, double, double*)>(&G::GetPermissibleHexagon));

// Circle tolerance cells.
static_assert(Is<ErrorCode(WPoint, WPoint, WPoint, bool, bool, int, int*, Point2D<double>*)>(
    &G::GetCirclePolygon));
static_assert(
    Is<ErrorCode(WPoint, WPoint, WPoint, bool, bool, int, Cell*)>(&G::GetCircleTriangles));

// Cell centres and bounds.
static_assert(Is<bool(Cell const*, double*)>(&G::GetBoundingRect));
static_assert(Is<bool(Cell const*, double, double, double, Triangle*)>(
    &G::GetBoundingCircleAndLineIntersectionTriangle));
static_assert(Is<bool(Cell const*, Point*)>(&G::GetCenter));
static_assert(Is<bool(Point const&, Point const&, Cell const*, Point*)>(&G::GetCenterForCircle));
static_assert(Is<bool(bool, Point const&, bool, Point const&, bool, Cell const*, Point*)>(
    &G::GetCenterForLine));

// Fitting driver and line fitting.
static_assert(Is<ErrorCode(Points const&, FittingStrategy, std::vector<Elem>*, double*, Long*,
                           ExecutionState*, Long)>(&G::CreateFittingCurve));
static_assert(
    Is<ErrorCode(Points const&, Long, Long, bool, Point*, bool, Point*, bool, Long*, double*, Long*,
                 std::vector<Long>*, ErrorCode*, ProgressBase const&)>(&G::GetFittingLine));
static_assert(Is<double(Points const&, Long, Long, Point const&, Point const&, Long*)>(
    &G::GetMaxDeviationFromLine));
static_assert(Is<bool(Point const&, Point const&, Points const&, Long, Long, double*, double*,
                      Long*, Long*)>(&G::GetDeviationFromLineParameters));
static_assert(Is<bool(Point const&, Point const&, Points const&, Long, Long, std::vector<Long>*)>(
    &G::GetDeviationFromLineParameters));
static_assert(Is<bool(Cell const*, double, double, double, double, bool, bool, Point, bool, Point,
                      double*, double*, double*, double*)>(&G::GetOptimalLineSegment));
static_assert(Is<bool(Point const&, Point const&, Point const&)>(&G::IsValidLineOrder));
static_assert(Is<bool(Points const&, int, int, double, Cell*)>(
    &G::ReduceOverlappedTrianglesQuantityForStraightLine));
static_assert(Is<void(ProgressBase const&, Long)>(&G::SetProgressState));

// Arc fitting over cells and arc point reduction.
static_assert(
    Is<ErrorCode(Points const&, Long, Long, bool, Point*, bool, Point*, std::vector<IndexedPoint>*,
                 Cell*, Long*, Point*, double*, bool*, double*, Long*)>(&G::GetFittingCircleO));
static_assert(
    Is<ErrorCode(Points const&, Long, Long, Long, bool, Point*, bool, Point*, Cell*, Long*, Point*,
                 double*, bool*, double*, Long*, ProgressBase const&)>(&G::GetFittingCircle2));
static_assert(Is<ErrorCode(Points const&, Long, Long, Long, bool, Point*, bool, Point*, Long*,
                           Point*, double*, bool*, double*, Long*)>(&G::GetFittingCircle1));
static_assert(Is<bool(Point const&, bool, Point const&, Point const&, Point const&, bool)>(
    &G::IsValidArcOrder));
static_assert(Is<ErrorCode(std::vector<IndexedPoint>*, Cell*, int, bool, Point*, bool, Point*,
                           Points const&, Long, Long, bool)>(&G::ReduceCircleArcPoints));
static_assert(Is<void(int, int, int, int*, int*, int*)>(&G::GetTriPointIndices));
static_assert(Is<void(std::vector<IndexedPoint> const*, int, int, int, bool, Point const&, bool,
                      Point const&, bool*, bool*, double*)>(&G::TriPointsCoordsToArray));
static_assert(
    Is<bool(Point const&, bool, Point const&, Point const&, Point const&)>(&G::IsValidArcOrder));

// Circle estimation and radius choice.
static_assert(Is<bool(Points const&, Point*, Point*, Point*, Point*, double*, double*)>(
    &G::GetEstimatedCircle));
static_assert(Is<bool(Point const&, Point const&, Point const&, double, double*)>(
    &G::GetEstimatedMaxDeviationForCircle));
static_assert(Is<bool(Points const&, double*, std::vector<Long>*, Point*, double*)>(
    &G::GetEstimatedDeviationForCircle));
static_assert(Is<bool(Points const&, Long, Long, double, double, double, double*, double*)>(
    &G::GetRadiusRange));
static_assert(Is<bool(Points const&, Long, Long, double, double, double, RadiusStrategy, double*)>(
    &G::CalcOptimalRadius));
static_assert(Is<bool(Points const&, Long, Long, Point const&, double, std::vector<WPoint2>*)>(
    &G::CalcDeviationCurve));
static_assert(Is<bool(std::vector<WPoint2> const&, Point*)>(&G::CalcCorrectionShiftForCircle));
static_assert(Is<double(Points const&, Long, Long, Point const&, double, Long*)>(
    &G::GetMaxObtainedDeviation));
static_assert(Is<bool(Points const&, Long, Long, Point const&, double, double*, double*)>(
    &G::GetMaxObtainedDeviation));

// Circle fit by mean circumcentre.
static_assert(Is<ErrorCode(Points const&, Long, Long, bool, Point*, bool, Point*, Long*, Point*,
                           double*, bool*, double*)>(&G::GetFittingCircle));
static_assert(Is<bool(Points const&, Long, Long, double, double, double, bool, Point const*, bool,
                      Point const*, Long*, double*, double*)>(&G::GetRadiusRange));
static_assert(Is<bool(Point const&, Point const&, Point const&, Point*)>(&G::AdjustCenter));
static_assert(Is<ErrorCode(Points const&, Long, Long, bool, Point const&, bool, Point const&,
                           Point const&, bool*)>(&G::IsCcw));

// Linear algebra.
static_assert(Is<bool(int, double*, double*, double*)>(&MathUtils::LinearEquationSystemSolve));
static_assert(Is<bool(double const*, double const*, double const*, double const*, double*,
                      double*)>(&MathUtils::CalcNormalized3DVectors));
static_assert(Is<bool(int, double*, int)>(&Matrix::Reorth));

}  // namespace
}  // namespace Vorn::Testing
