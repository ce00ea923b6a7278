// The longest run of points that one segment can follow.

#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "geometry/fitting/runs/Pieces.h"
#include "geometry/fitting/runs/Runs.h"

namespace Vorn::Fitting {

/// What the line fitter is asked.
struct LineTask {
  /// The run from the first point on; its count is the most points that the line may take.
  Run run;
  Ends ends;
  /// Whether no further attempt follows: then the run is shortened until it is within tolerance or
  /// has two points.
  bool isLastAttempt = true;
  /// Told after every accepted point.
  GeometryUtils::ProgressBase const& progress;
};

/// Whether a task can be answered: its run exists and has two points at least.
inline bool IsFittable(LineTask const& task) { return task.run.count >= 2 && task.run.Exists(); }

/// What the line fitter found.
struct LineFitResult {
  /// Ok when there is a line. Failed for a task that is not fittable, and when a deviation cannot
  /// be computed.
  ErrorCode code = ErrorCode::Failed;
  /// Set with Ok, and with Failed when the deviations from a line found could not be computed.
  /// Within tolerance, but for a run of two points, which is not tested, and for a full run of an
  /// attempt that is not the last.
  std::optional<FittedLine> line;
};

/// Finds the longest run that a segment passes within tolerance.
///
/// The run grows point by point while the line cells of its consecutive pairs have a common part
/// and the points keep moving away from the first. The segment is the line at the centre of that
/// part, cut at the run's ends; it is then measured against every point, and the run is shortened
/// when a point lies outside its tolerance.
///
/// `offenders` holds the points where earlier attempts deviated most; they are heeded when an
/// oversized cell is rebuilt. It is emptied when the line is within tolerance or has two points;
/// otherwise the points of least and greatest signed deviation are appended.
///
/// A pass over m points takes m overlaps of a pair cell with the running cell; each shortening
/// costs one measurement of the run, and now and then a pass.
LineFitResult FitLine(LineTask const& task, std::vector<std::int32_t>* offenders);

}  // namespace Vorn::Fitting
