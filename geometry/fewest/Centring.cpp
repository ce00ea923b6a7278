// Pieces are joined where their own circles nearly meet, which settles noisy scans of true lines
// and arcs at once. Only where a piece finds no place there, or deviates far more than it would by
// itself, is a stretch of few pieces searched with gates and intervals; the joints beside it stay.
// So a tight place costs work there and leaves the rest of the chain alone.

#include "geometry/fewest/Centring.h"

#include <algorithm>
#include <cstddef>
#include <limits>
#include <utility>
#include <vector>

#include "geometry/fewest/Balance.h"
#include "geometry/fewest/FollowGates.h"
#include "geometry/fewest/Stretch.h"

namespace Vorn::Fewest {

namespace {

/// The share at which the search itself works.
constexpr double kWholeShare = 1.0 - 1e-6;

/// The share that a stretch needs is found to this part of itself.
constexpr double kAccuracy = 0.02;

/// Below this share of the tolerances left to a piece its neighbour takes the joint.
constexpr double kLeastRoom = 1e-3;

/// A piece is good where it deviates by no more than this many times as much as it, or a neighbour,
/// would by itself.
constexpr double kGoodRatio = 1.25;

/// A chain within this share of the tolerances is not brought down further.
constexpr double kLeastShare = 1.0 / 64.0;

/// Stretches of more pieces are not searched for a smaller largest ratio.
constexpr std::size_t kWidestStretch = 32;

/// How often the largest ratio of a chain is brought down.
constexpr int kMostLowerings = 8;

double LargestRatio(Chain const& chain) {
  double largest = 0.0;
  for (ChainPiece const& piece : chain.pieces) largest = std::max(largest, piece.ratio);
  return largest;
}

std::ptrdiff_t CountLines(Chain const& chain) {
  return std::count_if(chain.pieces.begin(), chain.pieces.end(),
                       [](ChainPiece const& piece) { return piece.circle.about.a == 0.0; });
}

class Centring {
 public:
  Centring(Path const& path, Chain const& chain)
      : path_(path), search_(path, kWholeShare), original_(chain) {}

  Chain Run() {
    chain_ = Balance(path_, original_);
    for (ChainPiece const& piece : chain_.pieces) alone_.push_back(piece.ratio);
    Settle();
    if (!Mend()) chain_ = original_;
    Improve();
    LowerLargest();
    return std::move(chain_);
  }

 private:
  std::size_t Count() const { return chain_.pieces.size(); }

  /// Joins neighbours where both come nearest to their own circles.
  void Settle() {
    for (std::size_t k = 0; k < chain_.gates.size(); ++k) chain_.offsets[k] = MeetingAt(k);
    std::vector<PieceFit> fits;
    for (std::size_t k = 0; k < Count(); ++k) fits.push_back(FitBetweenJoints(k));
    for (std::size_t k = 0; k < Count(); ++k) {
      ChainPiece& piece = chain_.pieces[k];
      piece.ratio = kNotPlaced;
      bool const isPlaced = fits[k].isFound && fits[k].ratio <= 1.0;
      if (!isPlaced) continue;
      piece.circle = fits[k].circle;
      piece.ratio = fits[k].ratio;
    }
  }

  /// The offset between those of both neighbours, the nearer to that of one the less room it has.
  double MeetingAt(std::size_t k) const {
    Gate const& gate = chain_.gates[k];
    double before = 0.0;
    double behind = 0.0;
    if (!FindCrossing(chain_.pieces[k].circle, gate, &before)) return 0.0;
    if (!FindCrossing(chain_.pieces[k + 1].circle, SeenFromBehind(gate), &behind)) {
      return std::clamp(before, gate.least, gate.greatest);
    }
    if (gate.isCusp) behind = -behind;
    double const roomBefore = std::max(kLeastRoom, 1.0 - alone_[k]);
    double const roomBehind = std::max(kLeastRoom, 1.0 - alone_[k + 1]);
    double const offset = (before * roomBehind + behind * roomBefore) / (roomBefore + roomBehind);
    return std::clamp(offset, gate.least, gate.greatest);
  }

  PieceFit FitBetweenJoints(std::size_t k) {
    ChainPiece const& piece = chain_.pieces[k];
    Opening const from = k == 0 ? path_.start : StartAt(chain_.gates[k - 1], chain_.offsets[k - 1]);
    Opening const to = k + 1 == Count() ? path_.finish : EndAt(chain_.gates[k], chain_.offsets[k]);
    search_.MoveTo(piece.first, piece.end);
    PieceFit const straight = search_.FindStraight(from, to);
    if (straight.isFound && straight.ratio <= 1.0) return straight;
    return search_.FindBest(from, to, {piece.circle, 0.0, false});
  }

  /// Searches the pieces that found no place together with their neighbours. False where that does
  /// not help.
  bool Mend() {
    for (std::size_t k = 0; k < Count(); ++k) {
      if (chain_.pieces[k].ratio != kNotPlaced) continue;
      Stretch stretch = Stretch{k, k + 1}.Widened(Count());
      while (!MendStretch(stretch)) {
        if (stretch.Size() == Count()) return false;
        stretch = stretch.Widened(Count());
      }
    }
    return true;
  }

  bool MendStretch(Stretch const& stretch) {
    if (!HasOuterPoints(chain_, stretch)) return false;
    Path const path = PathOf(path_, chain_, stretch);
    Chain const known = PartOf(chain_, stretch);
    Chain found = FollowGates(path, kWholeShare, known);
    if (found.pieces.empty() && HasOriginalGates(stretch)) {
      found = FollowGatesOr(path, kWholeShare, known, OriginalPartOf(stretch));
    }
    if (found.pieces.empty()) return false;
    Put(found, stretch, &chain_);
    return true;
  }

  /// Whether the gates of the original chain lie between the ends of a stretch.
  bool HasOriginalGates(Stretch const& stretch) const {
    return stretch.Size() > 1 &&
           original_.gates[stretch.first].split > chain_.pieces[stretch.first].first &&
           original_.gates[stretch.end - 2].split < chain_.pieces[stretch.end - 1].end;
  }

  /// The pieces of the original chain, the points counted from the first of the stretch.
  Chain OriginalPartOf(Stretch const& stretch) const {
    std::int32_t const moved =
        original_.pieces[stretch.first].first - chain_.pieces[stretch.first].first;
    Chain part = PartOf(original_, stretch);
    for (Gate& gate : part.gates) gate.split += moved;
    return part;
  }

  /// Searches pieces that deviate more than they have to together with their neighbours.
  void Improve() {
    for (std::size_t k = 0; k < Count(); ++k) {
      Stretch const stretch = Stretch{k, k + 1}.Widened(Count());
      double const least = LargestAlone(stretch);
      if (chain_.pieces[k].ratio > std::max(kGoodRatio * least, kLeastShare)) Bisect(stretch);
    }
  }

  /// Searches the piece that deviates most together with ever more neighbours until it deviates
  /// less, and then the next one.
  void LowerLargest() {
    for (int i = 0; i < kMostLowerings; ++i) {
      auto const worst = std::max_element(
          chain_.pieces.begin(), chain_.pieces.end(),
          [](ChainPiece const& p, ChainPiece const& q) { return p.ratio < q.ratio; });
      auto const k = static_cast<std::size_t>(worst - chain_.pieces.begin());
      double const largest = worst->ratio;
      if (largest <= kLeastShare) return;
      Stretch stretch{k, k + 1};
      do {
        if (stretch.Size() >= std::min(Count(), kWidestStretch)) return;
        stretch = stretch.Widened(Count());
        Bisect(stretch);
      } while (!(chain_.pieces[k].ratio < largest));
    }
  }

  /// The largest ratio of a piece of a stretch by itself, below which no pieces there come.
  double LargestAlone(Stretch const& stretch) const {
    double largest = 0.0;
    for (std::size_t k = stretch.first; k < stretch.end; ++k) {
      largest = std::max(largest, alone_[k]);
    }
    return largest;
  }

  /// Bisects the share of the tolerances that a stretch needs; no line is given up.
  void Bisect(Stretch const& stretch) {
    if (!HasOuterPoints(chain_, stretch)) return;
    double bad = LargestAlone(stretch);
    Path const path = PathOf(path_, chain_, stretch);
    Chain best = PartOf(chain_, stretch);
    double good = LargestRatio(best);
    double share = std::max(kLeastShare, (1.0 + kAccuracy) * bad);
    while (good > kLeastShare && share < good && good - bad > kAccuracy * good) {
      Chain next = FollowGates(path, share, best);
      if (next.pieces.empty() || CountLines(next) < CountLines(best)) {
        bad = share;
      } else {
        best = std::move(next);
        good = share;
      }
      share = 0.5 * (good + bad);
    }
    Put(best, stretch, &chain_);
  }

  /// The ratio of a piece that found no place between its joints.
  static constexpr double kNotPlaced = std::numeric_limits<double>::infinity();

  Path const& path_;
  PieceSearch search_;
  Chain const& original_;
  Chain chain_;
  std::vector<double> alone_;
};

}  // namespace

Chain Centre(Path const& path, Chain const& chain) { return Centring(path, chain).Run(); }

}  // namespace Vorn::Fewest
