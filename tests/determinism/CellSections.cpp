#include <array>
#include <cstdint>
#include <vector>

#include "determinism/Digest.h"
#include "determinism/Inputs.h"
#include "determinism/Sections.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {

namespace {

using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;

constexpr int kRounds = 3000;

void AddCellsOfLines(Inputs* inputs, Digest* digest) {
  WPoint const a = inputs->Measured();
  WPoint const b = inputs->Measured();
  auto const [x1, y1, x2, y2, r] = inputs->Numbers<5>();
  bool formFixed = inputs->Random().Flip();
  bool xOfY = inputs->Random().Flip();
  std::array<double, 8> rect{};
  std::array<double, 8> otherRect{};
  std::array<Point2D<double>, 4> polygon{};
  std::vector<Triangle> cell;
  std::vector<Triangle> otherCell;
  digest->Add(GeometryUtils::GetPermissibleRect(a, b, rect.data()));
  digest->Add(GeometryUtils::GetPermissibleRect(x1, y1, x2, y2, 0.125 * r, otherRect.data()));
  digest->Add(GeometryUtils::GetLinePolygon(a, b, &formFixed, &xOfY, polygon.data()), xOfY);
  digest->Add(GeometryUtils::GetLineTriangles(a, b, &formFixed, &xOfY, &cell), xOfY, cell);
  digest->Add(
      GeometryUtils::GetLineTriangles(x1, y1, x2, y2, 0.125 * r, &formFixed, &xOfY, &otherCell),
      xOfY, otherCell);
  for (double const value : rect) digest->Add(value);
  for (double const value : otherRect) digest->Add(value);
  for (auto const& vertex : polygon) digest->Add(vertex);
}

void AddCellsOfCircles(Inputs* inputs, Digest* digest) {
  WPoint const a = inputs->Measured();
  WPoint const b = inputs->Measured();
  WPoint const c = inputs->Measured();
  bool const firstFixed = inputs->Random().Integer(0, 3) == 0;
  bool const lastFixed = inputs->Random().Integer(0, 3) == 0;
  int const orientation = inputs->Random().Integer(-1, 1);
  int vertexCount = -1;
  std::array<Point2D<double>, 6> vertices{};
  std::array<double, 12> hexagon{};
  std::vector<Triangle> cell;
  digest->Add(GeometryUtils::GetCirclePolygon(a, b, c, firstFixed, lastFixed, orientation,
                                              &vertexCount, vertices.data()),
              vertexCount);
  digest->Add(GeometryUtils::GetCircleTriangles(a, b, c, firstFixed, lastFixed, orientation, &cell),
              cell);
  digest->Add(GeometryUtils::GetPermissibleHexagon({a.x, a.y}, {b.x, b.y}, {c.x, c.y}, a.w,
                                                   hexagon.data()));
  for (auto const& vertex : vertices) digest->Add(vertex);
  for (double const value : hexagon) digest->Add(value);
}

void AddCentres(Inputs* inputs, Digest* digest) {
  std::vector<Triangle> cell;
  auto const size = static_cast<std::size_t>(inputs->Random().Integer(0, 4));
  for (std::size_t i = 0; i < size; ++i) cell.push_back(inputs->Triangle());
  auto const [p, q] = inputs->Points<2>();
  std::array<double, 4> box{};
  Point centre;
  Point centreForCircle;
  digest->Add(GeometryUtils::GetBoundingRect(&cell, box.data()),
              GeometryUtils::GetCenter(&cell, &centre),
              GeometryUtils::GetCenterForCircle(p, q, &cell, &centreForCircle));
  for (double const value : box) digest->Add(value);
  digest->Add(centre, centreForCircle);
}

}  // namespace

std::uint64_t DigestTriangles() {
  return DigestRounds(201, kRounds, [](Inputs* inputs, Digest* digest) {
    Triangle const first = inputs->Triangle();
    Triangle const second = inputs->Triangle();
    Triangle const third = inputs->Triangle();
    Point const p = inputs->Point();
    Point centre;
    std::vector<GeometryUtils::CrossingPoint> crossings;
    std::vector<Point> ofSide;
    std::vector<Triangle> overlap;
    std::vector<Triangle> cellOverlap;
    std::vector<Triangle> const cell{second, third};
    digest->Add(GeometryUtils::GetArea(first), GeometryUtils::IsValidTriangle(first),
                GeometryUtils::CalcCenter(first, &centre), GeometryUtils::GetPointStatus(p, first));
    GeometryUtils::GetCrossingPoints(first, second, &crossings);
    int const side = inputs->Random().Integer(0, 2);
    digest->Add(GeometryUtils::GetCrossingPoints(first, side, second, &ofSide),
                GeometryUtils::GetOverlapping(first, second, &overlap),
                GeometryUtils::GetOverlapping(first, &cell, &cellOverlap));
    digest->Add(centre, crossings, ofSide, overlap, cellOverlap);
  });
}

std::uint64_t DigestPolygons() {
  return DigestRounds(202, kRounds, [](Inputs* inputs, Digest* digest) {
    int const size = inputs->Random().Integer(3, 7);
    std::vector<Point> polygon;
    for (int i = 0; i < size; ++i) polygon.push_back(inputs->Point());
    Point const p = inputs->Point();
    std::vector<Triangle> triangles;
    int const begin = inputs->Random().Integer(0, size - 1);
    int const cutOff = inputs->Random().Integer(2, size);
    digest->Add(GeometryUtils::SimplePolygonIsValid(polygon, 0, size, cutOff),
                GeometryUtils::PointIsInsideOfPolygon(p, polygon, begin, size),
                GeometryUtils::ConvexPolygonDivide(polygon, 0, size, &triangles), triangles);
  });
}

std::uint64_t DigestCells() {
  return DigestRounds(203, kRounds, [](Inputs* inputs, Digest* digest) {
    AddCellsOfLines(inputs, digest);
    AddCellsOfCircles(inputs, digest);
    AddCentres(inputs, digest);
  });
}

}  // namespace Vorn::Testing
