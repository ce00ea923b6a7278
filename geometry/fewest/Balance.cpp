#include "geometry/fewest/Balance.h"

#include <algorithm>

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
  Balancer(Path const& path, Chain const& chain)
      : path_(path), search_(path, 1.0), balanced_{chain, 0.0} {}

  BalancedChain Run() {
    Chain& chain = balanced_.chain;
    // From the last gate on: there the piece behind begins too late, but ends where it has to.
    for (std::size_t k = chain.gates.size(); k-- > 0;) Move(k);
    for (ChainPiece& piece : chain.pieces) {
      search_.MoveTo(piece.first, piece.end);
      PieceFit const fit = search_.FitAlone(piece.first, piece.end);
      if (!fit.isFound) continue;
      balanced_.leastShare = std::max(balanced_.leastShare, fit.ratio);
      piece.circle = fit.circle;
    }
    return std::move(balanced_);
  }

 private:
  Neighbours FitAt(std::int32_t first, std::int32_t split, std::int32_t end) {
    return {search_.FitAlone(first, split), search_.FitAlone(split, end)};
  }

  void Move(std::size_t k) {
    ChainPiece& before = balanced_.chain.pieces[k];
    ChainPiece& behind = balanced_.chain.pieces[k + 1];
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
    if (!CornerGate(path_, split, best.before.circle, best.behind.circle, &gate)) {
      gate = MiddleGate(path_, split, best.before.circle);
    }
    balanced_.chain.gates[k] = gate;
    before.end = split;
    behind.first = split;
  }

  Path const& path_;
  PieceSearch search_;
  BalancedChain balanced_;
};

}  // namespace

BalancedChain Balance(Path const& path, Chain const& chain) { return Balancer(path, chain).Run(); }

}  // namespace Vorn::Fewest
