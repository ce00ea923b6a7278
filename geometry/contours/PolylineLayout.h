#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <vector>

/// The layout of flat polylines: an array of doubles cut into runs by an array of signed entries.
/// The magnitude of an entry is the offset of the run's last vertex, which is also where the next
/// run starts; its sign chooses how the vertices of the run are laid out.
namespace Vorn::Flat {

/// Kinds of runs, as PolylineParam::kind holds them.
inline constexpr std::int32_t kVertexRun = 0;
inline constexpr std::int32_t kRecordRun = 1;

/// x, y
inline constexpr std::int32_t kVertexStride = 2;

/// x, y, centre x, centre y, radius, direction, start angle, end angle
inline constexpr std::int32_t kRecordStride = 8;
inline constexpr std::int64_t kRecordCenter = 2;
inline constexpr std::int64_t kRecordRadius = 4;
inline constexpr std::int64_t kRecordDirection = 5;
inline constexpr std::int64_t kRecordStartAngle = 6;
inline constexpr std::int64_t kRecordEndAngle = 7;

/// Offsets are kept in 64 bits: the magnitude of the lowest 32-bit entry does not fit in 32.
inline std::int64_t Magnitude(std::int32_t entry) { return std::abs(std::int64_t{entry}); }

/// The doubles of a polyline, read by 64-bit offsets. Entries come from the caller unchecked, so
/// every read is preceded by a question whether the data holds it.
class Data {
 public:
  explicit Data(std::vector<double> const& coords) : coords_(&coords) {}

  /// Are all offsets of [first, last] inside?
  bool Holds(std::int64_t first, std::int64_t last) const {
    return first >= 0 && last < static_cast<std::int64_t>(coords_->size());
  }

  double operator[](std::int64_t offset) const {
    return (*coords_)[static_cast<std::size_t>(offset)];
  }

 private:
  std::vector<double> const* coords_;
};

}  // namespace Vorn::Flat
