// Strategy MixedCells: the longest segments are looked for first, and the points passed over
// between two of them are covered by arcs.
//
// The search begins two points behind the anchor once a segment stands, so that an arc of three
// points at least lies between two segments. An arc that does not fit gives up its last points one
// by one, and what it leaves is covered by the next arc; only where not even three points fit do
// plain segments from point to point take its place.

#include <cstdint>
#include <vector>

#include "geometry/fitting/Runs.h"
#include "geometry/fitting/Strategies.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Fitting::At;
using Fitting::kFewestArcPoints;
using Fitting::ToPoint;

namespace {

/// Points passed over before the next segment is looked for: with the anchor, three for an arc.
constexpr std::int32_t kArcRoom = 2;

bool IsKnownType(GeometryUtils::ElemType type) {
  return type == GeometryUtils::ElemType::Segment || type == GeometryUtils::ElemType::Arc;
}

}  // namespace

CellsWalk::CellsWalk(std::vector<WPoint> const& points, std::vector<GeometryUtils::Elem>* contour,
                     GeometryUtils::ProgressBase const& progress)
    : points_(points), contour_(*contour), progress_(progress) {}

ErrorCode CellsWalk::Run(LargestDeviation* largest) {
  while (anchor_ < LastIndex()) {
    bool const isLastPair = anchor_ == LastIndex() - 1;
    if (isLastPair) skipped_ = 0;
    std::int32_t const remaining = LastIndex() + 1 - skipped_ - anchor_;
    if (remaining < kFewestArcPoints && !isLastPair) {
      CoverTail();
      continue;
    }
    Line line;
    ErrorCode const found = FindLine(isLastPair, &line);
    if (found != ErrorCode::Ok) return found;
    if (line.count > 2 || isLastPair) {
      ErrorCode const taken = TakeLine(&line);
      if (taken != ErrorCode::Ok) return taken;
    } else {
      // An opening arc needs three points as well.
      skipped_ += anchor_ == 0 && skipped_ == 0 ? kArcRoom : 1;
    }
  }
  *largest = largest_;
  return ErrorCode::Ok;
}

/// The longest segment from the first point not passed over; between the last two points one that
/// begins where the contour ends.
ErrorCode CellsWalk::FindLine(bool isLastPair, Line* line) {
  if (isLastPair && (contour_.empty() || !IsKnownType(contour_.back().type))) {
    return ErrorCode::Failed;
  }
  std::int32_t const first = anchor_ + skipped_;
  return FitLine(first, LastIndex() + 1 - first, isLastPair, false, line);
}

ErrorCode CellsWalk::FitLine(std::int32_t first, std::int32_t count, bool startFixed, bool endFixed,
                             Line* line) {
  if (startFixed) line->start = CurrentEnd();
  std::vector<std::int32_t> indexList;
  ErrorCode lineCode = ErrorCode::Ok;
  return GeometryUtils::GetFittingLine(points_, first, count, startFixed, &line->start, endFixed,
                                       &line->end, true, &line->count, &line->deviation,
                                       &line->deviationIndex, &indexList, &lineCode, progress_);
}

/// Covers the points passed over and appends the segment. One that would leave a single point over
/// gives up its last one, even if only two remain.
ErrorCode CellsWalk::TakeLine(Line* line) {
  std::int32_t const first = anchor_ + skipped_;
  if (first + line->count == LastIndex()) {
    ErrorCode const shortened = FitLine(first, line->count - 1, false, false, line);
    if (shortened != ErrorCode::Ok) return shortened;
  }
  ErrorCode const code = CoverGap(first, line->start);
  if (code != ErrorCode::Ok) return code;
  PlaceStart(line->start);
  GeometryUtils::AddSegm(&contour_, line->end);
  largest_.Take(line->deviation, line->deviationIndex);
  anchor_ += line->count - 1;
  skipped_ = kArcRoom;
  return ErrorCode::Ok;
}

/// Covers the points from the anchor to `last`, where the next segment begins at `end`.
ErrorCode CellsWalk::CoverGap(std::int32_t last, Point const& end) {
  while (anchor_ < last) {
    ErrorCode const code = last - anchor_ == 1 ? BridgeGap(end) : CoverByArc(last, end);
    if (code != ErrorCode::Ok) return code;
  }
  return ErrorCode::Ok;
}

ErrorCode CellsWalk::BridgeGap(Point const& end) {
  Line line;
  line.end = end;
  ErrorCode const code = FitLine(anchor_, 2, true, true, &line);
  if (code != ErrorCode::Ok) return code;
  GeometryUtils::AddSegm(&contour_, line.end);
  largest_.Take(line.deviation, line.deviationIndex);
  ++anchor_;
  return ErrorCode::Ok;
}

ErrorCode CellsWalk::CoverByArc(std::int32_t last, Point const& end) {
  std::int32_t const longest = last - anchor_ + 1;
  for (std::int32_t count = longest; count >= kFewestArcPoints; --count) {
    ErrorCode const code = FitArc(count, true, count == longest, end);
    if (code == ErrorCode::NoFit) continue;
    if (code != ErrorCode::OrientationMismatch) return code;
    // Points that bend both ways: one segment stands for all of them, whatever it leaves.
    AppendSegment(last, end);
    return ErrorCode::Ok;
  }
  AppendSegments(last, end);
  return ErrorCode::Ok;
}

/// Covers the points behind the anchor when too few are left to look for a segment.
void CellsWalk::CoverTail() {
  for (std::int32_t count = LastIndex() + 1 - anchor_; count >= kFewestArcPoints; --count) {
    ErrorCode const code = FitArc(count, !startElementPending_, false, {});
    if (code == ErrorCode::Ok) {
      skipped_ = kArcRoom;
      return;
    }
    if (code != ErrorCode::NoFit) break;
  }
  AppendSegments(LastIndex(), ToPoint(points_.back()));
}

/// Fits an arc over the points from the anchor on and appends it. On success the anchor moves to
/// its last point.
ErrorCode CellsWalk::FitArc(std::int32_t count, bool startFixed, bool endFixed, Point const& end) {
  Point arcStart = CurrentEnd();
  Point arcEnd = end;
  std::vector<GeometryUtils::IndexedPoint> samples;
  std::int32_t arcCount = 0;
  Point centre;
  double radius = 0.0;
  bool ccw = false;
  double deviation = 0.0;
  std::int32_t deviationIndex = -1;
  ErrorCode const code = GeometryUtils::GetFittingCircleO(
      points_, anchor_, count, startFixed, &arcStart, endFixed, &arcEnd, &samples, nullptr,
      &arcCount, &centre, &radius, &ccw, &deviation, &deviationIndex);
  if (code != ErrorCode::Ok) return code;
  PlaceStart(arcStart);
  GeometryUtils::AddArc(&contour_, arcStart, arcEnd, centre, radius, !ccw);
  largest_.Take(deviation, deviationIndex);
  anchor_ += arcCount - 1;
  return ErrorCode::Ok;
}

/// From point to point, the last one ending at `end`.
void CellsWalk::AppendSegments(std::int32_t last, Point const& end) {
  while (anchor_ < last) {
    std::int32_t const next = anchor_ + 1;
    AppendSegment(next, next == last ? end : ToPoint(At(points_, next)));
  }
}

/// One segment from the contour's end over the points up to `last`, with the deviation that it has.
void CellsWalk::AppendSegment(std::int32_t last, Point const& end) {
  Point const start = CurrentEnd();
  std::int32_t deviationIndex = -1;
  double const deviation = GeometryUtils::GetMaxDeviationFromLine(
      points_, anchor_, last - anchor_ + 1, start, end, &deviationIndex);
  PlaceStart(start);
  GeometryUtils::AddSegm(&contour_, end);
  largest_.Take(deviation, deviationIndex);
  anchor_ = last;
}

void CellsWalk::PlaceStart(Point const& start) {
  if (!startElementPending_) return;
  GeometryUtils::AddSegm(&contour_, start);
  startElementPending_ = false;
}

CellsWalk::Point CellsWalk::CurrentEnd() const {
  return startElementPending_ ? ToPoint(points_.front()) : contour_.back().end;
}

std::int32_t CellsWalk::LastIndex() const { return static_cast<std::int32_t>(points_.size()) - 1; }

}  // namespace Vorn
