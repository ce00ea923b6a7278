#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <limits>

#include "determinism/Digest.h"
#include "support/RandomGeometry.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {

/// Seeded arguments for members. Each round has one kind of number, so that coincidences (equal,
/// collinear, touching) are as frequent as ordinary cases and not-a-numbers do not drown them.
///
/// Numbers are drawn one by one into arrays, never inside the arguments of a call: compilers differ
/// in the order in which they evaluate those.
class Inputs {
 public:
  explicit Inputs(std::uint64_t seed) : random_(seed) {}

  void StartRound(int round) { kind_ = kKinds[static_cast<std::size_t>(round) % kKinds.size()]; }

  double Number() {
    switch (kind_) {
      case Kind::Grid:
        return random_.Integer(-3, 3);
      case Kind::Ordinary:
        return random_.Uniform(-5.0, 5.0);
      case Kind::Wide:
        return random_.Wide(-60, 60);
      default:
        return Odd();
    }
  }

  template <std::size_t kCount>
  std::array<double, kCount> Numbers() {
    std::array<double, kCount> numbers;
    for (double& number : numbers) number = Number();
    return numbers;
  }

  GeometryUtils::Point Point() {
    auto const [x, y] = Numbers<2>();
    return {x, y};
  }

  template <std::size_t kCount>
  std::array<GeometryUtils::Point, kCount> Points() {
    std::array<GeometryUtils::Point, kCount> points;
    for (auto& point : points) point = Point();
    return points;
  }

  GeometryUtils::Triangle Triangle() {
    auto const [a, b, c] = Points<3>();
    return {{a, b, c}};
  }

  WPoint Measured() {
    auto const [x, y, w] = Numbers<3>();
    return {x, y, 0.125 * w};
  }

  RandomGeometry& Random() { return random_; }

 private:
  enum class Kind { Grid, Ordinary, Wide, Odd };
  static constexpr std::array<Kind, 8> kKinds{Kind::Grid,     Kind::Ordinary, Kind::Grid,
                                              Kind::Ordinary, Kind::Wide,     Kind::Grid,
                                              Kind::Ordinary, Kind::Odd};

  double Odd() {
    using Limits = std::numeric_limits<double>;
    constexpr std::array<double, 8> kOdd{0.0,
                                         -0.0,
                                         Limits::infinity(),
                                         -Limits::infinity(),
                                         Limits::quiet_NaN(),
                                         Limits::denorm_min(),
                                         Limits::max(),
                                         -Limits::min()};
    if (random_.Flip()) return random_.Uniform(-2.0, 2.0);
    return kOdd[static_cast<std::size_t>(random_.Bits() % kOdd.size())];
  }

  RandomGeometry random_;
  Kind kind_ = Kind::Grid;
};

/// The digest of what body(&inputs, &digest) adds in that many rounds.
template <typename Body>
std::uint64_t DigestRounds(std::uint64_t seed, int rounds, Body const& body) {
  Inputs inputs(seed);
  Digest digest;
  for (int round = 0; round < rounds; ++round) {
    inputs.StartRound(round);
    body(&inputs, &digest);
  }
  return digest.Value();
}

}  // namespace Vorn::Testing
