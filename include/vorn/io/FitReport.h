#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "vorn/GeometryUtils.h"
#include "vorn/io/Closure.h"
#include "vorn/io/Deviations.h"
#include "vorn/io/Export.h"
#include "vorn/io/Pieces.h"
#include "vorn/io/Points.h"

namespace Vorn::IO {

/// How the progress of a fit is counted: from 0 to here.
inline constexpr std::int32_t kFullProgress = 100;

/// The stretch of points that one piece stands for. The fit does not tell, so it is found again.
/// On a closed contour it may run past the last point and on from the first.
struct PointRange {
  std::size_t first = 0;
  std::size_t count = 0;
};

/// One call of the library's fit and what it answered.
struct FitAnswer {
  ErrorCode code = ErrorCode::Failed;
  std::vector<GeometryUtils::Elem> contour;
  double deviation = 0.0;            ///< see IsDeviationRelative
  std::int32_t deviationIndex = -1;  ///< -1: the library names no point
  double seconds = 0.0;
};

/// The single arc reports its largest deviation as a length, the other strategies as a multiple
/// of the point's tolerance.
VORN_IO_EXPORT bool IsDeviationRelative(GeometryUtils::FittingStrategy strategy);

/// As written on the command line: mixed, cells, arc.
VORN_IO_EXPORT std::string NameOf(GeometryUtils::FittingStrategy strategy);

/// "23, NoFit: no arc fits a run of points", for messages.
VORN_IO_EXPORT std::string Describe(ErrorCode code);

enum class Verdict { WithinTolerance, OutsideTolerance, StopsEarly };

/// All that the table, the JSON file and the drawing tell about one fit.
struct VORN_IO_EXPORT FitReport {
  PointFile file;
  std::string toleranceSource;
  GeometryUtils::FittingStrategy strategy = GeometryUtils::FittingStrategy::Mixed;
  FitAnswer fit;
  Closure closure;
  std::size_t seam = 0;       ///< where a closed contour was cut open, as counted in the file
  bool isFullCircle = false;  ///< found by the program; the fit has nothing to say then
  std::vector<Piece> pieces;
  std::optional<std::vector<PointRange>> ranges;
  Remeasured remeasured;
  Verdict verdict = Verdict::WithinTolerance;

  /// From the end of the contour to its start; 0 when it is closed exactly.
  double Gap() const;
  std::size_t LineCount() const;
  std::size_t ArcCount() const;
  double SmallestTolerance() const;
  double LargestTolerance() const;
};

/// One line of words.
VORN_IO_EXPORT std::string Describe(Verdict verdict);

/// The report as a JSON document in the layout of kJsonSchemaVersion, ending with a line end.
/// Doubles are written with as many digits as it takes to read back the same bits. Angles are
/// radians; points are counted from 0; what is not known is null.
VORN_IO_EXPORT std::string ToJson(FitReport const& report);

}  // namespace Vorn::IO
