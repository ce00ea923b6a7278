#pragma once

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "vorn/Types.h"
#include "vorn/io/Export.h"
#include "vorn/io/Points.h"
#include "vorn/io/Tolerances.h"

namespace Vorn::IO {

/// Whether two points are too close to each other to be neighbours.
using TooClose = std::function<bool(WPoint const&, WPoint const&)>;

/// The rule for points whose tolerances are assigned; see AreTooClose.
VORN_IO_EXPORT TooClose RuleOfTolerances();

/// The rule for points that get their tolerances from the spacing that is left: only those are too
/// close that leave no tolerance above zero.
VORN_IO_EXPORT TooClose RuleOfSpacing(double cap);

/// The indices of the points to keep so that no two neighbours are too close: the first point, then
/// always the next one far enough from the one kept before. The last point is kept as well, in
/// place of those just before it that are too close to it. Fewer than two indices when even the
/// first and the last point cannot be neighbours. O(n).
VORN_IO_EXPORT std::vector<std::size_t> KeepSpaced(std::vector<WPoint> const& points,
                                                   TooClose const& tooClose);

/// Of a closed contour: takes those away at the end that are too close to the first point.
VORN_IO_EXPORT void DropCloseToFirst(std::vector<WPoint> const& points, TooClose const& tooClose,
                                     std::vector<std::size_t>* kept);

/// The indices from 0 to count - 1 that are not in the ascending list.
VORN_IO_EXPORT std::vector<std::size_t> Others(std::vector<std::size_t> const& kept,
                                               std::size_t count);

/// The text without the lines of these numbers, counted from 1 and ascending; every other byte
/// stays as it was.
VORN_IO_EXPORT std::string WithoutLines(std::string_view text,
                                        std::vector<std::size_t> const& lines);

}  // namespace Vorn::IO
