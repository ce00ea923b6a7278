// A caller that has changed how the processor rounds, or that flushes denormals to zero: every
// operation still ends with an answer of the right form, and nothing of it stays in the library.
#include <cfenv>
#include <cmath>
#include <cstdint>
#include <vector>

#if defined(__SSE2__)
#include <immintrin.h>
#endif

#include "determinism/Digest.h"
#include "gtest/gtest.h"
#include "support/Profiles.h"
#include "vorn/FewestPieces.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {
namespace {

using Elem = GeometryUtils::Elem;
using Strategy = GeometryUtils::FittingStrategy;

constexpr int kProfiles = 60;

struct Answers {
  Digest digest;
  int fits = 0;
  int badElements = 0;  ///< of an unknown type or not finite, in contours that are said to fit
};

bool IsSound(Elem const& elem) {
  bool const isKnown =
      elem.type == GeometryUtils::ElemType::Segment || elem.type == GeometryUtils::ElemType::Arc;
  return isKnown && std::isfinite(elem.end.x) && std::isfinite(elem.end.y);
}

void Note(std::vector<Elem> const& contour, Answers* answers) {
  ++answers->fits;
  for (Elem const& elem : contour) answers->badElements += IsSound(elem) ? 0 : 1;
  answers->digest.Add(contour);
}

Answers FitThemAll(std::vector<std::vector<WPoint>> const& profiles) {
  Answers answers;
  for (std::vector<WPoint> const& points : profiles) {
    for (Strategy const strategy : {Strategy::Mixed, Strategy::MixedCells, Strategy::SingleArc}) {
      std::vector<Elem> contour;
      double deviation = 0.0;
      std::int32_t index = 0;
      if (GeometryUtils::CreateFittingCurve(points, strategy, &contour, &deviation, &index, nullptr,
                                            100) == ErrorCode::Ok) {
        Note(contour, &answers);
      }
    }
    FewestPieces::Result result;
    if (FewestPieces::Fit(points, FewestPieces::Options(), &result, nullptr, 100) ==
        ErrorCode::Ok) {
      Note(result.contour, &answers);
    }
  }
  return answers;
}

std::vector<std::vector<WPoint>> MakeProfiles() {
  std::vector<std::vector<WPoint>> profiles;
  RandomGeometry random(31);
  for (int i = 0; i < kProfiles; ++i) profiles.push_back(MakeProfile(&random, 30));
  return profiles;
}

class RoundingMode : public testing::TestWithParam<int> {};

TEST_P(RoundingMode, ChangesNoFormAndLeavesNothingBehind) {
  std::vector<std::vector<WPoint>> const profiles = MakeProfiles();
  Answers const before = FitThemAll(profiles);
  ASSERT_EQ(std::fesetround(GetParam()), 0);
  Answers const during = FitThemAll(profiles);
  EXPECT_EQ(std::fegetround(), GetParam());
  ASSERT_EQ(std::fesetround(FE_TONEAREST), 0);
  Answers const after = FitThemAll(profiles);
  EXPECT_EQ(before.badElements, 0);
  EXPECT_EQ(during.badElements, 0);
  EXPECT_GT(during.fits, before.fits / 2);
  EXPECT_EQ(after.digest.Value(), before.digest.Value());
}

INSTANTIATE_TEST_SUITE_P(Modes, RoundingMode,
                         testing::Values(FE_UPWARD, FE_DOWNWARD, FE_TOWARDZERO));

#if defined(__SSE2__)
constexpr unsigned kFlushToZero = 0x8000;
constexpr unsigned kDenormalsAreZero = 0x0040;

TEST(FlushedDenormals, ChangeNothingOfOrdinaryFits) {
  std::vector<std::vector<WPoint>> const profiles = MakeProfiles();
  Answers const before = FitThemAll(profiles);
  unsigned const mode = _mm_getcsr();
  _mm_setcsr(mode | kFlushToZero | kDenormalsAreZero);
  Answers const during = FitThemAll(profiles);
  _mm_setcsr(mode);
  EXPECT_EQ(during.badElements, 0);
  EXPECT_EQ(during.digest.Value(), before.digest.Value());
}

TEST(FlushedDenormals, EndFitsOfTinyPointsWithAnAnswer) {
  std::vector<std::vector<WPoint>> profiles = MakeProfiles();
  for (std::vector<WPoint>& points : profiles) {
    for (WPoint& p : points) p = {p.x * 0x1p-1040, p.y * 0x1p-1040, p.w * 0x1p-1040};
  }
  unsigned const mode = _mm_getcsr();
  _mm_setcsr(mode | kFlushToZero | kDenormalsAreZero);
  Answers const during = FitThemAll(profiles);
  _mm_setcsr(mode);
  EXPECT_EQ(during.badElements, 0);
}
#endif

}  // namespace
}  // namespace Vorn::Testing
