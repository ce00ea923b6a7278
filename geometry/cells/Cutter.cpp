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
//   parallel segments follow other rules.
// - Where all vertices of the other triangle are beyond one line, at distances above a 256th of
//   the largest distance of any of the six vertices from that line, nothing crosses: weighting the
//   ends by scaled parameters in [-E, det + 2 E], a point of one segment would have to lie at an
//   offset of det m or more beyond the line, and the same point of the other not above 6 E G, with
//   m the least and G the largest distance; but a side that does cross the line of another one has
//   det > 2048 E.
// - A triangle whose vertices are clearly on one side of a chord does not cross it, by the same
//   argument as for one side; the side (P2, P2) has no length and is out of its box.
#include "geometry/cells/Cutter.h"

#include <algorithm>
#include <array>
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

/// Above this, sums of products of coordinates may overflow.
constexpr double kLargestError = 1e250;

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

template <typename Pair>
Pair Least(Pair const& a, Pair const& b) {
  return b < a ? b : a;
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

  Pair SmallestDifference() const {
    return Least(Least(Sizes(o0 - o1), Sizes(o1 - o2)), Sizes(o2 - o0));
  }

  /// Each lane's bit, shifted by one for every further vertex, where the vertex is inside.
  Bits InnerBits(Bits const& bits) const {
    return ((o0 > 0.0) & bits) | ((o1 > 0.0) & (bits << 1)) | ((o2 > 0.0) & (bits << 2));
  }

  Pair o0, o1, o2;
};

/// Whether a side counts as parallel to one of a triangle. A side of no length does not: it is a
/// point, and clearly on no line.
bool IsParallelToASide(Shape::Side const& side, Triangle const& triangle) {
  for (int i = 0; i < 3; ++i) {
    double const dx = triangle.pts[(i + 1) % 3].x - triangle.pts[i].x;
    double const dy = triangle.pts[(i + 1) % 3].y - triangle.pts[i].y;
    bool const isPoint = dx == 0.0 && dy == 0.0;
    if (!isPoint && Numeric::IsZeroMagnitude(side.dy * dx - dy * side.dx)) return true;
  }
  return false;
}

/// The bound of rounding errors, or infinity where that is not the only thing to fear.
double ErrorBound(Triangle const& triangle, Magnitude const& ofOthers) {
  Magnitude whole = ofOthers;
  whole.Include(triangle);
  double const error = kErrorBound * whole.x * whole.y + whole.doubt;
  bool const isUsable = error > kLeastError && error < kLargestError;
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

void Cutter::FindOverlapWith(BoxedTriangle const& other, Overlap* overlap) const {
  Sight sight;
  switch (PlaceOf(other, &sight)) {
    case Place::Apart:
      overlap->status = GeometryUtils::OverlappingStatus::NoOverlap;
      overlap->parts.clear();
      break;
    case Place::Within:
      overlap->status = GeometryUtils::OverlappingStatus::Overlap;
      overlap->parts.clear();
      for (int copy = 0; copy < 3; ++copy) overlap->parts.push_back(other.triangle);
      break;
    case Place::Crossing:
      FindOverlap(other, shape_, sight, overlap);
      break;
    case Place::Unclear:
      FindOverlap(Shape(other.triangle), shape_, overlap);
      break;
  }
}

Cutter::Place Cutter::PlaceOf(BoxedTriangle const& other, Sight* sight) const {
  using Offsets = OffsetsFrom<LinePair>;
  Offsets const first(lines_[0], other.triangle);
  Offsets const second(lines_[1], other.triangle);
  Pair const least = Least(first.Smallest(), second.Smallest());
  Pair const leastSkew = Least(first.SmallestDifference(), second.SmallestDifference());
  bool const isClear = (least[0] > clear_) & (least[1] > clear_);
  if (!isClear) return Place::Unclear;
  bool const isSkew = (leastSkew[0] > skew_) & (leastSkew[1] > skew_);
  if (!isSkew && HasSideParallelTo(other.triangle)) return Place::Unclear;

  Bits const inner = first.InnerBits(Bits{1, 8}) | second.InnerBits(Bits{64, 0});
  Signs const& signs = kSigns[static_cast<std::size_t>(inner[0] | inner[1])];
  sight->inside = signs.inside;
  sight->mayCross = signs.mayCross;
  if (signs.inside == 7U) return IsOutOfBoxOf(other) ? Place::Within : Place::Crossing;
  bool const isApart = signs.beyond >= 0 && IsFarBeyond(signs.beyond, other) && IsOutOfBoxOf(other);
  return isApart ? Place::Apart : Place::Crossing;
}

/// Whether a side of the other triangle counts as parallel to one of this one.
bool Cutter::HasSideParallelTo(Triangle const& other) const {
  return std::any_of(std::begin(shape_.sides), std::end(shape_.sides),
                     [&other](Shape::Side const& side) { return IsParallelToASide(side, other); });
}

/// Whether vertices beyond a line are not much nearer to it than any vertex is.
bool Cutter::IsFarBeyond(int line, BoxedTriangle const& other) const {
  LinePair const& pair = lines_[line / 2];
  int const lane = line % 2;
  double const o0 = pair.OffsetsOf(other.triangle.pts[0])[lane];
  double const o1 = pair.OffsetsOf(other.triangle.pts[1])[lane];
  double const o2 = pair.OffsetsOf(other.triangle.pts[2])[lane];
  double const nearest = -std::max({o0, o1, o2});
  double const farthest = -std::min({o0, o1, o2});
  return nearest * kFarRatio > std::max(farthest, area2_);
}

/// Whether no vertex of this triangle can be in or on the other one.
bool Cutter::IsOutOfBoxOf(BoxedTriangle const& other) const {
  Point const* const pts = shape_.triangle.pts;
  return other.IsOutOfBox(pts[0]) && other.IsOutOfBox(pts[1]) && other.IsOutOfBox(pts[2]);
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
         !IsParallelToASide(along, other.triangle);
}

}  // namespace Vorn::Cells
