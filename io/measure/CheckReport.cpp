#include "vorn/io/CheckReport.h"

#include <algorithm>
#include <numeric>
#include <utility>

#include "vorn/io/ContourArea.h"

namespace Vorn::IO {

namespace {

/// The library measures relative deviations; without tolerances those of 1 make it lengths.
std::vector<WPoint> WithUnitTolerances(std::vector<WPoint> points) {
  for (WPoint& point : points) point.w = 1.0;
  return points;
}

std::size_t IndexOfFurthest(std::vector<PointDeviation> const& deviations) {
  return static_cast<std::size_t>(
      std::max_element(deviations.begin(), deviations.end(),
                       [](PointDeviation const& a, PointDeviation const& b) {
                         return a.distance < b.distance;
                       }) -
      deviations.begin());
}

std::vector<std::size_t> IndicesOutside(std::vector<PointDeviation> const& deviations,
                                        std::vector<WPoint> const& points) {
  std::vector<std::size_t> outside;
  for (std::size_t i = 0; i < deviations.size(); ++i) {
    if (!IsWithinTolerance(deviations[i], points[i])) outside.push_back(i);
  }
  return outside;
}

}  // namespace

std::vector<std::size_t> CheckReport::WorstFirst() const {
  std::vector<std::size_t> order(deviations.size());
  std::iota(order.begin(), order.end(), std::size_t{0});
  std::stable_sort(order.begin(), order.end(), [this](std::size_t a, std::size_t b) {
    return deviations[a].relative > deviations[b].relative;
  });
  return order;
}

double SignedDistance(PointDeviation const& deviation) {
  return deviation.isLeft ? deviation.distance : 0.0 - deviation.distance;
}

CheckReport MakeCheckReport(PointFile file, std::string toleranceSource, ContourFile contour) {
  CheckReport report;
  report.file = std::move(file);
  report.contour = std::move(contour);
  report.toleranceSource = std::move(toleranceSource);
  Remeasured remeasured =
      report.HasTolerances()
          ? Remeasure(report.file.points, report.contour.pieces)
          : Remeasure(WithUnitTolerances(report.file.points), report.contour.pieces);
  report.deviations = std::move(remeasured.points);
  report.worst = remeasured.worst;
  report.furthest = IndexOfFurthest(report.deviations);
  if (report.HasTolerances())
    report.outside = IndicesOutside(report.deviations, report.file.points);
  report.gaps = FindGaps(report.contour);
  report.meetings = SelfIntersectionsOf(report.contour);
  if (report.contour.isClosed && Tally(report.meetings).crossings == 0) {
    report.signedArea = SignedAreaOf(report.contour);
  }
  return report;
}

}  // namespace Vorn::IO
