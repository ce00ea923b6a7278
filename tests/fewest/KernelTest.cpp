#include <boost/multiprecision/cpp_int.hpp>
#include <cmath>
#include <cstdint>
#include <vector>

#include "fewest/oracle/BoundOracle.h"
#include "fewest/oracle/CoverOracle.h"
#include "geometry/fewest/Bound.h"
#include "gtest/gtest.h"
#include "support/RandomGeometry.h"

// The proof that one circle covers a run, or that none does, against the enumeration of all edges
// of the polytope of its coefficients.

namespace Vorn::Testing {
namespace {

using Exact = boost::multiprecision::cpp_rational;
using Set = std::vector<WPoint>;

std::size_t CountRuns(Set const& points) {
  return Fewest::CoverGreedily(points, Fewest::Limits{}, [](std::int32_t) {}).starts.size();
}

bool IsCovered(Set const& points) { return CountRuns(points) == 1; }

/// Points about an arc, a line, a point; dense, sparse; of equal and of very different tolerances.
Set RandomSet(RandomGeometry* random) {
  Set set;
  int const kind = random->Integer(0, 5);
  std::int32_t const count = random->Integer(4, 9);
  double const radius = std::exp2(random->Uniform(0.0, 8.0));
  double const sweep = random->Uniform(0.2, 5.0) * std::fmin(1.0, 4.0 / radius);
  double const w = radius * sweep * std::exp2(random->Uniform(-10.0, -3.0));
  double const reach = random->Uniform(0.8, 2.5);
  for (std::int32_t i = 0; i < count; ++i) {
    double const angle = sweep * (i + random->Uniform(-0.3, 0.3)) / count;
    double const own =
        kind == 3 ? w * std::pow(10.0, random->Uniform(-3.0, 0.0)) : w * random->Uniform(0.5, 1.5);
    double const r = radius + reach * own * random->Uniform(-1.0, 1.0);
    switch (kind) {
      case 0:
        set.push_back({random->Uniform(-1, 1), random->Uniform(-1, 1), random->Uniform(0.05, 0.5)});
        break;
      case 1:
        set.push_back({i + random->Uniform(-0.4, 0.4), 1e-6 * random->Uniform(-1, 1),
                       1e-6 * random->Uniform(0.2, 1)});
        break;
      case 2:
        set.push_back({1e6 + 0.01 * i + random->Uniform(-0.01, 0.01),
                       random->Uniform(-0.02, 0.02) - 1e6, 0.01});
        break;
      case 4:
        set.push_back({1.0 * random->Integer(-3, 3), 1.0 * random->Integer(-3, 3),
                       0.25 * random->Integer(1, 4)});
        break;
      default:
        set.push_back({r * std::cos(angle), r * std::sin(angle), own});
    }
  }
  return set;
}

TEST(FewestKernel, AgreesWithTheEnumerationOfAllEdges) {
  RandomGeometry random(7101);
  int covered = 0;
  for (int round = 0; round < 20000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 7101, round " << round);
    Set const set = RandomSet(&random);
    bool const isCovered = IsCovered(set);
    covered += isCovered ? 1 : 0;
    if (isCovered == IsCoverable(set)) continue;
    // Border cases are left to exact numbers, below.
    EXPECT_NE(IsCoverable(set, 1.0L - 1e-8L), IsCoverable(set, 1.0L + 1e-8L));
  }
  EXPECT_GT(covered, 5000);
  EXPECT_LT(covered, 15000);
}

/// The factor on the tolerances at which a set becomes coverable, or 0 when it lies outside of 0.01
/// to 100.
long double BorderOf(Set const& set) {
  long double low = 0.01L;
  long double high = 100.0L;
  if (IsCoverable(set, low) || !IsCoverable(set, high)) return 0.0L;
  for (int i = 0; i < 50; ++i) {
    long double const middle = 0.5L * (low + high);
    (IsCoverable(set, middle) ? high : low) = middle;
  }
  return high;
}

Set Scaled(Set set, long double factor) {
  for (WPoint& p : set) p.w = static_cast<double>(factor * p.w);
  return set;
}

TEST(FewestKernel, NeverDeniesWhatExactNumbersCover) {
  RandomGeometry random(7102);
  int borders = 0;
  for (int round = 0; round < 400; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 7102, round " << round);
    Set set = RandomSet(&random);
    if (set.size() > 6) set.resize(6);
    long double const border = BorderOf(set);
    if (border == 0.0L) continue;
    for (long double const off : {1e-11L, 1e-10L, 1e-9L, 1e-8L, 1e-7L, 1e-6L}) {
      Set const wider = Scaled(set, border * (1 + off));
      if (IsCovered(wider)) continue;
      EXPECT_FALSE(IsCoverableIn<Exact>(wider, 1)) << "off by " << static_cast<double>(off);
    }
    ++borders;
  }
  EXPECT_GT(borders, 150);
}

/// How much wider the tolerances of a run may have to be for it to count as covered all the same,
/// as a share of them: what the header leaves to rounding.
long double RoundingOf(Set const& set) {
  double extent = 0.0;
  double least = set.front().w;
  for (WPoint const& p : set) {
    least = std::fmin(least, p.w);
    extent = std::fmax(extent, std::fabs(p.x - set.front().x));
    extent = std::fmax(extent, std::fabs(p.y - set.front().y));
  }
  return 1e-8L + 2e-14L * extent / least;
}

TEST(FewestKernel, DeniesWhatIsClearlyNotCovered) {
  RandomGeometry random(7103);
  int borders = 0;
  for (int round = 0; round < 400; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 7103, round " << round);
    Set const set = RandomSet(&random);
    long double const border = BorderOf(set);
    if (border == 0.0L) continue;
    long double const rounding = RoundingOf(Scaled(set, border));
    EXPECT_FALSE(IsCovered(Scaled(set, border * (1 - rounding))));
    ++borders;
  }
  EXPECT_GT(borders, 150);
}

TEST(FewestBound, IsTheLeastOfAllDivisions) {
  RandomGeometry random(7104);
  for (int round = 0; round < 60; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 7104, round " << round);
    Set points;
    double heading = 0.0;
    GeometryUtils::Point at;
    for (int i = random.Integer(5, 17); i > 0; --i) {
      points.push_back({at.x + random.Uniform(-0.1, 0.1), at.y + random.Uniform(-0.1, 0.1), 0.1});
      heading += random.Uniform(-0.6, 0.6);
      at = {at.x + std::cos(heading), at.y + std::sin(heading)};
    }
    EXPECT_EQ(CountRuns(points), static_cast<std::size_t>(LeastNumberOfRuns(points)));
  }
}

}  // namespace
}  // namespace Vorn::Testing
