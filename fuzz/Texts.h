// Contours, and text that knows the grammar of its format, out of the bytes that a fuzzer makes;
// what every reader promises of any text.
#pragma once

#include <array>
#include <cctype>
#include <cmath>
#include <cstddef>
#include <string>

#include "Input.h"
#include "Require.h"
#include "vorn/io/ContourFile.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Formats.h"

namespace Vorn::Fuzz {

/// What readers stumble over, in the place of a word.
inline constexpr std::array kWords = {
    "nan",  "-inf", "1e999",       "-0",  "1e-320",  "",         "[",    "]",      "{",
    "}",    "\"",   ",",           ";",   "(",       ")",        "\\u0", "VERTEX", "SEQEND",
    "null", "\xff", "99999999999", "G91", "G2",      "EMPTY",    "<g>",  "</g>",   "1e5",
    "z",    "A",    "1e-9",        "\n",  "Feature", "matrix(0)"};

/// One to eight lines and arcs on the grid, each from the end of the one before.
inline IO::ContourFile MakeContour(Input* input) {
  IO::ContourFile contour;
  contour.path = "f";
  IO::XY at = input->PointOnGrid();
  for (int count = input->Integer(1, 8); count > 0; --count) {
    if (input->Flip()) {
      contour.pieces.push_back(IO::MakeLine(at, input->PointOnGrid()));
    } else {
      IO::XY const centre = input->PointOnGrid();
      double const dx = at.x - centre.x;
      double const dy = at.y - centre.y;
      IO::XY const end = input->Flip() ? IO::XY{centre.x - dy, centre.y + dx}
                                       : IO::XY{centre.x - dx, centre.y - dy};
      if (dx == 0.0 && dy == 0.0) continue;
      contour.pieces.push_back(IO::MakeArc(at, end, centre, std::hypot(dx, dy), input->Flip()));
    }
    at = contour.pieces.back().end;
  }
  return contour;
}

/// Loses, doubles or replaces some of the words of a text.
inline std::string Mangle(std::string text, Input* input) {
  auto const isWord = [&](std::size_t i) {
    return std::isalnum(static_cast<unsigned char>(text[i])) != 0;
  };
  for (int count = input->Integer(1, 4); count > 0 && !text.empty(); --count) {
    std::size_t const at = static_cast<std::size_t>(input->Integer(0, 65535)) % text.size();
    std::size_t begin = at;
    while (begin > 0 && isWord(begin - 1)) --begin;
    std::size_t end = at + 1;
    while (end < text.size() && isWord(end)) ++end;
    std::string const word = text.substr(begin, end - begin);
    switch (input->Byte() % 4) {
      case 0:
        text.erase(begin, end - begin);
        break;
      case 1:
        text.insert(end, word);
        break;
      case 2:
        text.replace(begin, end - begin, kWords[input->Byte() % kWords.size()]);
        break;
      default:
        text.resize(at);
        break;
    }
  }
  return text;
}

inline bool IsFinite(IO::XY const& p) { return std::isfinite(p.x) && std::isfinite(p.y); }

/// What holds of every contour that was read.
inline void RequireSound(IO::ContourFile const& contour) {
  Require(!contour.pieces.empty(), "a contour that was read has pieces");
  for (IO::Piece const& piece : contour.pieces) {
    Require(IsFinite(piece.start) && IsFinite(piece.end), "ends are finite");
    Require(!piece.IsArc() || (IsFinite(piece.center) && piece.radius > 0.0),
            "arcs have a centre and a radius");
  }
}

/// What holds of every failure to read the text of the file "f".
inline void RequirePlace(IO::Failure const& failure) {
  Require(failure.Kind() == IO::FailureKind::File, "bad text is the file's fault");
  Require(failure.Where().file.starts_with("f"), "the failure names the file");
  Require(!failure.Message().empty(), "the failure says what is wrong");
}

/// What the reader of contours does with any text: a sound contour, or a failure with its place.
inline void TryAnyText(std::string const& text, IO::Format format) {
  try {
    RequireSound(IO::ParseContour(text, "f", format));
  } catch (IO::Failure const& failure) {
    RequirePlace(failure);
  }
}

}  // namespace Vorn::Fuzz
