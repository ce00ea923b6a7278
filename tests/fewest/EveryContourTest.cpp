#include <algorithm>
#include <cmath>
#include <cstdint>
#include <string>
#include <vector>

#include "fewest/SharedContours.h"
#include "gtest/gtest.h"
#include "support/fewest/FewestCalls.h"
#include "support/fewest/Motions.h"

// Every measured contour with tolerances of a third, one and three times the usual, and with twenty
// that grow, open and closed, forwards and backwards.

namespace Vorn::Testing {
namespace {

class FewestPiecesOnEveryContour : public testing::TestWithParam<SharedContour> {
 protected:
  void SetUp() override {
    if (!SharedDataFolder()) GTEST_SKIP() << "VORN_DATA_DIR names no folder";
    scan_ = GetParam().Read();
  }

  Scan scan_;
};

TEST_P(FewestPiecesOnEveryContour, KeepsItsPromises) {
  for (double const factor : {1.0 / 3.0, 1.0, 3.0}) {
    for (bool const isClosed : {false, true}) {
      SCOPED_TRACE(testing::Message() << "times " << factor << (isClosed ? ", closed" : ""));
      FewestOptions options;
      options.closed = isClosed;
      Scan const scan = WithTolerances(scan_, factor);
      FewestResult const forwards = FitKept(scan, options);
      FewestResult const backwards = FitKept(Reversed(scan), options);
      if (isClosed) continue;
      EXPECT_EQ(forwards.fewestPossible, backwards.fewestPossible);
    }
  }
}

TEST_P(FewestPiecesOnEveryContour, LooserTolerancesNeverGiveMorePieces) {
  FewestResult last = FitKept(WithTolerances(scan_, 0.3));
  for (int step = 1; step < 20; ++step) {
    double const factor = 0.3 * std::pow(1.2, step);
    SCOPED_TRACE(testing::Message() << "times " << factor);
    FewestResult const result = FitKept(WithTolerances(scan_, factor));
    EXPECT_LE(PieceCount(result), PieceCount(last));
    EXPECT_LE(result.fewestPossible, last.fewestPossible);
    last = result;
  }
}

TEST_P(FewestPiecesOnEveryContour, HasTheSameNumberWhereverItLies) {
  FewestResult const known = FitKept(scan_);
  double const far = 1e8 * GetParam().tolerance;
  for (Scan const& moved : {Shifted(scan_, far, -0.3 * far), Magnified(scan_, 1000.0 / 3.0),
                            Magnified(scan_, 1e-9), Reversed(scan_)}) {
    FewestResult const result = FitKept(moved);
    EXPECT_EQ(PieceCount(result), PieceCount(known));
    EXPECT_EQ(result.fewestPossible, known.fewestPossible);
  }
}

/// The points without the one of the first and the last that repeats the other; the smaller
/// tolerance of the two stays.
Scan WithoutRepeatedEnd(Scan scan) {
  if (scan.front().x != scan.back().x || scan.front().y != scan.back().y) return scan;
  scan.front().w = std::min(scan.front().w, scan.back().w);
  scan.pop_back();
  return scan;
}

TEST_P(FewestPiecesOnEveryContour, ClosedTakesNoMorePiecesThanTheBestOpenOne) {
  if (!GetParam().isClosed) GTEST_SKIP() << "an open contour";
  std::int32_t const closed = PieceCount(FitKept(scan_, Closed()));
  Scan scan = WithoutRepeatedEnd(scan_);
  std::int32_t best = closed;
  for (int start = 0; start < 8; ++start) {
    Scan open = scan;
    open.push_back(open.front());
    best = std::min(best, PieceCount(FitKept(open)));
    std::rotate(scan.begin(), scan.begin() + static_cast<std::ptrdiff_t>(scan.size() / 8),
                scan.end());
  }
  // A full circle is one arc when open and two when closed.
  EXPECT_LE(closed, std::max(best, 2));
}

TEST_P(FewestPiecesOnEveryContour, AClosedOneHasItsBoundWhereverItBegins) {
  if (!GetParam().isClosed) GTEST_SKIP() << "an open contour";
  FewestOptions options = Closed();
  options.centre = false;
  Scan scan = WithoutRepeatedEnd(scan_);
  for (int start = 0; start < 3; ++start) {
    EXPECT_EQ(FitKept(scan, options).fewestPossible, GetParam().closedBound);
    std::rotate(scan.begin(), scan.begin() + static_cast<std::ptrdiff_t>(scan.size() / 3),
                scan.end());
  }
}

INSTANTIATE_TEST_SUITE_P(Contours, FewestPiecesOnEveryContour, testing::ValuesIn(kSharedContours),
                         NameOf);

}  // namespace
}  // namespace Vorn::Testing
