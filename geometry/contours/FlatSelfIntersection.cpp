// A piece starts at every vertex offset of a run: a straight segment to the next vertex, or the arc
// of the record there. Every piece P is tested against the later pieces of its own run and against
// all later runs. Crossings and invalid data are told apart by the verdict.
//
// Nothing is exempted where the polyline closes: a closed run of three or more straight pieces
// always counts as touching itself at its first vertex.
//
// The plain walk takes all pairs in their order. Where no piece can make a pair invalid, all that
// matters is whether any pair crosses, so long polylines are left to the search. Polylines with an
// invalid piece are left to the plain walk, which most often ends at that piece in the first of its
// passes.

#include "geometry/contours/FlatSelfIntersection.h"

#include "geometry/contours/FlatSearch.h"

namespace Vorn::Flat {

namespace {

Verdict CheckPiece(Data const& data, std::vector<Run> const& runs, std::size_t r,
                   FlatPiece const& piece) {
  Run const& own = runs[r];
  std::int64_t const steps = FirstStep(own.kind);
  Verdict verdict = CheckAgainst(data, piece, own, piece.offset + steps * own.stride);
  // Deliberate: for every later run the scan restarts at the end of this run, so the data of the
  // runs in between is read again with the later run's layout.
  for (std::size_t m = r + 1; m < runs.size() && !verdict.IsFinal(); ++m) {
    verdict = CheckAgainst(data, piece, runs[m], own.end);
  }
  return verdict;
}

Verdict WalkAllPairs(Data const& data, std::vector<Run> const& runs) {
  for (std::size_t r = 0; r < runs.size(); ++r) {
    for (std::int64_t q = runs[r].begin; q < runs[r].end; q += runs[r].stride) {
      Verdict const verdict = CheckPiece(data, runs, r, {q, runs[r].kind});
      if (verdict.IsFinal()) return verdict;
    }
  }
  return {};
}

}  // namespace

Verdict CheckRuns(Data const& data, std::vector<Run> const& runs, std::size_t plainSize) {
  std::int64_t pieces = 0;
  for (Run const& run : runs) pieces += run.CountPieces();
  bool const isLong = pieces > 0 && static_cast<std::uint64_t>(pieces) > plainSize;
  if (!isLong) return WalkAllPairs(data, runs);
  FlatSearch const search(data, runs);
  return search.AreAllPairsValid() ? Verdict{ErrorCode::Ok, search.HasCrossing()}
                                   : WalkAllPairs(data, runs);
}

}  // namespace Vorn::Flat
