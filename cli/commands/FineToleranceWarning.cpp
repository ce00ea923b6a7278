#include "cli/commands/FineToleranceWarning.h"

#include <memory>
#include <mutex>
#include <ostream>

#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

namespace {

std::string TextOf(PointFile const& file, FineTolerance const& fine, Strategy strategy) {
  return Printable(file.path) + ": the tolerance " + FormatShort(file.points[fine.point].w) +
         " of " + file.NameOf(fine.point) + " is less than " + FormatShort(kFineTolerance) +
         " of the contour's extent (" + FormatShort(fine.extent) + "): strategy " +
         NameOf(strategy) +
         " may take minutes and break the contour up; --strategy fewest does neither";
}

}  // namespace

FitChoice WarningOfFineTolerances(FitChoice choice, Console const& console) {
  auto const oneAtATime = std::make_shared<std::mutex>();
  choice.warnOfFineTolerance = [oneAtATime, strategy = choice.strategy, &errors = console.err](
                                   PointFile const& file, FineTolerance const& fine) {
    std::lock_guard const lock(*oneAtATime);
    errors << "contour: warning: " << TextOf(file, fine, strategy) << std::endl;
  };
  return choice;
}

}  // namespace Vorn::Cli
