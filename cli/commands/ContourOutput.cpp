#include "cli/commands/ContourOutput.h"

#include "cli/commands/CommonOptions.h"
#include "io/base/Failure.h"
#include "io/base/Numbers.h"

namespace Vorn::Cli {

void AddWriteOptions(Command& command, WriteOptions* options) {
  constexpr int kMostDecimals = 9;
  command.AddFlag("--dxf-entities", &options->dxfEntities,
                  "DXF: a LINE or an ARC for each piece in place of one POLYLINE");
  AddPositiveNumber(command, "--feed", &options->feed, "F",
                    "G-code: the feed in units a minute; without it there is no F word");
  AddWholeNumber(command, "--gcode-decimals", &options->gcodeDecimals, 0, kMostDecimals, "N",
                 "G-code: digits after the point; 4 unless the units are inches, then 5");
}

Format OutputFormat(std::string const& path, std::optional<Format> otherwise,
                    std::string const& option) {
  if (std::optional<Format> const format = FormatOf(path)) return *format;
  if (otherwise) return *otherwise;
  throw Failure(FailureKind::BadArgument, (path == "-" ? "the standard output" : Quoted(path)) +
                                              ": " + option + " must say which format to write");
}

}  // namespace Vorn::Cli
