// Contours and flat polylines: the search for self-intersections against the plain walk over all
// pairs, areas of the reverse, and the editing of chains.
#include <cmath>
#include <cstdint>
#include <vector>

#include "Input.h"
#include "Require.h"
#include "support/Bits.h"
#include "support/ReferenceSelfIntersection.h"

namespace Vorn::Fuzz {
namespace {

using Contour = std::vector<GeometryUtils::Elem>;
using Point = GeometryUtils::Point;
using Testing::kSentinel;
using Testing::SameBits;

void AppendArc(Input* input, Point const& start, Contour* contour) {
  Point const centre = input->PointOnGrid();
  Point end = input->PointOnGrid();
  // A quarter turn or a half turn about the centre ends exactly on the grid.
  double const dx = start.x - centre.x;
  double const dy = start.y - centre.y;
  switch (input->Byte() % 4) {
    case 0:
      end = {centre.x - dy, centre.y + dx};
      break;
    case 1:
      end = {centre.x - dx, centre.y - dy};
      break;
    case 2:
      end = {centre.x + dy, centre.y - dx};
      break;
    default:
      break;
  }
  GeometryUtils::AddArc(contour, start, end, centre, std::hypot(dx, dy), input->Flip());
}

Contour MakeContour(Input* input) {
  Contour contour;
  Point at = input->PointOnGrid();
  GeometryUtils::AddSegm(&contour, at);
  for (int count = input->Integer(0, 40); count > 0; --count) {
    std::uint8_t const kind = input->Byte();
    if (kind % 3 == 0) {
      AppendArc(input, at, &contour);
    } else if (kind == 254) {
      GeometryUtils::AddSegm(&contour, at);
    } else {
      GeometryUtils::AddSegm(&contour, input->PointOnGrid());
    }
    if (kind == 255) contour.back().type = GeometryUtils::ElemType{7};
    at = contour.back().end;
  }
  return contour;
}

void TrySelfIntersection(Contour const& contour) {
  Require(GeometryUtils::CheckPolySelfIntersection(contour) ==
              Testing::ReferenceCheckOfContour(contour),
          "the search for self-intersections answers what all pairs answer");
}

bool HasSegmentsOnly(Contour const& contour) {
  for (GeometryUtils::Elem const& elem : contour) {
    if (elem.type != GeometryUtils::ElemType::Segment) return false;
  }
  return true;
}

void TryArea(Contour const& contour) {
  double area = kSentinel;
  ErrorCode const code = GeometryUtils::GetArea(contour, &area);
  if (code != ErrorCode::Ok) {
    Require(SameBits(area, kSentinel), "no area, nothing written");
    return;
  }
  if (!HasSegmentsOnly(contour)) return;
  double reversed = kSentinel;
  Contour const back(contour.rbegin(), contour.rend());
  // Which touches at the ends are forgiven depends on the direction.
  if (GeometryUtils::GetArea(back, &reversed) != ErrorCode::Ok) return;
  // Products of coordinates on the grid are exact.
  Require(area == -reversed, "the area of the reverse is the negated one");
}

void TrySplit(Contour const& contour, int parts) {
  if (contour.size() < 2 || parts < 1) return;
  Point const& start = contour[contour.size() - 2].end;
  std::vector<GeometryUtils::Elem> pieces(static_cast<std::size_t>(parts));
  if (!GeometryUtils::SplitElem(contour.back(), parts, {start.x, start.y}, pieces.data())) return;
  Require(SameBits(pieces.back().end, contour.back().end),
          "the last part ends where the whole does");
}

void TryEditing(Contour contour) {
  Contour const before = contour;
  GeometryUtils::Elem removed;
  if (!GeometryUtils::RemoveElem(&contour, &removed)) {
    Require(contour.size() == before.size(), "what cannot be removed stays");
    return;
  }
  Require(contour.size() + 1 == before.size(), "one element is removed");
  Require(SameBits(removed.end, before.back().end), "the removed element is the last one");
}

void TryFlatPolyline(Input* input) {
  std::vector<double> coords;
  for (int count = input->Integer(0, 60); count > 0; --count) coords.push_back(input->OnGrid());
  auto const size = static_cast<int>(coords.size());
  std::vector<std::int32_t> indices;
  for (int count = input->Integer(1, 4); count > 0; --count) {
    indices.push_back(input->Integer(-size, size));
  }
  // A last entry equal to the size has the closing vertex appended, which the plain walk does not.
  if (indices.back() == size) indices.back() = size - 1;
  std::vector<double> const before = coords;
  bool isCrossing = false;
  ErrorCode const code = GeometryUtils::CheckPolySelfIntersection(coords, indices, &isCrossing);
  Require(coords == before, "the coordinates are what they were");
  if (coords.empty()) return;
  int const answer = code == ErrorCode::Ok && isCrossing ? Testing::ReferenceFlatCheck::kCrossing
                                                         : static_cast<int>(code);
  Require(answer == Testing::ReferenceFlatCheck(coords, indices).Answer(),
          "the search in flat polylines answers what all pairs answer");
}

}  // namespace
}  // namespace Vorn::Fuzz

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size) {
  namespace Fuzz = Vorn::Fuzz;
  Fuzz::Input input(data, size);
  Fuzz::Contour const contour = Fuzz::MakeContour(&input);
  Fuzz::TrySelfIntersection(contour);
  Fuzz::TryArea(contour);
  Fuzz::TryEditing(contour);
  Fuzz::TrySplit(contour, input.Integer(0, 9));
  Fuzz::TryFlatPolyline(&input);
  return 0;
}
