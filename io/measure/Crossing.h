#pragma once

#include <optional>
#include <string>
#include <vector>

#include "io/pieces/ContourFile.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::IO {

/// The contour as the library holds one: the start, then the pieces, and a segment across every gap
/// wider than JointTolerance, that of the seam of a closed contour included.
std::vector<GeometryUtils::Elem> ElementsOf(ContourFile const& contour);

/// What the library's test for self-intersection answers.
enum class Crossing {
  None,
  Found,         ///< two elements cross or touch
  NotTestable,   ///< too few elements for a test: a single one, or two segments
  NotDecidable,  ///< the test failed on an element of the contour
};

/// Tests the contour made by ElementsOf. Neighbours may share their joint, and where the ends meet
/// the last element may touch the first. Deliberate in the library, and so here: segments that
/// overlap on one line are no crossing, and a touch at the end of an arc does not count.
///
/// The library always allows the last element one point in common with the first. So that it does
/// not overlook a crossing of these two where the ends do not meet, such a contour is given a very
/// short segment ahead of its start, at a right angle to it.
Crossing FindCrossing(std::vector<GeometryUtils::Elem> const& elements, bool endsMeet);

/// In words, for the report.
std::string Describe(Crossing crossing);

/// The area that a closed contour encloses.
struct Enclosed {
  double area = 0.0;  ///< never negative
  bool isCounterClockwise = false;
};

/// Nothing for an open contour and for one that crosses itself.
std::optional<Enclosed> EnclosedBy(ContourFile const& contour,
                                   std::vector<GeometryUtils::Elem> const& elements);

}  // namespace Vorn::IO
