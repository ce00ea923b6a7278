// Fits measured points and prints the contour: a straight edge that runs into a fillet.

#include <cmath>
#include <cstdint>
#include <cstdio>
#include <vector>

#include "vorn/GeometryUtils.h"

using Vorn::GeometryUtils;

int main() {
  std::vector<Vorn::WPoint> points;  // x, y and the tolerance of each point
  for (int i = 0; i < 10; ++i) points.push_back({1.0 * i, 2.0, 0.01});
  for (int i = 0; i <= 15; ++i) {
    points.push_back({10.0 + 5.0 * std::sin(0.1 * i), 7.0 - 5.0 * std::cos(0.1 * i), 0.01});
  }

  std::vector<GeometryUtils::Elem> contour;
  double deviation = 0.0;
  std::int32_t index = -1;
  Vorn::ErrorCode const code = GeometryUtils::CreateFittingCurve(
      points, GeometryUtils::FittingStrategy::Mixed, &contour, &deviation, &index, nullptr, 100);
  if (code != Vorn::ErrorCode::Ok) {
    std::printf("no contour: code %d\n", static_cast<int>(code));
    return 1;
  }

  // The first element only says where the contour starts.
  std::printf("start   (%.2f, %.2f)\n", contour.front().end.x, contour.front().end.y);
  for (std::size_t i = 1; i < contour.size(); ++i) {
    GeometryUtils::Elem const& piece = contour[i];
    if (piece.type == GeometryUtils::ElemType::Segment) {
      std::printf("segment to (%.2f, %.2f)\n", piece.end.x, piece.end.y);
    } else {
      std::printf("arc     to (%.2f, %.2f), centre (%.2f, %.2f), radius %.2f\n", piece.end.x,
                  piece.end.y, piece.center.x, piece.center.y, piece.radius);
    }
  }
  std::printf("%zu points, %zu pieces, largest deviation %.2f of the tolerance\n", points.size(),
              contour.size() - 1, deviation);
  return 0;
}
