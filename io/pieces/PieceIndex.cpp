#include "io/pieces/PieceIndex.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>
#include <utility>

#include "io/pieces/Turning.h"
#include "vorn/io/Pieces.h"

namespace Vorn::IO {

namespace {

/// Some thousand times what the few steps of DistanceTo round, in parts of the numbers involved.
constexpr double kRounding = 1e-12;

}  // namespace

PieceIndex::PieceIndex(std::vector<Piece> const& pieces)
    : pieces_(pieces),
      tree_(
          pieces.size(), [&](std::size_t i) { return BoxOf(pieces[i]); }, Joined) {}

PieceIndex::Box PieceIndex::BoxOf(Piece const& piece) {
  Box box{std::min(piece.start.x, piece.end.x), std::max(piece.start.x, piece.end.x),
          std::min(piece.start.y, piece.end.y), std::max(piece.start.y, piece.end.y), 0.0};
  double largest = std::max(
      {std::fabs(box.lowX), std::fabs(box.highX), std::fabs(box.lowY), std::fabs(box.highY)});
  if (piece.IsArc()) {
    GeometryUtils::Point const& center = piece.center;
    auto const include = [&](GeometryUtils::Point const& point) {
      box.lowX = std::min(box.lowX, point.x);
      box.highX = std::max(box.highX, point.x);
      box.lowY = std::min(box.lowY, point.y);
      box.highY = std::max(box.highY, point.y);
    };
    // The arc as its angles have it: its ends need not be exactly on it.
    include(PointOnArc(piece, 0.0));
    include(PointOnArc(piece, piece.sweep));
    using std::numbers::pi;
    if (TurnTo(piece, 0.0) <= piece.sweep) include({center.x + piece.radius, center.y});
    if (TurnTo(piece, pi / 2.0) <= piece.sweep) include({center.x, center.y + piece.radius});
    if (TurnTo(piece, pi) <= piece.sweep) include({center.x - piece.radius, center.y});
    if (TurnTo(piece, -pi / 2.0) <= piece.sweep) include({center.x, center.y - piece.radius});
    largest = std::max({largest, std::fabs(center.x), std::fabs(center.y)}) + piece.radius;
  }
  box.slack = kRounding * largest;
  return box;
}

PieceIndex::Box PieceIndex::Joined(Box const& a, Box const& b) {
  return {std::min(a.lowX, b.lowX), std::max(a.highX, b.highX), std::min(a.lowY, b.lowY),
          std::max(a.highY, b.highY), std::max(a.slack, b.slack)};
}

/// Written so that what is not a number makes 0, and nothing is passed over.
double PieceIndex::LeastDistance(Box const& box, double x, double y) {
  double const beyondX = std::max({0.0, box.lowX - x, x - box.highX});
  double const beyondY = std::max({0.0, box.lowY - y, y - box.highY});
  double const distance = std::hypot(beyondX, beyondY);
  return distance - kRounding * distance - box.slack;
}

void PieceIndex::Search(std::size_t node, double x, double y, Nearest* nearest) const {
  if (LeastDistance(tree_[node], x, y) > nearest->distance) return;
  if (tree_.IsLeaf(node)) {
    std::size_t const piece = tree_.ItemOf(node);
    double const distance = DistanceTo(pieces_[piece], x, y);
    bool const isEarlier = distance == nearest->distance && piece < nearest->piece;
    if (distance < nearest->distance || isEarlier) *nearest = {piece, distance};
    return;
  }
  std::size_t nearer = 2 * node;
  std::size_t further = 2 * node + 1;
  if (!tree_.Has(nearer)) return;
  if (!tree_.Has(further)) return Search(nearer, x, y, nearest);
  if (LeastDistance(tree_[further], x, y) < LeastDistance(tree_[nearer], x, y)) {
    std::swap(nearer, further);
  }
  Search(nearer, x, y, nearest);
  Search(further, x, y, nearest);
}

PieceIndex::Nearest PieceIndex::Find(double x, double y, std::size_t hint) const {
  Nearest nearest{0, std::numeric_limits<double>::infinity()};
  double const distance = DistanceTo(pieces_[hint], x, y);
  if (distance < nearest.distance) nearest = {hint, distance};
  Search(Tree::kRoot, x, y, &nearest);
  return nearest;
}

}  // namespace Vorn::IO
