#include "io/measure/MeasureJson.h"

namespace Vorn::IO {

namespace {

using Json = nlohmann::ordered_json;

void AddScatter(PieceMeasure const& measure, Json* json) {
  Scatter const* const scatter = measure.ScatterOfPoints();
  (*json)["formError"] = scatter->formError;
  (*json)["standardDeviation"] = OrNull(scatter->standardDeviation);
}

}  // namespace

Json OrNull(std::optional<double> const& value) { return value ? Json(*value) : Json(nullptr); }

Json LeastSquaresJson(PieceMeasure const& measure) {
  Json json = {{"points", measure.points}};
  if (measure.circle) {
    XY const& center = measure.circle->center;
    json["center"] = {{"x", center.x}, {"y", center.y}};
    json["radius"] = measure.circle->radius;
    json["radiusDeviation"] = OrNull(measure.circle->radiusDeviation);
  } else if (measure.line) {
    json["direction"] = measure.line->direction;
    json["directionDeviation"] = OrNull(measure.line->directionDeviation);
  } else {
    return nullptr;
  }
  AddScatter(measure, &json);
  return json;
}

Json HistogramJson(DeviationSummary const& summary) {
  Histogram const& histogram = summary.histogram;
  return {{"kind", summary.isRelative ? "relative" : "absolute"},
          {"low", histogram.low},
          {"width", histogram.width},
          {"counts", histogram.counts},
          {"below", histogram.below},
          {"above", histogram.above}};
}

Json FieldsJson(ReportHead const& head) {
  Json fields = Json::object();
  for (ReportField const& field : head.fields) fields[field.name] = field.value;
  return fields;
}

}  // namespace Vorn::IO
