// Layout, signed area and orientation of flat polylines.
//
// The area is positive for a polyline that runs clockwise with y up. The orientation looks at the
// lowest vertex only: there the polyline turns the way it runs as a whole.

#include <cmath>

#include "geometry/contours/PolylineLayout.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Flat::Magnitude;
using Numeric::kTruncatedPi;

namespace {

/// Adds twice the signed area of the straight pieces that start in [begin, end). False when a
/// vertex would lie outside the data.
bool AddVertexRun(Flat::Data const& data, std::int64_t begin, std::int64_t end, double* sum) {
  for (std::int64_t i = begin; i < end; i += Flat::kVertexStride) {
    std::int64_t const next = i + Flat::kVertexStride;
    if (!data.Holds(i, next + 1)) return false;
    *sum += data[next] * data[i + 1] - data[next + 1] * data[i];
  }
  return true;
}

/// Adds the terms of the records that start at p.
void AddRecord(Flat::Data const& data, std::int64_t p, double* sum) {
  double const x = data[p];
  double const y = data[p + 1];
  double const cx = data[p + Flat::kRecordCenter];
  double const cy = data[p + Flat::kRecordCenter + 1];
  double const radius = data[p + Flat::kRecordRadius];
  double const start = data[p + Flat::kRecordStartAngle];
  double const end = data[p + Flat::kRecordEndAngle];
  double const nextX = data[p + Flat::kRecordStride];
  double const nextY = data[p + Flat::kRecordStride + 1];

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
bool AddRecordRun(Flat::Data const& data, std::int64_t begin, std::int64_t end, double* sum) {
  // Deliberate: one double at a time, not one record: every offset of the run is taken as the
  // start of a record. Areas of such runs are compared with values computed this way.
  for (std::int64_t p = begin; p < end; ++p) {
    if (!data.Holds(p, p + Flat::kRecordStride + 1)) return false;
    AddRecord(data, p, sum);
  }
  return true;
}

/// The lowest vertex seen so far, the first one among equals.
struct LowestVertex {
  std::int64_t offset = -1;
  double y = 0.0;

  bool IsFound() const { return offset >= 0; }

  void Offer(std::int64_t candidate, double candidateY) {
    if (IsFound() && !(candidateY < y)) return;
    offset = candidate;
    y = candidateY;
  }
};

/// Offers the vertices of a run. False when one would lie outside the data.
bool OfferRun(Flat::Data const& data, std::int64_t begin, std::int64_t end, std::int64_t stride,
              LowestVertex* lowest) {
  for (std::int64_t q = begin; q < end; q += stride) {
    if (!data.Holds(q, q + 1)) return false;
    lowest->Offer(q, data[q + 1]);
  }
  return true;
}

/// The turn at the lowest vertex v, between its neighbours.
PolyOrientation OrientationAt(Flat::Data const& data, std::int64_t prev, std::int64_t v,
                              std::int64_t next) {
  double const prevDx = data[prev] - data[v];
  double const nextDx = data[next] - data[v];
  int const prevSide = Numeric::Sign(prevDx);
  int const nextSide = Numeric::Sign(nextDx);
  if (prevSide != nextSide) {
    return prevSide < nextSide ? PolyOrientation::Ccw : PolyOrientation::Cw;
  }
  if (prevSide == 0) return PolyOrientation::OrientationDegenerate;
  double const prevSlope = (data[prev + 1] - data[v + 1]) / prevDx;
  double const nextSlope = (data[next + 1] - data[v + 1]) / nextDx;
  return prevSlope > nextSlope ? PolyOrientation::Ccw : PolyOrientation::Cw;
}

}  // namespace

bool GeometryUtils::GetPolylineParam(std::int32_t entry, PolylineParam* param) {
  // Zero counts with the negative entries.
  *param = entry < 1 ? PolylineParam{Flat::kRecordRun, Flat::kRecordStride}
                     : PolylineParam{Flat::kVertexRun, Flat::kVertexStride};
  return true;
}

std::uint32_t GeometryUtils::GetIncrement(std::int32_t entry) {
  PolylineParam param;
  GetPolylineParam(entry, &param);
  return static_cast<std::uint32_t>(param.stride);
}

bool GeometryUtils::GetIndicesIndex(std::vector<std::int32_t> const& indices, std::uint32_t offset,
                                    std::uint32_t* k) {
  for (std::size_t i = 0; i < indices.size(); ++i) {
    if (std::int64_t{offset} < Magnitude(indices[i])) {
      *k = static_cast<std::uint32_t>(i);
      return true;
    }
  }
  return false;
}

ErrorCode GeometryUtils::GetArea(std::vector<double> const& coords,
                                 std::vector<std::int32_t> const& indices, double* area) {
  Flat::Data const data(coords);
  double sum = 0.0;
  std::int64_t begin = 0;
  for (std::int32_t const entry : indices) {
    PolylineParam param;
    GetPolylineParam(entry, &param);
    std::int64_t const end = Magnitude(entry);
    bool const isInside = param.kind == Flat::kVertexRun ? AddVertexRun(data, begin, end, &sum)
                                                         : AddRecordRun(data, begin, end, &sum);
    if (!isInside) return ErrorCode::Failed;
    begin = end;
  }
  if (area == nullptr) return ErrorCode::Failed;
  *area = 0.5 * sum;
  return ErrorCode::Ok;
}

PolyOrientation GeometryUtils::GetPolyOrientation(std::vector<double> const& coords,
                                                  std::vector<std::int32_t> const& indices) {
  if (indices.empty()) return PolyOrientation::OrientationUnknown;
  Flat::Data const data(coords);
  LowestVertex lowest;
  std::int64_t begin = 0;
  for (std::int32_t const entry : indices) {
    std::int64_t const end = Magnitude(entry);
    if (!OfferRun(data, begin, end, GetIncrement(entry), &lowest)) {
      return PolyOrientation::OrientationUnknown;
    }
    begin = end;
  }
  if (!lowest.IsFound()) return PolyOrientation::OrientationUnknown;

  auto const strideOfRunWith = [&indices](std::int64_t offset, std::int64_t* stride) {
    std::uint32_t run = 0;
    if (!GetIndicesIndex(indices, static_cast<std::uint32_t>(offset), &run)) return false;
    *stride = GetIncrement(indices[run]);
    return true;
  };
  std::int64_t const v = lowest.offset;
  std::int64_t const length = Magnitude(indices.back());
  std::int64_t stride = 0;

  std::int64_t prev = length - GetIncrement(indices.back());
  if (v > 0) {
    if (!strideOfRunWith(v - 1, &stride)) return PolyOrientation::OrientationUnknown;
    prev = v - stride;
  }
  // Deliberate: the stride that decides where the polyline wraps is that of the number of the last
  // run, not of its entry: 8 for a single run, else 2.
  auto const lastRun = static_cast<std::int32_t>(indices.size() - 1);
  std::int64_t next = 0;
  if (v != length - GetIncrement(lastRun)) {
    if (!strideOfRunWith(v, &stride)) return PolyOrientation::OrientationUnknown;
    next = v + stride;
  }
  if (!data.Holds(prev, prev + 1) || !data.Holds(next, next + 1)) {
    return PolyOrientation::OrientationUnknown;
  }
  return OrientationAt(data, prev, v, next);
}

}  // namespace Vorn
