#include "io/pieces/Chains.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <deque>
#include <numeric>
#include <optional>
#include <tuple>
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
    entries_.reserve(2 * all.size());
    for (std::size_t i = 0; i < all.size(); ++i) {
      entries_.push_back({CellOf(all[i].start), true, i});
      entries_.push_back({CellOf(all[i].end), false, i});
    }
    std::sort(entries_.begin(), entries_.end());
    // One more stands for the end of the list.
    next_.resize(entries_.size() + 1);
    std::iota(next_.begin(), next_.end(), std::size_t{0});
  }

  bool IsUsed(std::size_t index) const { return isUsed_[index]; }
  void Use(std::size_t index) { isUsed_[index] = true; }

  /// The end of an unused one at the place: of the first such, its start before its end if
  /// `wantsStart`.
  std::optional<End> Find(XY const& place, bool wantsStart) {
    for (bool const isStart : {wantsStart, !wantsStart}) {
      std::optional<std::size_t> const index = FindKind(place, isStart);
      if (index) return End{*index, isStart};
    }
    return {};
  }

 private:
  using Cell = std::pair<std::int64_t, std::int64_t>;

  /// An end, in the order of cells, starts before ends, the first before the later ones.
  struct Entry {
    Cell cell;
    bool isStart = true;
    std::size_t index = 0;

    bool operator<(Entry const& other) const {
      return std::tuple(cell, !isStart, index) <
             std::tuple(other.cell, !other.isStart, other.index);
    }
  };

  Cell CellOf(XY const& place) const { return {NumberOf(place.x), NumberOf(place.y)}; }

  /// The column or row of cells. What is not finite, or further out than there are numbers for, is
  /// all in one, where its distances tell it apart.
  std::int64_t NumberOf(double coordinate) const {
    constexpr double kFurthest = 0x1p62;
    double const number = std::floor(coordinate / tolerance_);
    return std::fabs(number) < kFurthest ? static_cast<std::int64_t>(number) : 0;
  }

  /// The first unused one of which a start, or an end, lies at the place.
  std::optional<std::size_t> FindKind(XY const& place, bool isStart) {
    std::optional<std::size_t> best;
    Cell const middle = CellOf(place);
    for (std::int64_t i = -1; i <= 1; ++i) {
      for (std::int64_t k = -1; k <= 1; ++k) {
        Entry const first = {{middle.first + i, middle.second + k}, isStart, 0};
        std::optional<std::size_t> const index = FindInCell(first, place);
        if (index && (!best || *index < *best)) best = index;
      }
    }
    return best;
  }

  std::optional<std::size_t> FindInCell(Entry const& first, XY const& place) {
    auto const begin = std::lower_bound(entries_.begin(), entries_.end(), first);
    for (std::size_t at = UnusedFrom(static_cast<std::size_t>(begin - entries_.begin()));
         at < entries_.size(); at = UnusedFrom(at + 1)) {
      Entry const& entry = entries_[at];
      if (entry.cell != first.cell || entry.isStart != first.isStart) return {};
      Ends const& ends = all_[entry.index];
      if (Distance(entry.isStart ? ends.start : ends.end, place) <= tolerance_) return entry.index;
    }
    return {};
  }

  /// The first entry from here on that is not used. Ways over used ones are shortened, so that ends
  /// that crowd in one place are not gone over again and again.
  std::size_t UnusedFrom(std::size_t at) {
    std::size_t unused = at;
    while (unused < entries_.size() && isUsed_[entries_[unused].index]) {
      unused = std::max(unused + 1, next_[unused]);
    }
    for (std::size_t next = at; next < unused; at = next) {
      next = std::max(at + 1, next_[at]);
      next_[at] = unused;
    }
    return unused;
  }

  std::vector<Ends> const& all_;
  double tolerance_;
  std::vector<bool> isUsed_;
  std::vector<Entry> entries_;     ///< sorted
  std::vector<std::size_t> next_;  ///< where to look on behind a used entry, or the entry itself
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
