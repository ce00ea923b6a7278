#include "cli/commands/IntersectCommand.h"

#include <memory>
#include <ostream>

#include "cli/commands/CommonOptions.h"
#include "cli/commands/ContourInput.h"
#include "cli/commands/Outputs.h"
#include "cli/texts/IntersectionText.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Files.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Intersections.h"

namespace Vorn::Cli {

namespace {

constexpr char const* kText =
    "List the points where two contours meet, or where one contour meets itself.";

constexpr char const* kFooter =
    R"(
Contours are read from JSON, CSV, DXF, G-code, WKT, GeoJSON or SVG, told by the name, by --from or
by the content. Gaps between pieces are not bridged. Of a file with several outlines all are taken
together, or that of --outline from A and that of --outline-b from B.

Kinds: crossing, each passes to the other side of the other; touching, they stay on one side, run in
one direction there, or one of them ends there; overlap, they share a stretch, told for each pair of
pieces. What is no further apart than 1e-9 of the largest coordinate touches. Joints of neighbouring
pieces are no intersections of a contour with itself.

The points are sorted along A. Pieces are counted from 1; "at" is the length from the start of the
contour. With -o - the table is not printed.

Exit codes:
  0   the question is answered, whether there are intersections or not
  1   there are some, and --fail-if-any is given
  2   wrong usage
  3   a file cannot be read or written, or holds no contour
  70  internal error
  130 interrupted

Examples:
  contour intersect part.json tool.dxf
  contour intersect part.dxf --fail-if-any
  contour intersect part.json tool.dxf -o points.csv
  contour intersect plate.dxf plate.dxf --outline 1 --outline-b 2
)";

struct Options {
  std::string a;
  std::string b;  ///< empty: the first with itself
  std::optional<Format> from;
  std::optional<int> outline;   ///< of the first file
  std::optional<int> outlineB;  ///< of the second file
  std::optional<double> flattening;
  std::string output;
  bool asJson = false;
  bool failIfAny = false;

  std::vector<NamedFile> Read() const {
    std::vector<NamedFile> files = {{"A", a}};
    if (!b.empty()) files.push_back({"B", b});
    return files;
  }

  std::vector<NamedFile> Written() const {
    if (output.empty()) return {};
    return {{"--output", output}};
  }
};

ExitCode Run(Options const& options, Console const& console) {
  RequireWritable(options.Written());
  ContourFile const a =
      ReadContourInput({options.a, options.from, options.outline, options.flattening}, console);
  std::optional<ContourFile> other;
  if (!options.b.empty())
    other =
        ReadContourInput({options.b, options.from, options.outlineB, options.flattening}, console);
  ContourFile const* const b = other ? &*other : nullptr;
  std::vector<Intersection> const found =
      b == nullptr ? SelfIntersectionsOf(a) : IntersectionsOf(a, *b);
  Outputs outputs;
  if (!options.output.empty()) outputs.Add(options.output, ToCsv(found, a, b));
  outputs.Write(console);
  if (options.output != "-") {
    console.out << (options.asJson ? ToJson(found, a, b) : ToText(found, a, b));
  }
  return options.failIfAny && !found.empty() ? ExitCode::OutsideTolerance : ExitCode::Ok;
}

void AddOptions(Command& command, Options* options) {
  command.AddText("A", &options->a, "FILE", "File with a contour; - is the standard input")
      .Require();
  command.AddText("B", &options->b, "FILE",
                  "File with another contour; without it, A meets itself");
  AddContourFormat(command, &options->from, "Read the contours as this");
  AddOutline(command, &options->outline);
  AddOutline(command, &options->outlineB, "--outline-b");
  AddFlatten(command, &options->flattening);
  command.AddOutput("-o,--output", &options->output,
                    "Write the points to this CSV file; - is the standard output");
  command.AddFlag("--json", &options->asJson, "Write the points as JSON, with every digit");
  command.AddFlag("--fail-if-any", &options->failIfAny, "Exit with 1 when there are intersections");
  command.SetFooter(kFooter);
}

void RefuseBadFiles(Options const& options) {
  if (options.a == kStandardInput && options.b == kStandardInput) {
    throw Failure(FailureKind::BadArgument, "A and B cannot both be the standard input");
  }
  if (options.outlineB && options.b.empty()) {
    throw Failure(FailureKind::BadArgument, "--outline-b is for the file B, and there is none");
  }
  RefuseSharedFiles(options.Read(), options.Written());
}

}  // namespace

void AddIntersectCommand(CommandLine& program, Action* action) {
  Command command = program.AddCommand("intersect", kText);
  auto const options = std::make_shared<Options>();
  AddOptions(command, options.get());
  command.OnParsed([options, action] {
    RefuseBadFiles(*options);
    *action = [options](Console const& console) { return Run(*options, console); };
  });
}

}  // namespace Vorn::Cli
