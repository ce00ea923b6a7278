// Why the shortcuts are exact.
//
// Let X and Y bound the coordinates. Every offset, area, determinant and scaled parameter of an
// overlap is a sum of a few products of coordinates or of their differences; each is off its true
// value by less than E = 2^-47 X Y (the roundings add up to at most half of that). An offset is
// clear when its size is above 1024 E, so its sign is the true one, and so are the signs of all
// other formulas for it.
//
// - A vertex whose three offsets are clear is inside or outside by their signs; it is on no side.
// - A side of the other triangle whose ends are clearly on one side of a line of this one does not
//   cross it: the true scaled parameter s of the crossing is out of [0, det] by more than 1024 E at
//   one end. The two offsets must differ by more than 4 E, since their difference is det, and
//   parallel segments follow other rules, unless their boxes are apart.
// - Where all vertices of the other triangle are beyond one line, at distances above a 256th of
//   the largest distance of any of the six vertices from that line, nothing crosses: weighting the
//   ends by scaled parameters in [-E, det + 2 E], a point of one segment would have to lie at an
//   offset of det m or more beyond the line, and the same point of the other not above 6 E G, with
//   m the least and G the largest distance; but a side that does cross the line of another one has
//   det > 2048 E.
// - A triangle whose vertices are clearly on one side of a chord does not cross it, by the same
//   argument as for one side; the side (P2, P2) has no length and is out of its box.
#include "geometry/cells/fast/Cutter.h"

#include <algorithm>
#include <array>
#include <bit>
#include <limits>

#include "math/NumericConstants.h"

namespace Vorn::Cells {

namespace {

using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;

/// The bound of the rounding errors for coordinates of size 1.
constexpr double kErrorBound = 0x1p-47;

/// How many times larger a clear offset is than a rounding error.
constexpr double kClearance = 1024.0;

/// Two offsets that differ by more errors than this differ in truth.
constexpr double kSkewness = 4.0;

/// How much nearer to a line than the farthest vertex one beyond it may be.
constexpr double kFarRatio = 256.0;

/// Below this, products of coordinates may be subnormal, which rounds by other rules.
constexpr double kLeastError = 1e-250;

/// Above this, products of three coordinates, as in a crossing point, may overflow.
constexpr double kLargestCoordinate = 1e100;

/// What the signs of nine offsets say.
struct Signs {
  std::uint16_t inside;    ///< bit v: vertex v is inside
  std::uint16_t mayCross;  ///< bit 3 i + k: side i changes over line k
  std::int16_t beyond;     ///< a line that all vertices are beyond, or -1
};

constexpr bool IsInner(unsigned inner, unsigned k, unsigned v) {
  return (inner >> (3 * k + v) & 1U) != 0;
}

/// For every pattern of inner vertices; bit 3 k + v: vertex v is on the inner side of line k.
constexpr std::array<Signs, 512> kSigns = [] {
  std::array<Signs, 512> all{};
  for (unsigned inner = 0; inner < 512; ++inner) {
    Signs signs{0, 0, -1};
    for (unsigned k = 0; k < 3; ++k) {
      if ((inner >> 3 * k & 7U) == 0) signs.beyond = static_cast<std::int16_t>(k);
    }
    for (unsigned v = 0; v < 3; ++v) {
      bool isInside = true;
      for (unsigned k = 0; k < 3; ++k) {
        isInside = isInside && IsInner(inner, k, v);
        bool const changes = IsInner(inner, k, v) != IsInner(inner, k, (v + 1) % 3);
        if (changes)
          signs.mayCross = static_cast<std::uint16_t>(signs.mayCross | 1U << (3 * v + k));
      }
      if (isInside) signs.inside = static_cast<std::uint16_t>(signs.inside | 1U << v);
    }
    all[inner] = signs;
  }
  return all;
}();

using Bits [[gnu::vector_size(16)]] = std::int64_t;

/// The first of three bits of each line; the second pair repeats line 0, whose bits are there.
constexpr Bits kLineBits[2] = {{1, 8}, {64, 0}};

unsigned Union(Bits const& bits) { return static_cast<unsigned>(bits[0] | bits[1]); }

template <typename Pair>
Pair Least(Pair const& a, Pair const& b) {
  return b < a ? b : a;
}

template <typename Pair>
Pair Most(Pair const& a, Pair const& b) {
  return b > a ? b : a;
}

/// Without signs.
template <typename Pair>
Pair Sizes(Pair const& a) {
  return reinterpret_cast<Pair>(reinterpret_cast<Bits>(a) &
                                std::numeric_limits<std::int64_t>::max());
}

/// How far the vertices of a triangle are on the inner side of two lines.
template <typename LinePair>
struct OffsetsFrom {
  using Pair = decltype(LinePair::x);

  OffsetsFrom(LinePair const& lines, Triangle const& triangle)
      : o0(lines.OffsetsOf(triangle.pts[0])),
        o1(lines.OffsetsOf(triangle.pts[1])),
        o2(lines.OffsetsOf(triangle.pts[2])) {}

  Pair Smallest() const { return Least(Least(Sizes(o0), Sizes(o1)), Sizes(o2)); }

  /// As InnerBits, where the ends of the side from a vertex differ by no more than a bound.
  Bits FlatBits(Bits const& bits, Pair const& bound) const {
    return ((Sizes(o0 - o1) <= bound) & bits) | ((Sizes(o1 - o2) <= bound) & (bits << 1)) |
           ((Sizes(o2 - o0) <= bound) & (bits << 2));
  }

  Pair Largest() const { return Most(Most(Sizes(o0), Sizes(o1)), Sizes(o2)); }

  /// Each lane's bit, shifted by one for every further vertex, where the vertex is inside.
  Bits InnerBits(Bits const& bits) const {
    return ((o0 > 0.0) & bits) | ((o1 > 0.0) & (bits << 1)) | ((o2 > 0.0) & (bits << 2));
  }

  Pair o0, o1, o2;
};

bool AreBoxesApart(Shape::Side const& side, Point const& start, Point const& end) {
  return std::max(start.x, end.x) < side.xLow || side.xHigh < std::min(start.x, end.x) ||
         std::max(start.y, end.y) < side.yLow || side.yHigh < std::min(start.y, end.y);
}

/// Whether two sides count as parallel and are not apart by their boxes. A side of no length is
/// along nothing: it is a point, and clearly on no line.
bool IsAlong(Shape::Side const& side, Point const& start, Point const& end) {
  double const dx = end.x - start.x;
  double const dy = end.y - start.y;
  bool const isPoint = dx == 0.0 && dy == 0.0;
  return !isPoint && Numeric::IsZeroMagnitude(side.dy * dx - dy * side.dx) &&
         !AreBoxesApart(side, start, end);
}

bool IsAlongASide(Shape::Side const& side, Triangle const& triangle) {
  Point const* const pts = triangle.pts;
  return IsAlong(side, pts[0], pts[1]) || IsAlong(side, pts[1], pts[2]) ||
         IsAlong(side, pts[2], pts[0]);
}

/// The bound of rounding errors, or infinity where that is not the only thing to fear.
double ErrorBound(Triangle const& triangle, Magnitude const& ofOthers) {
  Magnitude whole = ofOthers;
  whole.Include(triangle);
  double const error = kErrorBound * whole.x * whole.y + whole.doubt;
  bool const isUsable =
      error > kLeastError && whole.x < kLargestCoordinate && whole.y < kLargestCoordinate;
  return isUsable ? error : std::numeric_limits<double>::infinity();
}

}  // namespace

Cutter::Cutter(Triangle const& triangle, Magnitude const& magnitude) : shape_(triangle) {
  double const error = ErrorBound(triangle, magnitude);
  double const turn = shape_.sense < 0 ? -1.0 : 1.0;
  for (int pair = 0; pair < 2; ++pair) {
    for (int lane = 0; lane < 2; ++lane) {
      int const k = (2 * pair + lane) % 3;
      lines_[pair].x[lane] = triangle.pts[k].x;
      lines_[pair].y[lane] = triangle.pts[k].y;
      vertices_[pair].x[lane] = triangle.pts[k].x;
      vertices_[pair].y[lane] = triangle.pts[k].y;
      lines_[pair].dx[lane] = turn * shape_.sides[k].dx;
      lines_[pair].dy[lane] = turn * shape_.sides[k].dy;
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
      overlap->status = GeometryUtils::OverlappingStatus::NoOverlap;
      overlap->parts.clear();
      return Rest::Parts;
    case Place::Crossing:
      FindOverlap(other, shape_, sight, overlap);
      return Rest::Parts;
    case Place::Unclear:
      break;
  }
  FindOverlap(Shape(other.triangle), shape_, overlap);
  return Rest::Parts;
}

Cutter::Place Cutter::PlaceOf(BoxedTriangle const& other, Sight* sight) const {
  using Offsets = OffsetsFrom<LinePair>;
  Offsets const offsets[2] = {Offsets(lines_[0], other.triangle),
                              Offsets(lines_[1], other.triangle)};
  Pair const smallest[2] = {offsets[0].Smallest(), offsets[1].Smallest()};
  Pair const least = Least(smallest[0], smallest[1]);
  bool const isClear = (least[0] > clear_) & (least[1] > clear_);
  if (!isClear) return Place::Unclear;
  Pair const skew = {skew_, skew_};
  Bits const flat =
      offsets[0].FlatBits(kLineBits[0], skew) | offsets[1].FlatBits(kLineBits[1], skew);
  if (Union(flat) != 0 && HasSideAlong(Union(flat), other.triangle)) return Place::Unclear;

  Bits const inner = offsets[0].InnerBits(kLineBits[0]) | offsets[1].InnerBits(kLineBits[1]);
  Signs const& signs = kSigns[Union(inner)];
  sight->inside = signs.inside;
  sight->outside = VerticesOutside(other);
  sight->mayCross = signs.mayCross;
  if (!sight->IsSecondOutside()) return Place::Crossing;
  if (signs.mayCross == 0) return signs.inside != 0 ? Place::Within : Place::Apart;
  if (signs.beyond < 0) return Place::Crossing;
  // Vertices beyond a line that are not much nearer to it than any vertex is.
  int const pair = signs.beyond / 2;
  int const lane = signs.beyond % 2;
  double const nearest = smallest[pair][lane];
  double const farthest = offsets[pair].Largest()[lane];
  return nearest * kFarRatio > std::max(farthest, area2_) ? Place::Apart : Place::Crossing;
}

/// Whether one of the sides with a bit in `flat` counts as parallel to the line of that bit, and is
/// near the side on it.
bool Cutter::HasSideAlong(unsigned flat, Triangle const& other) const {
  for (; flat != 0; flat &= flat - 1) {
    int const bit = std::countr_zero(flat);
    int const i = bit % 3;
    if (IsAlong(shape_.sides[bit / 3], other.pts[i], other.pts[(i + 1) % 3])) return true;
  }
  return false;
}

/// The vertices of this triangle that surely are neither in nor on the other one.
unsigned Cutter::VerticesOutside(BoxedTriangle const& other) const {
  auto const outOfBox = [&](PointPair const& p) {
    return (other.xMin > p.x) | (p.x > other.xMax) | (other.yMin > p.y) | (p.y > other.yMax);
  };
  return Union((outOfBox(vertices_[0]) & Bits{1, 2}) | (outOfBox(vertices_[1]) & Bits{4, 0}));
}

ChordCutter::ChordCutter(Triangle const& chord, Magnitude const& magnitude) : shape_(chord) {
  Point const* const pts = chord.pts;
  bool const isChord = pts[1].x == pts[2].x && pts[1].y == pts[2].y;
  clear_ =
      isChord ? kClearance * ErrorBound(chord, magnitude) : std::numeric_limits<double>::infinity();
}

void ChordCutter::FindOverlapWith(BoxedTriangle const& other, Overlap* overlap) const {
  if (IsClearlyApartFrom(other)) {
    overlap->status = GeometryUtils::OverlappingStatus::NoOverlap;
    overlap->parts.clear();
  } else {
    FindOverlap(shape_, Shape(other.triangle), overlap);
  }
}

bool ChordCutter::IsClearlyApartFrom(BoxedTriangle const& other) const {
  Point const& start = shape_.triangle.pts[0];
  Shape::Side const& along = shape_.sides[0];
  auto const offsetOf = [&](Point const& p) {
    return (p.x - start.x) * along.dy - (p.y - start.y) * along.dx;
  };
  double const o0 = offsetOf(other.triangle.pts[0]);
  double const o1 = offsetOf(other.triangle.pts[1]);
  double const o2 = offsetOf(other.triangle.pts[2]);
  bool const isClear = ((o0 > clear_) & (o1 > clear_) & (o2 > clear_)) |
                       ((o0 < -clear_) & (o1 < -clear_) & (o2 < -clear_));
  return isClear && other.IsOutOfBox(start) && other.IsOutOfBox(shape_.triangle.pts[1]) &&
         !IsAlongASide(along, other.triangle);
}

}  // namespace Vorn::Cells
