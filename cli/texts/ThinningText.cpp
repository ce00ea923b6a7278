#include "cli/texts/ThinningText.h"

#include <algorithm>
#include <cmath>

#include "vorn/io/Deviations.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

namespace {

constexpr std::size_t kMostListed = 10;
constexpr std::size_t kMostOutliersListed = 100;

std::string LineText(PointFile const& file, std::size_t point) {
  std::optional<std::size_t> const line = file.LineOf(point);
  return line ? std::to_string(*line) : "";
}

}  // namespace

std::string OutliersText(std::vector<Outlier> const& outliers, PointFile const& file) {
  std::string const begin = "contour: " + file.path + ": ";
  std::string text = begin + Counted(outliers.size(), "outlier") + '\n';
  for (std::size_t i = 0; i < std::min(outliers.size(), kMostOutliersListed); ++i) {
    Outlier const& outlier = outliers[i];
    text += begin + file.NameOf(outlier.point) + " is " + FormatShort(outlier.distance) +
            " from its neighbours, " + FormatShort(outlier.deviations, 3) +
            " standard deviations\n";
  }
  return text;
}

std::string FitOfRestText(FitReport const& report, PointFile const& file,
                          std::vector<WPoint> const& points) {
  Remeasured const all = Remeasure(points, report.pieces);
  double squares = 0.0;
  std::size_t outside = 0;
  for (std::size_t i = 0; i < points.size(); ++i) {
    squares += all.points[i].distance * all.points[i].distance;
    if (!IsWithinTolerance(all.points[i], points[i])) ++outside;
  }
  return "a fit of the rest has " + Counted(report.pieces.size(), "piece") + "; of all " +
         Counted(points.size(), "point") + " of the file " + std::to_string(outside) +
         " are outside their tolerance, the largest deviation is " +
         FormatShort(all.Worst().distance) + ", " + FormatShort(all.Worst().relative) +
         " of the tolerance, at " + file.NameOf(all.worst) + ", the root mean square " +
         FormatShort(std::sqrt(squares / static_cast<double>(points.size())));
}

std::string DroppedList(PointFile const& file, std::vector<std::size_t> const& dropped) {
  std::string text = "point,line,x,y\n";
  for (std::size_t const i : dropped) {
    text += std::to_string(i) + "," + LineText(file, i) + "," + FormatExact(file.points[i].x) +
            "," + FormatExact(file.points[i].y) + "\n";
  }
  return text;
}

std::string DroppedText(PointFile const& file, std::vector<std::size_t> const& dropped) {
  std::string text = "contour: " + file.path + ": dropped " + std::to_string(dropped.size()) +
                     " of " + Counted(file.points.size(), "point");
  for (std::size_t i = 0; i < std::min(dropped.size(), kMostListed); ++i) {
    text += (i == 0 ? ": " : ", ") + file.NameOf(dropped[i]);
  }
  if (dropped.size() > kMostListed) {
    text += " and " + std::to_string(dropped.size() - kMostListed) + " more";
  }
  return text + "\n";
}

std::string PointTable(PointFile const& file, std::vector<WPoint> const& points) {
  std::string text = file.units.empty() ? "" : "# units " + file.units + "\n";
  if (file.tolerance) text += "# tolerance " + FormatExact(*file.tolerance) + "\n";
  text += file.hasTolerances ? "x,y,w\n" : "x,y\n";
  for (WPoint const& point : points) {
    text += FormatExact(point.x) + "," + FormatExact(point.y);
    text += file.hasTolerances ? "," + FormatExact(point.w) + "\n" : "\n";
  }
  return text;
}

}  // namespace Vorn::Cli
