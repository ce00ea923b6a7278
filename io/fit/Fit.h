#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "io/pieces/Pieces.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::IO {

/// How the progress of a fit is counted: from 0 to here.
inline constexpr std::int32_t kFullProgress = 100;

/// One call of the library's fit and what it answered.
struct FitAnswer {
  ErrorCode code = ErrorCode::Failed;
  std::vector<GeometryUtils::Elem> contour;
  double deviation = 0.0;            ///< see IsDeviationRelative
  std::int32_t deviationIndex = -1;  ///< -1: the library names no point
  double seconds = 0.0;
};

FitAnswer Fit(std::vector<WPoint> const& points, GeometryUtils::FittingStrategy strategy,
              ExecutionState* progress);

/// The single arc reports its largest deviation as a length, the other strategies as a multiple
/// of the point's tolerance.
bool IsDeviationRelative(GeometryUtils::FittingStrategy strategy);

/// As written on the command line: mixed, cells, arc.
std::string NameOf(GeometryUtils::FittingStrategy strategy);

/// "23, NoFit: no arc fits a run of points", for messages.
std::string Describe(ErrorCode code);

/// Whether the contour goes on to the last point. A fit may give up on the way and still answer
/// Ok with the pieces made so far; the end of such a contour lies nearer to an earlier point. The
/// single arc is one piece for all points, so its end says nothing.
bool ReachesLastPoint(std::vector<WPoint> const& points, std::vector<Piece> const& pieces,
                      GeometryUtils::FittingStrategy strategy);

}  // namespace Vorn::IO
