#include "vorn/io/FileMeasure.h"

#include <algorithm>

#include "io/formats/GCode.h"
#include "vorn/io/Deviations.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Formats.h"

namespace Vorn::IO {

namespace {

/// One more digit divides the error by ten; with so many more than the tolerance asks for, rounding
/// is no longer what takes a point out.
constexpr int kMostExtraDecimals = 8;

double SmallestTolerance(std::vector<WPoint> const& points) {
  return std::min_element(points.begin(), points.end(),
                          [](WPoint const& a, WPoint const& b) { return a.w < b.w; })
      ->w;
}

/// Nothing when the contour cannot be written with these digits.
std::optional<std::string> GCodeWith(int decimals, ContourFile const& contour,
                                     GCodeOptions options) {
  options.decimals = decimals;
  try {
    return ToGCode(contour, options);
  } catch (Failure const&) {
    return {};
  }
}

}  // namespace

FileMeasure MeasureText(std::string_view text, Format format, std::vector<WPoint> const& points) {
  FileMeasure measure;
  try {
    ContourFile const contour = ParseContour(text, "the file", format);
    Remeasured const remeasured = Remeasure(points, contour.pieces);
    measure.relative = remeasured.Worst().relative;
    measure.point = remeasured.worst;
    measure.isWithin = AreWithinTolerance(remeasured, points);
  } catch (Failure const& failure) {
    measure.unreadable = failure.what();
  }
  return measure;
}

std::string ToTextFor(std::vector<WPoint> const& points, ContourFile const& contour, Format format,
                      WriteOptions options) {
  if (format != Format::GCode) return ToText(contour, format, options);
  options.gcode.tolerance = SmallestTolerance(points);
  bool const isWithin = AreWithinTolerance(Remeasure(points, contour.pieces), points);
  int const first = GCodeDecimals(contour.units, options.gcode.tolerance);
  if (!options.gcode.decimals && isWithin) {
    int const last = std::min(first + kMostExtraDecimals, kMostGCodeDecimals);
    for (int decimals = first; decimals <= last; ++decimals) {
      auto const text = GCodeWith(decimals, contour, options.gcode);
      if (text && MeasureText(*text, format, points).IsWithin()) return *text;
    }
  }
  return ToText(contour, format, options);
}

}  // namespace Vorn::IO
