#include "geometry/fewest/BackwardPass.h"

#include <algorithm>
#include <utility>

namespace Vorn::Fewest {

namespace {

/// How often a piece behind is asked for a joint nearer to the middle of its interval.
constexpr int kMostRetries = 6;

/// By this many least tolerances rounding may put an offset outside an opening.
constexpr double kOffsetRounding = 1e-3;

class BackwardPass {
 public:
  BackwardPass(Path const& path, std::vector<Link> links, PieceSearch* search)
      : path_(path), links_(std::move(links)), search_(*search) {}

  /// Empty when a piece cannot end where it has to.
  Chain Run() {
    std::size_t const count = links_.size();
    chain_.pieces.resize(count);
    chain_.gates.resize(count - 1);
    chain_.offsets.resize(count - 1);
    std::vector<int> retries(count);
    for (std::size_t k = count; k-- > 0;) {
      if (Place(k)) continue;
      if (k + 1 == count || ++retries[k] > kMostRetries) return {};
      // Try the piece behind again, from a joint nearer to the middle.
      Opening& behind = links_[k + 1].opening;
      double const quarter = 0.25 * (behind.high - behind.low);
      behind.low += quarter;
      behind.high -= quarter;
      k += 2;
    }
    return std::move(chain_);
  }

 private:
  bool Place(std::size_t k) {
    Link const& link = links_[k];
    Opening end = path_.finish;
    if (k + 1 < links_.size()) {
      end = EndAt(chain_.gates[k], chain_.offsets[k]);
    }
    std::int32_t const first = link.opening.First();
    std::int32_t const last = end.isFree ? path_.Count() : end.gate.split;
    search_.MoveTo(first, last);
    PieceFit fit = search_.FindStraight(link.opening, end);
    if (!fit.isFound || fit.ratio > 1.0) fit = search_.FindBest(link.opening, end, StartFor(k));
    if (!fit.isFound || fit.ratio > kWholeTolerance) return false;
    chain_.pieces[k] = {first, last, fit.circle, fit.ratio};
    if (k == 0) return true;
    double offset = 0.0;
    if (!FindCrossing(fit.circle, link.opening.gate, &offset)) return false;
    if (!IsWithin(link.opening, offset)) return false;
    chain_.gates[k - 1] = SeenFromBehind(link.opening.gate);
    chain_.offsets[k - 1] = link.opening.gate.isCusp ? -offset : offset;
    return true;
  }

  /// The piece known beforehand, which stands in where no better one is found, may start outside an
  /// opening that was narrowed since.
  bool IsWithin(Opening const& opening, double offset) const {
    double const rounding = kOffsetRounding * path_.leastTolerance;
    return offset >= opening.low - rounding && offset <= opening.high + rounding;
  }

  /// Between two pieces that end on both sides of a joint there is one that ends there.
  PieceFit StartFor(std::size_t k) const {
    if (k + 1 == links_.size()) return {links_[k].guess, 0.0, false};
    Link const& next = links_[k + 1];
    Fewest::Place const joint = PlaceOn(chain_.gates[k], chain_.offsets[k]);
    double const low = ValueAt(next.atLow, joint);
    double const high = ValueAt(next.atHigh, joint);
    double const share = low != high ? low / (low - high) : 0.5;
    // Both come from one interval, so their coefficients are about one origin.
    Circle const circle = Between(next.atLow.about, next.atHigh.about, std::clamp(share, 0.0, 1.0));
    double const form = Form(circle, circle);
    if (!(form > 0.0)) return {links_[k].guess, 0.0, false};
    double const ratio = 1.0 / std::sqrt(form);
    return {{Scaled(circle, ratio), next.atLow.origin}, std::max(ratio, 1.0), true};
  }

  Path const& path_;
  std::vector<Link> links_;
  PieceSearch& search_;
  Chain chain_;
};

}  // namespace

Chain PlacePieces(Path const& path, std::vector<Link> links, PieceSearch* search) {
  return BackwardPass(path, std::move(links), search).Run();
}

}  // namespace Vorn::Fewest
