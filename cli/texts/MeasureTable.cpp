#include "cli/texts/MeasureTable.h"

#include <numbers>

#include "cli/texts/Columns.h"
#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

namespace {

constexpr int kAngleDecimals = 3;
constexpr double kDegreesPerRadian = 180.0 / std::numbers::pi;
constexpr int kDeviationDigits = 2;
constexpr char const* kNothing = "-";

constexpr char const* kHeading =
    "Measured by least squares over the points of each piece, angles in degrees. A radius of the\n"
    "contour is one of those that the tolerance admits; the one here is that of the points.\n\n";

std::string Degrees(double radians) {
  return FormatFixed(radians * kDegreesPerRadian, kAngleDecimals);
}

template <typename Show>
std::string OrNothing(std::optional<double> const& value, Show const& show) {
  return value ? show(*value) : kNothing;
}

/// Radius, direction and the standard deviation of the one that is there.
Row FittedCells(PieceMeasure const& measure, LengthFormat const& length) {
  auto const few = [](double value) { return FormatShort(value, kDeviationDigits); };
  auto const fewDegrees = [&](double value) { return few(value * kDegreesPerRadian); };
  if (measure.circle) {
    return {length(measure.circle->radius), kNothing,
            OrNothing(measure.circle->radiusDeviation, few)};
  }
  if (measure.line) {
    return {kNothing, Degrees(measure.line->direction),
            OrNothing(measure.line->directionDeviation, fewDegrees)};
  }
  return {kNothing, kNothing, kNothing};
}

Row ScatterCells(PieceMeasure const& measure, LengthFormat const& length) {
  Scatter const* const scatter = measure.ScatterOfPoints();
  auto const finer = [&](double value) { return length.Finer(value); };
  if (scatter == nullptr) return {kNothing, kNothing};
  return {finer(scatter->formError), OrNothing(scatter->standardDeviation, finer)};
}

}  // namespace

std::string MeasureTable(std::vector<Piece> const& pieces,
                         std::vector<PieceMeasure> const& measures, LengthFormat const& length) {
  std::vector<Row> rows = {{"no", "kind", "points", "radius", "direction", "+-", "form error",
                            "deviation", "turn to next"}};
  for (std::size_t i = 0; i < measures.size(); ++i) {
    Row row = {std::to_string(i + 1), pieces[i].IsArc() ? "arc" : "line",
               std::to_string(measures[i].points)};
    for (Row const& cells : {FittedCells(measures[i], length), ScatterCells(measures[i], length)}) {
      row.insert(row.end(), cells.begin(), cells.end());
    }
    row.push_back(OrNothing(measures[i].turn, Degrees));
    rows.push_back(row);
  }
  return kHeading + Aligned(rows, {"kind"});
}

}  // namespace Vorn::Cli
