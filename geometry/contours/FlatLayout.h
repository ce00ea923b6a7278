// The layout of flat polylines: an array of doubles cut into runs by an array of signed entries.
// The magnitude of an entry is the offset of the run's last vertex, which is also where the next
// run starts; its sign chooses how the vertices of the run are laid out.

#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <vector>

#include "geometry/elementary/Points.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Flat {

using Elementary::Point;
using Arc = GeometryUtils::Arc;

/// Kinds of runs, as PolylineParam::kind holds them.
inline constexpr std::int32_t kVertexRun = 0;
inline constexpr std::int32_t kRecordRun = 1;

/// Doubles of a vertex: x, y.
inline constexpr std::int32_t kVertexStride = 2;

/// Doubles of a record: x, y, centre x, centre y, radius, direction, start angle, end angle.
inline constexpr std::int32_t kRecordStride = 8;
inline constexpr std::int64_t kRecordCentre = 2;
inline constexpr std::int64_t kRecordRadius = 4;
inline constexpr std::int64_t kRecordDirection = 5;
inline constexpr std::int64_t kRecordStartAngle = 6;
inline constexpr std::int64_t kRecordEndAngle = 7;

/// The offset that an entry stands for. Offsets are kept in 64 bits: the magnitude of the lowest
/// 32-bit entry does not fit in 32.
inline std::int64_t Magnitude(std::int32_t entry) { return std::abs(std::int64_t{entry}); }

/// The layout of the run of an entry; zero counts with the negative ones.
inline PolylineParam LayoutOf(std::int32_t entry) {
  return entry < 1 ? PolylineParam{kRecordRun, kRecordStride}
                   : PolylineParam{kVertexRun, kVertexStride};
}

/// A run of a flat polyline.
struct Run {
  std::int32_t kind;
  std::int64_t stride;
  std::int64_t begin;
  std::int64_t end;  ///< the offset of the last vertex, where no piece of the run starts

  /// How many pieces start in the run.
  std::int64_t CountPieces() const { return begin < end ? (end - begin + stride - 1) / stride : 0; }
};

/// The run of an entry that starts where the run before ends.
inline Run RunOf(std::int32_t entry, std::int64_t begin) {
  PolylineParam const layout = LayoutOf(entry);
  return {layout.kind, layout.stride, begin, Magnitude(entry)};
}

/// The runs that entries stand for, in their order.
inline std::vector<Run> RunsOf(std::vector<std::int32_t> const& indices) {
  std::vector<Run> runs;
  runs.reserve(indices.size());
  for (std::int32_t const entry : indices) {
    runs.push_back(RunOf(entry, runs.empty() ? 0 : runs.back().end));
  }
  return runs;
}

/// The number of the first run whose magnitude is above an offset; that of the runs when there is
/// none. O(number of runs).
inline std::size_t RunWith(std::int64_t offset, std::vector<std::int32_t> const& indices) {
  std::size_t run = 0;
  while (run < indices.size() && offset >= Magnitude(indices[run])) ++run;
  return run;
}

/// The doubles of a polyline, read by 64-bit offsets. Entries come from the caller unchecked, so
/// every read is preceded by a question whether the data holds it.
class Data {
 public:
  /// The array must stay as it is.
  explicit Data(std::vector<double> const& coords)
      : coords_(coords.data()), size_(static_cast<std::int64_t>(coords.size())) {}

  /// Are all offsets of [first, last] inside?
  bool Holds(std::int64_t first, std::int64_t last) const { return first >= 0 && last < size_; }

  /// The double at an offset that the data holds.
  double operator[](std::int64_t offset) const { return coords_[offset]; }

  /// The point at an offset; the data must hold it and the next one.
  Point PointAt(std::int64_t offset) const { return {coords_[offset], coords_[offset + 1]}; }

  /// The arc of the record at an offset, but for its end point, which intersections do not need.
  Arc ArcAt(std::int64_t offset) const {
    Arc arc;
    arc.center = PointAt(offset + kRecordCentre);
    arc.radius = coords_[offset + kRecordRadius];
    arc.direction = coords_[offset + kRecordDirection];
    arc.startAngle = coords_[offset + kRecordStartAngle];
    arc.endAngle = coords_[offset + kRecordEndAngle];
    return arc;
  }

 private:
  double const* coords_;
  std::int64_t size_;
};

}  // namespace Vorn::Flat
