#include "cli/commands/ContourInput.h"

#include <ostream>

#include "vorn/io/Messages.h"

namespace Vorn::Cli {

ContourFile ReadContourInput(std::string const& path, std::optional<Format> from,
                             Console const& console) {
  ContourFile contour = ReadContour(path, console.in, from);
  if (contour.leftOut > 0) {
    console.err << "contour: " << contour.path << ": left out " << Counted(contour.leftOut, "piece")
                << " without length\n";
  }
  return contour;
}

void ReportGaps(ContourFile const& contour, Console const& console) {
  for (Gap const& gap : FindGaps(contour)) {
    console.err << "contour: " << contour.path << ": " << Describe(gap) << '\n';
  }
}

}  // namespace Vorn::Cli
