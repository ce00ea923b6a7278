// What is said of measured points that were left out, and the files that hold what is left.

#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "cli/base/Library.h"
#include "vorn/Types.h"
#include "vorn/io/FitReport.h"
#include "vorn/io/Points.h"
#include "vorn/io/Thinning.h"

namespace Vorn::Cli {

/// How many points are far from where their neighbours have them, and the first hundred of them.
std::string OutliersText(std::vector<Outlier> const& outliers, PointFile const& file);

/// How many points were left out, and the first ten of them.
std::string DroppedText(PointFile const& file, std::vector<std::size_t> const& dropped);

/// What a fit of the points that are left does to all points, each with its tolerance.
std::string FitOfRestText(FitReport const& report, PointFile const& file,
                          std::vector<WPoint> const& points);

/// The points left out as a table: number, line in the file, x and y.
std::string DroppedList(PointFile const& file, std::vector<std::size_t> const& dropped);

/// A table of points, with their tolerances where the file has them, and its units and tolerance.
std::string PointTable(PointFile const& file, std::vector<WPoint> const& points);

}  // namespace Vorn::Cli
