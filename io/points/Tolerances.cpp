#include "vorn/io/Tolerances.h"

#include <algorithm>

#include "vorn/io/Failure.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/Spacing.h"

namespace Vorn::IO {

namespace {

/// With 0.3 of the spacing on both sides, 1.5 times the sum is at most 0.9 of it.
constexpr double kShareOfSpacing = 0.3;

/// As many as any decimal text that a user types keeps through a double.
constexpr int kDigits = 15;

void AssignOne(double tolerance, PointFile* file) {
  for (WPoint& point : file->points) point.w = tolerance;
}

[[noreturn]] void RefuseCoinciding(PointFile const& file, std::size_t first, std::size_t second) {
  throw Failure(FailureKind::PointsTooClose, {file.path},
                file.NameOf(first) + " and " + file.NameOf(second) +
                    " coincide: no tolerance can follow from a spacing of zero\n" +
                    "to leave one of them out: contour simplify " + ArgumentFor(file) +
                    " --drop-close");
}

bool RepeatsFirst(std::vector<WPoint> const& points) {
  return points.front().x == points.back().x && points.front().y == points.back().y;
}

void AssignBySpacing(double cap, bool isClosed, Coinciding coinciding, PointFile* file) {
  std::vector<WPoint>& points = file->points;
  for (WPoint& point : points) point.w = cap;
  auto const limit = [&](std::size_t i, std::size_t k) {
    double const most = kShareOfSpacing * Distance(points[i], points[k]);
    bool const isGood = most > 0.0 || coinciding == Coinciding::GivenZero;
    if (!isGood) RefuseCoinciding(*file, i, k);
    points[i].w = std::min(points[i].w, most);
    points[k].w = std::min(points[k].w, most);
  };
  for (std::size_t i = 1; i < points.size(); ++i) limit(i - 1, i);
  if (!isClosed) return;
  WPoint& first = points.front();
  WPoint& last = points.back();
  if (RepeatsFirst(points)) {
    first.w = last.w = std::min(first.w, last.w);
  } else {
    limit(points.size() - 1, 0);
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

std::string AssignTolerances(ToleranceChoice const& choice, PointFile* file, bool isClosed,
                             Coinciding coinciding) {
  if (choice.cap) {
    AssignBySpacing(*choice.cap, isClosed, coinciding, file);
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
  throw Failure(FailureKind::BadArgument, {},
                "no tolerance: " + file->path + " has no column 'w' and no comment '# tolerance T'",
                Remedy::GiveTolerance);
}

std::string OptionsFor(ToleranceChoice const& choice) {
  if (choice.cap) return "--tolerance-per-point " + FormatShort(*choice.cap, kDigits);
  if (choice.same) return "-t " + FormatShort(*choice.same, kDigits);
  if (choice.column) return "--tolerance-column " + ShellQuoted(*choice.column);
  return "";
}

}  // namespace Vorn::IO
