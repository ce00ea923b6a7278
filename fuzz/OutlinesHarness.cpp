// Points read from drawings: the vertices of what was written, in runs, in every format that holds
// lines; arcs only as chords, and no further from them than was asked for.
#include <array>
#include <cstdint>
#include <string>
#include <vector>

#include "Input.h"
#include "Require.h"
#include "Texts.h"
#include "vorn/io/Formats.h"
#include "vorn/io/PointOutlines.h"

namespace Vorn::Fuzz {
namespace {

constexpr double kChords = 0.01;
/// Of a coordinate that was written with the digits of a tool path or a drawing.
constexpr double kRounding = 1e-4;

struct Choice {
  IO::Format format;
  IO::WriteOptions options;
};

Choice MakeChoice(Input* input) {
  constexpr std::array kFormats = {IO::Format::Json, IO::Format::Dxf,     IO::Format::GCode,
                                   IO::Format::Wkt,  IO::Format::GeoJson, IO::Format::Svg};
  Choice choice;
  choice.format = kFormats[input->Byte() % kFormats.size()];
  choice.options.dxfEntities = input->Flip();
  choice.options.dxfVersion = input->Flip() ? IO::DxfVersion::R2000 : IO::DxfVersion::R12;
  choice.options.svgPlain = true;
  choice.options.chords = kChords;
  choice.options.gcode.feed = 100.0;
  return choice;
}

IO::PointReading Reading(IO::Format format, bool flattens) {
  IO::PointReading reading;
  reading.format = format;
  if (flattens) reading.flattening = kChords;
  return reading;
}

void RequireSoundPoints(std::vector<IO::PointFile> const& outlines) {
  Require(!outlines.empty(), "what was read has an outline");
  std::size_t count = 0;
  for (IO::PointFile const& outline : outlines) {
    Require(outline.points.size() >= 2, "an outline has two points or more");
    for (WPoint const& point : outline.points)
      Require(IsFinite({point.x, point.y}), "points are finite");
    count += outline.points.size();
  }
  Require(IO::Joined(outlines).points.size() == count, "joined outlines have all points");
}

bool HasArcs(IO::ContourFile const& contour) {
  for (IO::Piece const& piece : contour.pieces) {
    if (piece.IsArc()) return true;
  }
  return false;
}

void RequireVertices(IO::ContourFile const& contour, std::vector<IO::PointFile> const& outlines) {
  std::size_t pieces = 0;
  for (IO::PointFile const& outline : outlines) pieces += outline.points.size() - 1;
  Require(pieces == contour.pieces.size(), "every line has its two ends among the points");
}

void RequireNear(IO::ContourFile const& contour, std::vector<IO::PointFile> const& outlines) {
  for (IO::PointFile const& outline : outlines) {
    for (WPoint const& point : outline.points) {
      double least = 1e9;
      for (IO::Piece const& piece : contour.pieces) {
        least = std::min(least, IO::DistanceTo(piece, point.x, point.y));
      }
      Require(least <= kChords + kRounding, "every point is as near as was asked for");
    }
  }
}

/// The text that the contour is written as; nothing where the format cannot hold it.
std::string Written(IO::ContourFile const& contour, Choice const& choice) {
  try {
    return IO::ToText(contour, choice.format, choice.options);
  } catch (IO::Failure const& failure) {
    Require(failure.Kind() == IO::FailureKind::BadArgument, "what cannot be written is refused");
    return "";
  }
}

void TryWithoutChords(std::string const& text, IO::ContourFile const& contour, IO::Format format) {
  bool const wantsChords = HasArcs(contour) && format != IO::Format::GeoJson;
  try {
    std::vector<IO::PointFile> const outlines =
        IO::ParsePointOutlines(text, "f", Reading(format, false));
    RequireSoundPoints(outlines);
    Require(!wantsChords, "arcs are no points");
    if (!HasArcs(contour)) RequireVertices(contour, outlines);
  } catch (IO::Failure const& failure) {
    RequirePlace(failure);
    Require(wantsChords && failure.Help() == IO::Remedy::FlattenCurves, "lines are read");
  }
}

void TryMangled(std::string const& text, IO::Format format) {
  try {
    RequireSoundPoints(IO::ParsePointOutlines(text, "f", Reading(format, true)));
  } catch (IO::Failure const& failure) {
    RequirePlace(failure);
  }
}

}  // namespace
}  // namespace Vorn::Fuzz

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size) {
  namespace Fuzz = Vorn::Fuzz;
  namespace IO = Vorn::IO;
  Fuzz::Input input(data, size);
  Fuzz::Choice const choice = Fuzz::MakeChoice(&input);
  IO::ContourFile contour = Fuzz::MakeContour(&input);
  std::string const text = Fuzz::Written(contour, choice);
  if (text.empty()) return 0;
  IO::RemovePiecesWithoutLength(&contour.pieces);
  Fuzz::TryWithoutChords(text, contour, choice.format);
  std::vector<IO::PointFile> const outlines =
      IO::ParsePointOutlines(text, "f", Fuzz::Reading(choice.format, true));
  Fuzz::RequireSoundPoints(outlines);
  Fuzz::RequireNear(contour, outlines);
  Fuzz::TryMangled(Fuzz::Mangle(text, &input), choice.format);
  return 0;
}
