#pragma once

#include "vorn/GeometryUtils.h"

namespace Vorn::Circles {

/// The circumcentre of three points by a four-by-four system whose last two unknowns are forced to
/// zero. The padding is kept so that pivoting, failure test and rounding are those that recorded
/// cells were made with. False, center untouched, when the solver meets a zero pivot column.
bool SolveCircumcentre(GeometryUtils::Point const& p0, GeometryUtils::Point const& p1,
                       GeometryUtils::Point const& p2, GeometryUtils::Point* center);

}  // namespace Vorn::Circles
