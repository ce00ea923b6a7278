#pragma once

#include <cmath>
#include <vector>

#include "vorn/GeometryUtils.h"

/// Contours written as a chain of calls: ContourBuilder(0, 0).To(1, 0).Around(...).Build().
namespace Vorn::Testing {

class ContourBuilder {
 public:
  using Elem = GeometryUtils::Elem;
  using Point = GeometryUtils::Point;

  ContourBuilder(double x, double y) { To(x, y); }

  ContourBuilder& To(double x, double y) {
    Elem elem;
    elem.type = GeometryUtils::ElemType::Segment;
    elem.end = {x, y};
    contour_.push_back(elem);
    return *this;
  }

  /// An arc about center to (x, y); radius and both angles follow from the points.
  ContourBuilder& Around(Point const& center, double x, double y, double direction) {
    Point const start = contour_.back().end;
    double const radius = std::hypot(start.x - center.x, start.y - center.y);
    return Arc({{x, y},
                center,
                radius,
                direction,
                std::atan2(start.y - center.y, start.x - center.x),
                std::atan2(y - center.y, x - center.x)});
  }

  /// An arc with every field given: it need not agree with its neighbours.
  ContourBuilder& Arc(GeometryUtils::Arc const& arc) {
    Elem elem;
    static_cast<GeometryUtils::Arc&>(elem) = arc;
    elem.type = GeometryUtils::ElemType::Arc;
    contour_.push_back(elem);
    return *this;
  }

  /// A segment again to the last end: an element of zero length.
  ContourBuilder& Stay() {
    Point const end = contour_.back().end;
    return To(end.x, end.y);
  }

  /// An element of a type that does not exist, ending at (x, y).
  ContourBuilder& OfType(int type, double x, double y) {
    To(x, y);
    contour_.back().type = static_cast<GeometryUtils::ElemType>(type);
    return *this;
  }

  std::vector<Elem> const& Build() const { return contour_; }

 private:
  std::vector<Elem> contour_;
};

}  // namespace Vorn::Testing
