// Members for the circle cells of three measured points.

#include "geometry/cells/CircleCells.h"

#include <vector>

#include "vorn/GeometryUtils.h"

namespace Vorn {

ErrorCode GeometryUtils::GetCirclePolygon(WPoint first, WPoint middle, WPoint last, bool firstFixed,
                                          bool lastFixed, int orientation, int* vertexCount,
                                          Point2D<double>* const vertices) {
  Cells::CircleCellCorners corners;
  ErrorCode const code =
      Cells::FindCorners({first, middle, last, firstFixed, lastFixed, orientation}, &corners);
  if (code != ErrorCode::Ok) return code;
  for (std::size_t i = 0; i < corners.size(); ++i) vertices[i] = {corners[i].x, corners[i].y};
  *vertexCount = static_cast<int>(corners.size());
  return ErrorCode::Ok;
}

ErrorCode GeometryUtils::GetCircleTriangles(WPoint first, WPoint middle, WPoint last,
                                            bool firstFixed, bool lastFixed, int orientation,
                                            std::vector<Triangle>* triangles) {
  Cells::CircleCell cell;
  ErrorCode const code =
      Cells::FindCircleCell({first, middle, last, firstFixed, lastFixed, orientation}, &cell);
  triangles->insert(triangles->end(), cell.begin(), cell.end());
  return code;
}

}  // namespace Vorn
