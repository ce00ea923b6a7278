#include "geometry/fewest/Stretch.h"

#include <algorithm>
#include <utility>

#include "math/Assert.h"

namespace Vorn::Fewest {

namespace {

/// Moves the points that a piece or a gate counts.
ChainPiece Moved(ChainPiece piece, std::int32_t by) {
  piece.first += by;
  piece.end += by;
  return piece;
}
Gate Moved(Gate gate, std::int32_t by) {
  gate.split += by;
  return gate;
}

Outside PointsBefore(Path const& path, std::int32_t first) {
  Outside before;
  for (std::int32_t i = first - 1; i >= 0 && before.count < 2; --i) before.Add(path.At(i));
  for (std::int32_t i = 0; before.count < 2 && path.before.At(i) != nullptr; ++i) {
    before.Add(*path.before.At(i));
  }
  return before;
}

Outside PointsFrom(Path const& path, std::int32_t end) {
  Outside behind;
  for (std::int32_t i = end; i < path.Count() && behind.count < 2; ++i) behind.Add(path.At(i));
  for (std::int32_t i = 0; behind.count < 2 && path.behind.At(i) != nullptr; ++i) {
    behind.Add(*path.behind.At(i));
  }
  return behind;
}

}  // namespace

Stretch Stretch::Widened(std::size_t count) const {
  std::size_t const more = (Size() + 1) / 2;
  return {first - std::min(first, more), std::min(count, end + more)};
}

bool HasOuterPoints(Chain const& chain, Stretch const& stretch) {
  ChainPiece const& first = chain.pieces[stretch.first];
  ChainPiece const& last = chain.pieces[stretch.end - 1];
  return first.first < first.end && last.first < last.end;
}

Path PathBetween(Path const& path, PathEnd const& start, PathEnd const& finish) {
  Path part;
  part.points.assign(path.points.begin() + start.point, path.points.begin() + finish.point);
  part.limits = path.limits;
  part.leastTolerance = path.leastTolerance;
  part.before = PointsBefore(path, start.point);
  part.behind = PointsFrom(path, finish.point);
  part.start = start.opening;
  part.finish = finish.opening;
  if (!part.start.isFree) part.start.gate.split = 0;
  part.finish.gate.split = finish.point - start.point;
  return part;
}

Path PathOf(Path const& path, Chain const& chain, Stretch const& stretch) {
  VORN_ASSERT(HasOuterPoints(chain, stretch));
  PathEnd start{chain.pieces[stretch.first].first, path.start};
  PathEnd finish{chain.pieces[stretch.end - 1].end, path.finish};
  if (stretch.first > 0) {
    std::size_t const k = stretch.first - 1;
    start.opening = StartAt(chain.gates[k], chain.offsets[k]);
  }
  if (stretch.end < chain.pieces.size()) {
    std::size_t const k = stretch.end - 1;
    finish.opening = EndAt(chain.gates[k], chain.offsets[k]);
  }
  return PathBetween(path, start, finish);
}

Chain PartOf(Chain const& chain, Stretch const& stretch) {
  std::int32_t const first = chain.pieces[stretch.first].first;
  Chain part;
  part.pieces.reserve(stretch.end - stretch.first);
  part.gates.reserve(stretch.end - stretch.first);
  for (std::size_t k = stretch.first; k < stretch.end; ++k) {
    part.pieces.push_back(Moved(chain.pieces[k], -first));
    if (k + 1 == stretch.end) break;
    part.gates.push_back(Moved(chain.gates[k], -first));
    part.offsets.push_back(chain.offsets[k]);
  }
  return part;
}

void Append(Chain const& part, Chain* chain) {
  chain->pieces.insert(chain->pieces.end(), part.pieces.begin(), part.pieces.end());
  chain->gates.insert(chain->gates.end(), part.gates.begin(), part.gates.end());
  chain->offsets.insert(chain->offsets.end(), part.offsets.begin(), part.offsets.end());
}

Chain MovedBy(Chain chain, std::int32_t by) {
  for (ChainPiece& piece : chain.pieces) piece = Moved(piece, by);
  for (Gate& gate : chain.gates) gate = Moved(gate, by);
  return chain;
}

void Put(Chain const& part, Stretch const& stretch, Chain* chain) {
  std::int32_t const first = chain->pieces[stretch.first].first;
  for (std::size_t k = 0; k < part.pieces.size(); ++k) {
    chain->pieces[stretch.first + k] = Moved(part.pieces[k], first);
    if (k + 1 == part.pieces.size()) break;
    chain->gates[stretch.first + k] = Moved(part.gates[k], first);
    chain->offsets[stretch.first + k] = part.offsets[k];
  }
}

void Splicing::Replace(Stretch const& stretch, Chain const& part) {
  KeepUpTo(stretch.first);
  Append(MovedBy(part, chain_.pieces[stretch.first].first), &spliced_);
  AddGateBehind(stretch.end - 1);
  next_ = stretch.end;
}

Chain Splicing::Finish() {
  KeepUpTo(chain_.pieces.size());
  return std::move(spliced_);
}

void Splicing::KeepUpTo(std::size_t end) {
  for (; next_ < end; ++next_) {
    spliced_.pieces.push_back(chain_.pieces[next_]);
    AddGateBehind(next_);
  }
}

void Splicing::AddGateBehind(std::size_t piece) {
  if (piece >= chain_.gates.size()) return;
  spliced_.gates.push_back(chain_.gates[piece]);
  spliced_.offsets.push_back(chain_.offsets[piece]);
}

}  // namespace Vorn::Fewest
