#include "geometry/fewest/Retracing.h"

#include <algorithm>
#include <cstddef>
#include <utility>

namespace Vorn::Fewest {

namespace {

Place PlaceOf(WPoint const& p) { return {p.x, p.y}; }

/// The line through two points.
PlacedCircle LineBetween(WPoint const& p, WPoint const& q) {
  return {LineThrough({0.0, 0.0}, {q.x - p.x, q.y - p.y}), PlaceOf(p)};
}

/// Builds a chain from its start on, edge by edge and part by part.
class Tracer {
 public:
  Tracer(Path const& path, double share, std::vector<char> const& isJoint)
      : path_(path), share_(share), isJoint_(isJoint), start_(path.start) {}

  /// Empty where a part has no pieces.
  Chain Run() {
    while (true) {
      std::int32_t const next = NextJoint();
      bool const isLast = next == path_.Count();
      Opening const finish = isLast ? path_.finish : EndAt(GateAt(next), 0.0);
      if (!isLast && IsEdgeTo(next)) {
        AppendEdge(next);
      } else if (!AppendPart(next, finish)) {
        return {};
      }
      if (isLast) return std::move(chain_);
      chain_.gates.push_back(finish.gate);
      chain_.offsets.push_back(0.0);
      start_ = StartAt(finish.gate, 0.0);
      first_ = next;
    }
  }

 private:
  /// A chain that begins at no gate begins at its first point. It never ends with an edge.
  bool IsJoint(std::int32_t point) const {
    if (point == 0) return path_.start.isFree;
    return point + 1 < path_.Count() && isJoint_[static_cast<std::size_t>(point)] != 0;
  }

  /// The next joint at another place than the last one; the number of points where there is none.
  std::int32_t NextJoint() const {
    std::int32_t next = first_ + 1;
    while (next < path_.Count() && !(IsJoint(next) && !IsHere(next))) ++next;
    return next;
  }

  /// Whether a point lies where the chain has come to.
  bool IsHere(std::int32_t point) const {
    WPoint const& p = path_.At(first_);
    WPoint const& q = path_.At(point);
    return p.x == q.x && p.y == q.y;
  }

  /// Whether nothing lies between two joints.
  bool IsEdgeTo(std::int32_t next) const {
    if (!IsJoint(first_)) return false;
    std::int32_t between = first_ + 1;
    while (between < next && IsHere(between)) ++between;
    return between == next;
  }

  /// The gate through a point, square to the way from the point before to the one behind.
  Gate GateAt(std::int32_t point) const {
    Gate gate;
    gate.split = point;
    gate.origin = PlaceOf(path_.At(point));
    gate.across = LeftNormal(path_.At(point - 1), path_.At(point + 1));
    return gate;
  }

  /// Searches the pieces of the points up to an end.
  bool AppendPart(std::int32_t end, Opening const& finish) {
    Path const part = PathBetween(path_, {first_, start_}, {end, finish});
    Chain const found = FindChain(part, share_, [](std::int32_t) {});
    Append(MovedBy(found, first_), &chain_);
    return !found.pieces.empty();
  }

  void AppendEdge(std::int32_t end) {
    chain_.pieces.push_back({first_, end, LineBetween(path_.At(first_), path_.At(end)), 0.0});
  }

  Path const& path_;
  double share_;
  std::vector<char> const& isJoint_;
  Opening start_;
  std::int32_t first_ = 0;
  Chain chain_;
};

}  // namespace

Chain FindChainWithEdges(Path const& path, double share, std::vector<char> const& isJoint) {
  return Tracer(path, share, isJoint).Run();
}

Retracing::Retracing(Path const& path, double share, Chain chain)
    : path_(path),
      share_(share),
      original_(std::move(chain)),
      current_(original_),
      isJoint_(path.points.size()) {}

bool Retracing::Follow(std::vector<std::int32_t> const& points, std::int32_t reach) {
  bool isNew = false;
  for (std::int32_t const point : points) {
    std::int32_t const first = std::max(0, point - reach);
    std::int32_t const last = std::min(path_.Count() - 1, point + reach);
    auto const begin = isJoint_.begin() + first;
    auto const end = isJoint_.begin() + last + 1;
    isNew = isNew || std::find(begin, end, 0) != end;
    std::fill(begin, end, 1);
  }
  return isNew && Rebuild();
}

bool Retracing::IsTouched(ChainPiece const& piece) const {
  return std::find(isJoint_.begin() + piece.first, isJoint_.begin() + piece.end, 1) !=
         isJoint_.begin() + piece.end;
}

bool Retracing::Rebuild() {
  Splicing splicing(original_);
  std::size_t const count = original_.pieces.size();
  for (std::size_t k = 0; k < count; ++k) {
    if (!IsTouched(original_.pieces[k])) continue;
    Stretch stretch{k, k + 1};
    while (stretch.end < count && IsTouched(original_.pieces[stretch.end])) ++stretch.end;
    Chain const part = Search(stretch);
    if (part.pieces.empty()) return false;
    splicing.Replace(stretch, part);
    k = stretch.end;
  }
  current_ = splicing.Finish();
  return true;
}

Chain Retracing::Search(Stretch const& stretch) const {
  if (!HasOuterPoints(original_, stretch)) return {};
  std::int32_t const first = original_.pieces[stretch.first].first;
  std::int32_t const end = original_.pieces[stretch.end - 1].end;
  std::vector<char> const isJoint(isJoint_.begin() + first, isJoint_.begin() + end);
  return FindChainWithEdges(PathOf(path_, original_, stretch), share_, isJoint);
}

}  // namespace Vorn::Fewest
