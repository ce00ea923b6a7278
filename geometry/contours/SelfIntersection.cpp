// Does a contour of segments and arcs cross or touch itself?
//
// Every element i is tested against the elements k after it. Zero-length elements are skipped, and
// an element of invalid type ends the walk like the end of the contour does. The first pass, that
// of the first element, has rules of its own: the closing element may touch the first one, and a
// contour too short to be tested is invalid rather than free of crossings.
//
// The end points of arcs never count as intersections, which is how an arc and its neighbours may
// share their joints. Two consecutive segments are not tested: all they can share is their joint.
// The walk is quadratic in the number of elements and needs no storage.

#include <iterator>

#include "geometry/contours/ArcSteps.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

namespace {

using Point = GeometryUtils::Point;
using Arc = GeometryUtils::Arc;
using Elem = GeometryUtils::Elem;
using ElemType = GeometryUtils::ElemType;
using Contour = std::vector<Elem>;
using Iterator = Contour::const_iterator;

using NextIter = ErrorCode (*)(Contour const& contour, Iterator& it, Iterator* next);

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

class Walk {
 public:
  Walk(Contour const& contour, NextIter nextIter, ArcSteps const& arcSteps)
      : contour_(contour), nextIter_(nextIter), arcSteps_(arcSteps) {}

  ErrorCode Run() const {
    if (contour_.empty() || !IsSegment(contour_.begin())) return ErrorCode::Failed;
    Iterator i = contour_.begin();
    if (!Advance(&i)) return ErrorCode::Failed;
    bool isFirstPass = true;
    do {
      ErrorCode const code = ScanCandidates(i, isFirstPass);
      if (code != ErrorCode::Ok) return code;
      isFirstPass = false;
    } while (Advance(&i));
    return ErrorCode::Ok;
  }

 private:
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
  NextIter nextIter_;
  ArcSteps arcSteps_;
};

}  // namespace

ErrorCode GeometryUtils::CheckPolySelfIntersection(std::vector<Elem> const& contour) {
  ArcSteps const arcSteps{&GetLineSegmentAndCircleArcIntersection,
                          &GetCircleArcAndCircleArcIntersection};
  return Walk(contour, &GetNextIter, arcSteps).Run();
}

}  // namespace Vorn
