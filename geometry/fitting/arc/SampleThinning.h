#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "geometry/cells/fast/CellSequence.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Fitting {

/// A run of measured points that an arc is to follow, and the ends it must keep to. Of the end
/// points only the fixed ones are read.
struct ArcRun {
  std::vector<WPoint> const& points;
  std::int32_t first;
  std::int32_t count;
  bool startFixed;
  GeometryUtils::Point start;
  bool endFixed;
  GeometryUtils::Point end;
};

/// ReduceCircleArcPoints for a cell whose centre is known. The run must exist.
ErrorCode ThinSamples(ArcRun const& run, GeometryUtils::Point const& centre, int steps, bool ccw,
                      std::vector<GeometryUtils::IndexedPoint>* samples);

/// The same for a centre that is off by no more than an error. Thinning takes nothing from the
/// centre but three choices among points, so a rough one mostly does. Nothing, and the samples left
/// as they are, where a choice could be another one for the true centre.
std::optional<ErrorCode> ThinSamples(ArcRun const& run, Cells::RoughCentre const& centre, int steps,
                                     bool ccw, std::vector<GeometryUtils::IndexedPoint>* samples);

}  // namespace Vorn::Fitting
