// The growth of a run that a segment is to follow.
//
// Every pair of neighbouring points allows the lines of one line cell; the lines that pass near all
// points taken so far are the overlap of these cells.

#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

#include "geometry/cells/LineCells.h"
#include "geometry/cells/fast/CellSequence.h"
#include "geometry/elementary/Shapes.h"
#include "geometry/fitting/line/LineFit.h"

namespace Vorn::Fitting {

/// Takes points from the first one on as long as a line can pass near all of them.
class LineGrowth {
 public:
  /// How the growth ended: at the limit asked for; at a point that does not fit or lies too close;
  /// at a point where the run turns back; at a point behind which an oversized cell cannot be
  /// rebuilt, so that only a lower limit helps; or without any result.
  enum class End { AtLimit, Early, TurnedBack, NeedsLowerLimit, Failed };

  /// The task's run must exist. `offenders` as for FitLine, read only.
  LineGrowth(LineTask const& task, std::vector<std::int32_t> const& offenders)
      : task_(task), offenders_(offenders) {}

  /// Takes points from the first one on until so many are taken or the next one does not fit.
  End Grow(std::int32_t limit);

  /// Makes the run what growing anew up to a limit would make it, which must not be above the
  /// points taken: the fast form of Grow. Growing anew would take the same points into the same
  /// cells, so the run only goes back to what it was. What it would report as progress is reported.
  void GrowAgain(std::int32_t limit);

  /// The points taken, 1 at least once it has grown.
  std::int32_t Taken() const { return taken_; }

  /// The run of the points taken.
  Run TakenRun() const { return task_.run.OfCount(taken_); }

  /// The segment along the line at the centre of the cell, cut at the run's ends; nothing when no
  /// line of the cell passes through the fixed ends or a free end has no foot on it.
  std::optional<Elementary::Segment> FindSegment() const;

 private:
  using CellSequence = Cells::CellSequence;

  /// A stretch of the growth over which the cell was only narrowed. Its first depth belongs to
  /// `begin` points taken, every further depth to one point more.
  struct Stretch {
    std::int32_t begin;
    std::size_t firstDepth;
    CellSequence cell;

    /// Goes back to so many points taken, `begin` at least.
    void ReturnTo(std::int32_t taken) {
      cell.ReturnTo(firstDepth + static_cast<std::size_t>(taken - begin));
    }
  };

  /// The cell of the points taken; there must be one.
  CellSequence& Cell() { return stretches_.back().cell; }

  /// Whether two points at least have been taken, so that there is a cell.
  bool HasCell() const { return !stretches_.empty(); }

  /// Brings the next point into the cell. AtLimit when it fits.
  End TakeNext();

  /// Makes this the cell after one point more.
  void BeginStretch(CellSequence&& cell);

  /// Replaces an oversized cell by that of a short chain that ends with the next point. AtLimit
  /// when the cell was rebuilt.
  End RebuildCell(WPoint const& next);

  /// The indices of a chain behind the first point: the points that deviate most from the chord to
  /// the next point, those that deviated most in earlier attempts, and the next point itself.
  /// Nothing when the deviations cannot be computed.
  std::optional<std::vector<std::int32_t>> FindChain(WPoint const& next) const;

  /// The line cell of two points, in the run's form. False when there is none.
  bool FindPairCell(WPoint const& from, WPoint const& to);

  LineTask const& task_;
  std::vector<std::int32_t> const& offenders_;
  std::int32_t taken_ = 0;
  /// The form of the line parameters, chosen by the first pair and kept by the others.
  Cells::LineForm form_;
  /// The latest of the stretches; none before the first pair has a cell.
  std::vector<Stretch> stretches_;
  /// The cell of the pair asked for last.
  Cells::LineCell pairCell_;
};

}  // namespace Vorn::Fitting
