#pragma once

#include <bit>
#include <cmath>
#include <cstdint>
#include <random>
#include <vector>

#include "vorn/GeometryUtils.h"

/// Seeded generators of random geometry. The engine's output is fixed by the standard; the
/// distributions of the library are not, so numbers are drawn from the engine's bits directly.
namespace Vorn::Testing {

class RandomGeometry {
 public:
  explicit RandomGeometry(std::uint64_t seed) : engine_(seed) {}

  std::uint64_t Bits() { return engine_(); }

  bool Flip() { return (engine_() >> 63U) != 0; }

  /// Uniform in [0, 1).
  double Unit() { return static_cast<double>(engine_() >> 11U) * 0x1p-53; }

  /// Uniform in [low, high).
  double Uniform(double low, double high) { return low + (high - low) * Unit(); }

  /// Uniform whole number in [low, high].
  std::int32_t Integer(std::int32_t low, std::int32_t high) {
    auto const span = static_cast<std::uint64_t>(std::int64_t{high} - low + 1);
    return static_cast<std::int32_t>(low + static_cast<std::int64_t>(engine_() % span));
  }

  /// Random magnitude between 2^lowExponent and 2^highExponent and a random sign.
  double Wide(int lowExponent, int highExponent) {
    double const mantissa = 1.0 + Unit();
    double const value = std::ldexp(mantissa, Integer(lowExponent, highExponent - 1));
    return Flip() ? -value : value;
  }

  /// Any bit pattern at all: not-a-numbers, infinities and subnormals included.
  double AnyDouble() { return std::bit_cast<double>(engine_()); }

  GeometryUtils::Point PointIn(double low, double high) {
    double const x = Uniform(low, high);
    double const y = Uniform(low, high);
    return {x, y};
  }

  /// A grid point; a small grid makes collinear, touching and equal points frequent.
  GeometryUtils::Point GridPoint(std::int32_t reach) {
    double const x = Integer(-reach, reach);
    double const y = Integer(-reach, reach);
    return {x, y};
  }

  GeometryUtils::Point PointOnCircle(GeometryUtils::Point const& center, double radius) {
    double const angle = Uniform(-3.1, 3.1);
    return {center.x + radius * std::cos(angle), center.y + radius * std::sin(angle)};
  }

  GeometryUtils::Triangle TriangleIn(double low, double high) {
    GeometryUtils::Triangle triangle;
    for (auto& pt : triangle.pts) pt = PointIn(low, high);
    return triangle;
  }

  GeometryUtils::Triangle GridTriangle(std::int32_t reach) {
    GeometryUtils::Triangle triangle;
    for (auto& pt : triangle.pts) pt = GridPoint(reach);
    return triangle;
  }

 private:
  std::mt19937_64 engine_;
};

/// Quarter turn counter-clockwise, exact.
inline GeometryUtils::Point QuarterTurn(GeometryUtils::Point const& p) { return {-p.y, p.x}; }

/// Exact when the factor is a power of two and nothing overflows or underflows.
inline GeometryUtils::Point Scale(GeometryUtils::Point const& p, double factor) {
  return {p.x * factor, p.y * factor};
}

inline WPoint Weighted(GeometryUtils::Point const& p, double w) { return {p.x, p.y, w}; }

}  // namespace Vorn::Testing
