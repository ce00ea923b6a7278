// What one writes another reads back with the same geometry, in every format; and the written text
// with words lost, doubled or replaced: text that knows the grammar of its format.
#include <array>
#include <cmath>
#include <cstdint>
#include <string>

#include "Input.h"
#include "Require.h"
#include "vorn/io/ContourFile.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Pieces.h"

namespace Vorn::Fuzz {
namespace {

constexpr std::array kFormats = {IO::Format::Json, IO::Format::Csv, IO::Format::Dxf,
                                 IO::Format::GCode, IO::Format::Wkt};

constexpr std::array kWords = {"nan",    "-inf", "1e999",       "-0",  "1e-320", "",      "[",
                               "]",      "{",    "}",           "\"",  ",",      ";",     "(",
                               ")",      "\\u0", "99999999999", "G91", "G2",     "EMPTY", "VERTEX",
                               "SEQEND", "null", "\xff",        "\n"};

IO::ContourFile MakeContour(Input* input) {
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
std::string Mangle(std::string text, Input* input) {
  for (int count = input->Integer(1, 4); count > 0 && !text.empty(); --count) {
    std::size_t const at = static_cast<std::size_t>(input->Integer(0, 65535)) % text.size();
    std::size_t begin = at;
    auto const isWord = [&](std::size_t i) {
      return std::isalnum(static_cast<unsigned char>(text[i])) != 0;
    };
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

bool AreNear(IO::XY const& a, IO::XY const& b) { return IO::Distance(a, b) <= 1e-5; }

void RequireSame(IO::ContourFile const& written, IO::ContourFile const& read) {
  Require(written.pieces.size() == read.pieces.size(), "as many pieces come back");
  for (std::size_t i = 0; i < written.pieces.size(); ++i) {
    IO::Piece const& a = written.pieces[i];
    IO::Piece const& b = read.pieces[i];
    Require(a.kind == b.kind, "a piece comes back as what it was");
    Require(AreNear(a.start, b.start) && AreNear(a.end, b.end), "ends come back");
    if (!a.IsArc()) continue;
    Require(AreNear(a.center, b.center), "centres come back");
    Require(a.counterClockwise == b.counterClockwise, "the sense comes back");
  }
}

/// A format that cannot hold the contour refuses it; what is written comes back, piece for piece.
void TryRoundTrip(IO::ContourFile contour, IO::Format format, std::string* text) {
  IO::WriteOptions options;
  options.gcode.feed = 100.0;
  try {
    *text = IO::ToText(contour, format, options);
  } catch (IO::Failure const& failure) {
    Require(failure.Kind() == IO::FailureKind::BadArgument, "what cannot be written is refused");
    return;
  }
  IO::RemovePiecesWithoutLength(&contour.pieces);
  RequireSame(contour, IO::ParseContour(*text, "f", format));
}

void TryMangled(std::string const& text, IO::Format format) {
  try {
    IO::ParseContour(text, "f", format);
  } catch (IO::Failure const& failure) {
    Require(failure.Kind() == IO::FailureKind::File, "bad text is the file's fault");
    Require(failure.Where().file == "f", "the failure names the file");
  }
}

}  // namespace
}  // namespace Vorn::Fuzz

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size) {
  namespace Fuzz = Vorn::Fuzz;
  Fuzz::Input input(data, size);
  Vorn::IO::Format const format =
      Fuzz::kFormats[static_cast<std::size_t>(input.Integer(0, Fuzz::kFormats.size() - 1))];
  Vorn::IO::ContourFile const contour = Fuzz::MakeContour(&input);
  std::string text;
  Fuzz::TryRoundTrip(contour, format, &text);
  Fuzz::TryMangled(Fuzz::Mangle(text, &input), format);
  return 0;
}
