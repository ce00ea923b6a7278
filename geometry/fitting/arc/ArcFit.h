#pragma once

#include <cstdint>
#include <vector>

#include "geometry/cells/fast/CellSequence.h"
#include "geometry/fitting/arc/ArcCell.h"
#include "geometry/fitting/arc/SampleThinning.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

/// One arc over one fixed run. Kept over many fits, it keeps its room for the distances.
class ArcFit {
 public:
  using Point = GeometryUtils::Point;
  using AfterFailure = ArcCellBuilder::AfterFailure;

  explicit ArcFit(AfterFailure afterFailure) : afterFailure_(afterFailure) {}

  /// What a successful fit hands out.
  struct Arc {
    Point start;
    Point end;
    Point centre;
    double radius = 0.0;
    bool ccw = false;
    double deviation = 0.0;
    std::int32_t deviationIndex = -1;
  };

  /// Fits an arc; as GetFittingCircleO, but for the cell, which is held without copies. `samples`
  /// and `cell` are left alone when the run is too short, does not exist, or does not turn.
  ErrorCode Fit(Fitting::ArcRun const& run, std::vector<GeometryUtils::IndexedPoint>* samples,
                Cells::CellSequence* cell, Arc* arc);

  /// Whether the last fit got as far as to collect samples and to build a cell.
  bool HasBuiltCell() const { return hasBuiltCell_; }

 private:
  /// Centre and radius: from the cell and the points' tolerances, or from the fixed ends.
  ErrorCode PlaceCircle(Fitting::ArcRun const& run, Cells::CellSequence const& cell, Arc* arc);
  /// As GetRadiusRange with each point's own tolerance; keeps the distances for the deviation.
  bool FindRadiusRange(Fitting::ArcRun const& run, Point const& centre);
  /// The largest relative deviation, and the first point that has it.
  void MeasureDeviation(Fitting::ArcRun const& run, Arc* arc) const;

  AfterFailure const afterFailure_;
  bool hasBuiltCell_ = false;
  double minRadius_ = 0.0;
  double maxRadius_ = 0.0;
  std::vector<double> distances_;
};

}  // namespace Vorn
