#pragma once

#include <string_view>
#include <vector>

#include "vorn/io/Export.h"
#include "vorn/io/FileMeasure.h"
#include "vorn/io/FitReport.h"

namespace Vorn::IO {

/// The fits of several outlines of one file as one report, with gaps between the contours: points,
/// pieces and deviations one after the other, the worst of the verdicts. There must be at least
/// one.
VORN_IO_EXPORT FitReport Joined(std::vector<FitReport> const& reports);

/// How the points lie against the outlines as they stand in the text of a file: those of each
/// report against the outline nearest to the first of them. Points are counted through all reports.
/// Where the outlines cannot be told apart, every point is measured against all of them.
VORN_IO_EXPORT FileMeasure MeasureText(std::string_view text, Format format,
                                       std::vector<FitReport> const& reports);

}  // namespace Vorn::IO
