#pragma once

#include <optional>
#include <string>
#include <vector>

#include "io/base/Failure.h"
#include "io/fit/Assignment.h"
#include "io/fit/Fit.h"
#include "io/measure/Remeasure.h"
#include "io/pieces/Pieces.h"
#include "io/points/Closure.h"
#include "io/points/CsvReader.h"

namespace Vorn::IO {

enum class Verdict { WithinTolerance, OutsideTolerance, StopsEarly };

/// All that the table, the JSON file and the drawing tell about one fit.
struct Report {
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

/// Measures the contour of a fit that answered Ok with at least one piece, and judges it.
Report MakeReport(PointFile file, std::string toleranceSource,
                  GeometryUtils::FittingStrategy strategy, FitAnswer fit);

/// The same for a closed contour: closes the pieces exactly if it can. Without pieces in `fit` the
/// contour is the full circle `circle`.
Report MakeClosedReport(PointFile file, std::string toleranceSource,
                        GeometryUtils::FittingStrategy strategy, FitAnswer fit,
                        Closure const& closure, Circuit const& circuit,
                        std::optional<std::vector<Piece>> circle);

/// One line of words.
std::string Describe(Verdict verdict);

}  // namespace Vorn::IO
