// What the signs of nine offsets say: on which side of each line of a triangle the vertices of
// another one lie.

#pragma once

#include <array>
#include <cstdint>

namespace Vorn::Cells {

/// Vertices on the inner side of lines; bit 3 k + v stands for vertex v and line k.
using InnerBits = unsigned;

/// How many patterns of inner bits there are.
inline constexpr InnerBits kInnerPatterns = 512;

/// What a pattern of inner bits says.
struct CutSigns {
  std::uint16_t inside;    ///< bit v: vertex v is inside
  std::uint16_t mayCross;  ///< bit 3 i + k: side i changes over line k
  std::int16_t beyond;     ///< the last line that all vertices are beyond, or -1
};

/// Whether vertex v is on the inner side of line k.
constexpr bool IsInner(InnerBits inner, unsigned k, unsigned v) {
  return (inner >> (3 * k + v) & 1U) != 0;
}

/// What one pattern says.
constexpr CutSigns SignsOf(InnerBits inner) {
  CutSigns signs{0, 0, -1};
  for (unsigned k = 0; k < 3; ++k) {
    bool const isBeyond = (inner >> 3 * k & 7U) == 0;
    if (isBeyond) signs.beyond = static_cast<std::int16_t>(k);
  }
  for (unsigned v = 0; v < 3; ++v) {
    bool isInside = true;
    for (unsigned k = 0; k < 3; ++k) {
      isInside = isInside && IsInner(inner, k, v);
      bool const changes = IsInner(inner, k, v) != IsInner(inner, k, (v + 1) % 3);
      if (changes) signs.mayCross = static_cast<std::uint16_t>(signs.mayCross | 1U << (3 * v + k));
    }
    if (isInside) signs.inside = static_cast<std::uint16_t>(signs.inside | 1U << v);
  }
  return signs;
}

/// What each pattern says.
inline constexpr std::array<CutSigns, kInnerPatterns> kCutSigns = [] {
  std::array<CutSigns, kInnerPatterns> all{};
  for (InnerBits inner = 0; inner < kInnerPatterns; ++inner) all[inner] = SignsOf(inner);
  return all;
}();

}  // namespace Vorn::Cells
