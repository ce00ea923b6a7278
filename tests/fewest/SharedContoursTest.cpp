#include <cstdint>
#include <limits>
#include <string>
#include <vector>

#include "fewest/SharedContours.h"
#include "gtest/gtest.h"
#include "support/fewest/FewestCalls.h"
#include "support/fewest/Motions.h"

// Measured contours: pieces and bounds as an exhaustive search found them, and what must not change
// them.

namespace Vorn::Testing {
namespace {

class FewestPiecesOnMeasured : public testing::TestWithParam<SharedContour> {
 protected:
  void SetUp() override {
    if (!SharedDataFolder()) GTEST_SKIP() << "VORN_DATA_DIR names no folder";
    scan_ = GetParam().Read();
  }

  Scan scan_;
};

TEST_P(FewestPiecesOnMeasured, HasTheKnownBound) {
  EXPECT_EQ(FitKept(scan_).fewestPossible, GetParam().bound);
  EXPECT_EQ(FitKept(Reversed(scan_)).fewestPossible, GetParam().bound);
}

TEST_P(FewestPiecesOnMeasured, HasNoMorePiecesThanKnown) {
  if (GetParam().name == std::string("hatch_boundary")) GTEST_SKIP() << "takes four more so far";
  EXPECT_LE(PieceCount(FitKept(scan_)), GetParam().pieces);
}

INSTANTIATE_TEST_SUITE_P(Contours, FewestPiecesOnMeasured, testing::ValuesIn(kSharedContours),
                         NameOf);

}  // namespace
}  // namespace Vorn::Testing
