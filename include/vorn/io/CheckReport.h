#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

#include "vorn/io/ContourFile.h"
#include "vorn/io/Deviations.h"
#include "vorn/io/Export.h"
#include "vorn/io/Intersections.h"
#include "vorn/io/Points.h"

namespace Vorn::IO {

/// What `contour check` finds when it measures points against a contour from a file.
struct VORN_IO_EXPORT CheckReport {
  PointFile file;               ///< the points
  ContourFile contour;          ///< what they were measured against
  std::string toleranceSource;  ///< empty: nobody states a tolerance, and `relative` means nothing
  std::vector<PointDeviation> deviations;  ///< one for each point
  std::size_t furthest = 0;                ///< index of the largest distance; the first of several
  std::size_t worst = 0;                   ///< index of the largest relative deviation; likewise
  std::vector<std::size_t> outside;        ///< indices of the points beyond their tolerance
  std::vector<Gap> gaps;                   ///< where pieces of the contour do not meet
  std::vector<Intersection> meetings;      ///< where the contour meets itself, but for its joints
  std::optional<double> signedArea;        ///< of a closed contour that does not cross itself

  /// Whether every point has a tolerance.
  bool HasTolerances() const { return !toleranceSource.empty(); }

  /// All indices, the worst point first: by relative deviation where there are tolerances, else by
  /// distance.
  std::vector<std::size_t> WorstFirst() const;
};

/// Measures; the points carry their tolerances unless the source is empty.
VORN_IO_EXPORT CheckReport MakeCheckReport(PointFile file, std::string toleranceSource,
                                           ContourFile contour);

/// To the left of the contour's sense of travel is positive; on it there is no minus sign.
VORN_IO_EXPORT double SignedDistance(PointDeviation const& deviation);

/// Every point in a line of CSV, with all digits, deviations signed.
VORN_IO_EXPORT std::string ToCsv(CheckReport const& report);

/// For programs: everything, with all digits, as a JSON document that ends with a line end. Points
/// are counted from 0, pieces and lines of the file from 1; what is not known is null.
VORN_IO_EXPORT std::string ToJson(CheckReport const& report);

}  // namespace Vorn::IO
