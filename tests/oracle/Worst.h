// The largest error of an operation over many cases, in units that its documentation names, and
// the bound that it must keep.
#pragma once

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <limits>
#include <string>
#include <utility>

#include "gtest/gtest.h"
#include "oracle/Real.h"
#include "support/RandomGeometry.h"

namespace Vorn::Oracle {

/// The distance of 1.0 from the next double: what headers call eps.
inline constexpr double kEps = std::numeric_limits<double>::epsilon();

/// How many cases of each operation are tried: VORN_ORACLE_CASES, or what takes seconds.
inline int CaseCount() {
  constexpr int kUsual = 20000;
  char const* const text = std::getenv("VORN_ORACLE_CASES");
  return text != nullptr ? std::atoi(text) : kUsual;
}

/// Collects the errors of one operation. Ends with a failure where the bound is broken, or where
/// so few cases could be measured that it says nothing.
class Worst {
 public:
  /// @param bound what the documentation states, in the units of Note
  Worst(std::string operation, double bound) : operation_(std::move(operation)), bound_(bound) {}

  /// An error of one case, beside what eps stands for there.
  void Note(Real const& error, Real const& unit) {
    ++count_;
    if (error.Sign() == 0) return;
    double const units = (Abs(error) / (Real(kEps) * unit)).ToDouble();
    worst_ = std::isnan(units) ? std::numeric_limits<double>::infinity() : std::max(worst_, units);
  }

  /// To be called at the end: prints the largest error.
  void Check(int cases) const {
    std::printf("%-52s %8.3f of %5.4g eps, %d of %d cases\n", operation_.c_str(), worst_, bound_,
                count_, cases);
    testing::Test::RecordProperty("worst", std::to_string(worst_));
    EXPECT_LE(worst_, bound_) << operation_;
    EXPECT_GE(count_, cases / 5) << "too few cases to say anything of " << operation_;
  }

 private:
  std::string operation_;
  double bound_;
  double worst_ = 0.0;
  int count_ = 0;
};

/// Inputs of a case: well-conditioned ones, small whole numbers that make degenerate cases
/// frequent, ones far from the origin and of very different sizes, in turn.
class Inputs {
 public:
  Inputs(std::uint64_t seed, int number)
      : random_(seed + static_cast<std::uint64_t>(number)), family_(number % 4) {}

  double Coordinate() {
    switch (family_) {
      case 0:
        return random_.Uniform(-100.0, 100.0);
      case 1:
        return random_.Integer(-4, 4);
      case 2:
        return 1e6 + random_.Uniform(-10.0, 10.0);
      default:
        return random_.Wide(-12, 12);
    }
  }

  GeometryUtils::Point Point() {
    double const x = Coordinate();
    return {x, Coordinate()};
  }

  double Positive() {
    return family_ == 1 ? random_.Integer(1, 6) : std::exp2(random_.Uniform(-6.0, 6.0));
  }

  Testing::RandomGeometry& Random() { return random_; }

 private:
  Testing::RandomGeometry random_;
  int family_;
};

/// Runs `measure(inputs, &worst)` for every case, then checks.
template <typename Measure>
void ForEachCase(std::uint64_t seed, Worst worst, Measure const& measure) {
  int const cases = CaseCount();
  for (int i = 0; i < cases; ++i) {
    Inputs inputs(seed * 1'000'000'007U, i);
    measure(inputs, &worst);
  }
  worst.Check(cases);
}

inline RealPoint Exact(GeometryUtils::Point const& p) { return {p.x, p.y}; }

/// A line as the library takes it, in exact numbers.
struct RealLine {
  Real a;
  Real b;
  Real c;
  Real Norm() const { return Sqrt(a * a + b * b); }
  Real At(RealPoint const& p) const { return a * p.x + b * p.y + c; }
  /// The sum of the magnitudes of the three terms at a point.
  Real Terms(RealPoint const& p) const { return Abs(a * p.x) + Abs(b * p.y) + Abs(c); }
};

}  // namespace Vorn::Oracle
