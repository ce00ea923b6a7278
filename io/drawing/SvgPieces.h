#pragma once

#include <string>

#include "io/drawing/Scene.h"

namespace Vorn::IO::Svg {

/// Lines and arcs, each with its size as the text that viewers show under the cursor.
std::string Pieces(Scene const& scene);

/// A small circle where two pieces meet.
std::string Joints(Scene const& scene);

/// More pieces are told by their numbers alone.
inline constexpr std::size_t kMostSizedLabels = 40;

/// Number and size of each piece beside it; of many pieces the number, where there is room.
std::string PieceLabels(Scene const& scene);

}  // namespace Vorn::IO::Svg
