#include <algorithm>
#include <cmath>
#include <cstdint>
#include <vector>

#include "determinism/Digest.h"
#include "determinism/Sections.h"
#include "support/Profiles.h"
#include "support/RandomGeometry.h"
#include "support/SharedData.h"
#include "support/Transcript.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {

namespace {

using Strategy = GeometryUtils::FittingStrategy;

constexpr int kProfiles = 2000;
constexpr int kStrategies = 3;

void AddFit(std::vector<WPoint> const& points, Strategy strategy, Digest* digest) {
  std::vector<GeometryUtils::Elem> contour;
  double maxDeviation = kSentinel;
  std::int32_t maxDeviationIndex = kIntSentinel;
  ProgressRecorder progress;
  ErrorCode const code = GeometryUtils::CreateFittingCurve(
      points, strategy, &contour, &maxDeviation, &maxDeviationIndex, &progress, 100);
  digest->Add(code, contour, maxDeviation, maxDeviationIndex, progress.percents);
}

/// Every third profile, from that of the strategy's number on; every fourth of those has a fault.
std::uint64_t DigestFits(Strategy strategy) {
  Digest digest;
  for (int seed = static_cast<int>(strategy); seed < kProfiles; seed += kStrategies) {
    RandomGeometry random(static_cast<std::uint64_t>(seed));
    std::vector<WPoint> points = MakeProfile(&random, random.Integer(2, 36));
    if (random.Integer(0, 3) == 0) AddHazard(&random, &points);
    AddFit(points, strategy, &digest);
  }
  return digest.Value();
}

}  // namespace

std::uint64_t DigestMixedFits() { return DigestFits(Strategy::Mixed); }
std::uint64_t DigestMixedCellsFits() { return DigestFits(Strategy::MixedCells); }
std::uint64_t DigestSingleArcFits() { return DigestFits(Strategy::SingleArc); }

std::uint64_t DigestLibm() {
  constexpr int kArguments = 20000;
  RandomGeometry random(1);
  Digest digest;
  for (int i = 0; i < kArguments; ++i) {
    double const angle = random.Uniform(-7.0, 7.0);
    double const x = random.Wide(-20, 20);
    double const y = random.Wide(-20, 20);
    double const share = random.Uniform(-1.0, 1.0);
    digest.Add(std::sin(angle), std::cos(angle), std::sin(x), std::cos(y), std::atan2(y, x),
               std::asin(share));
  }
  return digest.Value();
}

std::vector<ContourSection> const& ContourSections() {
  static std::vector<ContourSection> const sections = {
      {"rail_head_known_arcs", 0.01, false}, {"wheel_worn_a", 0.03, false},
      {"rail_worn_low", 0.025, false},       {"mirror_sphere_83m", 0.00005, false},
      {"hatch_boundary", 0.002, false},      {"glyph_five", 2.0, true},
      {"test_track_centreline", 0.03, true}, {"gcode_letter_d", 0.015, false},
      {"airfoil_clark_y", 0.0004, false},    {"circle_r3", 0.001, false},
  };
  return sections;
}

std::uint64_t DigestContourFit(ContourSection const& contour, Strategy strategy) {
  std::vector<WPoint> points = ReadPoints(*SharedDataFolder() + '/' + contour.file + ".csv");
  if (contour.isPerPoint) {
    SetTolerancePerPoint(&points, contour.tolerance);
  } else {
    SetTolerance(&points, contour.tolerance);
  }
  Digest digest;
  AddFit(points, strategy, &digest);
  return digest.Value();
}

}  // namespace Vorn::Testing
