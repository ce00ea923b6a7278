#include "geometry/fewest/Centring.h"

#include <algorithm>

#include "geometry/fewest/Balance.h"
#include "geometry/fewest/FollowGates.h"

namespace Vorn::Fewest {

namespace {

/// A chain within this share of the tolerances is not brought down further.
constexpr double kLeastShare = 1.0 / 64.0;

/// The share at which the search itself works.
constexpr double kWholeShare = 1.0 - 1e-6;

/// The factor is found to this share of itself.
constexpr double kAccuracy = 0.01;

/// A chain and the share of the tolerances that it needs.
struct Centred {
  Chain chain;
  double share = 1.0;
};

/// Bisects the share for the gates of a chain. `share` 1 is known to hold for the chain given;
/// `leastShare` is one below which none does.
Centred Bisect(Path const& path, Centred best, double leastShare) {
  double bad = leastShare;
  double share = std::max(kLeastShare, (1.0 + kAccuracy) * leastShare);
  while (best.share > kLeastShare && best.share - bad > kAccuracy * best.share) {
    Chain next = share < best.share ? FollowGates(path, share, best.chain) : Chain();
    if (next.pieces.empty()) {
      bad = std::max(bad, share);
    } else {
      best = {std::move(next), share};
    }
    share = 0.5 * (best.share + bad);
  }
  return best;
}

}  // namespace

Chain Centre(Path const& path, Chain const& chain) {
  BalancedChain const balanced = Balance(path, chain);
  Chain moved = FollowGatesOr(path, kWholeShare, balanced.chain, chain);
  if (moved.pieces.empty()) return Bisect(path, {chain, 1.0}, 0.0).chain;
  return Bisect(path, {std::move(moved), 1.0}, balanced.leastShare).chain;
}

}  // namespace Vorn::Fewest
