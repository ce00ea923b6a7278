#pragma once

#include <cmath>

#include "geometry/fewest/Circle.h"

namespace Vorn::Fewest {

/// The angle by which places turn about the centre of a circle, one after another: the sum of the
/// angles between neighbours, each from -pi to pi. Laps count.
class Turn {
 public:
  /// About a normalised circle; a line has no centre and makes no turn.
  explicit Turn(Circle const& circle) : circle_(circle) {}

  /// Goes on to a place.
  void Add(Place const& place) {
    // The gradient points along the radius, and nowhere at the centre itself.
    Place const radial = GradientAt(circle_, place);
    double const sine = before_.x * radial.y - before_.y * radial.x;
    double const cosine = before_.x * radial.x + before_.y * radial.y;
    if (hasPlace_) angle_ += std::atan2(sine, cosine);
    before_ = radial;
    hasPlace_ = true;
  }

  /// The turn so far in radians, without its sign.
  double Angle() const { return std::fabs(angle_); }

 private:
  Circle circle_;
  Place before_;
  bool hasPlace_ = false;
  double angle_ = 0.0;
};

}  // namespace Vorn::Fewest
