#include "geometry/fewest/FollowGates.h"

#include <algorithm>
#include <utility>
#include <vector>

#include "geometry/fewest/PieceSearch.h"

namespace Vorn::Fewest {

namespace {

class GateFollower {
 public:
  /// `safe` is null where there are no other gates.
  GateFollower(Path const& path, double share, Chain const& known, Chain const* safe)
      : path_(path),
        search_(path, share),
        share_(share),
        known_(known),
        safe_(safe),
        isSafe_(known.gates.size()) {
    links_.reserve(known.pieces.size());
  }

  Chain Run() {
    Chain chain = Follow();
    for (ChainPiece& piece : chain.pieces) piece.ratio *= share_;
    return chain;
  }

 private:
  Chain Follow() {
    std::size_t const last = known_.pieces.size() - 1;
    Link first;
    first.opening = path_.start;
    links_.push_back(first);
    std::size_t farthest = 0;
    std::size_t back = 1;
    while (links_.size() <= last) {
      if (Advance()) continue;
      // The gates before decide whether a piece reaches this one, the nearest most of all.
      back = links_.size() > farthest ? 1 : 2 * back;
      farthest = std::max(farthest, links_.size());
      if (!GoBack(back)) return {};
    }
    links_.back().guess = known_.pieces[last].circle;
    return PlacePieces(path_, std::move(links_), &search_);
  }

  /// Adds the link behind the next gate; false when no piece reaches it.
  bool Advance() {
    std::size_t const k = links_.size() - 1;
    Link& link = links_.back();
    Chain const& from = isSafe_[k] ? *safe_ : known_;
    link.guess = from.pieces[k].circle;
    Gate const& gate = from.gates[k];
    search_.MoveTo(link.opening.First(), gate.split);
    Interval const interval = search_.FindInterval(link.opening, gate, link.guess);
    if (!interval.isFound) return false;
    links_.push_back({StartOn(gate, interval), {}, interval.atLow, interval.atHigh});
    return true;
  }

  /// Takes the next gate and some before it from the safe chain, and goes back to the first of
  /// them. False where that changes nothing.
  bool GoBack(std::size_t count) {
    if (safe_ == nullptr) return false;
    std::size_t const k = links_.size() - 1;
    std::size_t const first = k + 1 - std::min(k + 1, count);
    bool isChanged = false;
    for (std::size_t i = first; i <= k; ++i) {
      isChanged = isChanged || !IsSafe(i);
      isSafe_[i] = true;
    }
    links_.resize(first + 1);
    return isChanged || first > 0;
  }

  bool IsSafe(std::size_t k) const {
    if (isSafe_[k]) return true;
    Gate const& gate = known_.gates[k];
    Gate const& safe = safe_->gates[k];
    return gate.split == safe.split && gate.origin.x == safe.origin.x &&
           gate.origin.y == safe.origin.y;
  }

  Path const& path_;
  PieceSearch search_;
  double share_;
  Chain const& known_;
  Chain const* safe_;
  std::vector<bool> isSafe_;  ///< the gates that are taken from the safe chain
  std::vector<Link> links_;
};

}  // namespace

Chain FollowGates(Path const& path, double share, Chain const& known) {
  return GateFollower(path, share, known, nullptr).Run();
}

Chain FollowGatesOr(Path const& path, double share, Chain const& known, Chain const& safe) {
  return GateFollower(path, share, known, &safe).Run();
}

}  // namespace Vorn::Fewest
