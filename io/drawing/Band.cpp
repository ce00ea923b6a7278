#include "io/drawing/Band.h"

#include <algorithm>

namespace Vorn::IO::Svg {

namespace {

struct Node {
  double along = 0.0;
  double tolerance = 0.0;
};

std::vector<std::vector<Node>> NodesByPiece(Drawing const& drawing, std::vector<Foot> const& feet) {
  std::vector<std::vector<Node>> nodes(drawing.pieces.size());
  for (std::size_t i = 0; i < feet.size(); ++i) {
    nodes[drawing.deviations[i].piece].push_back({feet[i].along, drawing.points[i].w});
  }
  for (std::vector<Node>& ofPiece : nodes) {
    std::stable_sort(ofPiece.begin(), ofPiece.end(),
                     [](Node const& a, Node const& b) { return a.along < b.along; });
  }
  return nodes;
}

void Append(BandSection const& section, std::vector<BandSection>* sections) {
  bool const isContinued = !sections->empty() && sections->back().piece == section.piece &&
                           sections->back().tolerance == section.tolerance;
  if (isContinued) {
    sections->back().to = section.to;
  } else {
    sections->push_back(section);
  }
}

/// The sections of one piece; answers the tolerance at its end.
double AppendPiece(std::size_t piece, double length, std::vector<Node> const& nodes,
                   double leastLength, double toleranceBefore, std::vector<BandSection>* sections) {
  double from = 0.0;
  double tolerance = nodes.empty() ? toleranceBefore : nodes.front().tolerance;
  double largest = tolerance;
  for (Node const& node : nodes) {
    largest = std::max(largest, node.tolerance);
    tolerance = node.tolerance;
    if (node.along - from < leastLength || node.along <= from) continue;
    Append({piece, from, node.along, largest}, sections);
    from = node.along;
    largest = tolerance;
  }
  if (length > from) Append({piece, from, length, largest}, sections);
  return tolerance;
}

double FirstTolerance(std::vector<std::vector<Node>> const& nodes) {
  for (std::vector<Node> const& ofPiece : nodes) {
    if (!ofPiece.empty()) return ofPiece.front().tolerance;
  }
  return 0.0;
}

}  // namespace

std::vector<BandSection> BandSections(Drawing const& drawing, std::vector<Foot> const& feet,
                                      double leastLength) {
  std::vector<std::vector<Node>> const nodes = NodesByPiece(drawing, feet);
  std::vector<BandSection> sections;
  double tolerance = FirstTolerance(nodes);
  for (std::size_t i = 0; i < drawing.pieces.size(); ++i) {
    tolerance =
        AppendPiece(i, drawing.pieces[i].length, nodes[i], leastLength, tolerance, &sections);
  }
  return sections;
}

}  // namespace Vorn::IO::Svg
