// One arc over one run of points: the cell of admissible centres gives the centre, the points' own
// tolerances about it give the radius, and the free ends are moved onto the circle.

#pragma once

#include <optional>
#include <vector>

#include "geometry/fitting/arc/ArcCell.h"
#include "geometry/fitting/arc/RadiusRange.h"
#include "geometry/fitting/runs/Pieces.h"

namespace Vorn::Fitting {

/// Whether a run turns counter-clockwise, judged by its first, middle and last point, with fixed
/// ends in the place of the first and the last. Nothing for a run that is too short for an arc or
/// does not exist, and for three points that are exactly collinear.
std::optional<bool> SenseOf(Run const& run, Ends const& ends);

/// A centre moved onto the perpendicular bisector of two points, so that a circle passes through
/// both; nothing for coinciding points.
std::optional<Point> AdjustedCentre(Point const& p1, Point const& p2, Point const& centre);

/// Fits arcs to runs. Kept over many fits, it keeps its room for the distances.
class ArcFit {
 public:
  /// What is asked for after failures goes for all fits.
  explicit ArcFit(AfterFailure afterFailure) : afterFailure_(afterFailure) {}

  /// Fits an arc to a run. `cell` is left alone when the run has no sense; otherwise it holds the
  /// samples used and, as far as AfterFailure asks for it, the cell. `arc` is written on success.
  /// Failed for a run without sense and for an end that cannot be moved onto the circle; NoFit when
  /// the cell is empty or the radius leaves its range; otherwise the code of ArcCellBuilder::Build.
  ErrorCode Fit(ArcRun const& arcRun, ArcCell* cell, FittedArc* arc);

 private:
  /// Centre and radius: from the cell and the points' tolerances, or from the fixed ends.
  ErrorCode PlaceCircle(ArcRun const& arcRun, Cells::CellSequence const& centres,
                        Elementary::Circle* circle);
  /// As FindRadiusRange with each point's own tolerance; keeps the distances for the deviation.
  std::optional<RadiusRange> MeasureRadiusRange(Run const& run, Point const& centre);
  /// The largest relative deviation, from the distances kept.
  Deviation MeasureDeviation(Run const& run, double radius) const;

  AfterFailure const afterFailure_;
  /// Of the points of the run from the centre.
  std::vector<double> distances_;
};

}  // namespace Vorn::Fitting
