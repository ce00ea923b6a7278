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

/// The closed outlines in ascending order of what `key` says of each.
template <typename Key>
std::vector<std::size_t> ClosedBy(std::vector<ContourFile> const& outlines, Key const& key) {
  std::vector<std::size_t> order;
  for (std::size_t i = 0; i < outlines.size(); ++i) {
    if (outlines[i].isClosed) order.push_back(i);
  }
  std::sort(order.begin(), order.end(),
            [&](std::size_t a, std::size_t b) { return key(a) < key(b); });
  return order;
}

}  // namespace

// Goes through the starts of the outlines from left to right and keeps the boxes that have begun
// and not ended there, so that outlines side by side are not compared with each other.
std::vector<std::vector<std::size_t>> ContainersOf(std::vector<ContourFile> const& outlines) {
  std::vector<Extent> boxes;
  boxes.reserve(outlines.size());
  for (ContourFile const& outline : outlines) boxes.push_back(ExtentOf(outline.pieces));
  auto const startOf = [&](std::size_t i) -> XY { return outlines[i].pieces.front().start; };
  auto const byBox = ClosedBy(outlines, [&](std::size_t i) { return boxes[i].low.x; });
  auto const byStart = ClosedBy(outlines, [&](std::size_t i) { return startOf(i).x; });
  std::vector<std::vector<std::size_t>> containers(outlines.size());
  std::vector<std::size_t> reached;
  auto next = byBox.begin();
  for (std::size_t const i : byStart) {
    XY const place = startOf(i);
    while (next != byBox.end() && boxes[*next].low.x <= place.x) reached.push_back(*next++);
    std::erase_if(reached, [&](std::size_t k) { return boxes[k].high.x < place.x; });
    for (std::size_t const k : reached) {
      bool const mayBeAround = k != i && IsInBox(place, boxes[k]);
      if (mayBeAround && Encloses(outlines[k], place)) containers[i].push_back(k);
    }
    std::sort(containers[i].begin(), containers[i].end());
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
