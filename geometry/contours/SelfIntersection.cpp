// Does a contour of segments and arcs cross or touch itself?
//
// Every element i is tested against the elements k after it. Zero-length elements are skipped, and
// an element of invalid type ends the walk like the end of the contour does. The first pass, that
// of the first element, has rules of its own: the closing element may touch the first one, and a
// contour too short to be tested is invalid rather than free of crossings.
//
// The end points of arcs never count as intersections, which is how an arc and its neighbours may
// share their joints. Two consecutive segments are not tested: all they can share is their joint.
//
// The plain walk is quadratic in the number of elements and needs no storage. On long contours only
// its first pass is walked. Of the later ones it matters which is the first to meet an invalid
// pair, for that pair ends the walk; that can be told without looking at pairs. What is left is
// whether any pair of an earlier pass crosses, and for this the pairs may be taken in any order.

#include <iterator>

#include "geometry/contours/SelfIntersectionSteps.h"
#include "geometry/contours/near/PieceExtents.h"
#include "geometry/intersections/SegmentPair.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

namespace {

using Point = GeometryUtils::Point;
using Arc = GeometryUtils::Arc;
using Elem = GeometryUtils::Elem;
using ElemType = GeometryUtils::ElemType;
using Contour = std::vector<Elem>;
using Iterator = Contour::const_iterator;

enum class PairResult { Clear, EndOfScan, Crossing, Invalid };

/// Where the pair (i, k) stands in the contour.
struct PairPlace {
  bool isClosing;         ///< i is the first element and k the last of the contour
  bool isFirstCandidate;  ///< k is the first element that i is tested against
  bool isNeighbour;       ///< k comes physically right after i
};

Point const& StartOf(Iterator elem) { return std::prev(elem)->end; }

bool IsSegment(Iterator elem) { return elem->type == ElemType::Segment; }

PairResult JudgeTouch(int count, bool isAccepted) {
  if (count == 0 || (count == 1 && isAccepted)) return PairResult::Clear;
  return PairResult::Crossing;
}

/// Knows which passes over a chain of elements meet an invalid pair, if nothing ends them before.
class InvalidPairs {
 public:
  explicit InvalidPairs(std::vector<Iterator> const& chain) : chain_(chain) {
    for (std::size_t k = 0; k < chain.size(); ++k) {
      if (IsSegment(chain[k])) continue;
      lastArc_ = k;
      if (chain[k]->startAngle == chain[k]->endAngle) lastOfEqualAngles_ = k;
      if (chain[k]->radius <= 0.0) lastWithoutRadius_ = k;
    }
  }

  bool HasPass(std::size_t i) const {
    if (IsSegment(chain_[i])) return lastOfEqualAngles_ > i;
    return chain_[i]->radius <= 0.0 ? lastArc_ > i : lastWithoutRadius_ > i;
  }

 private:
  std::vector<Iterator> const& chain_;
  // The greatest numbers of their kind; 0, which is after no element, also when there is none.
  std::size_t lastArc_ = 0;
  std::size_t lastOfEqualAngles_ = 0;
  std::size_t lastWithoutRadius_ = 0;
};

class Walk {
 public:
  Walk(Contour const& contour, Contours::ContourSteps const& steps)
      : contour_(contour), nextIter_(steps.nextIter), arcSteps_(steps.arcSteps) {}

  ErrorCode Run(std::size_t plainSize) const {
    if (contour_.empty() || !IsSegment(contour_.begin())) return ErrorCode::Failed;
    Iterator first = contour_.begin();
    if (!Advance(&first)) return ErrorCode::Failed;
    ErrorCode const code = ScanCandidates(first, true);
    if (code != ErrorCode::Ok) return code;
    return contour_.size() > plainSize ? SearchLaterPasses(first) : WalkLaterPasses(first);
  }

 private:
  using Chain = std::vector<Iterator>;

  ErrorCode WalkLaterPasses(Iterator first) const {
    for (Iterator i = first; Advance(&i);) {
      ErrorCode const code = ScanCandidates(i, false);
      if (code != ErrorCode::Ok) return code;
    }
    return ErrorCode::Ok;
  }

  ErrorCode SearchLaterPasses(Iterator first) const {
    Chain chain;
    chain.reserve(contour_.size());
    for (Iterator i = first; Advance(&i);) chain.push_back(i);
    InvalidPairs const invalidPairs(chain);
    // Passes that look beyond the element right after i; the others are cut short by a touch.
    std::vector<bool> isLong(chain.size(), false);
    ErrorCode code = ErrorCode::Ok;
    for (std::size_t i = 0; i + 1 < chain.size() && code == ErrorCode::Ok; ++i) {
      PairResult const next = TestNext(chain[i], chain[i + 1]);
      if (next == PairResult::Crossing) return ErrorCode::SelfIntersection;
      if (next == PairResult::EndOfScan) continue;
      if (invalidPairs.HasPass(i)) {
        code = ScanCandidates(chain[i], false);
      } else {
        isLong[i] = true;
      }
    }
    if (code == ErrorCode::SelfIntersection) return code;
    return HasCrossing(chain, isLong) ? ErrorCode::SelfIntersection : code;
  }

  PairResult TestNext(Iterator i, Iterator k) const {
    if (IsSegment(i) && IsSegment(k)) return PairResult::Clear;
    return TestPair(i, k, {false, true, std::next(i) == k});
  }

  /// Does any element of a long pass cross an element after the one right after it? Nothing is
  /// exempted there, and a negative count means an arc that is passed over.
  bool HasCrossing(Chain const& chain, std::vector<bool> const& isLong) const {
    std::vector<Contours::Shape> shapes;
    shapes.reserve(chain.size());
    for (Iterator const elem : chain) {
      shapes.push_back({StartOf(elem), elem->end, IsSegment(elem) ? nullptr : &*elem});
    }
    return Contours::AnyPair(shapes, [&](std::size_t i, std::size_t k) {
      return k > i + 1 && isLong[i] && DoCross(shapes[i], shapes[k]);
    });
  }

  bool DoCross(Contours::Shape const& a, Contours::Shape const& b) const {
    if (a.arc != nullptr) {
      return (b.arc != nullptr ? arcSteps_.CountArcArc(*a.arc, *b.arc)
                               : arcSteps_.CountSegmentArc(b.start, b.end, *a.arc)) > 0;
    }
    if (b.arc != nullptr) return arcSteps_.CountSegmentArc(a.start, a.end, *b.arc) > 0;
    return Intersections::HaveOneCommonPoint({a.start, a.end}, {b.start, b.end});
  }

  /// Moves to the next element of non-zero length. False, it untouched, when there is none before
  /// the end of the contour or before an element of invalid type.
  bool Advance(Iterator* it) const {
    Iterator next;
    if (nextIter_(contour_, *it, &next) != ErrorCode::Ok) return false;
    *it = next;
    return true;
  }

  bool IsLast(Iterator elem) const { return std::next(elem) == contour_.end(); }

  /// Moves from i to the first element it is tested against.
  bool AdvanceToFirstCandidate(Iterator i, Iterator* k) const {
    *k = i;
    if (!Advance(k)) return false;
    bool const areConsecutiveSegments = IsSegment(i) && IsSegment(*k);
    return !areConsecutiveSegments || Advance(k);
  }

  ErrorCode ScanCandidates(Iterator i, bool isFirstPass) const {
    ErrorCode const missing = isFirstPass ? ErrorCode::Failed : ErrorCode::Ok;
    Iterator k;
    if (!AdvanceToFirstCandidate(i, &k)) return missing;
    bool isFirstCandidate = true;
    while (true) {
      PairPlace const place{isFirstPass && IsLast(k), isFirstCandidate, std::next(i) == k};
      switch (TestPair(i, k, place)) {
        case PairResult::Invalid:
          return ErrorCode::Failed;
        case PairResult::Crossing:
          return ErrorCode::SelfIntersection;
        case PairResult::EndOfScan:
          return ErrorCode::Ok;
        case PairResult::Clear:
          break;
      }
      // Deliberate: zero-length elements at the end make the first pass fail, since the last
      // element is the physically last one and is never reached then.
      if (IsLast(k)) return ErrorCode::Ok;
      if (!Advance(&k)) return missing;
      isFirstCandidate = false;
    }
  }

  PairResult TestPair(Iterator i, Iterator k, PairPlace const& place) const {
    if (IsSegment(i)) {
      return IsSegment(k) ? TestSegmentSegment(i, k, place) : TestSegmentArc(i, k, place);
    }
    return IsSegment(k) ? TestArcSegment(i, k, place) : TestArcArc(i, k, place);
  }

  /// Only a single common point is a crossing: parallel and overlapping segments are not.
  PairResult TestSegmentSegment(Iterator i, Iterator k, PairPlace const& place) const {
    if (place.isClosing) return PairResult::EndOfScan;
    Point const& a = StartOf(i);
    Point const& b = StartOf(k);
    double x = 0.0;
    double y = 0.0;
    SegmentsRelPosition const relation = GeometryUtils::GetLineSegmentsIntersection(
        a.x, a.y, i->end.x, i->end.y, b.x, b.y, k->end.x, k->end.y, &x, &y);
    return relation == SegmentsRelPosition::Intersecting ? PairResult::Crossing : PairResult::Clear;
  }

  PairResult TestSegmentArc(Iterator i, Iterator k, PairPlace const& place) const {
    int const count = arcSteps_.CountSegmentArc(StartOf(i), i->end, *k);
    if (count < 0) return PairResult::Invalid;
    return JudgeTouch(count, place.isClosing);
  }

  PairResult TestArcSegment(Iterator i, Iterator k, PairPlace const& place) const {
    int const count = arcSteps_.CountSegmentArc(StartOf(k), k->end, *i);
    // Deliberate: unlike as a candidate, an arc of equal angles passes here for free of crossings.
    if (count < 0) return PairResult::Clear;
    return JudgeTouch(count, place.isFirstCandidate || place.isClosing);
  }

  PairResult TestArcArc(Iterator i, Iterator k, PairPlace const& place) const {
    int const count = arcSteps_.CountArcArc(*i, *k);
    if (count < 0) return PairResult::Invalid;
    bool const isAccepted = place.isNeighbour || place.isClosing;
    // Deliberate: an accepted touch of two arcs ends the scan of i; the elements after k are not
    // looked at.
    if (count == 1 && isAccepted) return PairResult::EndOfScan;
    return JudgeTouch(count, isAccepted);
  }

  Contour const& contour_;
  Contours::ContourSteps::NextIter nextIter_;
  ArcSteps arcSteps_;
};

}  // namespace

ErrorCode Contours::CheckContour(Contour const& contour, ContourSteps const& steps,
                                 std::size_t plainSize) {
  return Walk(contour, steps).Run(plainSize);
}

ErrorCode GeometryUtils::CheckPolySelfIntersection(std::vector<Elem> const& contour) {
  ArcSteps const arcSteps{&GetLineSegmentAndCircleArcIntersection,
                          &GetCircleArcAndCircleArcIntersection};
  return Contours::CheckContour(contour, {&GetNextIter, arcSteps}, Contours::kPlainSize);
}

}  // namespace Vorn
