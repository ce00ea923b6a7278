#pragma once

#include <string>

#include "vorn/io/Pieces.h"

/// What the parts of the drawing have in common. The colours of the pieces, the band and the worst
/// point are told apart with any kind of colour vision; shapes and dashes tell the same again.
namespace Vorn::IO::Svg {

inline std::string const kLineColor = "#0072b2";
inline std::string const kArcColor = "#d55e00";
inline std::string const kArcTextColor = "#a84a00";
inline std::string const kLineTint = "#d6e9f5";
inline std::string const kArcTint = "#fae3d2";
inline std::string const kPointColor = "#3d4348";
inline std::string const kWhiskerColor = "#868e96";
inline std::string const kBandColor = "#dcf1ea";
inline std::string const kBandEdgeColor = "#6dbfa6";
inline std::string const kStartColor = "#009e73";
inline std::string const kGoodTextColor = "#00704f";
inline std::string const kWorstColor = "#b5478b";
inline std::string const kOutsideColor = "#c8102e";
inline std::string const kGridColor = "#e3e6e9";
inline std::string const kFrameColor = "#868e96";
inline std::string const kTextColor = "#212529";

inline constexpr double kContourWidth = 1.7;
inline constexpr double kWorstRadius = 7.0;
inline std::string const kArcDashes = "stroke-dasharray=\"9 2.2\"";

/// The colour that lines or arcs are drawn in.
inline std::string const& ColorOf(Piece const& piece) {
  return piece.IsArc() ? kArcColor : kLineColor;
}

/// The darker one for text about them.
inline std::string const& TextColorOf(Piece const& piece) {
  return piece.IsArc() ? kArcTextColor : kLineColor;
}

}  // namespace Vorn::IO::Svg
