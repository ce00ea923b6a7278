// Triangles, their crossings and overlaps, and the cells made of them: the library against a plain
// second implementation, bit for bit.
#include <vector>

#include "Input.h"
#include "Require.h"
#include "support/Bits.h"
#include "support/ReferenceCells.h"
#include "support/ReferenceOverlap.h"
#include "support/ReferenceTriangles.h"
#include "support/Transcript.h"

namespace Vorn::Fuzz {
namespace {

namespace Reference = Testing::Reference;
using Cell = std::vector<GeometryUtils::Triangle>;
using Testing::Transcript;

std::string TextOf(Cell const& cell) {
  Transcript transcript;
  transcript.Add("cell", cell);
  return transcript.Text();
}

void CompareOverlap(GeometryUtils::Triangle const& first, Cell const& cell) {
  Cell found;
  Cell expected;
  Require(GeometryUtils::GetOverlapping(first, &cell, &found) ==
              Reference::Overlap(first, cell, &expected),
          "the overlap of a triangle and a cell ends alike");
  Require(TextOf(found) == TextOf(expected), "the overlap of a triangle and a cell is the same");
}

void ComparePointStatus(GeometryUtils::Point const& p, GeometryUtils::Triangle const& triangle) {
  Require(GeometryUtils::GetPointStatus(p, triangle) == Reference::StatusOf(p, triangle),
          "a point has the same place in a triangle");
}

void CompareLineCell(WPoint const& a, WPoint const& b) {
  Cell found;
  Cell expected;
  bool isFixed[2] = {false, false};
  bool isSwapped[2] = {false, false};
  ErrorCode const code = GeometryUtils::GetLineTriangles(a, b, &isFixed[0], &isSwapped[0], &found);
  Require(code == Reference::LineCell(a, b, &isFixed[1], &isSwapped[1], &expected),
          "line cells end alike");
  Require(TextOf(found) == TextOf(expected), "line cells are the same");
  Require(isFixed[0] == isFixed[1] && isSwapped[0] == isSwapped[1], "line cells have one form");
  if (code != ErrorCode::Ok) Require(found.empty(), "a failed line cell writes nothing");
}

void CompareCirclePolygon(WPoint const (&triple)[3], bool isFirstFixed, bool isLastFixed,
                          int orientation) {
  int count = 0;
  Point2D<double> found[6];
  std::vector<GeometryUtils::Point> expected;
  ErrorCode const code = GeometryUtils::GetCirclePolygon(
      triple[0], triple[1], triple[2], isFirstFixed, isLastFixed, orientation, &count, found);
  Require(code == Reference::CirclePolygon(triple[0], triple[1], triple[2], isFirstFixed,
                                           isLastFixed, orientation, &expected),
          "circle cells end alike");
  Require(static_cast<std::size_t>(count) == expected.size(), "circle cells have as many vertices");
  for (std::size_t i = 0; i < expected.size(); ++i) {
    Require(Testing::SameBits(found[i].x, expected[i].x) &&
                Testing::SameBits(found[i].y, expected[i].y),
            "circle cells have the same vertices");
  }
}

WPoint MeasuredPoint(Input* input) {
  double const x = input->Number();
  double const y = input->Number();
  return {x, y, input->Number()};
}

}  // namespace
}  // namespace Vorn::Fuzz

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size) {
  namespace Fuzz = Vorn::Fuzz;
  Fuzz::Input input(data, size);
  Vorn::GeometryUtils::Triangle const first = input.TriangleOnGrid();
  Fuzz::Cell cell;
  for (int count = input.Integer(0, 12); count > 0; --count) cell.push_back(input.TriangleOnGrid());
  Fuzz::CompareOverlap(first, cell);
  Fuzz::ComparePointStatus(input.PointOnGrid(), first);
  Vorn::WPoint const triple[3] = {Fuzz::MeasuredPoint(&input), Fuzz::MeasuredPoint(&input),
                                  Fuzz::MeasuredPoint(&input)};
  Fuzz::CompareLineCell(triple[0], triple[1]);
  bool const isFirstFixed = input.Flip();
  bool const isLastFixed = input.Flip();
  Fuzz::CompareCirclePolygon(triple, isFirstFixed, isLastFixed, input.Integer(-1, 1));
  return 0;
}
