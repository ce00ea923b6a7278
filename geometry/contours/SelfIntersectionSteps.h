#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "geometry/contours/ArcSteps.h"
#include "geometry/contours/PolylineLayout.h"
#include "vorn/GeometryUtils.h"

/// The self-intersection tests behind the public operations. Up to plainSize pieces they compare
/// all pairs; beyond it they look for the pairs that come near each other. The answer is the same.
namespace Vorn::Contours {

/// Where the search for near pairs begins to pay, as measured on rings, teeth and needles.
inline constexpr std::size_t kPlainSize = 32;

struct ContourSteps {
  using Contour = std::vector<GeometryUtils::Elem>;
  using NextIter = ErrorCode (*)(Contour const& contour, Contour::const_iterator& it,
                                 Contour::const_iterator* next);
  NextIter nextIter;
  ArcSteps arcSteps;
};

ErrorCode CheckContour(std::vector<GeometryUtils::Elem> const& contour, ContourSteps const& steps,
                       std::size_t plainSize);

/// A run of a flat polyline.
struct FlatRun {
  std::int32_t kind;
  std::int64_t stride;
  std::int64_t begin;
  std::int64_t end;  ///< the offset of the last vertex, where no piece of the run starts
};

/// What a pair of pieces, or all pairs up to now, say.
struct FlatVerdict {
  ErrorCode code = ErrorCode::Ok;
  bool isCrossing = false;

  bool IsFinal() const { return isCrossing || code != ErrorCode::Ok; }
};

FlatVerdict CheckRuns(Flat::Data const& data, std::vector<FlatRun> const& runs,
                      ArcSteps const& arcSteps, std::size_t plainSize);

}  // namespace Vorn::Contours
