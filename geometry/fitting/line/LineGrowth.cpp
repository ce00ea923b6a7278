#include "geometry/fitting/line/LineGrowth.h"

#include <algorithm>
#include <utility>

#include "geometry/fitting/line/LineCut.h"
#include "geometry/fitting/line/LineDeviation.h"
#include "geometry/fitting/runs/CellBudget.h"
#include "geometry/fitting/runs/LineOrder.h"
#include "geometry/fitting/runs/Progress.h"
#include "math/Assert.h"

namespace Vorn::Fitting {

namespace {

/// Stretches of a run that are kept to go back to. A limit falls by one point at a time, and a
/// stretch spans half a dozen points or more, so older ones are hardly ever asked for; then the run
/// is grown anew.
constexpr std::size_t kKeptStretches = 16;

}  // namespace

LineGrowth::End LineGrowth::Grow(std::int32_t limit) {
  taken_ = 1;
  stretches_.clear();
  while (taken_ < limit) {
    End const end = TakeNext();
    if (end != End::AtLimit) return end;
    ++taken_;
    ReportProgress(task_.progress, task_.run.first + taken_ - 1);
  }
  return End::AtLimit;
}

LineGrowth::End LineGrowth::TakeNext() {
  Run const& run = task_.run;
  WPoint const& previous = run[taken_ - 1];
  WPoint const& next = run[taken_];
  if (taken_ > 1 && !MovesAway(run.FirstPoint(), ToPoint(previous), ToPoint(next))) {
    return End::TurnedBack;
  }
  // Points too close, or lines that have no parameters in this run's form: the run so far is all
  // there is, and no later round could make a longer one.
  if (!FindPairCell(previous, next)) return End::Early;
  if (!HasCell()) {
    BeginStretch(CellSequence(pairCell_));
    return End::AtLimit;
  }
  if (IsOversized(Cell().size(), kLineCellWeight)) return RebuildCell(next);
  Cell().NarrowBy(pairCell_);
  if (!Cell().empty()) return End::AtLimit;
  Cell().ReturnTo(Cell().Depth() - 1);
  return End::Early;
}

void LineGrowth::BeginStretch(CellSequence&& cell) {
  std::size_t const depth = cell.Depth();
  stretches_.push_back({taken_ + 1, depth, std::move(cell)});
  if (stretches_.size() > kKeptStretches) stretches_.erase(stretches_.begin());
}

void LineGrowth::GrowAgain(std::int32_t limit) {
  VORN_ASSERT(limit <= taken_);
  while (HasCell() && stretches_.back().begin > limit) stretches_.pop_back();
  if (!HasCell()) {
    Grow(limit);
    return;
  }
  stretches_.back().ReturnTo(limit);
  taken_ = limit;
  if (task_.progress.state == nullptr) return;
  for (std::int32_t taken = 2; taken <= limit; ++taken) {
    ReportProgress(task_.progress, task_.run.first + taken - 1);
  }
}

LineGrowth::End LineGrowth::RebuildCell(WPoint const& next) {
  std::optional<std::vector<std::int32_t>> const chain = FindChain(next);
  if (!chain) return End::Failed;
  CellSequence chainCell;
  std::int32_t const first = task_.run.first;
  std::int32_t from = first;
  for (std::int32_t const to : *chain) {
    if (!FindPairCell(task_.run[from - first], task_.run[to - first])) {
      return task_.isLastAttempt ? End::NeedsLowerLimit : End::Failed;
    }
    if (from == first) {
      chainCell.Begin(pairCell_);
    } else {
      chainCell.NarrowBy(pairCell_);
      if (chainCell.empty()) return End::NeedsLowerLimit;
    }
    from = to;
  }
  BeginStretch(std::move(chainCell));
  return End::AtLimit;
}

std::optional<std::vector<std::int32_t>> LineGrowth::FindChain(WPoint const& next) const {
  Run const& run = task_.run;
  std::optional<DeviationExtremes> const extremes = FindDeviationExtremes(
      {run.points, run.first + 1, taken_ - 1}, {run.FirstPoint(), ToPoint(next)});
  if (!extremes) return std::nullopt;
  std::int32_t const nextIndex = run.first + taken_;
  std::vector<std::int32_t> chain;
  AppendIndices(*extremes, &chain);
  for (std::int32_t const index : offenders_) {
    if (index > run.first && index < nextIndex) chain.push_back(index);
  }
  std::sort(chain.begin(), chain.end());
  chain.erase(std::unique(chain.begin(), chain.end()), chain.end());
  chain.push_back(nextIndex);
  return chain;
}

bool LineGrowth::FindPairCell(WPoint const& from, WPoint const& to) {
  return Cells::FindLineCell(from, to, &form_, &pairCell_) == ErrorCode::Ok;
}

std::optional<Elementary::Segment> LineGrowth::FindSegment() const {
  if (!HasCell()) return std::nullopt;
  Cells::FixedPoints const fixed = PointsOfLine(task_.ends, form_.xOfY);
  std::optional<Point> const parameters = Cells::CentreForLine(fixed, stretches_.back().cell);
  if (!parameters) return std::nullopt;
  Run const taken = TakenRun();
  return CutLine(*parameters, fixed, {taken.FirstPoint(), taken.LastPoint()});
}

}  // namespace Vorn::Fitting
