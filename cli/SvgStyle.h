#pragma once

#include <string>

#include "cli/Pieces.h"

/// What the parts of the drawing have in common.
namespace Vorn::Cli::Svg {

inline std::string const kLineColor = "#1f5fa8";
inline std::string const kArcColor = "#d9480f";
inline std::string const kPointColor = "#495057";
inline std::string const kBandColor = "#d3f0d5";
inline std::string const kBandEdgeColor = "#8cc896";
inline std::string const kStartColor = "#2b8a3e";
inline std::string const kWorstColor = "#c2255c";
inline std::string const kGridColor = "#e9ecef";
inline std::string const kFrameColor = "#868e96";
inline std::string const kTextColor = "#212529";

inline std::string const& ColorOf(Piece const& piece) {
  return piece.IsArc() ? kArcColor : kLineColor;
}

}  // namespace Vorn::Cli::Svg
