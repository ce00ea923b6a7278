#include "cli/base/Advice.h"

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
    case Remedy::None:
      break;
  }
  return "";
}

}  // namespace

std::string WithAdvice(Failure const& failure) {
  return failure.what() + std::string(AdviceFor(failure.Help()));
}

}  // namespace Vorn::Cli
