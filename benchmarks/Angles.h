#pragma once

#include <array>
#include <cstddef>
#include <random>

namespace Vorn::Benchmarks {

/// Rotations about the three axes, radians.
struct AxisAngles {
  double x, y, z;
};

/// How many rotations one repetition makes.
constexpr std::size_t kRotations = 256;

/// Random angles within half a turn, the same on every call.
inline std::array<AxisAngles, kRotations> MakeAngles() {
  std::mt19937_64 random(3);
  std::uniform_real_distribution<double> angle(-3.14, 3.14);
  std::array<AxisAngles, kRotations> all;
  for (AxisAngles& angles : all) angles = {angle(random), angle(random), angle(random)};
  return all;
}

}  // namespace Vorn::Benchmarks
