#pragma once

#include <string_view>

#include "io/formats/SvgPen.h"

namespace Vorn::IO {

/// Draws what the attribute `d` of a path says: M, L, H, V, Z, C, S, Q, T and A, absolute and
/// relative.
/// @throws Failure (FailureKind::File) naming the element and the character.
void DrawSvgPath(XmlElement const& element, std::string_view data, SvgPen* pen);

}  // namespace Vorn::IO
