// How far the points of a run lie from a line.

#pragma once

#include <optional>
#include <vector>

#include "geometry/elementary/Shapes.h"
#include "geometry/fitting/runs/Deviations.h"
#include "geometry/fitting/runs/Runs.h"

namespace Vorn::Fitting {

/// The largest distance of a point of a run from the line through a segment, divided by the point's
/// tolerance; the index is that among all measured points. Value 0.0 and index -1 for a run that is
/// empty or does not exist and for a segment without length. O(count).
Deviation LargestDeviationFromLine(Run const& run, Elementary::Segment const& segment);

/// Signed distances from a line; the indices are those among all measured points.
struct DeviationExtremes {
  Deviation least;
  Deviation greatest;
};

/// The least and the greatest signed distance of a run from the line through a segment, of equal
/// ones the first. Nothing for equal ends of the segment and for a run that is empty or does not
/// exist. O(count).
std::optional<DeviationExtremes> FindDeviationExtremes(Run const& run,
                                                       Elementary::Segment const& segment);

/// Appends where a run deviates most to either side: the indices of the extremes in ascending
/// order, or one when they are equal.
void AppendIndices(DeviationExtremes const& extremes, std::vector<std::int32_t>* indices);

}  // namespace Vorn::Fitting
