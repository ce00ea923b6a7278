#include "geometry/fewest/Balance.h"

#include <algorithm>
#include <utility>

#include "geometry/fewest/Corner.h"

namespace Vorn::Fewest {

namespace {

/// A gate is moved only where both circles keep their points within this share of the tolerances:
/// joined pieces need more than free ones.
constexpr double kRoom = 0.9;

/// The circles of the points before and behind a gap.
struct Neighbours {
  PieceFit before;
  PieceFit behind;

  double Larger() const { return std::max(before.ratio, behind.ratio); }
};

class Balancer {
 public:
  Balancer(Path const& path, Chain chain)
      : path_(path), search_(path, 1.0), balanced_(std::move(chain)) {}

  Chain Run() {
    // From the last gate on: there the piece behind begins too late, but ends where it has to.
    for (std::size_t k = balanced_.gates.size(); k-- > 0;) Move(k);
    for (ChainPiece& piece : balanced_.pieces) {
      search_.MoveTo(piece.first, piece.end);
      PieceFit const fit = search_.FitAlone(piece.first, piece.end);
      if (!fit.isFound) continue;
      piece.circle = fit.circle;
      piece.ratio = fit.ratio;
    }
    return std::move(balanced_);
  }

 private:
  Neighbours FitAt(std::int32_t first, std::int32_t split, std::int32_t end) {
    return {search_.FitAlone(first, split), search_.FitAlone(split, end)};
  }

  void Move(std::size_t k) {
    ChainPiece& before = balanced_.pieces[k];
    ChainPiece& behind = balanced_.pieces[k + 1];
    std::int32_t low = before.first + (before.end - before.first + 1) / 2;
    std::int32_t high = before.end;
    search_.MoveTo(before.first, behind.end);
    Neighbours best;
    std::int32_t split = 0;
    while (low <= high) {
      std::int32_t const middle = low + (high - low) / 2;
      Neighbours const fits = FitAt(before.first, middle, behind.end);
      if (!fits.before.isFound || !fits.behind.isFound) return;
      if (split == 0 || fits.Larger() < best.Larger()) {
        best = fits;
        split = middle;
      }
      if (fits.before.ratio < fits.behind.ratio) {
        low = middle + 1;
      } else {
        high = middle - 1;
      }
    }
    if (split <= before.first || split >= behind.end || best.Larger() > kRoom) return;
    Gate gate;
    if (CornerGate(path_, split, best.before.circle, best.behind.circle, &gate)) {
      gate.split = split = SplitAt(gate, before.first, behind.end);
    } else {
      gate = MiddleGate(path_, split, best.before.circle);
    }
    balanced_.gates[k] = gate;
    before.end = split;
    behind.first = split;
  }

  /// The split at which the points before a corner in space end: one that lies near it may deviate
  /// little from either piece, but lies beside only one of them.
  std::int32_t SplitAt(Gate const& gate, std::int32_t first, std::int32_t end) const {
    std::int32_t split = gate.split;
    if (gate.isCusp) return split;
    auto const isBehind = [&](std::int32_t point) {
      WPoint const& p = path_.At(point);
      // The path runs to the right of the gate's direction.
      return gate.across.y * (p.x - gate.origin.x) > gate.across.x * (p.y - gate.origin.y);
    };
    while (split > first + 1 && isBehind(split - 1)) --split;
    while (split < end - 1 && !isBehind(split)) ++split;
    std::int32_t const stride = StrideFrom(path_, split);
    if (stride == 1) return split;
    // Noise puts dense points in another order: as many lie before the corner as come before it.
    std::int32_t const low = std::max(first + 1, split - stride);
    std::int32_t const high = std::min(end - 1, split + stride);
    split = low;
    for (std::int32_t point = low; point < high; ++point) split += isBehind(point) ? 0 : 1;
    return split;
  }

  Path const& path_;
  PieceSearch search_;
  Chain balanced_;
};

}  // namespace

Chain Balance(Path const& path, Chain const& chain) { return Balancer(path, chain).Run(); }

}  // namespace Vorn::Fewest
