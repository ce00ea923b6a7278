#include "io/formats/Affine.h"

#include <cmath>

namespace Vorn::IO {

XY Affine::operator()(XY const& at) const {
  return {a * at.x + c * at.y + e, b * at.x + d * at.y + f};
}

XY Affine::OfDirection(XY const& way) const {
  return {a * way.x + c * way.y, b * way.x + d * way.y};
}

bool Affine::IsSimilarity() const {
  constexpr double kRounding = 1e-9;
  double const first = a * a + b * b;
  double const second = c * c + d * d;
  double const allowed = kRounding * (first + second);
  return std::fabs(first - second) <= allowed && std::fabs(a * c + b * d) <= allowed;
}

Affine operator*(Affine const& first, Affine const& second) {
  XY const x = first.OfDirection({second.a, second.b});
  XY const y = first.OfDirection({second.c, second.d});
  XY const origin = first({second.e, second.f});
  return {x.x, x.y, y.x, y.y, origin.x, origin.y};
}

}  // namespace Vorn::IO
