#pragma once

#include <string>
#include <vector>

#include "io/drawing/Layout.h"

namespace Vorn::IO::Svg {

/// The path data of a stretch of one piece, without the move to its start.
std::string StretchData(Piece const& piece, double from, double to, View const& view);

/// The path data of pieces one after another, a joined line as long as each starts where the one
/// before ends.
std::string PathData(std::vector<Piece> const& pieces, View const& view);

}  // namespace Vorn::IO::Svg
