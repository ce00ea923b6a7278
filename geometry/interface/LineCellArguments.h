// How members for line cells hand the form of the line parameters and tangent points in and out.

#pragma once

#include "geometry/cells/LineCells.h"

namespace Vorn::Cells {

/// The form that a caller holds in two flags. xOfY is read only when the form is chosen.
inline LineForm ReadForm(bool const* formFixed, bool const* xOfY) {
  return {*formFixed, *formFixed && *xOfY};
}

/// Writes a chosen form to a caller's flags; they stay as long as none is chosen.
inline void WriteForm(LineForm const& form, bool* formFixed, bool* xOfY) {
  if (!form.isChosen) return;
  *formFixed = true;
  *xOfY = form.xOfY;
}

/// Writes tangent points to eight doubles.
inline void WriteRect(TangentPoints const& points, double* rect) {
  for (Point const& p : points) {
    *rect++ = p.x;
    *rect++ = p.y;
  }
}

}  // namespace Vorn::Cells
