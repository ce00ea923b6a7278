#include "vorn/io/CheckReport.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

std::string ToCsv(CheckReport const& report) {
  std::string text = "point,line,x,y,deviation,piece";
  text += report.HasTolerances() ? ",tolerance,relative\n" : "\n";
  for (std::size_t i = 0; i < report.deviations.size(); ++i) {
    WPoint const& point = report.file.points[i];
    PointDeviation const& deviation = report.deviations[i];
    std::optional<std::size_t> const line = report.file.LineOf(i);
    text += std::to_string(i) + "," + (line ? std::to_string(*line) : "") + "," +
            FormatExact(point.x) + "," + FormatExact(point.y) + "," +
            FormatExact(SignedDistance(deviation)) + "," + std::to_string(deviation.piece + 1);
    if (report.HasTolerances()) {
      text += "," + FormatExact(point.w) + "," + FormatExact(deviation.relative);
    }
    text += "\n";
  }
  return text;
}

}  // namespace Vorn::IO
