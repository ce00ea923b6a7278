#include "cli/commands/ContourInput.h"

#include <ostream>

#include "cli/commands/CommonOptions.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Outlines.h"

namespace Vorn::Cli {

namespace {

ContourFile Chosen(std::vector<ContourFile> const& outlines, int number) {
  auto const index = static_cast<std::size_t>(number) - 1;
  if (index < outlines.size()) return outlines[index];
  throw Failure(FailureKind::BadArgument, outlines.front().path + ": there is no outline " +
                                              std::to_string(number) + ", the file has " +
                                              Counted(outlines.size(), "outline"));
}

/// Says on the standard error what was left out.
ContourFile Read(ContourInput const& input, Console const& console) {
  ContourFile contour =
      ReadContour(input.path, console.in, ReadOptions{input.from, input.flattening});
  if (contour.leftOut > 0) {
    console.err << "contour: " << contour.path << ": left out " << Counted(contour.leftOut, "piece")
                << " without length\n";
  }
  if (contour.hadHeights) {
    console.err << "contour: " << contour.path << ": dropped the coordinates beside x and y\n";
  }
  return contour;
}

}  // namespace

void AddOutline(Command& command, std::optional<int>* outline, std::string const& name) {
  constexpr int kMost = 1000000;
  AddWholeNumber(command, name, outline, {1, kMost},
                 "Take only this one of the outlines in a file, counted from 1");
}

void AddFlatten(Command& command, std::optional<double>* flattening) {
  AddPositiveNumber(command, "--flatten", flattening, "T",
                    "Take splines, ellipses and curves of DXF and SVG as chords no further than T "
                    "from them");
}

std::vector<ContourFile> ReadOutlines(ContourInput const& input, Console const& console) {
  std::vector<ContourFile> outlines = OutlinesOf(Read(input, console));
  if (input.outline) return {Chosen(outlines, *input.outline)};
  return outlines;
}

ContourFile ReadContourInput(ContourInput const& input, Console const& console) {
  ContourFile const contour = Read(input, console);
  return input.outline ? Chosen(OutlinesOf(contour), *input.outline) : Chained(contour);
}

void ReportGaps(ContourFile const& contour, Console const& console) {
  for (Gap const& gap : FindGaps(contour)) {
    console.err << "contour: " << contour.path << ": " << Describe(gap) << '\n';
  }
}

}  // namespace Vorn::Cli
