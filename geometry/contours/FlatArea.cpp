#include "geometry/contours/FlatArea.h"

#include <cmath>

#include "math/NumericConstants.h"

namespace Vorn::Flat {

namespace {

using Numeric::kTruncatedPi;

/// The sum with twice the signed area of the straight pieces that start in a run. Nothing when a
/// vertex would lie outside the data.
std::optional<double> WithVertexRun(Data const& data, Run const& run, double sum) {
  std::int64_t const end = run.begin + kVertexStride * run.CountPieces();
  if (run.begin == end) return sum;
  if (!data.Holds(run.begin, end + 1)) return std::nullopt;
  Point from = data.PointAt(run.begin);
  for (std::int64_t next = run.begin + kVertexStride; next <= end; next += kVertexStride) {
    Point const to = data.PointAt(next);
    sum += to.x * from.y - to.y * from.x;
    from = to;
  }
  return sum;
}

/// The sum with the terms of the record that starts at p.
double WithRecord(Data const& data, std::int64_t p, double sum) {
  double const x = data[p];
  double const y = data[p + 1];
  double const cx = data[p + kRecordCentre];
  double const cy = data[p + kRecordCentre + 1];
  double const radius = data[p + kRecordRadius];
  double const start = data[p + kRecordStartAngle];
  double const end = data[p + kRecordEndAngle];
  double const nextX = data[p + kRecordStride];
  double const nextY = data[p + kRecordStride + 1];

  double const radius2 = radius * radius;
  sum += (nextX - cx) * nextY + (nextX - x) * cy + (cx - x) * y + radius2 * (start - end);
  if (!(std::fabs(start - end) >= kTruncatedPi)) return sum;
  // The shorter way round is meant, whatever the record's direction says.
  double const turn = 2.0 * radius2 * kTruncatedPi;
  return start > end ? sum - turn : sum + turn;
}

/// The sum with the records of a run. Nothing when a record would lie outside the data.
std::optional<double> WithRecordRun(Data const& data, Run const& run, double sum) {
  // Deliberate: one double at a time, not one record: every offset of the run is taken as the
  // start of a record. Areas of such runs are compared with values computed this way.
  for (std::int64_t p = run.begin; p < run.end; ++p) {
    if (!data.Holds(p, p + kRecordStride + 1)) return std::nullopt;
    sum = WithRecord(data, p, sum);
  }
  return sum;
}

}  // namespace

std::optional<double> SignedArea(Data const& data, std::vector<std::int32_t> const& indices) {
  double sum = 0.0;
  std::int64_t begin = 0;
  for (std::int32_t const entry : indices) {
    Run const run = RunOf(entry, begin);
    std::optional<double> const grown =
        run.kind == kVertexRun ? WithVertexRun(data, run, sum) : WithRecordRun(data, run, sum);
    if (!grown) return std::nullopt;
    sum = *grown;
    begin = run.end;
  }
  return 0.5 * sum;
}

}  // namespace Vorn::Flat
