#include "geometry/fewest/Levels.h"

#include <algorithm>
#include <utility>

#include "geometry/fewest/Corner.h"
#include "geometry/fewest/JointRoom.h"

namespace Vorn::Fewest {

namespace {

/// Points behind a gate whose circle tells whether there is a corner.
constexpr std::int32_t kPointsBehind = 16;

/// How many points the first piece is expected to cover.
constexpr std::int32_t kFirstExpected = 8;

/// Drops the states of a level from which no state of the next one comes: most of the memory.
void KeepOrigins(std::vector<State>* level, std::vector<State>* next) {
  constexpr std::int32_t kDropped = -1;
  std::vector<std::int32_t> positions(level->size(), kDropped);
  std::vector<State> kept;
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

/// The state from which a piece over a gap leads farthest; null where there is none.
State const* BestFor(std::vector<State> const& level, std::int32_t split) {
  State const* best = nullptr;
  for (State const& state : level) {
    if (state.reach.end < split || (!state.opening.isFree && state.opening.gate.split >= split)) {
      continue;
    }
    if (best == nullptr || state.reach.end > best->reach.end) best = &state;
  }
  return best;
}

}  // namespace

Levels::Levels(Path const& path, double share)
    : path_(path),
      search_(path, share),
      levels_{{State()}},
      expected_(std::min(path.Count(), kFirstExpected)) {
  levels_.back().front().opening = path.start;
}

std::int32_t Levels::FindFarthest() {
  Level& level = levels_.back();
  std::int32_t first = path_.Count() - 1;
  for (State const& state : level) first = std::min(first, state.opening.First());
  search_.MoveTo(first, std::min(path_.Count(), std::max(expected_, first + 2)));
  Reach rival;
  for (State& state : level) {
    state.reach = rival.end == 0
                      ? search_.FindReach(state.opening, std::min(path_.Count(), expected_))
                      : search_.FindReachBeyond(state.opening, rival);
    if (state.reach.end > rival.end) rival = state.reach;
  }
  return rival.end;
}

bool Levels::Add(std::int32_t farthest) {
  Level& level = levels_.back();
  Level next = MakeStates(level, farthest);
  if (next.empty() || (farthest <= before_ && path_.finish.isFree)) return false;
  if (levels_.size() > path_.points.size() + 2) return false;
  KeepOrigins(&level, &next);
  expected_ = farthest + std::max(4, farthest - before_);
  before_ = farthest;
  levels_.push_back(std::move(next));
  return true;
}

std::vector<Link> Levels::LinksThrough(std::size_t state) const {
  std::vector<Link> links(levels_.size());
  for (std::size_t k = levels_.size(); k-- > 0;) {
    State const& at = levels_[k][state];
    links[k] = {at.opening, at.reach.circle, at.atLow, at.atHigh};
    state = static_cast<std::size_t>(at.previous);
  }
  return links;
}

Levels::Level Levels::MakeStates(Level const& level, std::int32_t farthest) {
  Level next;
  std::int32_t half = std::max(before_ + 1, farthest - (farthest - before_) / 2 - 1);
  std::int32_t const stride = StrideFrom(path_, half - 1);
  // Where the end is fixed, the last pieces may have to begin elsewhere than those that only have
  // to reach far.
  bool const isNearEnd = !path_.finish.isFree && farthest + 2 * stride >= path_.Count();
  if (isNearEnd) half = std::min(half, std::max(1, farthest - 2 * stride));
  std::int32_t const quarter = std::max(1, stride / 4);
  std::int32_t back = 0;
  while (farthest - back >= half) {
    std::int32_t const split = farthest - back;
    bool const isWide = IsWideGap(path_, split);
    // Gates at points are enough so near to the others: more hardly ever save a piece.
    bool const areOthersNear = back == 2 * stride || back == 3 * stride;
    if (!isWide || !areOthersNear) AddGates(level, split, &next);
    if (isWide) AddPointGate(level, split, split - 1, &next);
    // Pieces that reach one point less far end beside the last point of the farthest too.
    if (isWide && (back == stride || isNearEnd)) AddPointGate(level, split, split, &next);
    if (back < stride) {
      back = std::min(back + quarter, stride);
    } else {
      back = back < 4 * stride ? back + stride : 2 * back;
    }
  }
  return next;
}

void Levels::AddGates(Level const& level, std::int32_t split, Level* next) {
  std::size_t const before = next->size();
  Gate corner;
  bool const isCorner = MakeCornerGate(level, split, &corner);
  if (isCorner) AddState(level, corner, next);
  State const* from = BestFor(level, split);
  if (from == nullptr) return;
  if (!isCorner) AddState(level, MiddleGate(path_, split, from->reach.circle), next);
  bool const isPointMissing = (next->size() == before || isCorner) && !IsWideGap(path_, split);
  if (isPointMissing) AddPointGate(level, split, split - 1, next);
}

void Levels::AddPointGate(Level const& level, std::int32_t split, std::int32_t point, Level* next) {
  State const* from = BestFor(level, split);
  if (from == nullptr) return;
  WPoint const& at = path_.At(point);
  Place const place{at.x, at.y};
  std::int32_t const ahead = std::min(point + StrideFrom(path_, point), path_.Count() - 1);
  Place const out = LeftNormal(at, path_.At(ahead));
  Gate gate = BisectorGate(place, GradientAt(from->reach.circle, place), out);
  gate.split = split;
  gate.least = -at.w;
  gate.greatest = at.w;
  AddState(level, gate, next);
}

bool Levels::MakeCornerGate(Level const& level, std::int32_t split, Gate* gate) {
  State const* from = BestFor(level, split);
  if (from == nullptr) return false;
  PieceFit const behind =
      path_.limits.looksFar ? search_.FitLongestAlone(split) : FitShortlyBehind(split);
  if (!behind.isFound || behind.ratio > 1.0) return false;
  return CornerGate(path_, split, BeforeCorner(*from, split), behind.circle, gate);
}

PieceFit Levels::FitShortlyBehind(std::int32_t split) {
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

PlacedCircle Levels::BeforeCorner(State const& from, std::int32_t split) {
  if (!path_.limits.looksFar) return from.reach.circle;
  PieceFit const best = search_.FindBestUpTo(from.opening, split, {from.reach.circle, 1.0, true});
  return best.isFound ? best.circle : from.reach.circle;
}

void Levels::AddState(Level const& level, Gate const& gate, Level* next) {
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

}  // namespace Vorn::Fewest
