#include "vorn/io/Numbers.h"
#include "vorn/io/Points.h"

namespace Vorn::IO {

std::string PointFile::NameOf(std::size_t index) const {
  std::string name = "point " + std::to_string(index);
  if (std::optional<std::size_t> const line = LineOf(index)) {
    return name + " (line " + std::to_string(*line) + ")";
  }
  if (path.empty()) return name;
  return name + " at (" + FormatShort(points[index].x) + ", " + FormatShort(points[index].y) + ")";
}

std::optional<std::size_t> PointFile::LineOf(std::size_t index) const {
  return index < lines.size() ? std::optional(lines[index]) : std::nullopt;
}

std::string OutlineSuffix(std::size_t outline) {
  return outline == 0 ? "" : ", outline " + std::to_string(outline);
}

}  // namespace Vorn::IO
