#include "io/pieces/Nesting.h"

#include <algorithm>

namespace Vorn::IO {

namespace {

/// Whether a ray from the place to the right crosses the stretch from a to b.
bool IsCrossed(XY const& a, XY const& b, XY const& place) {
  if ((a.y > place.y) == (b.y > place.y)) return false;
  return a.x + (place.y - a.y) / (b.y - a.y) * (b.x - a.x) > place.x;
}

bool Encloses(ContourFile const& outline, XY const& place) {
  constexpr int kPartsOfArc = 64;
  bool isInside = false;
  for (Piece const& piece : outline.pieces) {
    int const parts = piece.IsArc() ? kPartsOfArc : 1;
    XY from = piece.start;
    for (int i = 1; i <= parts; ++i) {
      XY const to = i == parts ? piece.end : PointOnArc(piece, piece.sweep * i / parts);
      if (IsCrossed(from, to, place)) isInside = !isInside;
      from = to;
    }
  }
  return isInside;
}

bool IsInBox(XY const& place, Extent const& box) {
  return place.x >= box.low.x && place.x <= box.high.x && place.y >= box.low.y &&
         place.y <= box.high.y;
}

}  // namespace

std::vector<std::vector<std::size_t>> ContainersOf(std::vector<ContourFile> const& outlines) {
  std::vector<Extent> boxes;
  boxes.reserve(outlines.size());
  for (ContourFile const& outline : outlines) boxes.push_back(ExtentOf(outline.pieces));
  std::vector<std::vector<std::size_t>> containers(outlines.size());
  for (std::size_t i = 0; i < outlines.size(); ++i) {
    if (!outlines[i].isClosed) continue;
    XY const& place = outlines[i].pieces.front().start;
    for (std::size_t k = 0; k < outlines.size(); ++k) {
      bool const mayBeAround = k != i && outlines[k].isClosed && IsInBox(place, boxes[k]);
      if (mayBeAround && Encloses(outlines[k], place)) containers[i].push_back(k);
    }
  }
  return containers;
}

std::vector<Face> FacesOf(std::vector<ContourFile> const& outlines) {
  std::vector<std::vector<std::size_t>> const containers = ContainersOf(outlines);
  std::vector<Face> faces;
  std::vector<std::size_t> faceOf(outlines.size());
  for (std::size_t i = 0; i < outlines.size(); ++i) {
    if (!outlines[i].isClosed || containers[i].size() % 2 != 0) continue;
    faceOf[i] = faces.size();
    faces.push_back({i, {}});
  }
  for (std::size_t i = 0; i < outlines.size(); ++i) {
    if (containers[i].size() % 2 == 0) continue;
    auto const innermost = std::max_element(
        containers[i].begin(), containers[i].end(),
        [&](std::size_t a, std::size_t b) { return containers[a].size() < containers[b].size(); });
    faces[faceOf[*innermost]].holes.push_back(i);
  }
  return faces;
}

}  // namespace Vorn::IO
