#include "cli/texts/ScatterText.h"

#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

std::string ScatterText(DeviationSummary const& summary, std::string const& units) {
  std::string const behind = units.empty() ? "" : " " + units;
  return "root mean square " + FormatShort(summary.rootMeanSquare, 4) + behind + ", mean " +
         FormatShort(summary.mean, 3) + behind;
}

std::string OutsideText(std::size_t outside, std::size_t points) {
  return (outside == 0 ? "none" : std::to_string(outside)) + " of " + Counted(points, "point");
}

}  // namespace Vorn::Cli
