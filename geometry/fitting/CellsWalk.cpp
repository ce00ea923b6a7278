// Strategy MixedCells.
//
// The search for segments begins two points behind the anchor once a segment stands, so that an arc
// of three points at least lies between two segments. An arc that does not fit gives up its last
// points one by one, and what it leaves is covered by the next arc; only where not even three
// points fit do plain segments from point to point take its place.

#include <cstdint>
#include <optional>
#include <vector>

#include "geometry/fitting/PieceElements.h"
#include "geometry/fitting/Strategies.h"
#include "geometry/fitting/arc/ArcFit.h"
#include "geometry/fitting/line/LineDeviation.h"
#include "geometry/fitting/line/LineFit.h"
#include "geometry/fitting/runs/Pieces.h"
#include "geometry/fitting/runs/Runs.h"

namespace Vorn::Fitting {

namespace {

/// Points passed over before the next segment is looked for: with the anchor, three for an arc.
constexpr std::int32_t kArcRoom = 2;

/// The walk from anchor to anchor.
class CellsWalk {
 public:
  explicit CellsWalk(CurveTask const& task)
      : task_(task), run_(RunOverAll(task.points)), arcFit_(AfterFailure::NoCell) {}

  CurveResult Walk() {
    while (anchor_ < LastIndex()) {
      ErrorCode const code = Advance();
      if (code != ErrorCode::Ok) return {code, std::nullopt};
    }
    return {ErrorCode::Ok, largest_.Get()};
  }

 private:
  /// One step of the search: covers points, or passes over more of them.
  ErrorCode Advance() {
    bool const isLastPair = anchor_ == LastIndex() - 1;
    if (isLastPair) skipped_ = 0;
    std::int32_t const first = anchor_ + skipped_;
    std::int32_t const remaining = run_.count - first;
    if (remaining < kFewestArcPoints && !isLastPair) {
      CoverTail();
      return ErrorCode::Ok;
    }
    FittedLine line;
    ErrorCode const found = FindLine({run_.points, first, remaining}, isLastPair, &line);
    if (found != ErrorCode::Ok) return found;
    if (line.count > 2 || isLastPair) return TakeLine(first, line);
    // An opening arc needs three points as well.
    skipped_ += first == 0 ? kArcRoom : 1;
    return ErrorCode::Ok;
  }

  /// The longest segment from the first point not passed over; between the last two points one that
  /// begins where the contour ends.
  ErrorCode FindLine(Run const& run, bool isLastPair, FittedLine* line) {
    if (!isLastPair) return FitLineTo(run, {}, line);
    if (task_.contour.empty() || !Contours::IsKnown(task_.contour.back())) return ErrorCode::Failed;
    return FitLineTo(run, {CurrentEnd(), std::nullopt}, line);
  }

  ErrorCode FitLineTo(Run const& run, Ends const& ends, FittedLine* line) {
    std::vector<std::int32_t> offenders;
    LineFitResult const result = FitLine({run, ends, true, task_.progress}, &offenders);
    if (result.code == ErrorCode::Ok) *line = *result.line;
    return result.code;
  }

  /// Covers the points passed over and appends the segment. One that would leave a single point
  /// over gives up its last one, even if only two remain.
  ErrorCode TakeLine(std::int32_t first, FittedLine line) {
    if (first + line.count == LastIndex()) {
      ErrorCode const shortened = FitLineTo({run_.points, first, line.count - 1}, {}, &line);
      if (shortened != ErrorCode::Ok) return shortened;
    }
    ErrorCode const code = CoverGap(first, line.start);
    if (code != ErrorCode::Ok) return code;
    PlaceStart(line.start);
    AppendLine(line);
    skipped_ = kArcRoom;
    return ErrorCode::Ok;
  }

  /// Covers the points from the anchor to `last`, where the next segment begins at `end`.
  ErrorCode CoverGap(std::int32_t last, Point const& end) {
    while (anchor_ < last) {
      ErrorCode const code = last - anchor_ == 1 ? BridgeGap(end) : CoverByArc(last, end);
      if (code != ErrorCode::Ok) return code;
    }
    return ErrorCode::Ok;
  }

  ErrorCode BridgeGap(Point const& end) {
    FittedLine line;
    ErrorCode const code = FitLineTo({run_.points, anchor_, 2}, {CurrentEnd(), end}, &line);
    if (code == ErrorCode::Ok) AppendLine(line);
    return code;
  }

  ErrorCode CoverByArc(std::int32_t last, Point const& end) {
    std::int32_t const longest = last - anchor_ + 1;
    for (std::int32_t count = longest; count >= kFewestArcPoints; --count) {
      ErrorCode const code = AppendFittedArc(count, {CurrentEnd(), FixedIf(count == longest, end)});
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
  void CoverTail() {
    for (std::int32_t count = run_.count - anchor_; count >= kFewestArcPoints; --count) {
      ErrorCode const code =
          AppendFittedArc(count, {FixedIf(!startElementPending_, CurrentEnd()), std::nullopt});
      if (code == ErrorCode::Ok) {
        skipped_ = kArcRoom;
        return;
      }
      if (code != ErrorCode::NoFit) break;
    }
    AppendSegments(LastIndex(), run_.LastPoint());
  }

  /// Fits an arc over so many points from the anchor on and appends it.
  ErrorCode AppendFittedArc(std::int32_t count, Ends const& ends) {
    arcCell_.samples.clear();
    FittedArc arc;
    ErrorCode const code = arcFit_.Fit({{run_.points, anchor_, count}, ends}, &arcCell_, &arc);
    if (code != ErrorCode::Ok) return code;
    PlaceStart(arc.start);
    task_.contour.push_back(ElementOf(arc));
    GoOnBehind(arc);
    return ErrorCode::Ok;
  }

  /// Segments from point to point, the last one ending at `end`.
  void AppendSegments(std::int32_t last, Point const& end) {
    while (anchor_ < last) {
      std::int32_t const next = anchor_ + 1;
      AppendSegment(next, next == last ? end : run_.PointAt(next));
    }
  }

  /// One segment from the contour's end over the points up to `last`, with the deviation that it
  /// has.
  void AppendSegment(std::int32_t last, Point const& end) {
    Point const start = CurrentEnd();
    std::int32_t const count = last - anchor_ + 1;
    PlaceStart(start);
    AppendLine({{start, end, count,
                 LargestDeviationFromLine({run_.points, anchor_, count}, {start, end})}});
  }

  void AppendLine(FittedLine const& line) {
    task_.contour.push_back(Contours::SegmentTo(line.end));
    GoOnBehind(line);
  }

  /// The anchor moves to the piece's last point.
  void GoOnBehind(Piece const& piece) {
    largest_.Take(piece.deviation);
    anchor_ += piece.count - 1;
  }

  void PlaceStart(Point const& start) {
    if (!startElementPending_) return;
    task_.contour.push_back(Contours::SegmentTo(start));
    startElementPending_ = false;
  }

  /// Where the next element begins: the last element's end, at first the first input point.
  Point CurrentEnd() const {
    return startElementPending_ ? run_.FirstPoint() : task_.contour.back().end;
  }

  std::int32_t LastIndex() const { return run_.count - 1; }

  CurveTask const& task_;
  Run const run_;
  ArcFit arcFit_;
  /// The samples and the cell of the arc fitted last; kept for its room only.
  ArcCell arcCell_;

  /// The last point that an element covers.
  std::int32_t anchor_ = 0;
  /// How many points after the anchor the search for segments has passed over.
  std::int32_t skipped_ = 0;
  bool startElementPending_ = true;
  LargestDeviation largest_;
};

}  // namespace

CurveResult FitMixedCells(CurveTask const& task) { return CellsWalk(task).Walk(); }

}  // namespace Vorn::Fitting
