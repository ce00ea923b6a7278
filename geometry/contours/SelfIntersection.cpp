// Every element i is tested against the elements k after it. Zero-length elements are skipped, and
// an element of an unknown kind ends the walk like the end of the contour does. The first pass,
// that of the first element, has rules of its own: the closing element may touch the first one, and
// a contour too short to be tested is invalid rather than free of crossings.
//
// Two consecutive segments are not tested: all they can share is their joint.
//
// The plain walk is quadratic in the number of elements and needs no storage. On long contours only
// its first pass is walked; SearchLaterPasses does the others.

#include "geometry/contours/SelfIntersection.h"

#include "geometry/contours/LaterPasses.h"
#include "geometry/contours/Walk.h"

namespace Vorn::Contours {

namespace {

ErrorCode WalkLaterPasses(Walk const& walk, Elem const* first) {
  for (Elem const* i = walk.Next(first); i != nullptr; i = walk.Next(i)) {
    ErrorCode const code = walk.Scan(i, Pass::Later);
    if (code != ErrorCode::Ok) return code;
  }
  return ErrorCode::Ok;
}

}  // namespace

ErrorCode CheckContour(Contour const& contour, std::size_t plainSize) {
  if (contour.empty() || !IsSegment(contour.front())) return ErrorCode::Failed;
  Walk const walk(contour);
  Elem const* const first = walk.Next(contour.data());
  if (first == nullptr) return ErrorCode::Failed;
  ErrorCode const code = walk.Scan(first, Pass::First);
  if (code != ErrorCode::Ok) return code;
  return contour.size() > plainSize ? SearchLaterPasses(walk, first) : WalkLaterPasses(walk, first);
}

}  // namespace Vorn::Contours
