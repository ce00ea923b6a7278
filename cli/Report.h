#pragma once

#include <optional>
#include <string>
#include <vector>

#include "cli/Assignment.h"
#include "cli/CsvReader.h"
#include "cli/Failure.h"
#include "cli/Fit.h"
#include "cli/Pieces.h"
#include "cli/Remeasure.h"

namespace Vorn::Cli {

/// A relative deviation counts as within tolerance up to here. A piece may touch the tolerance of
/// a point exactly, and re-measuring it by other formulas then ends some bits above 1.
inline constexpr double kLargestRelative = 1.0 + 1e-9;

enum class Verdict { WithinTolerance, OutsideTolerance, StopsEarly };

/// All that the table, the JSON file and the drawing tell about one fit.
struct Report {
  PointFile file;
  std::string toleranceSource;
  GeometryUtils::FittingStrategy strategy = GeometryUtils::FittingStrategy::Mixed;
  FitAnswer fit;
  std::vector<Piece> pieces;
  std::optional<std::vector<PointRange>> ranges;
  Remeasured remeasured;
  Verdict verdict = Verdict::WithinTolerance;

  std::size_t LineCount() const;
  std::size_t ArcCount() const;
  double SmallestTolerance() const;
  double LargestTolerance() const;
};

/// Measures the contour of a fit that answered Ok with at least one piece, and judges it.
Report MakeReport(PointFile file, std::string toleranceSource,
                  GeometryUtils::FittingStrategy strategy, FitAnswer fit);

/// One line of words.
std::string Describe(Verdict verdict);

ExitCode ExitCodeOf(Verdict verdict);

}  // namespace Vorn::Cli
