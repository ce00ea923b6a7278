#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "vorn/io/Export.h"
#include "vorn/io/FitReport.h"
#include "vorn/io/ReportHead.h"

namespace Vorn::IO {

/// What a summary of many fits says of one file.
struct SummaryRow {
  std::string path;           ///< of the points
  std::string result;         ///< the verdict, or why there is none
  bool isFitted = false;      ///< whether there is a contour; without one the rest means nothing
  bool isWithin = false;      ///< whether every point is within its tolerance
  std::size_t points = 0;     ///< measured
  std::size_t lines = 0;      ///< of the contour
  std::size_t arcs = 0;       ///< of the contour
  std::size_t outside = 0;    ///< points beyond their tolerance
  double deviation = 0.0;     ///< the largest, over the tolerance of its point
  double rootMeanSquare = 0;  ///< of all deviations, a length
  std::string picture;        ///< the contour as a small SVG element
};

/// The row of a fit that has a contour.
/// @param verdict about the contour and its files
VORN_IO_EXPORT SummaryRow SummaryRowOf(FitReport const& report, Verdict verdict);

/// A table of comma-separated values, a row for each file and one for all of them: without a
/// contour first, then by the largest deviation, the worst first.
VORN_IO_EXPORT std::string SummaryCsv(std::vector<SummaryRow> rows);

/// The same as a page that needs nothing else, each row with a picture of its contour.
VORN_IO_EXPORT std::string SummaryHtml(std::vector<SummaryRow> rows, ReportHead const& head);

}  // namespace Vorn::IO
