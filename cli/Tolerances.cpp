#include "cli/Tolerances.h"

#include <algorithm>
#include <limits>

#include "cli/Failure.h"
#include "cli/Numbers.h"
#include "cli/Spacing.h"

namespace Vorn::Cli {

namespace {

/// With 0.3 of the spacing on both sides, 1.5 times the sum is at most 0.9 of it.
constexpr double kShareOfSpacing = 0.3;

void AssignOne(double tolerance, PointFile* file) {
  for (WPoint& point : file->points) point.w = tolerance;
}

void AssignBySpacing(double cap, PointFile* file) {
  std::vector<WPoint>& points = file->points;
  double before = std::numeric_limits<double>::infinity();
  for (std::size_t i = 0; i < points.size(); ++i) {
    double const after = i + 1 < points.size() ? Distance(points[i], points[i + 1])
                                               : std::numeric_limits<double>::infinity();
    points[i].w = std::min(cap, kShareOfSpacing * std::min(before, after));
    if (!(points[i].w > 0.0)) {
      std::size_t const second = after > 0.0 ? i : i + 1;
      throw Failure(ExitCode::PointsTooClose,
                    file->path + ": " + file->NameOf(second - 1) + " and " + file->NameOf(second) +
                        " coincide: no tolerance can follow from a spacing of zero");
    }
    before = after;
  }
}

}  // namespace

ToleranceColumn ColumnFor(ToleranceChoice const& choice) {
  if (choice.column) return {ToleranceColumn::Use::Required, *choice.column};
  if (choice.same || choice.cap) return {ToleranceColumn::Use::Ignore, "w"};
  return {ToleranceColumn::Use::IfPresent, "w"};
}

double ToleranceForSpacing(double cap, double spacing) {
  return std::min(cap, kShareOfSpacing * spacing);
}

bool IsToleranceStated(ToleranceChoice const& choice, PointFile const& file) {
  return choice.same || choice.column || choice.cap || file.hasTolerances || file.tolerance;
}

std::string AssignTolerances(ToleranceChoice const& choice, PointFile* file) {
  if (choice.cap) {
    AssignBySpacing(*choice.cap, file);
    return "0.3 of the spacing, at most " + FormatShort(*choice.cap);
  }
  if (choice.same) {
    AssignOne(*choice.same, file);
    return "given by --tolerance";
  }
  if (file->hasTolerances) return "column " + Quoted(file->toleranceColumn) + " of the file";
  if (file->tolerance) {
    AssignOne(*file->tolerance, file);
    return "comment in the file";
  }
  throw Failure(ExitCode::Usage,
                "no tolerance: give --tolerance T, --tolerance-column NAME or "
                "--tolerance-per-point CAP (" +
                    file->path + " has no column 'w' and no comment '# tolerance T')");
}

}  // namespace Vorn::Cli
