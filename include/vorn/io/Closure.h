#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

#include "vorn/Types.h"
#include "vorn/io/Export.h"

namespace Vorn::IO {

/// What the user says about the ends of a contour.
enum class ClosedChoice { Auto, Yes, No };

/// Whether measured points run once around, back to where they began.
struct Closure {
  bool isClosed = false;      ///< the contour runs back to its start
  bool repeatsFirst = false;  ///< the last point is the first one again
  double gap = 0.0;           ///< from the last point to the first
  std::string reason;         ///< in words, for the summary
};

/// Takes the user's word, or judges by the points.
///
/// Auto: closed when the last point is the first one again. Else closed when there are at least
/// eight points, the gap is not more than 1.5 times the longest of the five steps at either end
/// (what is as short as a step looks like one; the steps elsewhere may be of another kind), and
/// the contour does not turn by more than 135 degrees between the steps before the gap and those
/// after it. The last condition leaves thin bodies that are open at one end open, and so leaves
/// the closed contour alone whose seam lies in a very sharp corner. An open contour whose ends
/// happen to be a step apart looks closed. Only the user can tell then.
VORN_IO_EXPORT Closure FindClosure(std::vector<WPoint> const& points, ClosedChoice choice);

/// The points of a closed contour in the order in which they are fitted: from the seam all the way
/// round to the seam again, which therefore stands at both ends.
struct Circuit {
  std::vector<WPoint> points;       ///< the first stands at the end again
  std::vector<std::size_t> origin;  ///< index of each in the file; of a repeated point its first
};

/// @param seam index in the file. Needs three different points.
VORN_IO_EXPORT Circuit MakeCircuit(std::vector<WPoint> const& points, Closure const& closure,
                                   std::size_t seam);

/// Where to cut a closed contour open: the point where it turns most, compared over a stretch of
/// 20 median tolerances before and after (at that length the tolerance moves a direction by not
/// more than some six degrees), but at least a step and at most a twentieth of the way round.
/// Nothing when no point turns by more than 20 degrees.
VORN_IO_EXPORT std::optional<std::size_t> SharpestCorner(std::vector<WPoint> const& points,
                                                         Closure const& closure);

}  // namespace Vorn::IO
