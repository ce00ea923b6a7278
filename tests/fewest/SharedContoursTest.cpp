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
  EXPECT_LE(PieceCount(FitKept(scan_)), GetParam().pieces);
}

TEST_P(FewestPiecesOnMeasured, BackwardsHasAsMany) {
  FewestResult const result = FitKept(Reversed(scan_));
  EXPECT_EQ(result.fewestPossible, GetParam().bound);
  EXPECT_LE(PieceCount(result), GetParam().pieces);
}

TEST_P(FewestPiecesOnMeasured, TurnedHasAsMany) {
  std::int32_t const pieces = PieceCount(FitKept(scan_));
  for (double const degrees : {30.0, 45.0, 90.0, 217.0, 300.0}) {
    SCOPED_TRACE(testing::Message() << degrees << " degrees");
    FewestResult const result = FitKept(Rotated(scan_, degrees * 3.141592653589793 / 180.0));
    EXPECT_EQ(result.fewestPossible, GetParam().bound);
    EXPECT_EQ(PieceCount(result), pieces);
  }
}

TEST_P(FewestPiecesOnMeasured, ClosedHasNoMoreThanOpen) {
  FewestResult const open = FitKept(scan_);
  if (!GetParam().isClosed) return;
  FewestResult const closed = FitKept(scan_, Closed());
  // A full circle is one arc when open and two when closed.
  EXPECT_LE(PieceCount(closed), std::max(PieceCount(open), 2));
  EXPECT_EQ(closed.fewestPossible, GetParam().closedBound);
}

INSTANTIATE_TEST_SUITE_P(Contours, FewestPiecesOnMeasured, testing::ValuesIn(kSharedContours),
                         NameOf);

}  // namespace
}  // namespace Vorn::Testing
