#include "geometry/fewest/Chain.h"

#include <algorithm>
#include <utility>
#include <vector>

#include "geometry/fewest/Corner.h"

namespace Vorn::Fewest {

namespace {

struct State {
  Opening opening;
  /// The pieces before it that end at the ends of the opening.
  PlacedCircle atLow;
  PlacedCircle atHigh;
  std::int32_t previous = -1;  ///< position in the level before
  Reach reach;
};

using Level = std::vector<State>;

/// Points behind a gate whose circle tells whether there is a corner.
constexpr std::int32_t kPointsBehind = 16;

/// In gaps wider than this many times the sum of the tolerances the joint may lie at either point.
constexpr double kWideGap = 8.0;

class ChainSearch {
 public:
  ChainSearch(Path const& path, double share, GoesOn const& goesOn)
      : path_(path), search_(path, share), goesOn_(goesOn) {}

  Chain Run() {
    levels_.push_back({State()});
    levels_.back().front().opening = path_.start;
    std::int32_t expected = std::min(path_.Count(), 8);
    std::int32_t before = 0;
    while (true) {
      Level& level = levels_.back();
      std::int32_t farthest = 0;
      std::int32_t first = path_.Count() - 1;
      for (State const& state : level) first = std::min(first, state.opening.First());
      search_.MoveTo(first, std::min(path_.Count(), std::max(expected, first + 2)));
      Reach rival;
      for (State& state : level) {
        state.reach = rival.end == 0
                          ? search_.FindReach(state.opening, std::min(path_.Count(), expected))
                          : search_.FindReachBeyond(state.opening, rival);
        if (state.reach.end > rival.end) rival = state.reach;
      }
      farthest = rival.end;
      if (!goesOn_(levels_.size(), farthest)) return {};
      if (farthest == path_.Count()) {
        std::int32_t const last = FindLast();
        if (last >= 0) return Backwards(last);
        // No piece ends where a closed path has to; one more closes it.
        farthest = path_.Count() - 1;
      }
      Level next = MakeStates(level, before, farthest);
      if (next.empty() || (farthest <= before && path_.finish.isFree)) return {};
      if (levels_.size() > path_.points.size() + 2) return {};
      KeepOrigins(&level, &next);
      expected = farthest + std::max(4, farthest - before);
      before = farthest;
      levels_.push_back(std::move(next));
    }
  }

 private:
  /// Drops the states of a level from which no state of the next one comes: most of the memory.
  static void KeepOrigins(Level* level, Level* next) {
    constexpr std::int32_t kDropped = -1;
    std::vector<std::int32_t> positions(level->size(), kDropped);
    Level kept;
    for (State& state : *next) {
      std::int32_t& position = positions[static_cast<std::size_t>(state.previous)];
      if (position == kDropped) {
        position = static_cast<std::int32_t>(kept.size());
        kept.push_back((*level)[static_cast<std::size_t>(state.previous)]);
      }
      state.previous = position;
    }
    kept.shrink_to_fit();
    *level = std::move(kept);
  }

  Level MakeStates(Level const& level, std::int32_t before, std::int32_t farthest) {
    Level next;
    std::int32_t const half = std::max(before + 1, farthest - (farthest - before) / 2 - 1);
    std::int32_t const stride = StrideFrom(path_, half - 1);
    std::int32_t const quarter = std::max(1, stride / 4);
    std::int32_t back = 0;
    while (farthest - back >= half) {
      std::int32_t const split = farthest - back;
      bool const isWide = IsWideGap(split);
      // Gates at points are enough so near to the others: more hardly ever save a piece.
      bool const areOthersNear = back == 2 * stride || back == 3 * stride;
      if (!isWide || !areOthersNear) AddGates(level, split, &next);
      if (isWide) AddPointGate(level, split, split - 1, &next);
      // Pieces that reach one point less far end beside the last point of the farthest too.
      if (isWide && back == stride) AddPointGate(level, split, split, &next);
      if (back < stride) {
        back = std::min(back + quarter, stride);
      } else {
        back = back < 4 * stride ? back + stride : 2 * back;
      }
    }
    return next;
  }

  void AddGates(Level const& level, std::int32_t split, Level* next) {
    std::size_t const before = next->size();
    Gate corner;
    bool const isCorner = MakeCornerGate(level, split, &corner);
    if (isCorner) AddState(level, corner, next);
    State const* from = BestFor(level, split);
    if (from == nullptr) return;
    if (!isCorner) AddState(level, MiddleGate(path_, split, from->reach.circle), next);
    bool const isPointMissing = (next->size() == before || isCorner) && !IsWideGap(split);
    if (isPointMissing) AddPointGate(level, split, split - 1, next);
  }

  bool IsWideGap(std::int32_t split) const {
    WPoint const& last = path_.At(split - 1);
    WPoint const& first = path_.At(split);
    return DistanceBetween(last, first) > kWideGap * (last.w + first.w);
  }

  /// The gate at one of the points beside a gap, square to the piece before and to the path behind.
  /// A joint on it is within tolerance of the point, so that it matters little to which of the two
  /// pieces the point belongs: mostly the one before the gap is enough, the other one has its turn
  /// at the next split.
  void AddPointGate(Level const& level, std::int32_t split, std::int32_t point, Level* next) {
    State const* from = BestFor(level, split);
    if (from == nullptr) return;
    WPoint const& at = path_.At(point);
    Place const place{at.x, at.y};
    Place const out = LeftNormal(at, path_.At(std::min(point + 1, path_.Count() - 1)));
    Gate gate = BisectorGate(place, GradientAt(from->reach.circle, place), out);
    gate.split = split;
    gate.least = -at.w;
    gate.greatest = at.w;
    AddState(level, gate, next);
  }

  bool MakeCornerGate(Level const& level, std::int32_t split, Gate* gate) {
    State const* from = BestFor(level, split);
    if (from == nullptr) return false;
    PieceFit const behind =
        path_.limits.looksFar ? search_.FitLongestAlone(split) : FitShortlyBehind(split);
    if (!behind.isFound || behind.ratio > 1.0) return false;
    return CornerGate(path_, split, BeforeCorner(*from, split), behind.circle, gate);
  }

  /// The circle of the points that follow a gap.
  PieceFit FitShortlyBehind(std::int32_t split) {
    PieceFit behind;
    for (std::int32_t length = kPointsBehind * StrideFrom(path_, split);;) {
      std::int32_t const end = std::min(split + length, path_.Count());
      if (end - split < 2) break;
      behind = search_.FitAlone(split, end);
      if (behind.isFound && behind.ratio <= 1.0) break;
      length = (end - split) / 2;
    }
    return behind;
  }

  /// The circle of a piece that ends before a gap. Noise near the tolerance leaves both circles of
  /// a corner hardly any room, so that the gate has to pass within a small share of the tolerance
  /// of their crossing: then the smallest largest ratio counts, not only that it is below 1.
  PlacedCircle BeforeCorner(State const& from, std::int32_t split) {
    if (!path_.limits.looksFar) return from.reach.circle;
    PieceFit const best = search_.FindBestUpTo(from.opening, split, {from.reach.circle, 1.0, true});
    return best.isFound ? best.circle : from.reach.circle;
  }

  static State const* BestFor(Level const& level, std::int32_t split) {
    State const* best = nullptr;
    for (State const& state : level) {
      if (state.reach.end < split || (!state.opening.isFree && state.opening.gate.split >= split)) {
        continue;
      }
      if (best == nullptr || state.reach.end > best->reach.end) best = &state;
    }
    return best;
  }

  /// Adds the gate with the offsets that the pieces before it can reach: first from the state that
  /// reaches farthest, then from others as far as they add offsets.
  void AddState(Level const& level, Gate const& gate, Level* next) {
    std::vector<State const*> order;
    for (State const& state : level) {
      if (state.reach.end >= gate.split && state.opening.First() < gate.split) {
        order.push_back(&state);
      }
    }
    std::stable_sort(order.begin(), order.end(), [](State const* one, State const* other) {
      return one->reach.end > other->reach.end;
    });
    std::size_t const begin = next->size();
    for (State const* from : order) {
      Interval const interval = search_.FindInterval(from->opening, gate, from->reach.circle);
      if (!interval.isFound) continue;
      State state;
      state.opening = StartOn(gate, interval);
      state.atLow = interval.atLow;
      state.atHigh = interval.atHigh;
      state.previous = static_cast<std::int32_t>(from - level.data());
      bool isNew = true;
      for (std::size_t i = begin; i < next->size(); ++i) {
        Opening& held = (*next)[i].opening;
        if (held.low <= state.opening.low && state.opening.high <= held.high) isNew = false;
        if (isNew && held.low >= state.opening.low && state.opening.high >= held.high) {
          (*next)[i] = state;
          isNew = false;
        }
      }
      if (isNew) next->push_back(state);
      if (next->size() - begin >= path_.limits.mostSources) break;
    }
  }

  /// The state of the last level whose piece to the finish deviates least; -1 if there is none.
  std::int32_t FindLast() {
    Level const& last = levels_.back();
    double least = 0.0;
    std::int32_t at = -1;
    search_.MoveTo(last.front().opening.First(), path_.Count());
    for (std::size_t i = 0; i < last.size(); ++i) {
      if (last[i].reach.end < path_.Count()) continue;
      PieceFit const fit = search_.FindBest(last[i].opening, path_.finish,
                                            {last[i].reach.circle, 1.0, path_.finish.isFree});
      if (fit.isFound && fit.ratio <= kWholeTolerance && (at < 0 || fit.ratio < least)) {
        least = fit.ratio;
        at = static_cast<std::int32_t>(i);
      }
    }
    return at;
  }

  Chain Backwards(std::int32_t at) {
    std::vector<Link> links(levels_.size());
    for (std::size_t k = levels_.size(); k-- > 0;) {
      State const& state = levels_[k][static_cast<std::size_t>(at)];
      links[k] = {state.opening, state.reach.circle, state.atLow, state.atHigh};
      at = state.previous;
    }
    return PlacePieces(path_, std::move(links), &search_);
  }

  Path const& path_;
  PieceSearch search_;
  GoesOn const& goesOn_;
  std::vector<Level> levels_;
};

}  // namespace

Chain FindChain(Path const& path, double share, std::function<void(std::int32_t)> const& tell) {
  return FindChainWhile(path, share, [&](std::size_t, std::int32_t covered) {
    tell(covered);
    return true;
  });
}

Chain FindChainWhile(Path const& path, double share, GoesOn const& goesOn) {
  return ChainSearch(path, share, goesOn).Run();
}

}  // namespace Vorn::Fewest
