#include "cli/commands/ContourOutput.h"

#include <iostream>

#include "cli/commands/Command.h"
#include "cli/commands/CommonOptions.h"
#include "vorn/io/Files.h"

namespace Vorn::Cli {

namespace {

using End = GCodeOptions::End;
using Plane = GCodeOptions::Plane;

constexpr int kMostDecimals = 12;

/// An option that names a file whose text goes into G-code.
void AddTextFile(Command& command, std::string const& name, std::string* text,
                 std::string const& help) {
  auto const complaint = [](std::string const& path) -> std::string {
    return path == kStandardInput ? "the standard input is no such file" : "";
  };
  auto const take = [text](std::string const& path) { *text = ReadTextFile(path, std::cin); };
  command.AddChecked(name, complaint, take, "FILE", help);
}

void AddProgramFrame(Command& command, GCodeOptions* options) {
  AddChoice<End>(command, "--end", &options->end,
                 {{"m2", End::M2}, {"m30", End::M30}, {"none", End::None}},
                 "G-code: how the program ends; m2 if not said");
  AddTextFile(command, "--header", &options->header,
              "G-code: put the text of this file ahead of the program; in it {name}, {date}, "
              "{units}, {tolerance}, {feed}, {pieces} and {length} are filled in");
  AddTextFile(command, "--footer", &options->footer,
              "G-code: the same behind the path, ahead of the end of the program");
}

void AddHeights(Command& command, GCodeOptions* options) {
  Option const safe = AddNumber(command, "--safe-height", &options->safeHeight, "Z",
                                "G-code: move rapidly at this height only");
  Option const cut = AddNumber(command, "--cut-height", &options->cutHeight, "Z",
                               "G-code: plunge to this height before the cut");
  safe.Need(cut);
  cut.Need(safe);
  AddPositiveNumber(command, "--plunge-feed", &options->plungeFeed, "F",
                    "G-code: the feed of the plunge; that of --feed if not said")
      .Need(cut);
}

void AddGCodeOptions(Command& command, GCodeOptions* options) {
  AddPositiveNumber(command, "--feed", &options->feed, "F",
                    "G-code: the feed in units a minute; without it there is no F word, and a "
                    "controller stops at the first cut");
  AddWholeNumber(command, "--gcode-decimals", &options->decimals, {0, kMostDecimals},
                 "G-code: digits after the point; if not said, 4, of inches 5, and more where the "
                 "tolerance asks for more");
  command.AddFlag("--r-words", &options->useRadiusWords, "G-code: arcs by R, not by I and J");
  AddChoice<Plane>(command, "--plane", &options->plane, {{"xy", Plane::G17}, {"xz", Plane::G18}},
                   "G-code: xy (default); xz for lathes: G18, the second coordinate is Z");
  AddProgramFrame(command, options);
  AddHeights(command, options);
}

}  // namespace

void AddWriteOptions(Command& command, WriteOptions* options) {
  command.AddFlag("--dxf-entities", &options->dxfEntities,
                  "DXF: a LINE or an ARC for each piece in place of one polyline");
  AddChoice<DxfVersion>(command, "--dxf-version", &options->dxfVersion,
                        {{"r12", DxfVersion::R12}, {"r2000", DxfVersion::R2000}},
                        "DXF: r12 (default), which every program reads; r2000 with LWPOLYLINE, "
                        "units ($INSUNITS) and a layer for holes");
  command.AddFlag(
      "--svg-plain", &options->svgPlain,
      "SVG: the contour itself in its true size, lines and arcs for a cutter, in place of "
      "a drawing");
  AddPositiveNumber(
      command, "--chords", &options->chords, "T",
      "GeoJSON, which has no arcs: how far their chords may be from them; if not said, "
      "a part of the tolerance");
  AddGCodeOptions(command, &options->gcode);
}

void WarnOfMissingFeed(WriteOptions const& options, bool writesGCode, Console const& console) {
  if (!writesGCode || options.gcode.feed) return;
  console.err << "contour: G-code without a feed: a controller stops at the first cut; --feed F "
                 "gives it one\n";
}

}  // namespace Vorn::Cli
