#include <algorithm>
#include <cmath>
#include <cstdint>

#include "determinism/Digest.h"
#include "determinism/Sections.h"
#include "support/Profiles.h"
#include "support/RandomGeometry.h"
#include "support/Transcript.h"
#include "support/fewest/Scans.h"
#include "vorn/FewestPieces.h"

namespace Vorn::Testing {

namespace {

using Options = FewestPieces::Options;

void AddFit(Scan const& scan, Options const& options, Digest* digest) {
  FewestPieces::Result result;
  ProgressRecorder progress;
  digest->Add(FewestPieces::Fit(scan, options, &result, &progress, 100));
  digest->Add(result.contour, result.largestDeviation, result.largestDeviationIndex,
              result.fewestPossible, result.isFewest, progress.percents);
  for (FewestPieces::Range const& range : result.ranges) digest->Add(range.first, range.last);
}

/// Every option is drawn, each limit for one scan of four.
Options DrawOptions(RandomGeometry* random, double extent) {
  auto const isDrawn = [random] { return random->Integer(0, 3) == 0; };
  Options options;
  options.effort = static_cast<FewestPieces::Effort>(std::max(0, random->Integer(-9, 2)));
  options.centre = !isDrawn();
  options.closed = random->Flip();
  options.segmentsOnly = random->Integer(0, 9) == 0;
  if (isDrawn()) options.largestStep = random->Uniform(0.05, 3.1);
  if (isDrawn()) options.smallestRadius = extent * random->Uniform(0.0, 0.5);
  if (isDrawn()) options.largestRadius = options.smallestRadius + extent * random->Uniform(0.1, 2);
  if (isDrawn()) options.farthestBetweenPoints = extent * std::exp2(random->Uniform(-9.0, -1.0));
  return options;
}

/// Sines and cosines of the platform's library differ in their last bits, and the points with them.
void RoundToMillionths(Scan* scan) {
  constexpr double kUnits = 0x1p20;
  for (WPoint& p : *scan)
    p = {std::round(p.x * kUnits) / kUnits, std::round(p.y * kUnits) / kUnits, p.w};
}

}  // namespace

std::uint64_t DigestFewestProfiles() {
  constexpr int kProfiles = 150;
  Digest digest;
  for (int seed = 0; seed < kProfiles; ++seed) {
    RandomGeometry random(static_cast<std::uint64_t>(seed));
    Scan scan = MakeProfile(&random, random.Integer(2, 24));
    if (random.Integer(0, 7) == 0) AddHazard(&random, &scan);
    RoundToMillionths(&scan);
    double const extent = std::max(std::fabs(scan.back().x - scan.front().x),
                                   std::fabs(scan.back().y - scan.front().y));
    AddFit(scan, DrawOptions(&random, extent), &digest);
  }
  return digest.Value();
}

std::uint64_t DigestFewestScans() {
  Digest digest;
  for (std::uint64_t seed = 1; seed <= 2; ++seed) {
    RandomGeometry random(seed);
    for (auto const style : {ProfileStyle::Smooth, ProfileStyle::Corners, ProfileStyle::Mixed}) {
      double const noise = random.Uniform(0.0, 0.9);
      AddFit(MakeNoisyProfile(seed, style, 1, 100, noise), DrawOptions(&random, 100.0), &digest);
      AddFit(MakeManyTolerances(seed, style, 40), DrawOptions(&random, 100.0), &digest);
    }
    AddFit(MakeNoisyArc(seed, 100, 0.9), DrawOptions(&random, 100.0), &digest);
    AddFit(MakeSpiral(2.0, 1.0, 60, 0.02), DrawOptions(&random, 4.0), &digest);
  }
  return digest.Value();
}

std::uint64_t DigestFewestScribbles() {
  constexpr int kScribbles = 60;
  RandomGeometry random(7);
  Digest digest;
  for (int i = 0; i < kScribbles; ++i) {
    bool const isOnGrid = random.Flip();
    double const w = isOnGrid ? 0.25 : std::exp2(random.Uniform(-8.0, 1.0));
    Scan scan;
    for (int k = random.Integer(2, 10); k > 0; --k) {
      auto const p = isOnGrid ? random.GridPoint(3) : random.PointIn(-5.0, 5.0);
      scan.push_back({p.x, p.y, isOnGrid ? w * random.Integer(1, 3) : w * random.Uniform(0.5, 1)});
    }
    AddFit(scan, DrawOptions(&random, 5.0), &digest);
  }
  return digest.Value();
}

}  // namespace Vorn::Testing
