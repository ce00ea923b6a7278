// Of the later passes it matters which is the first to meet an invalid pair, for that pair ends the
// walk; that can be told without looking at pairs. What is left is whether any pair of an earlier
// pass crosses, and for this the pairs may be taken in any order.

#include "geometry/contours/LaterPasses.h"

#include <cstddef>
#include <vector>

#include "geometry/contours/near/NearPairs.h"

namespace Vorn::Contours {

namespace {

/// Knows which passes over a chain of elements meet an invalid pair, if nothing ends them before.
class InvalidPairs {
 public:
  explicit InvalidPairs(std::vector<Piece> const& chain) : chain_(chain) {
    for (std::size_t k = 0; k < chain.size(); ++k) {
      if (chain[k].IsSegment()) continue;
      lastArc_ = k;
      if (chain[k].arc->startAngle == chain[k].arc->endAngle) lastOfEqualAngles_ = k;
      if (chain[k].arc->radius <= 0.0) lastWithoutRadius_ = k;
    }
  }

  bool HasPass(std::size_t i) const {
    if (chain_[i].IsSegment()) return lastOfEqualAngles_ > i;
    return chain_[i].arc->radius <= 0.0 ? lastArc_ > i : lastWithoutRadius_ > i;
  }

 private:
  std::vector<Piece> const& chain_;
  // The greatest numbers of their kind; 0, which is after no element, also when there is none.
  std::size_t lastArc_ = 0;
  std::size_t lastOfEqualAngles_ = 0;
  std::size_t lastWithoutRadius_ = 0;
};

class Search {
 public:
  Search(Walk const& walk, Elem const* first) : walk_(walk), first_(first) {
    chain_.reserve(walk.CountAfter(first));
    for (Elem const* elem = walk.Next(first); elem != nullptr; elem = walk.Next(elem)) {
      chain_.push_back(Walk::PieceOf(elem));
      hasArcs_ = hasArcs_ || !chain_.back().IsSegment();
    }
  }

  ErrorCode Run() {
    ErrorCode code = ErrorCode::Ok;
    // Segments alone have no invalid pairs, and nothing cuts their passes short.
    if (hasArcs_) code = FindLongPasses();
    if (code == ErrorCode::SelfIntersection) return code;
    return HasCrossing() ? ErrorCode::SelfIntersection : code;
  }

 private:
  /// Looks at each element and the one right after it, up to the first pass that meets an invalid
  /// pair. Gives the code of that pass, or of a crossing found on the way.
  ErrorCode FindLongPasses() {
    isLong_.resize(chain_.size(), false);
    InvalidPairs const invalidPairs(chain_);
    std::size_t i = 0;
    for (Elem const* elem = walk_.Next(first_); i + 1 < chain_.size(); ++i) {
      Elem const* const next = walk_.Next(elem);
      PairResult const result = JudgeNext(i, elem + 1 == next);
      if (result == PairResult::Crossing) return ErrorCode::SelfIntersection;
      if (result != PairResult::EndOfScan) {
        if (invalidPairs.HasPass(i)) {
          ErrorCode const code = walk_.Scan(elem, Pass::Later);
          if (code != ErrorCode::Ok) return code;
        } else {
          isLong_[i] = true;
        }
      }
      elem = next;
    }
    return ErrorCode::Ok;
  }

  PairResult JudgeNext(std::size_t i, bool isNeighbour) const {
    if (chain_[i].IsSegment() && chain_[i + 1].IsSegment()) return PairResult::Clear;
    return Judge(chain_[i], chain_[i + 1], {false, true, isNeighbour});
  }

  /// Does any element of a long pass cross an element after the one right after it? Nothing is
  /// exempted there, and a pair without an answer is an arc that is passed over.
  bool HasCrossing() const {
    return AnyPair(chain_, Neighbours::LeftOut, [this](std::size_t i, std::size_t k) {
      return k > i + 1 && (!hasArcs_ || isLong_[i]) &&
             Judge(chain_[i], chain_[k], {}) == PairResult::Crossing;
    });
  }

  Walk const& walk_;
  Elem const* first_;
  std::vector<Piece> chain_;
  bool hasArcs_ = false;
  /// Passes that look beyond the element right after theirs; the others are cut short by a touch.
  std::vector<bool> isLong_;
};

}  // namespace

ErrorCode SearchLaterPasses(Walk const& walk, Elem const* first) {
  return Search(walk, first).Run();
}

}  // namespace Vorn::Contours
