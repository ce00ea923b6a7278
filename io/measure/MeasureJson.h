#pragma once

#include <nlohmann/json.hpp>
#include <optional>

#include "vorn/io/PieceMeasures.h"
#include "vorn/io/ReportHead.h"

/// The parts that the JSON of a fit and the data of the HTML page have in common.
namespace Vorn::IO {

/// The number, or null.
nlohmann::ordered_json OrNull(std::optional<double> const& value);

/// Line or circle of least squares of the points of a piece; null where there is none.
nlohmann::ordered_json LeastSquaresJson(PieceMeasure const& measure);

/// Ranges with their counts, from the lowest to the highest.
nlohmann::ordered_json HistogramJson(DeviationSummary const& summary);

/// The fields by their names, in their order.
nlohmann::ordered_json FieldsJson(ReportHead const& head);

}  // namespace Vorn::IO
