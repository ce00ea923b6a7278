#include "io/pieces/Frame.h"

#include <algorithm>
#include <cmath>

namespace Vorn::IO {

namespace {

/// The offset is a multiple of a power of ten at least this many times the size of the points.
constexpr double kSizesToStep = 32.0;

/// The least power of ten, from 1 on, of which offsets for this size are multiples.
double StepFor(double size) {
  constexpr double kBase = 10.0;
  double step = 1.0;
  while (step < kSizesToStep * size) step *= kBase;
  return step;
}

/// The coordinates of one axis.
struct Range {
  double low = 0.0;
  double high = 0.0;

  double Size() const { return high - low; }
};

/// Whether value - offset is exact for every value of the range. It is where both are within a
/// factor of two: then the difference is a multiple of the last place of either and not larger than
/// the smaller of the two.
bool IsExact(Range const& range, double offset) {
  double const nearest = std::min(std::fabs(range.low), std::fabs(range.high));
  double const furthest = std::max(std::fabs(range.low), std::fabs(range.high));
  bool const isOneSided = (range.low > 0.0) == (range.high > 0.0);
  double const size = std::fabs(offset);
  return isOneSided && 0.5 * size <= nearest && furthest <= 2.0 * size;
}

/// The multiple of the step that is nearest to the middle; 0 where taking it off is not exact.
double OffsetOf(Range const& range, double step) {
  double const offset = std::round((range.low + range.Size() / 2.0) / step) * step;
  return std::isfinite(offset) && IsExact(range, offset) ? offset : 0.0;
}

}  // namespace

XY OriginFor(Extent const& extent) {
  Range const x = {extent.low.x, extent.high.x};
  Range const y = {extent.low.y, extent.high.y};
  double const size = std::max(x.Size(), y.Size());
  if (!(size > 0.0) || !std::isfinite(kSizesToStep * size)) return {0.0, 0.0};
  double const step = StepFor(size);
  return {OffsetOf(x, step), OffsetOf(y, step)};
}

std::vector<Piece> SeenFrom(XY const& origin, std::vector<Piece> pieces) {
  for (Piece& piece : pieces) {
    for (XY* point : {&piece.start, &piece.end, &piece.center}) {
      *point = {point->x - origin.x, point->y - origin.y};
    }
  }
  return pieces;
}

}  // namespace Vorn::IO
