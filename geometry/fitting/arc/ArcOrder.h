// Whether points follow an arc in its sense, by their angles about its centre. Angles are those of
// atan2, so an arc may cross the seam between +pi and -pi.

#pragma once

#include "geometry/fitting/runs/Runs.h"

namespace Vorn::Fitting {

/// How an arc turns.
struct ArcTurn {
  Point centre;
  /// Whether it runs counter-clockwise.
  bool ccw = false;
};

/// Whether p lies on the arc from start to end, by angle, both ends included.
bool IsOnArc(ArcTurn const& turn, Point const& start, Point const& p, Point const& end);

/// Whether a further point continues an arc that runs from start to previous: previous lies on the
/// arc from start to next, and the step to next is below a right angle, as is that from start to
/// previous unless it is not looked at.
bool ContinuesArc(ArcTurn const& turn, Point const& start, Point const& previous, Point const& next,
                  bool skipFirstStep);

}  // namespace Vorn::Fitting
