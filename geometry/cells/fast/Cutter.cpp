// Why the shortcuts are exact. E is the bound of the rounding errors (RoundingBound.h); an offset
// is clear when its size is above 1024 E.
//
// - A vertex whose three offsets are clear is inside or outside by their signs; it is on no side.
//
// - A side of the other triangle whose ends are clearly on one side of a line of this one does not
//   cross it. The scaled parameter s of the crossing along that side is the offset of its start,
//   and s - det that of its end: with equal signs, s is out of [0, det] by more than 1024 E at one
//   end, and the computed one is as well. That holds where the exact steps take the two for not
//   parallel: where the offsets differ by more than 4 E. Sides nearer to parallel are looked at one
//   by one.
//
// - Where all vertices of the other triangle are beyond one line, at distances above a 256th of the
//   largest distance G of any of the six vertices from that line, nothing crosses. Say the exact
//   steps took side (a, b) of the other triangle and side (c, d) of this one for crossing.
//     1. The computed s and u were in [0, det]; each is off by E / 2 at most, so are the true ones
//        in [-E, det + E].
//     2. With the true values, (det - s) a + s b = (det - u) c + u d: it is det times the crossing.
//     3. Offsets of a and b from the line are not above -m, with m the least distance. The weights
//        det - s and s add up to det, and a negative one is not below -E: the offset of the left
//        side is not above -det m + E G.
//     4. Offsets of c and d are in [0, G]: the offset of the right side is not below -E G.
//     5. So det m <= 2 E G, and det < 512 E with m above G / 256.
//     6. But side (a, b) has its ends clearly on both sides of the line of (c, d), or the point
//        before excludes it; det is the difference of these two offsets, above 2048 E. A
//        contradiction.
//   The computed distances are off by E / 2 where m is above 1024 E, which the room between 512 and
//   2048 covers.
#include "geometry/cells/fast/Cutter.h"

#include <algorithm>
#include <bit>
#include <limits>

#include "geometry/cells/fast/CutSigns.h"
#include "geometry/cells/fast/Parallel.h"

namespace Vorn::Cells {

namespace {

using Triangles::Overlap;
using Triangles::OverlappingStatus;
using Triangles::PreparedTriangle;

/// How many times nearer to a line than the farthest vertex those beyond it may be (G / m above).
constexpr double kFarRatio = 256.0;

static_assert(2.0 * kFarRatio < 2.0 * kClearance, "steps 5 and 6 of the proof contradict");

/// The first of three bits of each line; the second pair repeats line 0, whose bits are there.
constexpr PairBits kLineBits[2] = {PairBits{1, 8}, PairBits{64, 0}};

/// The bits of the vertices that the lines of a pair start at.
constexpr PairBits kVertexBits[2] = {PairBits{1, 2}, PairBits{4, 0}};

}  // namespace

/// How far the vertices of a triangle are on the inner side of two lines.
struct Cutter::Offsets {
  Offsets(LinePair const& lines, Triangle const& triangle)
      : o0(lines.OffsetsOf(triangle.pts[0])),
        o1(lines.OffsetsOf(triangle.pts[1])),
        o2(lines.OffsetsOf(triangle.pts[2])) {}

  Pair Smallest() const { return Least(Least(Sizes(o0), Sizes(o1)), Sizes(o2)); }

  Pair Largest() const { return Most(Most(Sizes(o0), Sizes(o1)), Sizes(o2)); }

  /// Each lane's bit, shifted by one for every further vertex, where the vertex is inside.
  PairBits InnerBits(PairBits const& bits) const {
    return ((o0 > 0.0) & bits) | ((o1 > 0.0) & (bits << 1)) | ((o2 > 0.0) & (bits << 2));
  }

  /// How little the ends of a side differ.
  Pair Flattest() const { return Least(Least(Sizes(o0 - o1), Sizes(o1 - o2)), Sizes(o2 - o0)); }

  /// As InnerBits, where the ends of the side from a vertex differ by no more than a bound.
  PairBits FlatBits(PairBits const& bits, double bound) const {
    return ((Sizes(o0 - o1) <= bound) & bits) | ((Sizes(o1 - o2) <= bound) & (bits << 1)) |
           ((Sizes(o2 - o0) <= bound) & (bits << 2));
  }

  Pair o0, o1, o2;
};

Cutter::Cutter(Triangle const& triangle, Magnitude const& magnitude) : prepared_(triangle) {
  double const error = ErrorBound(triangle, magnitude);
  double const turn = prepared_.sense < 0 ? -1.0 : 1.0;
  for (int pair = 0; pair < 2; ++pair) {
    for (int lane = 0; lane < 2; ++lane) {
      int const k = (2 * pair + lane) % 3;
      lines_[pair].x[lane] = triangle.pts[k].x;
      lines_[pair].y[lane] = triangle.pts[k].y;
      lines_[pair].dx[lane] = turn * prepared_.sides[k].dx;
      lines_[pair].dy[lane] = turn * prepared_.sides[k].dy;
    }
  }
  area2_ = lines_[0].OffsetsOf(triangle.pts[2])[0];
  clear_ = kClearance * error;
  skew_ = kSkewness * error;
  bool const isProper = area2_ > clear_;
  if (!isProper) clear_ = std::numeric_limits<double>::infinity();
}

Cutter::Rest Cutter::Cut(BoxedTriangle const& other, Overlap* overlap) const {
  Sight sight;
  switch (PlaceOf(other, &sight)) {
    case Place::Within:
      return Rest::Whole;
    case Place::Apart:
      overlap->Reset(OverlappingStatus::NoOverlap);
      return Rest::Parts;
    case Place::Crossing:
      FindSightedOverlap(other, prepared_, sight, overlap);
      return Rest::Parts;
    case Place::Unclear:
      break;
  }
  Triangles::FindOverlap(PreparedTriangle(other.triangle), prepared_, overlap);
  return Rest::Parts;
}

Cutter::Place Cutter::PlaceOf(BoxedTriangle const& other, Sight* sight) const {
  Offsets const offsets[2] = {Offsets(lines_[0], other.triangle),
                              Offsets(lines_[1], other.triangle)};
  Pair const smallest[2] = {offsets[0].Smallest(), offsets[1].Smallest()};
  Pair const least = Least(smallest[0], smallest[1]);
  bool const isClear = (least[0] > clear_) & (least[1] > clear_);
  if (!isClear) return Place::Unclear;
  Pair const flattest = Least(offsets[0].Flattest(), offsets[1].Flattest());
  bool const isAnyFlat = (flattest[0] <= skew_) | (flattest[1] <= skew_);
  if (isAnyFlat) {
    PairBits const flat =
        offsets[0].FlatBits(kLineBits[0], skew_) | offsets[1].FlatBits(kLineBits[1], skew_);
    if (HasSideAlong(Union(flat), other.triangle)) return Place::Unclear;
  }

  PairBits const inner = offsets[0].InnerBits(kLineBits[0]) | offsets[1].InnerBits(kLineBits[1]);
  CutSigns const& signs = kCutSigns[Union(inner)];
  sight->inside = signs.inside;
  sight->outside = VerticesOutside(other);
  sight->mayCross = signs.mayCross;
  if (!sight->IsSecondOutside()) return Place::Crossing;
  if (signs.mayCross == 0) return signs.inside != 0 ? Place::Within : Place::Apart;
  if (signs.beyond < 0) return Place::Crossing;
  int const pair = signs.beyond / 2;
  int const lane = signs.beyond % 2;
  double const nearest = smallest[pair][lane];
  double const farthest = offsets[pair].Largest()[lane];
  return nearest * kFarRatio > std::max(farthest, area2_) ? Place::Apart : Place::Crossing;
}

bool Cutter::HasSideAlong(unsigned flat, Triangle const& other) const {
  for (; flat != 0; flat &= flat - 1) {
    int const bit = std::countr_zero(flat);
    if (IsAlong(prepared_.sides[bit / 3], Triangles::SideOf(other, bit % 3))) return true;
  }
  return false;
}

unsigned Cutter::VerticesOutside(BoxedTriangle const& other) const {
  Triangles::Box const& box = other.box;
  auto const outOfBox = [&box](LinePair const& lines) {
    return (box.xMin > lines.x) | (lines.x > box.xMax) | (box.yMin > lines.y) |
           (lines.y > box.yMax);
  };
  return Union((outOfBox(lines_[0]) & kVertexBits[0]) | (outOfBox(lines_[1]) & kVertexBits[1]));
}

}  // namespace Vorn::Cells
