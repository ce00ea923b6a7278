#include "cli/Options.h"

#include <CLI/CLI.hpp>
#include <cmath>
#include <filesystem>
#include <map>
#include <sstream>

#include "cli/Failure.h"
#include "cli/Numbers.h"

namespace Vorn::Cli {

namespace {

using GeometryUtilsStrategy = GeometryUtils::FittingStrategy;

constexpr char const* kProgramText = "contour: measured points become a contour of lines and arcs.";

constexpr char const* kFitText =
    "Fit a contour of lines and arcs to measured points, so that it passes every point within\n"
    "its tolerance. Prints a table of the pieces and a summary; writes JSON and a drawing.";

constexpr char const* kFitFooter =
    R"(Points file: one point a line, x,y or x,y,w (w: the tolerance of the point), in the order of
the contour. The first line may be a header. Fields are separated by a comma, a semicolon, a
tab or blanks. Lines that begin with # are comments; "# tolerance T" and "# units mm" are read.

Tolerance: at most one of the three options. Without one, the column w of the file counts, and
without that its comment "# tolerance T". Neighbouring points must be more than 1.5 times the
sum of their tolerances apart (strategies mixed and cells).

Deviations are multiples of the tolerance of the point: up to 1 is within tolerance. They are
printed as the fit reports them, and as measured again by the program over every point. Up to
1 + 1e-9 counts as within, for the rounding of the second measurement. Points are counted from
0. The strategy arc reports its deviation as a length, and no point.

Exit codes:
  0   every point is within its tolerance
  1   the contour leaves the tolerance of a point (table and files are written)
  2   wrong usage
  3   a file cannot be read or written, or a line of the points file is wrong
  4   two neighbouring points are too close for their tolerances
  5   no fit, or a contour that stops before the last point (then table and files are written)
  70  internal error

Output files are written whole or not at all.

Examples:
  contour fit part.csv --tolerance 0.02 --svg part.svg
  contour fit part.csv --tolerance-per-point 0.05 --strategy cells --json part.json
)";

/// A number above zero, read independently of the locale.
CLI::Validator PositiveNumber() {
  return CLI::Validator(
      [](std::string& text) -> std::string {
        std::optional<double> const value = ParseNumber(text);
        bool const isGood = value && std::isfinite(*value) && *value > 0.0;
        return isGood ? "" : Quoted(text) + " is not a finite number above 0";
      },
      "");
}

CLI::Option* AddNumber(CLI::App* app, std::string const& name, std::optional<double>* value,
                       std::string const& valueName, std::string const& help) {
  return app
      ->add_option_function<std::string>(
          name, [value](std::string const& text) { *value = ParseNumber(text); }, help)
      ->check(PositiveNumber())
      ->type_name(valueName);
}

void AddFit(CLI::App* app, Options* options) {
  app->add_option("POINTS", options->points, "CSV file with the measured points")
      ->required()
      ->type_name("FILE");

  ToleranceChoice& choice = options->tolerance;
  CLI::Option* const same = AddNumber(app, "--tolerance", &choice.same, "T",
                                      "One tolerance for all points, in the units of the file");
  CLI::Option* const column =
      app->add_option("--tolerance-column", choice.column,
                      "Take each point's tolerance from the column of this name")
          ->type_name("NAME");
  CLI::Option* const cap = AddNumber(
      app, "--tolerance-per-point", &choice.cap, "CAP",
      "Give each point the smaller of CAP and 0.3 times the distance to its nearer neighbour");
  same->excludes(column)->excludes(cap);
  column->excludes(cap);

  static std::map<std::string, GeometryUtilsStrategy> const kStrategies = {
      {"mixed", GeometryUtilsStrategy::Mixed},
      {"cells", GeometryUtilsStrategy::MixedCells},
      {"arc", GeometryUtilsStrategy::SingleArc},
  };
  app->add_option_function<std::string>(
         "--strategy",
         [options](std::string const& name) { options->strategy = kStrategies.at(name); },
         "mixed: lines and arcs compared run by run (default); cells: lines first, arcs between "
         "them; arc: one arc for all points")
      ->check(CLI::Validator(
          [](std::string& name) -> std::string {
            bool const isKnown = kStrategies.count(name) > 0;
            return isKnown ? "" : Quoted(name) + " is none of mixed, cells, arc";
          },
          ""))
      ->type_name("NAME");

  app->add_option("--json", options->json, "Write the contour and its deviations to this file")
      ->type_name("FILE");
  app->add_option("--svg", options->svg, "Write a drawing to this file")->type_name("FILE");
  app->footer(kFitFooter);
}

bool AreSameFile(std::string const& a, std::string const& b) {
  std::error_code error;
  if (std::filesystem::equivalent(a, b, error)) return true;
  // Neither need be there yet.
  auto const whole = [&](std::string const& path) {
    return std::filesystem::weakly_canonical(std::filesystem::absolute(path), error);
  };
  return whole(a) == whole(b);
}

/// One output must not overwrite the other or the measurements.
void RefuseSharedFiles(Options const& options) {
  auto refuse = [](std::string const& what, std::string const& path) {
    throw Failure(ExitCode::Usage, what + " name the same file: " + path);
  };
  if (options.json && options.svg && AreSameFile(*options.json, *options.svg)) {
    refuse("--json and --svg", *options.svg);
  }
  if (options.json && AreSameFile(*options.json, options.points)) {
    refuse("POINTS and --json", *options.json);
  }
  if (options.svg && AreSameFile(*options.svg, options.points)) {
    refuse("POINTS and --svg", *options.svg);
  }
}

}  // namespace

std::optional<Options> ParseCommandLine(int argc, char const* const* argv, std::string* message) {
  CLI::App program(kProgramText, "contour");
  program.set_version_flag("--version", "contour " CONTOUR_VERSION);
  program.require_subcommand(1);
  program.footer("Run 'contour fit --help' for the options and exit codes of a fit.");
  Options options;
  CLI::App* const fit = program.add_subcommand("fit", kFitText);
  AddFit(fit, &options);
  try {
    program.parse(argc, argv);
  } catch (CLI::ParseError const& error) {
    std::ostringstream out;
    std::ostringstream err;
    if (program.exit(error, out, err) != 0) {
      throw Failure(ExitCode::Usage, std::string(error.what()) + "\nRun 'contour " +
                                         (fit->parsed() ? "fit " : "") + "--help' for the usage.");
    }
    *message = out.str();
    return {};
  }
  RefuseSharedFiles(options);
  return options;
}

}  // namespace Vorn::Cli
