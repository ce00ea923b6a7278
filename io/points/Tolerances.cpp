#include "vorn/io/Tolerances.h"

#include <algorithm>

#include "vorn/io/Failure.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/Spacing.h"
#include "vorn/io/SpacingFailure.h"

namespace Vorn::IO {

namespace {

/// With 0.3 of the spacing on both sides, 1.5 times the sum is at most 0.9 of it.
constexpr double kShareOfSpacing = 0.3;

void AssignOne(double tolerance, PointFile* file) {
  for (WPoint& point : file->points) point.w = tolerance;
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
    if (!isGood) {
      CloseNeighbours neighbours;
      neighbours.pair = {i, k, 0.0, 0.0};
      neighbours.tolerance.cap = cap;
      throw SpacingFailure::Coinciding(*file, neighbours);
    }
    points[i].w = std::min(points[i].w, most);
    points[k].w = std::min(points[k].w, most);
  };
  for (std::size_t i = 1; i < points.size(); ++i) limit(i - 1, i);
  if (!isClosed || points.empty()) return;
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
    return "given for all points";
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

}  // namespace Vorn::IO
