#include <cstddef>

#include "geometry/contours/FlatArea.h"
#include "math/NumericConstants.h"

namespace Vorn::Flat {

namespace {

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
bool OfferRun(Data const& data, Run const& run, LowestVertex* lowest) {
  for (std::int64_t q = run.begin; q < run.end; q += run.stride) {
    if (!data.Holds(q, q + 1)) return false;
    lowest->Offer(q, data[q + 1]);
  }
  return true;
}

/// The turn at the lowest vertex v, between its neighbours.
PolyOrientation OrientationAt(Data const& data, std::int64_t prev, std::int64_t v,
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

/// The lowest vertex of all; not found without vertices. Nothing when one lies outside the data.
std::optional<LowestVertex> FindLowest(Data const& data, std::vector<std::int32_t> const& indices) {
  LowestVertex lowest;
  std::int64_t begin = 0;
  for (std::int32_t const entry : indices) {
    Run const run = RunOf(entry, begin);
    if (!OfferRun(data, run, &lowest)) return std::nullopt;
    begin = run.end;
  }
  return lowest;
}

/// The stride of the run that holds an offset; nothing beyond the last run.
std::optional<std::int64_t> StrideAt(std::int64_t offset,
                                     std::vector<std::int32_t> const& indices) {
  std::size_t const run = RunWith(offset, indices);
  if (run == indices.size()) return std::nullopt;
  return LayoutOf(indices[run]).stride;
}

/// The vertex before one at v.
std::optional<std::int64_t> VertexBefore(std::int64_t v, std::vector<std::int32_t> const& indices) {
  if (v <= 0) return Magnitude(indices.back()) - LayoutOf(indices.back()).stride;
  std::optional<std::int64_t> const stride = StrideAt(v - 1, indices);
  if (!stride) return std::nullopt;
  return v - *stride;
}

/// The vertex after one at v.
std::optional<std::int64_t> VertexAfter(std::int64_t v, std::vector<std::int32_t> const& indices) {
  // Deliberate: the stride that decides where the polyline wraps is that of the number of the last
  // run, not of its entry: 8 for a single run, else 2.
  auto const lastRun = static_cast<std::int32_t>(indices.size() - 1);
  if (v == Magnitude(indices.back()) - LayoutOf(lastRun).stride) return 0;
  std::optional<std::int64_t> const stride = StrideAt(v, indices);
  if (!stride) return std::nullopt;
  return v + *stride;
}

}  // namespace

PolyOrientation Orientation(Data const& data, std::vector<std::int32_t> const& indices) {
  if (indices.empty()) return PolyOrientation::OrientationUnknown;
  std::optional<LowestVertex> const lowest = FindLowest(data, indices);
  if (!lowest || !lowest->IsFound()) return PolyOrientation::OrientationUnknown;
  std::optional<std::int64_t> const before = VertexBefore(lowest->offset, indices);
  std::optional<std::int64_t> const after = VertexAfter(lowest->offset, indices);
  if (!before || !after) return PolyOrientation::OrientationUnknown;
  if (!data.Holds(*before, *before + 1) || !data.Holds(*after, *after + 1)) {
    return PolyOrientation::OrientationUnknown;
  }
  return OrientationAt(data, *before, lowest->offset, *after);
}

}  // namespace Vorn::Flat
