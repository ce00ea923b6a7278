#include "cli/base/Advice.h"

#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/SpacingFailure.h"

namespace Vorn::Cli {

namespace {

/// What stands behind the message of a failure.
char const* AdviceFor(Remedy help) {
  switch (help) {
    case Remedy::ChooseColumns:
      return "; say it with --columns X,Y";
    case Remedy::ChooseUnits:
      return "; see --units";
    case Remedy::GiveTolerance:
      return "; give --tolerance T, --tolerance-column NAME or --tolerance-per-point CAP";
    case Remedy::CloseContour:
      return "; --closed yes closes it";
    case Remedy::FlattenCurves:
      return "; --flatten T takes chords of arcs and curves";
    case Remedy::GiveChords:
      return "; --chords T says how far chords may be from them";
    case Remedy::SpacePoints:
    case Remedy::LeaveOneOut:  // these need the points, see WaysOut
    case Remedy::None:
      break;
  }
  return "";
}

/// How another command line names the points: "-" for the standard input.
std::string ArgumentFor(SpacingFailure const& failure) {
  std::size_t const outline = failure.Neighbours().outline;
  std::string const& file = failure.Where().file;
  std::string const path = file.substr(0, file.size() - OutlineSuffix(outline).size());
  std::string const argument = path == kStandardInputName ? "-" : ShellQuoted(path);
  return outline == 0 ? argument : argument + " --outline " + std::to_string(outline);
}

/// The choice as options for another command line; empty when there is none.
std::string OptionsFor(ToleranceChoice const& choice) {
  // As many as any decimal text that a user types keeps through a double.
  constexpr int kDigits = 15;
  if (choice.cap) return " --tolerance-per-point " + FormatShort(*choice.cap, kDigits);
  if (choice.same) return " -t " + FormatShort(*choice.same, kDigits);
  if (choice.column) return " --tolerance-column " + ShellQuoted(*choice.column);
  return "";
}

/// The commands and options that help where neighbours are too close.
std::string WaysOut(SpacingFailure const& failure) {
  CloseNeighbours const& neighbours = failure.Neighbours();
  std::string const file = ArgumentFor(failure);
  if (failure.Help() == Remedy::LeaveOneOut) {
    return "\nto leave one of them out: contour simplify " + file + " --drop-close";
  }
  std::string const arguments = file + OptionsFor(neighbours.tolerance);
  std::string text = "\nsee: contour info " + arguments +
                     "\nways out: --strategy fewest, which takes points of any density\n";
  if (neighbours.largestTolerance) {
    text += "or --tolerance " + FormatShort(*neighbours.largestTolerance) +
            ", or --tolerance-per-point CAP to follow the spacing\n";
  }
  return text + "or leave points out: contour simplify " + arguments + " --drop-close";
}

}  // namespace

std::string WithAdvice(Failure const& failure) {
  if (auto const* spacing = dynamic_cast<SpacingFailure const*>(&failure)) {
    return spacing->what() + WaysOut(*spacing);
  }
  return failure.what() + std::string(AdviceFor(failure.Help()));
}

}  // namespace Vorn::Cli
