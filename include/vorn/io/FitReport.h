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
#include "vorn/io/PieceMeasures.h"
#include "vorn/io/Pieces.h"
#include "vorn/io/Points.h"
#include "vorn/io/ReportHead.h"
#include "vorn/io/Strategy.h"

namespace Vorn::IO {

/// How the progress of a fit is counted: from 0 to here.
inline constexpr std::int32_t kFullProgress = 100;

/// The stretch of points that one piece stands for. Where the fit does not tell, it is found again.
/// On a closed contour it may run past the last point and on from the first.
struct PointRange {
  std::size_t first = 0;  ///< index of the first point
  std::size_t count = 0;  ///< how many points; 0: none
};

/// One call of the library's fit and what it answered.
struct FitAnswer {
  ErrorCode code = ErrorCode::Failed;        ///< what the core answered
  std::vector<GeometryUtils::Elem> contour;  ///< empty unless it answered Ok
  double deviation = 0.0;                    ///< see IsDeviationRelative
  std::int32_t deviationIndex = -1;          ///< -1: the library names no point
  double seconds = 0.0;                      ///< that it took
  /// The points of each piece, where the fit tells.
  std::optional<std::vector<PointRange>> ranges;
  /// No contour within the tolerances has fewer pieces; nothing where the strategy proves none.
  std::optional<std::size_t> fewestPossible;
};

/// "23, NoFit: no arc fits a run of points", for messages.
VORN_IO_EXPORT std::string Describe(ErrorCode code);

/// How a fit ended: every point within its tolerance, one outside, a closed contour whose ends do
/// not meet though every point is within, or a contour that stops before the last point.
enum class Verdict { WithinTolerance, OutsideTolerance, NotClosed, StopsEarly };

/// All that the table, the JSON file and the drawing tell about one fit.
struct VORN_IO_EXPORT FitReport {
  PointFile file;                      ///< the points, each with its tolerance
  std::string toleranceSource;         ///< in words, where the tolerances came from
  Strategy strategy = kUsualStrategy;  ///< how the contour was found
  FitAnswer fit;                       ///< what the core answered
  Closure closure;                     ///< whether the contour is closed
  std::size_t seam = 0;       ///< where a closed contour was cut open, as counted in the file
  bool isFullCircle = false;  ///< found by the program; the fit has nothing to say then
  std::vector<Piece> pieces;  ///< the contour
  std::optional<std::vector<PointRange>> ranges;  ///< one for each piece; nothing: too many to tell
  Remeasured remeasured;                          ///< the deviation of every point
  Verdict verdict = Verdict::WithinTolerance;     ///< how the fit ended
  ReportHead head;                                ///< what the user puts at the head

  /// From the end of the contour to its start; 0 when it is closed exactly.
  double Gap() const;

  /// The larger of the relative deviations that the fit reports and that are measured again.
  struct Deviation {
    double relative = 0.0;  ///< to the tolerance of the point
    std::size_t point = 0;  ///< index in the file
  };
  /// The deviation that the verdict goes by.
  Deviation LargestDeviation() const;
  /// Whether the number of pieces is proven to be the smallest possible.
  bool IsFewest() const;
  /// How many pieces are straight.
  std::size_t LineCount() const;
  /// How many pieces are arcs.
  std::size_t ArcCount() const;
  /// The smallest tolerance of a point.
  double SmallestTolerance() const;
  /// The largest tolerance of a point.
  double LargestTolerance() const;
};

/// What the points of each piece say by themselves: see PieceMeasures.h.
VORN_IO_EXPORT std::vector<PieceMeasure> MeasurePieces(FitReport const& report);

/// All deviations together.
VORN_IO_EXPORT DeviationSummary Summarise(FitReport const& report);

/// One line of words.
VORN_IO_EXPORT std::string Describe(Verdict verdict);

/// The report as a JSON document in the layout of kJsonSchemaVersion, ending with a line end.
/// Doubles are written with as many digits as it takes to read back the same bits. Angles are
/// radians; points are counted from 0; what is not known is null.
VORN_IO_EXPORT std::string ToJson(FitReport const& report);

/// The same of several outlines of one file, at least one. The document is that of Joined, and
/// `outlines` holds a record for each: its points and elements, bound, verdict, closure and
/// deviations, with points counted from its own first one.
VORN_IO_EXPORT std::string ToJson(std::vector<FitReport> const& outlines);

}  // namespace Vorn::IO
