// What one writes another reads back with the same geometry, in every format; and the written text
// with words lost, doubled or replaced: text that knows the grammar of its format.
#include <array>
#include <cstdint>
#include <string>

#include "Input.h"
#include "Require.h"
#include "Texts.h"
#include "vorn/io/ContourFile.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Pieces.h"

namespace Vorn::Fuzz {
namespace {

constexpr std::array kFormats = {IO::Format::Json, IO::Format::Csv, IO::Format::Dxf,
                                 IO::Format::GCode, IO::Format::Wkt};

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
  Fuzz::TryAnyText(Fuzz::Mangle(text, &input), format);
  return 0;
}
