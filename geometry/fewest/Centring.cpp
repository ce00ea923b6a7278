#include "geometry/fewest/Centring.h"

#include <algorithm>

namespace Vorn::Fewest {

namespace {

/// A chain within this share of the tolerances is not brought down further.
constexpr double kLeastShare = 1.0 / 64.0;

/// The factor is found to this share of itself.
constexpr double kAccuracy = 0.02;

}  // namespace

Chain Centre(Path const& path, Chain const& chain) {
  Chain best = chain;
  double good = 1.0;
  double bad = 0.0;
  while (good > kLeastShare && good - bad > kAccuracy * good) {
    double const share = bad > 0.0 ? 0.5 * (good + bad) : 0.5 * good;
    Chain next = FollowGates(path, share, best);
    if (next.pieces.empty()) {
      bad = share;
      continue;
    }
    good = share;
    best = std::move(next);
  }
  return best;
}

}  // namespace Vorn::Fewest
