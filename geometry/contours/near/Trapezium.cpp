#include "geometry/contours/near/Trapezium.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "math/Assert.h"

namespace Vorn::Contours {

namespace {

/// Axes turned by an angle of which the cosine and sine are known.
class Frame {
 public:
  Frame(double cosine, double sine) : cosine_(cosine), sine_(sine) {}

  Point Turn(Point const& p) const {
    return {cosine_ * p.x + sine_ * p.y, cosine_ * p.y - sine_ * p.x};
  }
  Point TurnBack(Point const& p) const {
    return {cosine_ * p.x - sine_ * p.y, sine_ * p.x + cosine_ * p.y};
  }

  /// Seen from these axes, with lower below upper.
  Trapezium Turn(Trapezium const& t) const {
    Trapezium const turned{{Turn(t.lower.from), Turn(t.lower.to)},
                           {Turn(t.upper.from), Turn(t.upper.to)}};
    bool const isUpright = turned.lower.from.x <= turned.lower.to.x;
    return isUpright ? turned : Trapezium{turned.upper, turned.lower};
  }
  Trapezium TurnBack(Trapezium const& t) const {
    return {{TurnBack(t.lower.from), TurnBack(t.lower.to)},
            {TurnBack(t.upper.from), TurnBack(t.upper.to)}};
  }

 private:
  double cosine_;
  double sine_;
};

Frame FrameAlongTheLongest(Trapezium const* parts, std::size_t count) {
  double longest2 = 0.0;
  Point direction{1.0, 0.0};
  for (std::size_t i = 0; i < count; ++i) {
    Trapezium::Side const& side = parts[i].lower;
    double const dx = side.to.x - side.from.x;
    double const dy = side.to.y - side.from.y;
    double const length2 = dx * dx + dy * dy;
    if (length2 > longest2) {
      longest2 = length2;
      direction = {dx, dy};
    }
  }
  if (longest2 == 0.0) return {1.0, 0.0};
  double const length = std::sqrt(longest2);
  return {direction.x / length, direction.y / length};
}

double WidthOf(Trapezium::Side const& side) { return std::fabs(side.to.x - side.from.x); }

Trapezium const* WidestOf(Trapezium const* begin, Trapezium const* end) {
  return std::max_element(begin, end, [](Trapezium const& a, Trapezium const& b) {
    return WidthOf(a.lower) < WidthOf(b.lower);
  });
}

double DoubleHeight(Trapezium::Side const& side) { return side.from.y + side.to.y; }

/// Steep sides tell nothing about the outline along the frame.
double SlopeOf(Trapezium::Side const& side) {
  double const dx = side.to.x - side.from.x;
  double const dy = side.to.y - side.from.y;
  return std::fabs(dy) < std::fabs(dx) ? dy / dx : 0.0;
}

/// The trapezium around points whose long sides have given slopes.
class Outline {
 public:
  Outline(double lowerSlope, double upperSlope)
      : lowerSlope_(lowerSlope), upperSlope_(upperSlope) {}

  void Include(Point const& p) {
    left_ = std::min(left_, p.x);
    right_ = std::max(right_, p.x);
    lowest_ = std::min(lowest_, p.y - lowerSlope_ * p.x);
    highest_ = std::max(highest_, p.y - upperSlope_ * p.x);
  }

  Trapezium Get() const {
    auto const lower = [&](double x) { return Point{x, lowest_ + lowerSlope_ * x}; };
    auto const upper = [&](double x) { return Point{x, highest_ + upperSlope_ * x}; };
    return {{lower(left_), lower(right_)}, {upper(right_), upper(left_)}};
  }

 private:
  static constexpr double kInfinity = std::numeric_limits<double>::infinity();

  double lowerSlope_;
  double upperSlope_;
  double left_ = kInfinity;
  double right_ = -kInfinity;
  double lowest_ = kInfinity;
  double highest_ = -kInfinity;
};

/// The outermost of the long parts, whose slopes the bounds take. Short parts are not asked: their
/// slopes would carry far beyond them.
struct Outermost {
  Trapezium const* lowest;
  Trapezium const* highest;

  /// Of at least one part.
  Outermost(Trapezium const* begin, Trapezium const* end)
      : lowest(WidestOf(begin, end)), highest(lowest) {
    double const leastWidth = 0.5 * WidthOf(lowest->lower);
    for (Trapezium const* part = begin; part != end; ++part) {
      if (WidthOf(part->lower) < leastWidth) continue;
      if (DoubleHeight(part->lower) < DoubleHeight(lowest->lower)) lowest = part;
      if (DoubleHeight(part->upper) > DoubleHeight(highest->upper)) highest = part;
    }
  }
};

}  // namespace

Trapezium TrapeziumOf(Extent const& extent) {
  Box const& box = extent.box;
  Point const lowerLeft{box.xLow, box.yLow};
  Point const lowerRight{box.xHigh, box.yLow};
  Point const upperLeft{box.xLow, box.yHigh};
  Point const upperRight{box.xHigh, box.yHigh};
  if (extent.isSegment) {
    Point const& left = extent.isRising ? lowerLeft : upperLeft;
    Point const& right = extent.isRising ? upperRight : lowerRight;
    return {{left, right}, {right, left}};
  }
  bool const isWide = box.xHigh - box.xLow > box.yHigh - box.yLow;
  if (isWide) return {{lowerLeft, lowerRight}, {upperRight, upperLeft}};
  return {{lowerRight, upperRight}, {upperLeft, lowerLeft}};
}

Trapezium Around(Trapezium const* parts, std::size_t count) {
  VORN_ASSERT(count > 0 && count <= kMostParts);
  Frame const frame = FrameAlongTheLongest(parts, count);
  Trapezium turned[kMostParts];
  for (std::size_t i = 0; i < count; ++i) turned[i] = frame.Turn(parts[i]);
  Trapezium* const end = turned + count;
  Outermost const outermost(turned, end);
  Outline outline(SlopeOf(outermost.lowest->lower), SlopeOf(outermost.highest->upper));
  for (Trapezium const* part = turned; part != end; ++part) {
    for (Trapezium::Side const& side : {part->lower, part->upper}) {
      outline.Include(side.from);
      outline.Include(side.to);
    }
  }
  return frame.TurnBack(outline.Get());
}

}  // namespace Vorn::Contours
