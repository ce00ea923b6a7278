#pragma once

#include <cstddef>
#include <nlohmann/json.hpp>
#include <string>
#include <string_view>

#include "vorn/io/ContourFile.h"
#include "vorn/io/Formats.h"

namespace Vorn::IO {

/// One piece as the JSON documents of the program hold it; `number` counts from 1, `points` tells
/// which measured points it stands for and may be null.
nlohmann::ordered_json PieceJson(Piece const& piece, std::size_t number,
                                 nlohmann::ordered_json const& points);

/// A contour without a fit, in the layout of a fit's document less what only a fit knows. Doubles
/// read back as the same bits, and gaps are kept.
std::string ToJson(ContourFile const& contour);

/// Reads the contour of a document written by a fit or by the function above, or of GeoJSON.
/// Derived numbers (length, angles, sweep) are taken as written and worked out where they are
/// missing.
/// @throws Failure (FailureKind::File) naming the file and the path of the bad field, or line and
///         column where the text is no JSON.
ContourFile ParseJsonPieces(std::string_view text, std::string const& path,
                            ArcUse arcs = ArcUse::Keep);

}  // namespace Vorn::IO
