// A run grows as long as a line can pass near its points. When it ends, the line at the centre of
// the cell is measured against the points; a line that leaves a tolerance (the cell only knows
// pairs of neighbours) sends the growth back to a lower limit.

#include "geometry/fitting/line/LineFit.h"

#include "geometry/fitting/line/LineDeviation.h"
#include "geometry/fitting/line/LineGrowth.h"
#include "geometry/fitting/runs/Progress.h"

namespace Vorn::Fitting {

namespace {

/// One call of the line fitter.
class LineFit {
 public:
  LineFit(LineTask const& task, std::vector<std::int32_t>* offenders)
      : task_(task), offenders_(*offenders), growth_(task, *offenders), limit_(task.run.count) {}

  /// Grows until the run ends, then closes it, with a lower limit again and again, until a run is
  /// returned. Two points always are a run.
  LineFitResult Fit() {
    if (limit_ <= 2) return CloseWithTwoPoints();
    std::optional<LineFitResult> result = GrowAndClose();
    while (!result) {
      if (limit_ <= 2) return CloseWithTwoPoints();
      growth_.GrowAgain(limit_);
      result = CloseAtLimit();
    }
    return *result;
  }

 private:
  /// The first round. Nothing when the limit was lowered.
  std::optional<LineFitResult> GrowAndClose() {
    switch (growth_.Grow(limit_)) {
      case LineGrowth::End::Failed:
        return LineFitResult{ErrorCode::Failed, std::nullopt};
      case LineGrowth::End::TurnedBack:
        limit_ = growth_.Taken();
        hasTurnedBack_ = true;
        return std::nullopt;
      case LineGrowth::End::NeedsLowerLimit:
        limit_ = growth_.Taken();
        return std::nullopt;
      case LineGrowth::End::Early:
        return CloseEarly();
      case LineGrowth::End::AtLimit:
        return CloseAtLimit();
    }
    return std::nullopt;
  }

  /// Gives up the last point taken.
  void GiveUpLast() {
    limit_ = growth_.Taken() - 1;
    hasTurnedBack_ = false;
  }

  /// The line over the points taken, measured against them.
  FittedLine Measure(Elementary::Segment const& segment) {
    Deviation const deviation = LargestDeviationFromLine(growth_.TakenRun(), segment);
    offender_ = deviation.index;
    return {{segment.start, segment.end, growth_.Taken(), deviation}};
  }

  /// Whether the point that spoilt the round before spoils this one as well; then nothing else need
  /// be measured. A run is closed dozens of times for one and the same point.
  bool IsSpoiltAgain(Elementary::Segment const& segment) const {
    Run const taken = growth_.TakenRun();
    if (offender_ < taken.first || offender_ >= taken.first + taken.count) return false;
    return LargestDeviationFromLine({taken.points, offender_, 1}, segment).value > 1.0;
  }

  /// Ends a run that stopped before the limit: it must be within tolerance as it stands.
  std::optional<LineFitResult> CloseEarly() {
    std::optional<Elementary::Segment> const segment = growth_.FindSegment();
    std::optional<FittedLine> line;
    if (segment) line = Measure(*segment);
    if (!line || !IsWithinTolerance(*line)) {
      GiveUpLast();
      return std::nullopt;
    }
    ReportTaken();
    return Accept(*line);
  }

  /// Ends a run that reached the limit. Unless this is the last attempt, a run that leaves the
  /// tolerance is handed out as well, with the points that deviate most for the next attempt.
  std::optional<LineFitResult> CloseAtLimit() {
    std::optional<Elementary::Segment> const segment = growth_.FindSegment();
    if (!segment) {
      GiveUpLast();
      return std::nullopt;
    }
    bool const isSpoilt = task_.isLastAttempt && IsSpoiltAgain(*segment);
    std::optional<FittedLine> line;
    if (!isSpoilt) line = Measure(*segment);
    ReportTaken();
    if (line && IsWithinTolerance(*line)) return Accept(*line);
    if (!task_.isLastAttempt) return HandOutWithOffenders(*line);
    GiveUpLast();
    return std::nullopt;
  }

  LineFitResult HandOutWithOffenders(FittedLine const& line) {
    Run const& run = task_.run;
    std::optional<DeviationExtremes> const extremes = FindDeviationExtremes(
        {run.points, run.first + 1, growth_.Taken() - 2}, {line.start, line.end});
    if (!extremes) return {ErrorCode::Failed, line};
    AppendIndices(*extremes, &offenders_);
    return Found(line);
  }

  /// Two points need no cell, and deliberately no tolerance test either: the segment joins them.
  LineFitResult CloseWithTwoPoints() {
    Run const pair = task_.run.OfCount(2);
    Elementary::Segment const segment{task_.ends.fixedStart.value_or(pair.FirstPoint()),
                                      task_.ends.fixedEnd.value_or(pair.LastPoint())};
    FittedLine const line{
        {segment.start, segment.end, pair.count, LargestDeviationFromLine(pair, segment)}};
    ReportProgress(task_.progress, pair.first + pair.count);
    return Accept(line);
  }

  /// False for a NaN.
  static bool IsWithinTolerance(FittedLine const& line) { return line.deviation.value <= 1.0; }

  void ReportTaken() const { ReportProgress(task_.progress, task_.run.first + growth_.Taken()); }

  LineFitResult Accept(FittedLine const& line) {
    offenders_.clear();
    return Found(line);
  }

  LineFitResult Found(FittedLine line) const {
    line.hasTurnedBack = hasTurnedBack_;
    return {ErrorCode::Ok, line};
  }

  LineTask const& task_;
  std::vector<std::int32_t>& offenders_;
  LineGrowth growth_;
  std::int32_t limit_;
  /// Whether the limit stands where it does because the points turned back there.
  bool hasTurnedBack_ = false;
  /// Where the line of the last round deviated most.
  std::int32_t offender_ = -1;
};

}  // namespace

LineFitResult FitLine(LineTask const& task, std::vector<std::int32_t>* offenders) {
  if (!IsFittable(task)) return {ErrorCode::Failed, std::nullopt};
  return LineFit(task, offenders).Fit();
}

}  // namespace Vorn::Fitting
