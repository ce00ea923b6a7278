// Standalone members: no other operation of the library uses them. The layout of flat polylines,
// entry by entry, and the sense in which they run.

#include <cstddef>
#include <cstdint>

#include "geometry/contours/FlatArea.h"
#include "geometry/contours/FlatLayout.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

bool GeometryUtils::GetPolylineParam(std::int32_t entry, PolylineParam* param) {
  *param = Flat::LayoutOf(entry);
  return true;
}

std::uint32_t GeometryUtils::GetIncrement(std::int32_t entry) {
  return static_cast<std::uint32_t>(Flat::LayoutOf(entry).stride);
}

bool GeometryUtils::GetIndicesIndex(std::vector<std::int32_t> const& indices, std::uint32_t offset,
                                    std::uint32_t* k) {
  std::size_t const run = Flat::RunWith(offset, indices);
  if (run == indices.size()) return false;
  *k = static_cast<std::uint32_t>(run);
  return true;
}

PolyOrientation GeometryUtils::GetPolyOrientation(std::vector<double> const& coords,
                                                  std::vector<std::int32_t> const& indices) {
  return Flat::Orientation(Flat::Data(coords), indices);
}

}  // namespace Vorn
