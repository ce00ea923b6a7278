#include <cstdint>
#include <vector>

#include "geometry/fewest/Progress.h"
#include "gtest/gtest.h"
#include "support/Transcript.h"

namespace Vorn::Testing {
namespace {

using Percents = std::vector<std::int32_t>;

TEST(FewestProgress, TellsTheShareOfAPhaseOnce) {
  ProgressRecorder state;
  Fewest::Progress progress(&state, 50, 8);
  progress.Tell(20, 60, 4);
  EXPECT_EQ(state.percents, (Percents{20}));
  progress.Tell(20, 60, 4);
  progress.Tell(20, 60, 2);
  EXPECT_EQ(state.percents, (Percents{20}));
  progress.Tell(20, 60, 8);
  progress.Finish();
  EXPECT_EQ(state.percents, (Percents{20, 30, 50}));
}

TEST(FewestProgress, SaysNothingBelowOnePerCent) {
  ProgressRecorder state;
  Fewest::Progress(&state, 100, 1000).Tell(0, 100, 9);
  EXPECT_EQ(state.percents, Percents());
  Fewest::Progress(nullptr, 100, 8).Finish();
}

}  // namespace
}  // namespace Vorn::Testing
