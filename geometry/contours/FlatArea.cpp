#include "geometry/contours/FlatArea.h"

#include <cmath>

#include "math/NumericConstants.h"

namespace Vorn::Flat {

namespace {

using Numeric::kTruncatedPi;

/// Adds twice the signed area of the straight pieces that start in [begin, end). False when a
/// vertex would lie outside the data.
bool AddVertexRun(Data const& data, std::int64_t begin, std::int64_t end, double* sum) {
  for (std::int64_t i = begin; i < end; i += kVertexStride) {
    std::int64_t const next = i + kVertexStride;
    if (!data.Holds(i, next + 1)) return false;
    *sum += data[next] * data[i + 1] - data[next + 1] * data[i];
  }
  return true;
}

/// Adds the terms of the records that start at p.
void AddRecord(Data const& data, std::int64_t p, double* sum) {
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
  *sum += (nextX - cx) * nextY + (nextX - x) * cy + (cx - x) * y + radius2 * (start - end);
  if (!(std::fabs(start - end) >= kTruncatedPi)) return;
  // The shorter way round is meant, whatever the record's direction says.
  double const turn = 2.0 * radius2 * kTruncatedPi;
  if (start > end) {
    *sum -= turn;
  } else {
    *sum += turn;
  }
}

/// Adds the records of a run. False when a record would lie outside the data.
bool AddRecordRun(Data const& data, std::int64_t begin, std::int64_t end, double* sum) {
  // Deliberate: one double at a time, not one record: every offset of the run is taken as the
  // start of a record. Areas of such runs are compared with values computed this way.
  for (std::int64_t p = begin; p < end; ++p) {
    if (!data.Holds(p, p + kRecordStride + 1)) return false;
    AddRecord(data, p, sum);
  }
  return true;
}

}  // namespace

std::optional<double> SignedArea(Data const& data, std::vector<std::int32_t> const& indices) {
  double sum = 0.0;
  std::int64_t begin = 0;
  for (std::int32_t const entry : indices) {
    Run const run = RunOf(entry, begin);
    bool const isInside = run.kind == kVertexRun ? AddVertexRun(data, run.begin, run.end, &sum)
                                                 : AddRecordRun(data, run.begin, run.end, &sum);
    if (!isInside) return std::nullopt;
    begin = run.end;
  }
  return 0.5 * sum;
}

}  // namespace Vorn::Flat
