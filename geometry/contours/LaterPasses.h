// The passes of the walk but for the first, with fewer questions.

#pragma once

#include "geometry/contours/Walk.h"

namespace Vorn::Contours {

/// What the passes of the elements after the first one of the walk come to, by looking at pairs
/// that come near each other. It stands for Walk::Scan of each of them, the answer is the same.
ErrorCode SearchLaterPasses(Walk const& walk, Elem const* first);

}  // namespace Vorn::Contours
