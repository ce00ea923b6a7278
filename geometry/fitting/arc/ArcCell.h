// The cell of an arc: the centres of all circles that can follow a run of points.

#pragma once

#include <cstdint>
#include <vector>

#include "geometry/cells/CircleCells.h"
#include "geometry/cells/fast/CellSequence.h"
#include "geometry/fitting/arc/SampleThinning.h"
#include "geometry/fitting/arc/Triples.h"

namespace Vorn::Fitting {

/// A cell of centres and the samples that it is made of.
struct ArcCell {
  /// Empty before the first try from a start point; then those of the last try, which the next one
  /// begins with.
  Samples samples;
  /// What the last try left.
  Cells::CellSequence centres;
};

/// What is wanted of a try that no cell comes about for: what the cell was until then, or nothing.
enum class AfterFailure { KeepCell, NoCell };

/// Builds the cell of one run.
///
/// Every triple of samples allows the centres of one circle cell; the run's cell is the overlap of
/// the cells of all triples. The triples spread from the middle of the run outwards, each with its
/// mirror image.
class ArcCellBuilder {
 public:
  /// For a run that exists, of three points at least, which turns counter-clockwise or not.
  ArcCellBuilder(ArcRun const& arcRun, bool ccw, AfterFailure afterFailure, ArcCell* cell);

  /// Collects the samples and overlaps the cells of all triples. A cell that grows too large has
  /// its samples thinned, and the next pass starts afresh over those left, led by the triple that
  /// spans the run. A pass after a thinning that did not shorten the list is let grow, since
  /// thinning would go on for ever. Ends with a pass that thinned nothing. NoFit when there is no
  /// common part, otherwise the code of the first triple that has no cell or of a thinning.
  ErrorCode Build();

 private:
  /// The triples of one pass, in order.
  class Triples;

  /// Takes up every point of the run, or, when the samples of a shorter run over the same start are
  /// at hand, these with the new ends.
  void CollectSamples();
  /// The sample of the point at a position within the run.
  GeometryUtils::IndexedPoint SampleOf(std::int32_t position) const;
  /// Overlaps the cells of all triples afresh, led or not by the triple that spans the run. When it
  /// is guarded and the cell grows too large, the samples are thinned and the pass ends.
  ErrorCode RunPass(bool isLed, bool isGuarded, bool* hasThinned);
  /// Thins the samples and empties the cell, whose triples of so many steps have been taken.
  ErrorCode Thin(int steps);
  /// Whether the cell, overlapped with that of one triple, surely is neither empty nor oversized.
  bool StaysUsable(Cells::CircleCell const& tripleCell, bool isGuarded) const;
  /// The circle cell of one triple.
  ErrorCode CellOf(Triple const& triple, Cells::CircleCell* cell) const;
  /// The tolerance of the sample at a position.
  double ToleranceAt(int position) const;

  ArcRun const& arcRun_;
  bool const ccw_;
  AfterFailure const afterFailure_;
  Samples& samples_;
  Cells::CellSequence& centres_;
};

}  // namespace Vorn::Fitting
