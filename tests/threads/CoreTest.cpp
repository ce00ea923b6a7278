// All members of the library on several threads at once: the three strategies, the fewest pieces,
// cells, triangles, intersections, areas, self-intersection, the solver and the matrices. The
// thread sanitizer reports whatever two threads share.
#include <array>
#include <cstdint>
#include <string>
#include <vector>

#include "determinism/Digest.h"
#include "determinism/Sections.h"
#include "gtest/gtest.h"
#include "support/Profiles.h"
#include "threads/ThreadsAtOnce.h"
#include "vorn/FewestPieces.h"

namespace Vorn::Testing {
namespace {

using Strategy = GeometryUtils::FittingStrategy;

/// Takes every report of a fit; each thread has its own.
struct Listener : ExecutionState {
  void SetProgress(std::int32_t percent) override { last = percent; }
  std::int32_t last = 0;
};

void AddFits(std::vector<WPoint> const& points, Digest* digest) {
  Listener listener;
  for (Strategy const strategy : {Strategy::Mixed, Strategy::MixedCells, Strategy::SingleArc}) {
    std::vector<GeometryUtils::Elem> contour;
    double deviation = 0.0;
    std::int32_t index = 0;
    digest->Add(GeometryUtils::CreateFittingCurve(points, strategy, &contour, &deviation, &index,
                                                  &listener, 100));
    digest->Add(contour, deviation, index, listener.last);
    digest->Add(GeometryUtils::CheckPolySelfIntersection(contour));
  }
  FewestPieces::Result result;
  digest->Add(FewestPieces::Fit(points, FewestPieces::Options(), &result, &listener, 100));
  digest->Add(result.contour, result.fewestPossible, listener.last);
}

/// The points are shared by all threads, as a program may do that tries several strategies.
TEST(CallsOnSeveralThreads, FitSharedPointsToTheSameBits) {
  constexpr int kProfiles = 40;
  RandomGeometry random(7);
  std::vector<std::vector<WPoint>> profiles;
  for (int i = 0; i < kProfiles; ++i) profiles.push_back(MakeProfile(&random, 60));
  std::array<Digest, kThreads> digests;
  RunAtOnce([&](std::size_t thread) {
    for (std::vector<WPoint> const& points : profiles) AddFits(points, &digests[thread]);
  });
  EXPECT_EQ(digests[0].Value(), digests[1].Value());
  EXPECT_EQ(digests[0].Value(), digests[2].Value());
}

/// Sections with thousands of whole fits, of which the test above has some.
bool TakesLong(Section const& section) {
  std::string const name = section.name;
  return name.ends_with("Fits") || name.starts_with("fewest");
}

TEST(CallsOnSeveralThreads, GiveTheSameBitsForEveryMember) {
  std::vector<Section> sections;
  for (Section const& section : AllSections()) {
    if (!TakesLong(section)) sections.push_back(section);
  }
  ASSERT_GE(sections.size(), 10u);
  std::array<std::vector<std::uint64_t>, kThreads> digests;
  RunAtOnce([&](std::size_t thread) {
    digests[thread].resize(sections.size());
    // Each thread begins with another section, so that different members meet as well.
    for (std::size_t i = 0; i < sections.size(); ++i) {
      std::size_t const at = (i + thread * sections.size() / kThreads) % sections.size();
      digests[thread][at] = sections[at].compute();
    }
  });
  EXPECT_EQ(digests[0], digests[1]);
  EXPECT_EQ(digests[0], digests[2]);
}

}  // namespace
}  // namespace Vorn::Testing
