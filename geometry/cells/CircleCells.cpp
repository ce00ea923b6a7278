#include "geometry/cells/CircleCells.h"

#include <array>
#include <optional>
#include <span>

#include "geometry/elementary/CircleThrough.h"
#include "geometry/elementary/Sense.h"
#include "geometry/triangles/Ears.h"
#include "math/NumericConstants.h"

namespace Vorn::Cells {

namespace {

using Elementary::Circle;

/// Which of the eight candidate points an extreme circle passes through.
enum Candidate : std::size_t {
  FirstInner,
  FirstOuter,
  MiddleInner,
  MiddleOuter,
  LastInner,
  LastOuter,
  First,
  Last
};

/// Every candidate point.
using Candidates = std::array<Point, 8>;

/// The points that one extreme circle passes through.
struct Row {
  Candidate start;
  Candidate middle;
  Candidate end;
};

// Consecutive rows differ in one choice only, so the centres come out in cyclic order. All inner
// and all outer are never extreme.
constexpr Row kBothFree[] = {
    {FirstInner, MiddleInner, LastOuter}, {FirstInner, MiddleOuter, LastOuter},
    {FirstInner, MiddleOuter, LastInner}, {FirstOuter, MiddleOuter, LastInner},
    {FirstOuter, MiddleInner, LastInner}, {FirstOuter, MiddleInner, LastOuter}};
constexpr Row kFirstFixed[] = {{First, MiddleInner, LastOuter},
                               {First, MiddleOuter, LastOuter},
                               {First, MiddleOuter, LastInner},
                               {First, MiddleInner, LastInner}};
constexpr Row kLastFixed[] = {{FirstInner, MiddleInner, Last},
                              {FirstInner, MiddleOuter, Last},
                              {FirstOuter, MiddleOuter, Last},
                              {FirstOuter, MiddleInner, Last}};
// Deliberate: the last row repeats the one before it. The centres of circles through both ends lie
// on one line, and a polygon needs three corners.
constexpr Row kBothFixed[] = {
    {First, MiddleInner, Last}, {First, MiddleOuter, Last}, {First, MiddleOuter, Last}};

std::span<Row const> RowsFor(ArcTriple const& triple) {
  if (triple.firstFixed && triple.lastFixed) return kBothFixed;
  if (triple.firstFixed) return kFirstFixed;
  if (triple.lastFixed) return kLastFixed;
  return kBothFree;
}

/// The circle through the measured points; nothing when it has no centre or a tiny radius.
std::optional<Circle> MeasuredCircle(ArcTriple const& triple) {
  Point const first{triple.first.x, triple.first.y};
  std::optional<Point> const centre = Elementary::PaddedCircumcentre(
      first, {triple.middle.x, triple.middle.y}, {triple.last.x, triple.last.y});
  if (!centre) return std::nullopt;
  double const radius = Elementary::Distance(first, *centre);
  bool const isProperRadius = radius > Numeric::kZero;
  if (!isProperRadius) return std::nullopt;
  return Circle{*centre, radius};
}

/// A point of the circle, moved along its radius until it is so far from the centre.
Point MovedAlongRadius(WPoint const& p, Circle const& circle, double newRadius) {
  auto const& [centre, radius] = circle;
  return {centre.x + (p.x - centre.x) * newRadius / radius,
          centre.y + (p.y - centre.y) * newRadius / radius};
}

Candidates CandidatesOf(ArcTriple const& triple, Circle const& circle) {
  Candidates candidates;
  WPoint const measured[3] = {triple.first, triple.middle, triple.last};
  for (std::size_t i = 0; i < 3; ++i) {
    WPoint const& p = measured[i];
    candidates[2 * i] = MovedAlongRadius(p, circle, circle.radius - p.w);
    candidates[2 * i + 1] = MovedAlongRadius(p, circle, circle.radius + p.w);
  }
  candidates[First] = {triple.first.x, triple.first.y};
  candidates[Last] = {triple.last.x, triple.last.y};
  return candidates;
}

}  // namespace

ErrorCode FindCorners(ArcTriple const& triple, CircleCellCorners* corners) {
  std::optional<Circle> const measured = MeasuredCircle(triple);
  if (!measured) return ErrorCode::Failed;
  Candidates const candidates = CandidatesOf(triple, *measured);
  bool const isSelecting = triple.AreEndsFree() && triple.orientation != 0;
  int wantedSign = triple.orientation;
  CircleCellCorners kept;
  for (Row const& row : RowsFor(triple)) {
    Point const& start = candidates[row.start];
    Point const& middle = candidates[row.middle];
    Point const& end = candidates[row.end];
    std::optional<Circle> const extreme = Elementary::CircleThrough(start, middle, end);
    if (!extreme) return ErrorCode::Failed;
    int const sign = Numeric::Sign(Elementary::SignedArea(start, middle, end));
    if (!isSelecting && kept.empty()) wantedSign = sign;
    if (sign == wantedSign) {
      kept.push_back(extreme->centre);
    } else if (!isSelecting) {
      return ErrorCode::OrientationMismatch;
    }
  }
  if (kept.size() < 3) return ErrorCode::OrientationMismatch;
  *corners = kept;
  return ErrorCode::Ok;
}

ErrorCode FindCircleCell(ArcTriple const& triple, CircleCell* cell) {
  CircleCellCorners corners;
  ErrorCode const code = FindCorners(triple, &corners);
  if (code != ErrorCode::Ok) return code;
  cell->clear();
  Triangles::CutEars(corners.data(), static_cast<int>(corners.size()),
                     [cell](Triangle const& ear) { cell->push_back(ear); });
  return ErrorCode::Ok;
}

}  // namespace Vorn::Cells
