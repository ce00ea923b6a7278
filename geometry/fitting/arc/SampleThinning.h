// Thinning of an arc's samples once its cell has grown too large.
//
// Of the samples that made up the cell only those stay that bound it most: the two ends, and the
// samples nearest to and farthest from the cell's centre. The measured point in the angular middle
// of the arc comes in, so that the arc is held at three places at least.

#pragma once

#include <optional>

#include "geometry/cells/fast/CellSequence.h"
#include "geometry/fitting/arc/Triples.h"
#include "geometry/fitting/runs/Runs.h"

namespace Vorn::Fitting {

/// A run that an arc is to follow, and the ends it must keep to.
struct ArcRun {
  Run run;
  Ends ends;
};

/// Which samples are to be thinned.
struct ThinningTask {
  /// The run that the samples stand for, which must exist and not be empty.
  ArcRun const& arcRun;
  /// Whether the arc runs counter-clockwise.
  bool ccw = false;
  /// The number of triple steps made so far: their triples say which samples made up the cell.
  int steps = 0;
};

/// Thins samples for a cell with this centre. Failed, the samples left as they are, for fewer than
/// five samples in use, a triple that leaves the list, coinciding ends of the run, and a circle
/// without a defined middle. O(samples + points of the run), but for the logarithm of a map.
ErrorCode ThinSamples(ThinningTask const& task, Point const& centre, Samples* samples);

/// The same for a centre that is off by no more than an error: the fast form of the one above.
/// Thinning takes nothing from the centre but three choices among points, so a rough one mostly
/// does. Nothing, and the samples left as they are, where a choice could be another one for the
/// true centre.
std::optional<ErrorCode> ThinSamples(ThinningTask const& task, Cells::RoughCentre const& centre,
                                     Samples* samples);

}  // namespace Vorn::Fitting
