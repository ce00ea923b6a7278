#pragma once

#include <nlohmann/json.hpp>

#include "vorn/io/Drawing.h"

/// The measured points in the data of the interactive page.
///
/// Up to kMostExactPoints they are arrays of the very numbers. More of them are packed columns (see
/// PackedColumn), rounded to a power of ten no larger than a hundred-thousandth of the smallest
/// tolerance, or without tolerances than a billionth of the size of the whole: far below what a
/// drawing shows, and below the digits told for the point under the cursor. The power stands in the
/// data as `decimals`.
namespace Vorn::IO {

/// Some 60 bytes a point up to here make a page of less than 2 MB.
inline constexpr std::size_t kMostExactPoints = 20'000;

/// Coordinates and tolerances: `x`, `y` and `w`, one number if all tolerances are the same, null
/// without tolerances.
nlohmann::ordered_json PointsJson(Drawing const& drawing);

/// For each point of something measured the deviation, to the left positive, and its piece; and the
/// indexes of those outside their tolerance. Beside packed columns `exact` lists what keeps its
/// very number: the worst point of each piece, and each whose rounded deviation might lie on the
/// other side of its tolerance.
nlohmann::ordered_json DeviationsJson(Drawing const& drawing);

/// Where along the pieces the tolerance changes; null where it is the same everywhere. Beside
/// packed columns what is shorter than a part in kMostBandSections of the contour is joined, with
/// the largest tolerance in it.
nlohmann::ordered_json BandJson(Drawing const& drawing);

/// The finest division of the tolerance band beside packed columns.
inline constexpr double kMostBandSections = 20'000.0;

}  // namespace Vorn::IO
