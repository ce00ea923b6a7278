#pragma once

#include <cstdint>
#include <vector>

#include "geometry/cells/fast/CellSequence.h"
#include "geometry/fitting/arc/SampleThinning.h"
#include "geometry/fitting/arc/Triples.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

/// The cell of the centres of all circles that can follow a run, and the samples that make it up.
///
/// Every triple of samples allows the centres of one circle cell; the run's cell is the overlap of
/// the cells of all triples. The triples spread from the middle of the run outwards, each with its
/// mirror image.
class ArcCellBuilder {
 public:
  using IndexedPoint = GeometryUtils::IndexedPoint;
  using Triangle = GeometryUtils::Triangle;

  /// What is asked for when no cell comes about: what the cell was until then, or nothing of it.
  enum class AfterFailure { KeepCell, NoCell };

  ArcCellBuilder(Fitting::ArcRun const& run, bool ccw, AfterFailure afterFailure,
                 std::vector<IndexedPoint>* samples, Cells::CellSequence* cell);

  /// Takes up every point of the run, or, when the samples of a shorter run over the same start are
  /// at hand, these with the new ends.
  void CollectSamples();

  /// Overlaps the cells of all triples. A cell that grows too large has its samples thinned, and
  /// the next pass starts afresh over those left, led by the triple that spans the run. A pass
  /// after a thinning that did not shorten the list is let grow, since thinning would go on for
  /// ever. Ends with a pass that thinned nothing.
  ErrorCode Build();

 private:
  /// The triples of one pass, in order.
  class Triples;

  IndexedPoint SampleOf(std::int32_t index) const;
  ErrorCode RunPass(bool isLed, bool isGuarded, bool* hasThinned);
  ErrorCode Thin(int steps);
  /// Whether the cell, overlapped with that of one triple, surely is neither empty nor oversized.
  bool StaysUsable(std::vector<Triangle> const& tripleCell, bool isGuarded) const;
  ErrorCode CellOf(Fitting::Triple const& triple, std::vector<Triangle>* cell) const;
  double ToleranceAt(int position) const;

  Fitting::ArcRun const& run_;
  bool const ccw_;
  AfterFailure const afterFailure_;
  std::vector<IndexedPoint>& samples_;
  Cells::CellSequence& cell_;
};

}  // namespace Vorn
