// Distances, circles and intersections: what is written when, whether points lie on both curves,
// and grid input against exact whole numbers.
#include <cmath>
#include <cstdint>

#include "Input.h"
#include "Require.h"
#include "support/Bits.h"

namespace Vorn::Fuzz {
namespace {

using Point = GeometryUtils::Point;
using Testing::kPointSentinel;
using Testing::kSentinel;
using Testing::SameBits;

/// Coordinates on the grid are multiples of 1/4.
std::int64_t Quarters(double value) { return static_cast<std::int64_t>(4.0 * value); }

/// Twice the area of a triangle of grid points, in sixteenths, exactly.
std::int64_t Cross(Point const& a, Point const& b, Point const& c) {
  return (Quarters(b.x) - Quarters(a.x)) * (Quarters(c.y) - Quarters(a.y)) -
         (Quarters(b.y) - Quarters(a.y)) * (Quarters(c.x) - Quarters(a.x));
}

int SignOf(std::int64_t value) { return (value > 0) - (value < 0); }

struct Segment {
  Point a;
  Point b;
};

/// Whether the inner points of two segments cross: a claim that leaves out touching ends.
bool DoCrossProperly(Segment const& s, Segment const& t) {
  return SignOf(Cross(s.a, s.b, t.a)) * SignOf(Cross(s.a, s.b, t.b)) < 0 &&
         SignOf(Cross(t.a, t.b, s.a)) * SignOf(Cross(t.a, t.b, s.b)) < 0;
}

bool AreOnOneSide(Segment const& s, Segment const& t) {
  return SignOf(Cross(s.a, s.b, t.a)) * SignOf(Cross(s.a, s.b, t.b)) > 0;
}

bool AreParallel(Segment const& s, Segment const& t) {
  Point const shifted{t.b.x - t.a.x + s.a.x, t.b.y - t.a.y + s.a.y};
  return Cross(s.a, s.b, shifted) == 0;
}

double Off(Point const& p, Point const& centre, double radius) {
  return std::fabs(std::hypot(p.x - centre.x, p.y - centre.y) - radius);
}

void TrySegments(Segment const& s, Segment const& t) {
  Point at = kPointSentinel;
  SegmentsRelPosition const answer = GeometryUtils::GetLineSegmentsIntersection(
      s.a.x, s.a.y, s.b.x, s.b.y, t.a.x, t.a.y, t.b.x, t.b.y, &at.x, &at.y);
  bool const isWritten =
      answer == SegmentsRelPosition::Intersecting || answer == SegmentsRelPosition::Collinear;
  Require(isWritten != SameBits(at, kPointSentinel),
          "a common point is written where there is one");
  if (DoCrossProperly(s, t)) {
    Require(answer == SegmentsRelPosition::Intersecting, "segments that cross are found to");
  }
  // Of parallel ones only the raw constants of their lines are compared, which may agree by chance.
  if (!AreParallel(s, t) && (AreOnOneSide(s, t) || AreOnOneSide(t, s))) {
    Require(!isWritten, "segments on one side of each other have nothing in common");
  }
  if (answer == SegmentsRelPosition::Intersecting) {
    double const length = std::hypot(s.b.x - s.a.x, s.b.y - s.a.y);
    double const cross = (s.b.x - s.a.x) * (at.y - s.a.y) - (s.b.y - s.a.y) * (at.x - s.a.x);
    Require(std::fabs(cross) <= 1e-11 * (1.0 + length), "the common point is on the first segment");
  }
}

void TryLineAndCircle(Segment const& s, Point const& centre, double radius) {
  Point found[2] = {kPointSentinel, kPointSentinel};
  int const count = GeometryUtils::GetLineSegmentAndCircleIntersection(
      s.a.x, s.a.y, s.b.x, s.b.y, centre.x, centre.y, radius, &found[0].x, &found[0].y, &found[1].x,
      &found[1].y);
  Require(count >= -1 && count <= 2, "a segment and a circle have at most two common points");
  for (int i = 0; i < count; ++i) {
    // A line that touches is taken to touch as far as roots of rounding errors go.
    Require(Off(found[i], centre, radius) <= 1e-6, "a common point is on the circle");
  }
}

void TryCircle(Point const& a, Point const& b, Point const& c) {
  Point centre = kPointSentinel;
  double radius = kSentinel;
  bool const found = GeometryUtils::GetCircle(a, b, c, &centre, &radius);
  if (!found) {
    Require(SameBits(centre, kPointSentinel) && SameBits(radius, kSentinel),
            "no circle, nothing written");
    return;
  }
  // Points on a line may get any circle; callers look at the sense of the three first.
  if (Cross(a, b, c) == 0) return;
  double const room = 1e-9 * (1.0 + radius);
  Require(Off(a, centre, radius) <= room && Off(b, centre, radius) <= room &&
              Off(c, centre, radius) <= room,
          "a circle passes through its three points");
}

void TryDeviation(Input* input) {
  double const a = input->Number();
  double const b = input->Number();
  double const c = input->Number();
  double const x = input->Number();
  double const y = input->Number();
  double deviation = kSentinel;
  double withSign = kSentinel;
  bool const found = GeometryUtils::GetDeviation(a, b, c, x, y, &deviation);
  Require(found != SameBits(deviation, kSentinel), "a distance is written where there is one");
  Require(GeometryUtils::GetSignedDeviation(a, b, c, x, y, &withSign) == found,
          "distances with and without a sign are there alike");
  Require(!found || SameBits(std::fabs(withSign), deviation), "the sign changes nothing else");
}

void TrySpacing(Input* input) {
  WPoint const a{input->Number(), input->Number(), input->Number()};
  WPoint const b{input->Number(), input->Number(), input->Number()};
  Require(GeometryUtils::IsPointValidToFit(a, b) == GeometryUtils::IsPointValidToFit(b, a),
          "the spacing rule does not look at the order");
}

}  // namespace
}  // namespace Vorn::Fuzz

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size) {
  namespace Fuzz = Vorn::Fuzz;
  Fuzz::Input input(data, size);
  Fuzz::Segment const first{input.PointOnGrid(), input.PointOnGrid()};
  Fuzz::Segment const second{input.PointOnGrid(), input.PointOnGrid()};
  Fuzz::TrySegments(first, second);
  Fuzz::TryLineAndCircle(first, second.a, std::fabs(second.b.x) + 0.25);
  Fuzz::TryCircle(first.a, first.b, second.a);
  Fuzz::TryDeviation(&input);
  Fuzz::TrySpacing(&input);
  return 0;
}
