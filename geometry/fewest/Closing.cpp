#include "geometry/fewest/Closing.h"

#include <algorithm>
#include <limits>
#include <utility>

#include "geometry/fewest/Circuit.h"

namespace Vorn::Fewest {

namespace {

/// Joints at which a closed chain is tried to begin.
constexpr std::size_t kMostSeams = 4;

/// How many pieces there are while no contour is found.
constexpr std::size_t kNoContour = std::numeric_limits<std::size_t>::max();

/// Whether so many pieces from a seam on may lead around with fewer than `limit`: they have to be
/// ahead of a circuit with these leads. Where they are not they fall into step with it.
bool MaySave(std::span<std::int32_t const> leads, std::size_t pieces, std::int32_t covered,
             std::size_t limit) {
  if (limit == kNoContour || pieces + leads.size() <= limit) return true;
  std::size_t const asMany = pieces + leads.size() - limit;
  return asMany <= leads.size() && covered > leads[asMany - 1];
}

/// Takes the best of the contours that are tried.
class Closing {
 public:
  Closing(ClosingTask const& task, ClosedContour* best) : task_(task), best_(*best) {}

  /// A piece less than this is worth a search.
  std::size_t Count() const { return best_.isKept ? best_.answer.ranges.size() : kNoContour; }

  /// Tries to close a circuit along its gates.
  void Follow(Circuit const& circuit) {
    if (circuit.size() < 2 || circuit.size() >= Count()) return;
    for (Seam const& seam : SharpestJoints(circuit, kMostSeams)) {
      CutPath cut = CutAt(task_.path, seam);
      Chain const chain = CloseCircuit(&cut, circuit, seam.piece, task_.share);
      Offer(cut, chain);
      if (Count() <= circuit.size()) return;
    }
  }

  /// Searches anew at joints as long as that may save a piece. The circuit tells where it may not.
  void Search(std::vector<Seam> const& seams, Circuit const& circuit) {
    // Where chains break promises those of other seams mostly do so too; smaller tolerances help.
    if (!best_.isKept && !best_.answer.ranges.empty()) return;
    for (Seam const& seam : seams) {
      if (Count() <= task_.bound) return;
      CutPath cut = CutAt(task_.path, seam);
      std::size_t const limit = Count();
      std::vector<std::int32_t> const leads = LeadsFrom(cut, circuit);
      GoesOn const goesOn = [&](std::size_t pieces, std::int32_t covered) {
        task_.tell(covered);
        return MaySave(leads, pieces, covered, limit);
      };
      Chain const chain = CloseChain(&cut, task_.share, goesOn);
      Offer(cut, chain);
    }
  }

 private:
  /// Keeps a contour that is the first or better than the one held.
  void Offer(CutPath const& cut, Chain const& chain) {
    if (chain.pieces.empty() || chain.pieces.size() >= Count()) return;
    ClosedContour next;
    next.isKept = task_.keeps(cut, chain, &next.answer, &next.report);
    if (next.isKept || !best_.isKept) best_ = std::move(next);
  }

  ClosingTask const& task_;
  ClosedContour& best_;
};

}  // namespace

ClosedContour CloseAnywhere(ClosingTask const& task) {
  ClosedContour best;
  Closing closing(task, &best);
  GoesOn const goesOn = [&](std::size_t, std::int32_t covered) {
    task.tell(std::min(covered, task.path.Count()));
    return true;
  };
  Circuit const forwards = FindCircuit(task.path, task.share, goesOn);
  closing.Follow(forwards);
  if (closing.Count() > task.bound) {
    closing.Follow(FindCircuitBackwards(task.path, task.share, task.runStarts, closing.Count()));
  }
  closing.Search(SharpestJoints(forwards, kMostSeams), forwards);
  best.isShort = closing.Count() <= std::max(forwards.size(), task.bound);
  return best;
}

void CloseAtJoints(ClosingTask const& task, Chain const& open, ClosedContour* best) {
  Closing(task, best).Search(SharpestJoints(task.path, open, kMostSeams), {});
}

}  // namespace Vorn::Fewest
