#include "cli/Program.h"

#include <exception>
#include <new>
#include <ostream>

#include "cli/base/Advice.h"
#include "cli/commands/AreaCommand.h"
#include "cli/commands/CheckCommand.h"
#include "cli/commands/Command.h"
#include "cli/commands/CommandLine.h"
#include "cli/commands/ConvertCommand.h"
#include "cli/commands/FitCommand.h"
#include "cli/commands/InfoCommand.h"
#include "cli/commands/IntersectCommand.h"
#include "cli/commands/PlotCommand.h"
#include "cli/commands/SimplifyCommand.h"
#include "cli/terminal/PrintableStream.h"

namespace Vorn::Cli {

namespace {

constexpr char const* kText = "contour: measured points become a contour of lines and arcs.";

constexpr char const* kFooter =
    "Run 'contour COMMAND --help' for the options, exit codes and examples of a command.";

/// In the order in which --help lists them.
constexpr void (*kCommands[])(CommandLine& program, Action* action) = {
    AddFitCommand,  AddCheckCommand,     AddInfoCommand,    AddPlotCommand,
    AddAreaCommand, AddIntersectCommand, AddConvertCommand, AddSimplifyCommand,
};

/// What the command line asks for.
/// @throws Failure (FailureKind::BadArgument) when it is not understood or contradicts itself.
Action ParseCommandLine(int argc, char const* const* argv) {
  CommandLine line("contour", kText);
  line.SetVersion("contour " CONTOUR_VERSION);
  line.SetFooter(kFooter);
  Action action;
  for (auto const& add : kCommands) add(line, &action);
  if (std::optional<std::string> const answer = line.Parse(argc, argv)) {
    return [text = *answer](Console const& console) {
      console.out << text;
      return ExitCode::Ok;
    };
  }
  return action;
}

ExitCode Dispatch(int argc, char const* const* argv, Console const& console) {
  ExitCode const code = ParseCommandLine(argc, argv)(console);
  if (!console.out.flush()) throw Failure(FailureKind::File, "standard output: cannot be written");
  return code;
}

}  // namespace

ExitCode RunProgram(int argc, char const* const* argv, std::istream& in, std::ostream& out,
                    std::ostream& terminal) {
  PrintableStream err(terminal);
  try {
    return Dispatch(argc, argv, {in, out, err});
  } catch (Failure const& failure) {
    err << "contour: " << WithAdvice(failure) << '\n';
    return ExitCodeOf(failure.Kind());
  } catch (std::bad_alloc const&) {
    err << "contour: the memory does not suffice\n";
    return ExitCode::Internal;
  } catch (std::exception const& error) {
    err << "contour: internal error: " << error.what() << '\n';
    return ExitCode::Internal;
  }
}

}  // namespace Vorn::Cli
