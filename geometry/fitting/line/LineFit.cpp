// The longest run of points that one segment can follow.
//
// Every pair of neighbouring points allows the lines of one line cell; the lines that pass near all
// points taken so far are the overlap of these cells. A run grows point by point while that overlap
// is not empty and the points keep moving away from the first one. When it ends, the line at the
// centre of the cell is measured against the points; a line that leaves a tolerance (the cell only
// knows pairs of neighbours) sends the growth back to the start with a lower limit.

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <utility>
#include <vector>

#include "geometry/cells/FixedPoints.h"
#include "geometry/cells/fast/CellSequence.h"
#include "geometry/elementary/ImplicitLine.h"
#include "geometry/fitting/Runs.h"
#include "geometry/intersections/Lines.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Fitting::At;
using Fitting::ToPoint;

namespace {

using Cells::CellSequence;
using Point = GeometryUtils::Point;

/// As GetCenterForLine.
bool CenterForLine(Cells::FixedPoints const& fixed, CellSequence const& cell, Point* center) {
  std::optional<Point> const found = Cells::CentreForLine(fixed, cell);
  if (found) *center = *found;
  return found.has_value();
}

/// The ends of the line that a parameter point stands for: fixed ones as they are, the others the
/// feet of the given points.
bool CutLine(Point const& parameters, Point const& nearStart, Point const& nearEnd,
             Cells::FixedPoints const& fixed, Point* start, Point* end) {
  Elementary::ImplicitLine const line{fixed.swapped ? 1.0 : parameters.y,
                                      fixed.swapped ? parameters.y : 1.0, parameters.x};
  auto const findFoot = [&line](Point const& p, Point* foot) {
    std::optional<Point> const found = Intersections::FootOn(line, p);
    if (found) *foot = *found;
    return found.has_value();
  };
  *start = fixed.p1;
  *end = fixed.p2;
  return (fixed.hasP1 || findFoot(nearStart, start)) && (fixed.hasP2 || findFoot(nearEnd, end));
}

/// Stretches of a run that are kept to go back to. A limit falls by one point at a time, and a
/// stretch spans half a dozen points or more, so older ones are hardly ever asked for; then the run
/// is grown anew.
constexpr std::size_t kKeptStretches = 16;

}  // namespace

/// One call of the line fitter.
class LineRun {
 public:
  using Point = GeometryUtils::Point;
  using Triangle = GeometryUtils::Triangle;
  using ProgressBase = GeometryUtils::ProgressBase;

  struct Ends {
    bool startFixed;
    Point* start;
    bool endFixed;
    Point* end;
  };

  struct Outputs {
    std::int32_t* count;
    double* deviation;
    std::int32_t* deviationIndex;
    std::vector<std::int32_t>* indexList;
    ErrorCode* code;
  };

  LineRun(std::vector<WPoint> const& points, std::int32_t start, std::int32_t count,
          Ends const& ends, bool lastAttempt, Outputs const& out, ProgressBase const& progress)
      : points_(points),
        start_(start),
        limit_(count),
        ends_(ends),
        lastAttempt_(lastAttempt),
        out_(out),
        progress_(progress) {}

  /// Grows until the run ends, then closes it, with a lower limit again and again, until a run is
  /// returned. Two points always are a run.
  ErrorCode Fit() {
    if (limit_ <= 2) return CloseWithTwoPoints();
    std::optional<ErrorCode> result;
    switch (Grow()) {
      case Growth::Failed:
        return ErrorCode::Failed;
      case Growth::TurnedBack:
        LowerLimit(taken_, true);
        break;
      case Growth::LowerLimit:
        LowerLimit(taken_, false);
        break;
      case Growth::Early:
        result = CloseEarly();
        break;
      case Growth::Full:
        result = CloseFull();
        break;
    }
    while (!result) {
      if (limit_ <= 2) return CloseWithTwoPoints();
      GrowAgain();
      result = CloseFull();
    }
    return *result;
  }

 private:
  /// How the growth ended.
  enum class Growth { Full, Early, TurnedBack, LowerLimit, Failed };

  /// The line through the cell's centre, cut to the run, and its largest relative deviation.
  struct Segment {
    Point start;
    Point end;
    double deviation;
    std::int32_t deviationIndex;
  };

  /// A stretch of the growth over which the cell was only narrowed. Its first depth belongs to
  /// `begin` points taken, every further depth to one point more.
  struct Stretch {
    std::int32_t begin;
    std::size_t firstDepth;
    CellSequence cell;

    void ReturnTo(std::int32_t taken) {
      cell.ReturnTo(firstDepth + static_cast<std::size_t>(taken - begin));
    }
  };

  void LowerLimit(std::int32_t limit, bool hasTurnedBack) {
    limit_ = limit;
    hasTurnedBack_ = hasTurnedBack;
  }

  CellSequence& Cell() { return stretches_.back().cell; }
  bool HasCell() const { return !stretches_.empty(); }

  /// Takes points until the limit is reached or the next one does not fit.
  Growth Grow() {
    WPoint const& first = At(points_, start_);
    taken_ = 1;
    stretches_.clear();
    while (taken_ < limit_) {
      WPoint const& previous = At(points_, start_ + taken_ - 1);
      WPoint const& next = At(points_, start_ + taken_);
      if (taken_ > 1 &&
          !GeometryUtils::IsValidLineOrder(ToPoint(first), ToPoint(previous), ToPoint(next))) {
        return Growth::TurnedBack;
      }
      if (GeometryUtils::GetLineTriangles(previous, next, &formFixed_, &xOfY_, &pairCell_) !=
          ErrorCode::Ok) {
        // Points too close, or lines that have no parameters in this run's form: the run so far is
        // all there is, and no later round could make a longer one.
        return Growth::Early;
      }
      if (!HasCell()) {
        BeginStretch(CellSequence(pairCell_));
      } else if (Fitting::IsOversized(Cell().size(), Fitting::kLineCellWeight)) {
        Growth const rebuilt = RebuildCell(next);
        if (rebuilt != Growth::Full) return rebuilt;
      } else {
        Cell().NarrowBy(pairCell_);
        if (Cell().empty()) {
          Cell().ReturnTo(Cell().Depth() - 1);
          return Growth::Early;
        }
      }
      ++taken_;
      GeometryUtils::SetProgressState(progress_, start_ + taken_ - 1);
    }
    return Growth::Full;
  }

  /// The cell after one point more.
  void BeginStretch(CellSequence&& cell) {
    std::size_t const depth = cell.Depth();
    stretches_.push_back({taken_ + 1, depth, std::move(cell)});
    if (stretches_.size() > kKeptStretches) stretches_.erase(stretches_.begin());
  }

  /// Growing again from the first point would take the same points into the same cells, so the run
  /// only goes back to what it was at the limit. What it would report as progress is reported.
  void GrowAgain() {
    while (HasCell() && stretches_.back().begin > limit_) stretches_.pop_back();
    if (!HasCell()) {
      Grow();
      return;
    }
    stretches_.back().ReturnTo(limit_);
    taken_ = limit_;
    if (progress_.state == nullptr) return;
    for (std::int32_t taken = 2; taken <= limit_; ++taken) {
      GeometryUtils::SetProgressState(progress_, start_ + taken - 1);
    }
  }

  /// Replaces an oversized cell by that of a short chain: the first point, the points that deviate
  /// most from the chord to the next point, those that deviated most in earlier attempts, and the
  /// next point itself. Full when the cell was rebuilt.
  Growth RebuildCell(WPoint const& next) {
    std::vector<std::int32_t> chain;
    if (!GeometryUtils::GetDeviationFromLineParameters(ToPoint(At(points_, start_)), ToPoint(next),
                                                       points_, start_ + 1, taken_ - 1, &chain)) {
      return Growth::Failed;
    }
    for (std::int32_t const index : *out_.indexList) {
      if (index > start_ && index < start_ + taken_) chain.push_back(index);
    }
    std::sort(chain.begin(), chain.end());
    chain.erase(std::unique(chain.begin(), chain.end()), chain.end());
    chain.push_back(start_ + taken_);

    CellSequence chainCell;
    std::int32_t from = start_;
    for (std::int32_t const to : chain) {
      if (GeometryUtils::GetLineTriangles(At(points_, from), At(points_, to), &formFixed_, &xOfY_,
                                          &pairCell_) != ErrorCode::Ok) {
        return lastAttempt_ ? Growth::LowerLimit : Growth::Failed;
      }
      if (from == start_) {
        chainCell.Begin(pairCell_);
      } else {
        chainCell.NarrowBy(pairCell_);
        if (chainCell.empty()) return Growth::LowerLimit;
      }
      from = to;
    }
    BeginStretch(std::move(chainCell));
    return Growth::Full;
  }

  std::optional<Segment> MakeSegment() const {
    Cells::FixedPoints const fixed{ends_.startFixed, *ends_.start, ends_.endFixed, *ends_.end,
                                   xOfY_};
    Segment segment{};
    Point center;
    if (!HasCell() || !CenterForLine(fixed, stretches_.back().cell, &center) ||
        !CutLine(center, ToPoint(At(points_, start_)), ToPoint(At(points_, start_ + taken_ - 1)),
                 fixed, &segment.start, &segment.end)) {
      return std::nullopt;
    }
    return segment;
  }

  void Measure(Segment* segment) {
    segment->deviation = GeometryUtils::GetMaxDeviationFromLine(
        points_, start_, taken_, segment->start, segment->end, &segment->deviationIndex);
    offender_ = segment->deviationIndex;
  }

  /// Whether the point that spoilt the round before spoils this one as well; then nothing else need
  /// be measured. A run is closed dozens of times for one and the same point.
  bool IsSpoiltAgain(Segment const& segment) const {
    if (offender_ < start_ || offender_ >= start_ + taken_) return false;
    std::int32_t index = -1;
    return GeometryUtils::GetMaxDeviationFromLine(points_, offender_, 1, segment.start, segment.end,
                                                  &index) > 1.0;
  }

  /// Ends a run that stopped before the limit: it must be within tolerance as it stands.
  std::optional<ErrorCode> CloseEarly() {
    std::optional<Segment> segment = MakeSegment();
    if (segment) Measure(&*segment);
    if (!segment || !IsWithinTolerance(*segment)) {
      LowerLimit(taken_ - 1, false);
      return std::nullopt;
    }
    WriteOutputs(*segment);
    out_.indexList->clear();
    return Finish();
  }

  /// Ends a run that reached the limit. Unless this is the last attempt, a run that leaves the
  /// tolerance is handed out as well, with the points that deviate most for the next attempt.
  std::optional<ErrorCode> CloseFull() {
    std::optional<Segment> segment = MakeSegment();
    if (!segment) {
      LowerLimit(taken_ - 1, false);
      return std::nullopt;
    }
    if (lastAttempt_ && IsSpoiltAgain(*segment)) {
      ReportTaken();
      LowerLimit(taken_ - 1, false);
      return std::nullopt;
    }
    Measure(&*segment);
    WriteOutputs(*segment);
    if (IsWithinTolerance(*segment)) {
      out_.indexList->clear();
      return Finish();
    }
    if (lastAttempt_) {
      LowerLimit(taken_ - 1, false);
      return std::nullopt;
    }
    if (!GeometryUtils::GetDeviationFromLineParameters(segment->start, segment->end, points_,
                                                       start_ + 1, taken_ - 2, out_.indexList)) {
      return ErrorCode::Failed;
    }
    return Finish();
  }

  /// Two points need no cell, and deliberately no tolerance test either: the segment joins them.
  ErrorCode CloseWithTwoPoints() {
    *out_.count = 2;
    if (!ends_.startFixed) *ends_.start = ToPoint(At(points_, start_));
    if (!ends_.endFixed) *ends_.end = ToPoint(At(points_, start_ + 1));
    *out_.deviation = GeometryUtils::GetMaxDeviationFromLine(points_, start_, 2, *ends_.start,
                                                             *ends_.end, out_.deviationIndex);
    out_.indexList->clear();
    GeometryUtils::SetProgressState(progress_, start_ + 2);
    return Finish();
  }

  /// False for a NaN.
  static bool IsWithinTolerance(Segment const& segment) { return segment.deviation <= 1.0; }

  void WriteOutputs(Segment const& segment) {
    *out_.count = taken_;
    *ends_.start = segment.start;
    *ends_.end = segment.end;
    *out_.deviation = segment.deviation;
    *out_.deviationIndex = segment.deviationIndex;
    ReportTaken();
  }

  void ReportTaken() { GeometryUtils::SetProgressState(progress_, start_ + taken_); }

  ErrorCode Finish() {
    *out_.code = hasTurnedBack_ ? ErrorCode::SelfIntersection : ErrorCode::Ok;
    return ErrorCode::Ok;
  }

  std::vector<WPoint> const& points_;
  std::int32_t const start_;
  std::int32_t limit_;
  Ends const ends_;
  bool const lastAttempt_;
  Outputs const out_;
  ProgressBase const& progress_;

  /// Whether the limit stands where it does because the points turned back there.
  bool hasTurnedBack_ = false;
  bool formFixed_ = false;
  bool xOfY_ = false;
  std::int32_t taken_ = 0;
  /// Where the line of the last round deviated most.
  std::int32_t offender_ = -1;
  std::vector<Stretch> stretches_;
  std::vector<Triangle> pairCell_;
};

ErrorCode GeometryUtils::GetFittingLine(std::vector<WPoint> const& points, std::int32_t start,
                                        std::int32_t count, bool startFixed, Point* startPoint,
                                        bool endFixed, Point* endPoint, bool lastAttempt,
                                        std::int32_t* lineCount, double* lineDeviation,
                                        std::int32_t* lineDeviationIndex,
                                        std::vector<std::int32_t>* indexList, ErrorCode* lineCode,
                                        ProgressBase const& progress) {
  if (count < 2 || !Fitting::HoldsRun(points, start, count)) return ErrorCode::Failed;
  *lineCode = ErrorCode::Ok;
  return LineRun(points, start, count, {startFixed, startPoint, endFixed, endPoint}, lastAttempt,
                 {lineCount, lineDeviation, lineDeviationIndex, indexList, lineCode}, progress)
      .Fit();
}

bool GeometryUtils::GetOptimalLineSegment(std::vector<Triangle> const* cell, double x1, double y1,
                                          double x2, double y2, bool xOfY, bool startFixed,
                                          Point startPoint, bool endFixed, Point endPoint,
                                          double* sx, double* sy, double* ex, double* ey) {
  Point center;
  Point start;
  Point end;
  if (!GetCenterForLine(startFixed, startPoint, endFixed, endPoint, xOfY, cell, &center) ||
      !CutLine(center, {x1, y1}, {x2, y2}, {startFixed, startPoint, endFixed, endPoint, xOfY},
               &start, &end)) {
    return false;
  }
  *sx = start.x;
  *sy = start.y;
  *ex = end.x;
  *ey = end.y;
  return true;
}

}  // namespace Vorn
