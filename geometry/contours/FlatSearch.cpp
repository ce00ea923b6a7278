#include "geometry/contours/FlatSearch.h"

#include <algorithm>
#include <cstddef>

#include "geometry/contours/near/NearPairs.h"

namespace Vorn::Flat {

namespace {

using Contours::Neighbours;
using Contours::Piece;

/// The pieces of runs of up to this many are compared one by one with those of later runs.
constexpr std::int64_t kShortRun = 32;

/// The pieces of a run in the form that the search takes.
class PiecesOfRun {
 public:
  PiecesOfRun(Data const& data, Run const& run) {
    auto const count = static_cast<std::size_t>(run.CountPieces());
    pieces_.reserve(count);
    if (run.kind == kRecordRun) arcs_.reserve(count);
    for (std::int64_t q = run.begin; q < run.end; q += run.stride) {
      Point const start = data.PointAt(q);
      if (run.kind == kVertexRun) {
        pieces_.push_back({start, data.PointAt(q + kVertexStride), nullptr});
      } else {
        arcs_.push_back(data.ArcAt(q));
        pieces_.push_back({start, start, &arcs_.back()});
      }
    }
  }
  PiecesOfRun(PiecesOfRun const&) = delete;
  PiecesOfRun& operator=(PiecesOfRun const&) = delete;

  std::vector<Piece> const& Get() const { return pieces_; }

 private:
  std::vector<Arc> arcs_;
  std::vector<Piece> pieces_;
};

FlatPiece PieceOf(Run const& run, std::size_t number) {
  return {run.begin + static_cast<std::int64_t>(number) * run.stride, run.kind};
}

}  // namespace

Verdict CheckAgainst(Data const& data, FlatPiece const& piece, Run const& run, std::int64_t begin) {
  for (std::int64_t q = begin; q < run.end; q += run.stride) {
    Verdict const verdict = Judge(data, piece, {q, run.kind});
    if (verdict.IsFinal()) return verdict;
  }
  return {};
}

bool FlatSearch::AreAllPairsValid() const {
  bool const hasStraight = std::any_of(runs_.begin(), runs_.end(),
                                       [](Run const& run) { return run.kind == kVertexRun; });
  for (std::size_t r = 0; r < runs_.size(); ++r) {
    if (runs_[r].CountPieces() == 0) continue;
    if (!IsValid(runs_[r], hasStraight)) return false;
    for (Run const& stretch : LaterStretches(r)) {
      if (!IsValid(stretch, hasStraight)) return false;
    }
  }
  return true;
}

bool FlatSearch::IsValid(Run const& run, bool hasStraight) const {
  std::int64_t const count = run.CountPieces();
  if (count == 0) return true;
  if (!IsInside(data_, {run.begin, run.kind})) return false;
  if (!IsInside(data_, {run.begin + (count - 1) * run.stride, run.kind})) return false;
  if (run.kind == kVertexRun) return true;
  for (std::int64_t q = run.begin; q < run.end; q += run.stride) {
    Arc const arc = data_.ArcAt(q);
    if (arc.radius <= 0.0 || (hasStraight && arc.startAngle == arc.endAngle)) return false;
  }
  return true;
}

std::vector<Run> FlatSearch::LaterStretches(std::size_t r) const {
  std::vector<Run> stretches;
  for (std::int32_t const kind : {kVertexRun, kRecordRun}) {
    Run longest{kind, 0, runs_[r].end, runs_[r].end};
    for (std::size_t m = r + 1; m < runs_.size(); ++m) {
      if (runs_[m].kind != kind) continue;
      longest.stride = runs_[m].stride;
      longest.end = std::max(longest.end, runs_[m].end);
    }
    if (longest.begin < longest.end) stretches.push_back(longest);
  }
  return stretches;
}

bool FlatSearch::HasCrossing() const {
  for (std::size_t r = 0; r < runs_.size(); ++r) {
    if (runs_[r].CountPieces() == 0) continue;
    if (HasCrossingWithin(runs_[r])) return true;
    for (Run const& stretch : LaterStretches(r)) {
      if (HasCrossingBetween(runs_[r], stretch)) return true;
    }
  }
  return false;
}

bool FlatSearch::HasCrossingWithin(Run const& run) const {
  auto const steps = static_cast<std::size_t>(FirstStep(run.kind));
  PiecesOfRun const pieces(data_, run);
  return Contours::AnyPair(pieces.Get(), steps == 1 ? Neighbours::Tested : Neighbours::LeftOut,
                           [&](std::size_t i, std::size_t k) {
                             return k >= i + steps &&
                                    Judge(data_, PieceOf(run, i), PieceOf(run, k)).isCrossing;
                           });
}

bool FlatSearch::HasCrossingBetween(Run const& run, Run const& stretch) const {
  if (run.CountPieces() <= kShortRun) {
    for (std::int64_t q = run.begin; q < run.end; q += run.stride) {
      if (CheckAgainst(data_, {q, run.kind}, stretch, stretch.begin).isCrossing) return true;
    }
    return false;
  }
  PiecesOfRun const first(data_, run);
  PiecesOfRun const second(data_, stretch);
  return Contours::AnyPair(first.Get(), second.Get(), [&](std::size_t i, std::size_t k) {
    return Judge(data_, PieceOf(run, i), PieceOf(stretch, k)).isCrossing;
  });
}

}  // namespace Vorn::Flat
