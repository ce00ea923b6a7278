#include "io/pieces/Chains.h"

#include <cmath>
#include <cstdint>
#include <deque>
#include <map>
#include <optional>
#include <utility>

namespace Vorn::IO {

namespace {

/// One of the two ends of a link.
struct End {
  std::size_t index = 0;
  bool isStart = true;
};

/// Finds the ends near a place. Cells are as wide as the tolerance, so that only the cell of the
/// place and its neighbours need a look.
class EndIndex {
 public:
  EndIndex(std::vector<Ends> const& all, double tolerance)
      : all_(all), tolerance_(tolerance), isUsed_(all.size(), false) {
    for (std::size_t i = 0; i < all.size(); ++i) {
      ends_.emplace(CellOf(all[i].start), End{i, true});
      ends_.emplace(CellOf(all[i].end), End{i, false});
    }
  }

  bool IsUsed(std::size_t index) const { return isUsed_[index]; }
  void Use(std::size_t index) { isUsed_[index] = true; }

  /// The end of an unused one at the place: of the first such, its start before its end if
  /// `wantsStart`.
  std::optional<End> Find(XY const& place, bool wantsStart) const {
    std::optional<End> best;
    Cell const middle = CellOf(place);
    for (std::int64_t i = -1; i <= 1; ++i) {
      for (std::int64_t k = -1; k <= 1; ++k) {
        auto const [begin, end] = ends_.equal_range({middle.first + i, middle.second + k});
        for (auto at = begin; at != end; ++at) Consider(at->second, place, wantsStart, &best);
      }
    }
    return best;
  }

 private:
  using Cell = std::pair<std::int64_t, std::int64_t>;

  Cell CellOf(XY const& place) const { return {NumberOf(place.x), NumberOf(place.y)}; }

  /// The column or row of cells. What is not finite, or further out than there are numbers for, is
  /// all in one, where its distances tell it apart.
  std::int64_t NumberOf(double coordinate) const {
    constexpr double kFurthest = 0x1p62;
    double const number = std::floor(coordinate / tolerance_);
    return std::fabs(number) < kFurthest ? static_cast<std::int64_t>(number) : 0;
  }

  void Consider(End const& end, XY const& place, bool wantsStart, std::optional<End>* best) const {
    XY const& at = end.isStart ? all_[end.index].start : all_[end.index].end;
    if (isUsed_[end.index] || !(Distance(at, place) <= tolerance_)) return;
    auto const rank = [&](End const& e) { return std::pair(e.isStart != wantsStart, e.index); };
    if (!*best || rank(end) < rank(**best)) *best = end;
  }

  std::vector<Ends> const& all_;
  double tolerance_;
  std::vector<bool> isUsed_;
  std::multimap<Cell, End> ends_;
};

/// Grows one chain.
class Growth {
 public:
  Growth(std::size_t first, std::vector<Ends> const& all, double tolerance, EndIndex* ends)
      : all_(all), tolerance_(tolerance), ends_(*ends) {
    ends_.Use(first);
    links_.push_back({first, false});
  }

  LinkChain Grow() {
    while (!IsClosed() && GrowsAtEnd()) continue;
    while (!IsClosed() && GrowsAtStart()) continue;
    return {{links_.begin(), links_.end()}, IsClosed()};
  }

 private:
  XY const& StartOf(Link const& link) const {
    return link.isReversed ? all_[link.index].end : all_[link.index].start;
  }
  XY const& EndOf(Link const& link) const {
    return link.isReversed ? all_[link.index].start : all_[link.index].end;
  }

  bool IsClosed() const {
    return Distance(EndOf(links_.back()), StartOf(links_.front())) <= tolerance_;
  }

  bool GrowsAtEnd() {
    std::optional<End> const next = ends_.Find(EndOf(links_.back()), true);
    if (!next) return false;
    ends_.Use(next->index);
    links_.push_back({next->index, !next->isStart});
    return true;
  }

  bool GrowsAtStart() {
    std::optional<End> const before = ends_.Find(StartOf(links_.front()), false);
    if (!before) return false;
    ends_.Use(before->index);
    links_.push_front({before->index, before->isStart});
    return true;
  }

  std::vector<Ends> const& all_;
  double tolerance_;
  EndIndex& ends_;
  std::deque<Link> links_;
};

}  // namespace

std::vector<LinkChain> ChainsOf(std::vector<Ends> const& all, double tolerance) {
  EndIndex ends(all, tolerance);
  std::vector<LinkChain> chains;
  for (std::size_t i = 0; i < all.size(); ++i) {
    if (!ends.IsUsed(i)) chains.push_back(Growth(i, all, tolerance, &ends).Grow());
  }
  return chains;
}

}  // namespace Vorn::IO
