#pragma once

#include <array>
#include <cstddef>
#include <random>

namespace Vorn::Benchmarks {

/// A system of linear equations, row by row.
template <std::size_t kOrder>
struct System {
  std::array<double, kOrder * kOrder> matrix;
  std::array<double, kOrder> rhs;
};

constexpr std::size_t kSystems = 256;

template <std::size_t kOrder>
std::array<System<kOrder>, kSystems> MakeSystems() {
  std::mt19937_64 random(5);
  std::uniform_real_distribution<double> coefficient(-1.0, 1.0);
  std::array<System<kOrder>, kSystems> systems;
  for (auto& system : systems) {
    for (double& value : system.matrix) value = coefficient(random);
    for (double& value : system.rhs) value = coefficient(random);
  }
  return systems;
}

}  // namespace Vorn::Benchmarks
