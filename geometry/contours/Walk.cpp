#include "geometry/contours/Walk.h"

namespace Vorn::Contours {

Elem const* Walk::FirstCandidate(Elem const* elem) const {
  Elem const* const next = Next(elem);
  if (next == nullptr) return nullptr;
  bool const areConsecutiveSegments = IsSegment(*elem) && IsSegment(*next);
  return areConsecutiveSegments ? Next(next) : next;
}

ErrorCode Walk::Scan(Elem const* elem, Pass pass) const {
  ErrorCode const missing = pass == Pass::First ? ErrorCode::Failed : ErrorCode::Ok;
  Elem const* k = FirstCandidate(elem);
  Piece const piece = PieceOf(elem);
  for (bool isFirstCandidate = true; k != nullptr; isFirstCandidate = false) {
    PairPlace const place{pass == Pass::First && IsLast(k), isFirstCandidate, elem + 1 == k};
    switch (Judge(piece, PieceOf(k), place)) {
      case PairResult::Invalid:
        return ErrorCode::Failed;
      case PairResult::Crossing:
        return ErrorCode::SelfIntersection;
      case PairResult::EndOfScan:
        return ErrorCode::Ok;
      case PairResult::Clear:
        break;
    }
    if (IsLast(k)) return ErrorCode::Ok;
    // Deliberate: zero-length elements at the end make the first pass fail, since the last element
    // is the physically last one and is never reached then.
    k = Next(k);
  }
  return missing;
}

}  // namespace Vorn::Contours
