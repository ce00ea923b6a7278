// What a progress object throws leaves the fit at whichever call it is thrown. The contour then
// holds the first elements of the whole fit, and the next fit answers as ever.
#include <cstdint>
#include <iterator>
#include <vector>

#include "determinism/Digest.h"
#include "gtest/gtest.h"
#include "support/Profiles.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {
namespace {

using Elem = GeometryUtils::Elem;
using Strategy = GeometryUtils::FittingStrategy;

struct Stopped {};

/// Throws at one of its calls, counted from 0.
class Stopper final : public ExecutionState {
 public:
  explicit Stopper(int number) : left_(number) {}

  void SetProgress(std::int32_t) override {
    if (left_-- == 0) throw Stopped();
  }

 private:
  int left_;
};

std::uint64_t DigestOf(std::vector<Elem> const& contour) {
  Digest digest;
  digest.Add(contour);
  return digest.Value();
}

class ThrowingProgress : public testing::TestWithParam<Strategy> {};

TEST_P(ThrowingProgress, EndsTheFitAtEveryCallAndLeavesItsFirstElements) {
  RandomGeometry random(5);
  std::vector<WPoint> const points = GetParam() == Strategy::SingleArc
                                         ? MakeArcPoints({3, -2}, 25, 2, -2.5, 20, 0.05)
                                         : MakeProfile(&random, 40);
  auto const fit = [&](std::vector<Elem>* contour, ExecutionState* state) {
    double deviation = 0.0;
    std::int32_t index = 0;
    return GeometryUtils::CreateFittingCurve(points, GetParam(), contour, &deviation, &index, state,
                                             100);
  };
  std::vector<Elem> expected;
  ASSERT_EQ(fit(&expected, nullptr), ErrorCode::Ok);
  std::vector<Elem> contour;
  int thrown = 0;
  for (bool hasEnded = false; !hasEnded; ++thrown) {
    contour.clear();
    Stopper stopper(thrown);
    try {
      EXPECT_EQ(fit(&contour, &stopper), ErrorCode::Ok);
      hasEnded = true;
    } catch (Stopped const&) {
      ASSERT_LE(contour.size(), expected.size()) << "call " << thrown;
      std::vector<Elem> const first(expected.begin(), expected.begin() + std::ssize(contour));
      EXPECT_EQ(DigestOf(contour), DigestOf(first)) << "call " << thrown;
    }
  }
  EXPECT_GT(thrown, GetParam() == Strategy::SingleArc ? 1 : 40);
  EXPECT_EQ(DigestOf(contour), DigestOf(expected));
}

INSTANTIATE_TEST_SUITE_P(Strategies, ThrowingProgress,
                         testing::Values(Strategy::Mixed, Strategy::MixedCells,
                                         Strategy::SingleArc));

}  // namespace
}  // namespace Vorn::Testing
