// What makes it safe to leave pairs out. u = 2^-53 is the relative error of one operation; errors
// of higher order are covered by rounding the sums up.
//
// Underflow adds nothing that matters: magnitudes that count as regular are zero or above 2^-200,
// so differences of coordinates are zero or above 2^-253, and products of two of them are normal.

#include "geometry/contours/near/PieceExtents.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <cstdint>
#include <limits>
#include <utility>

#include "math/NumericConstants.h"

namespace Vorn::Contours {

namespace {

constexpr double kUnit = 0.5 * std::numeric_limits<double>::epsilon();

// Segments, M being the largest coordinate.
//
// Segments whose boxes are apart are Disjoint by the first step of their intersection, without any
// rounding. Of the others, three cross products decide: the scaled parameters s and u and the
// determinant det.
//
// u = (y1 - y3) dx1 - (x1 - x3) dy1 is the length L of the first segment times the distance of an
// end of the second one from the first one's line. Each product has three roundings and the
// difference one: 4 u. Sum of the magnitudes of the products: at most 2 sqrt(2) M L, for no
// difference of coordinates is above 2 M. Together 4 * 2.83 < 12 u M L.
constexpr double kCrossProductError = 12.0;

// u - det does the same for the other end of the second segment. det is wrong by at most 4 u times
// the product of both lengths, and no length is above 2 sqrt(2) M: again 12 u M L. So an end that
// lies on the wrong side of the line by more than 24 u M is seen to do so.
constexpr double kSideError = 2.0 * kCrossProductError;

// Two segments at a distance g, the shortest connection P-Q being between ends of both (where it
// meets a segment inside, it stands at right angles to it). At P and Q both turn away from the
// connection by 90 degrees or more. The triangle of P, Q and the crossing of the two lines has less
// than 180 degrees, so at least one end is on the wrong side of the other segment's line, by g
// times the greater of both sines. Were both sines below 1/sqrt(2), both segments would turn away
// by more than 135 degrees; along the axis that makes at most 45 degrees with the connection they
// would run away from each other, and their boxes would be apart. Hence a distance of
// sqrt(2) * 24 < 34 u M is enough. It does not hold for segments that are points: BoxTree tells
// those apart by boxes only.
constexpr double kSegmentDistance = 34.0;
static_assert(kSegmentDistance * kSegmentDistance > 2.0 * kSideError * kSideError);

// The computed trapezia, M being the largest coordinate plus the largest radius, so that no point
// is farther than sqrt(2) M from the origin. One level of the tree adds, in u times that distance:
// 8 for a frame whose cosine and sine are not exactly of unit length, there and back; 2 + 3 for
// turning; 3 + 4 for the two ordinates of a long side. Together 20 * 1.42 < 30 u M.
constexpr double kTrapeziumError = 30.0;
constexpr double kMostLevels = 32.0;

// Both bounds of a pair may be wrong, and so may the cross product that compares them.
constexpr double kSlantedMargin = 4096.0;
static_assert(2.0 * kMostLevels * kTrapeziumError + kCrossProductError + kSegmentDistance <
              kSlantedMargin);

// Arcs, D being a bound on all lengths in the formulas: segments, distances from centres, radii.
//
// A common point of a circle of radius r and a segment of length d, of which the first end is at f
// from the centre, is x1 + t dx with a root t of a t^2 + b t + c. By the value of that polynomial
// its squared distance from the centre differs from r^2. In u: 4 d^2 + 8 d f + 5 f^2 + 3 r^2 for
// the rounded coefficients, 4 f^2 + 2 r^2 for the discriminant, 4 f^2 + 2 r^2 for its root, twice
// 4 d f + 2 d r for the sum and the quotient. Together 44 u D^2.
//
// A common point of two circles is at q along and h across the line of centres. Seen from the
// bigger circle the squares of q and h are wrong by 11 u R^2 each; seen from the smaller one the
// numerator of q adds 3 R^2 + 9 d^2 + 3 rho^2 and its quotient 8 d R. Together 45 u D^2.
constexpr double kCircleCutError = 45.0;

// A half chord h that counts as tangency is dropped; then the squared distance from the smaller
// circle is wrong by 2 d h^2 / (2 R) <= 2 h^2.
constexpr double kSquareError = 128.0;
constexpr double kSquaredTangencies = 8.0;
static_assert(2.0 * kCircleCutError < kSquareError && 2.0 < kSquaredTangencies);

// The point itself is rounded by 7 u D where it is x1 + t dx and by 12 u D where two circles cut.
// It counts by its angle, which is wrong by 2 u for the differences and 8 u for atan2. The ends of
// the box lie where cosine or sine, product and sum put them: 8 u.
constexpr double kPlaceError = 12.0;
constexpr double kAngleError = 2.0 + 8.0;
constexpr double kEndError = 8.0;
constexpr double kPointError = 128.0;
static_assert(kPlaceError + kAngleError + kEndError < kPointError);

/// Magnitudes whose fourth powers neither overflow nor vanish.
constexpr double kSmallestRegular = 0x1p-200;
constexpr double kLargestRegular = 0x1p200;

/// Arcs much larger than the contour would take all others' bounds along with them.
constexpr double kLargestToContour = 1024.0;

/// The bits of the magnitude: they grow with it, and those of a not-a-number are above all others.
constexpr std::uint64_t MagnitudeBits(double value) {
  return std::bit_cast<std::uint64_t>(value) << 1U;
}

constexpr bool IsRegularMagnitude(double value) {
  return MagnitudeBits(value) - MagnitudeBits(kSmallestRegular) <=
         MagnitudeBits(kLargestRegular) - MagnitudeBits(kSmallestRegular);
}

constexpr bool IsRegularCoordinate(double value) {
  return IsRegularMagnitude(value) || value == 0.0;
}

bool IsRegularPoint(Point const& p) { return IsRegularCoordinate(p.x) && IsRegularCoordinate(p.y); }

double LargestOf(Point const& p) { return std::max(std::fabs(p.x), std::fabs(p.y)); }

Extent ExtentOfSegment(Point const& a, Point const& b) {
  Box const box{std::min(a.x, b.x), std::max(a.x, b.x), std::min(a.y, b.y), std::max(a.y, b.y)};
  return {box, (a.x <= b.x) == (a.y <= b.y), true};
}

/// Adds what a circle covers between two polar angles, as far as these are angles of atan2.
void IncludeSweep(Arc const& arc, double from, double to, Box* box) {
  double const pi = std::acos(-1.0);
  double const low = std::max(from, -pi);
  double const high = std::min(to, pi);
  if (low > high) return;
  double const quarter = 0.5 * pi;
  auto const covers = [&](double angle) { return low <= angle && angle <= high; };
  double const cosLow = std::cos(low);
  double const sinLow = std::sin(low);
  double const cosHigh = std::cos(high);
  double const sinHigh = std::sin(high);
  double const left = std::min(cosLow, cosHigh);
  double const right = covers(0.0) ? 1.0 : std::max(cosLow, cosHigh);
  double const bottom = covers(-quarter) ? -1.0 : std::min(sinLow, sinHigh);
  double const top = covers(quarter) ? 1.0 : std::max(sinLow, sinHigh);
  Point const& c = arc.center;
  double const r = arc.radius;
  box->Include({c.x + r * left, c.x + r * right, c.y + r * bottom, c.y + r * top});
}

}  // namespace

PieceExtents::PieceExtents(std::vector<std::vector<Piece> const*> const& sets)
    : extents_(sets.size()) {
  for (std::size_t set = 0; set < sets.size(); ++set) AddSegments(*sets[set], &extents_[set]);
  if (!hasArcs_) return;
  // Which arcs are regular depends on all end points, and how far their boxes reach on all arcs.
  for (std::vector<Piece> const* const pieces : sets) MeasureArcs(*pieces);
  for (std::size_t set = 0; set < sets.size(); ++set) AddArcs(*sets[set], &extents_[set]);
}

Extents PieceExtents::Take(std::size_t set) { return std::move(extents_[set]); }

double PieceExtents::SlantedMargin() const {
  return kSlantedMargin * kUnit * (largestCoordinate_ + largestRadius_);
}

void PieceExtents::AddSegments(std::vector<Piece> const& pieces, Extents* extents) {
  extents->all.reserve(pieces.size());
  for (std::size_t i = 0; i < pieces.size(); ++i) {
    Piece const& piece = pieces[i];
    bool const isEndRegular = IsRegularPoint(piece.end);
    if (isEndRegular) largestEnd_ = std::max(largestEnd_, LargestOf(piece.end));
    Extent extent;
    if (!piece.IsSegment()) {
      hasArcs_ = true;
    } else if (isEndRegular && IsRegularPoint(piece.start)) {
      extent = ExtentOfSegment(piece.start, piece.end);
      double const largest = std::max(LargestOf(piece.start), LargestOf(piece.end));
      largestCoordinate_ = std::max(largestCoordinate_, largest);
    } else {
      extents->irregular.push_back(i);
    }
    extents->all.push_back(extent);
  }
}

void PieceExtents::MeasureArcs(std::vector<Piece> const& pieces) {
  for (Piece const& piece : pieces) {
    if (piece.IsSegment() || !IsRegular(*piece.arc)) continue;
    largestCoordinate_ = std::max(largestCoordinate_, LargestOf(piece.arc->center));
    largestRadius_ = std::max(largestRadius_, piece.arc->radius);
  }
}

void PieceExtents::AddArcs(std::vector<Piece> const& pieces, Extents* extents) const {
  for (std::size_t i = 0; i < pieces.size(); ++i) {
    if (pieces[i].IsSegment()) continue;
    if (IsRegular(*pieces[i].arc)) {
      extents->all[i] = {BoxOfArc(*pieces[i].arc), true, false};
    } else {
      extents->irregular.push_back(i);
    }
  }
}

bool PieceExtents::IsRegular(Arc const& arc) const {
  double const largest = kLargestToContour * largestEnd_;
  return IsRegularPoint(arc.center) && arc.radius > 0.0 && IsRegularMagnitude(arc.radius) &&
         arc.radius <= largest && LargestOf(arc.center) <= largest &&
         std::isfinite(arc.startAngle) && std::isfinite(arc.endAngle);
}

Box PieceExtents::BoxOfArc(Arc const& arc) const {
  bool const isCounterClockwise = arc.direction > 0.0;
  double const low = isCounterClockwise ? arc.startAngle : arc.endAngle;
  double const high = isCounterClockwise ? arc.endAngle : arc.startAngle;
  Box box;
  if (high > low) {
    IncludeSweep(arc, low, high, &box);
  } else {
    constexpr double kBeyondAnyAngle = 4.0;
    IncludeSweep(arc, low, kBeyondAnyAngle, &box);
    IncludeSweep(arc, -kBeyondAnyAngle, high, &box);
  }
  if (box.IsEmpty()) return box;
  double const padding = PaddingOf(arc);
  return {box.xLow - padding, box.xHigh + padding, box.yLow - padding, box.yHigh + padding};
}

/// How far a common point of the arc may lie off its circle: with a wrong square E of the distance
/// at most E / r, and at most the root of E. No length is above 2 sqrt(2) times the largest
/// coordinate or the largest radius.
double PieceExtents::PaddingOf(Arc const& arc) const {
  double const lengths = 6.0 * largestCoordinate_ + 3.0 * largestRadius_;
  double const squareError = kSquareError * kUnit * lengths * lengths +
                             kSquaredTangencies * Numeric::kTangency * Numeric::kTangency;
  return std::min(squareError / arc.radius, std::sqrt(squareError)) + kPointError * kUnit * lengths;
}

}  // namespace Vorn::Contours
