#include <gtest/gtest.h>

#include "cli/base/ExitCode.h"

namespace Vorn::Cli {
namespace {

TEST(ExitCodeOf, VerdictsHaveTheirNumbers) {
  EXPECT_EQ(static_cast<int>(ExitCodeOf(Verdict::WithinTolerance)), 0);
  EXPECT_EQ(static_cast<int>(ExitCodeOf(Verdict::OutsideTolerance)), 1);
  EXPECT_EQ(static_cast<int>(ExitCodeOf(Verdict::StopsEarly)), 5);
}

TEST(ExitCodeOf, FailuresHaveTheirNumbers) {
  EXPECT_EQ(static_cast<int>(ExitCodeOf(FailureKind::BadArgument)), 2);
  EXPECT_EQ(static_cast<int>(ExitCodeOf(FailureKind::File)), 3);
  EXPECT_EQ(static_cast<int>(ExitCodeOf(FailureKind::PointsTooClose)), 4);
  EXPECT_EQ(static_cast<int>(ExitCodeOf(FailureKind::NoFit)), 5);
  EXPECT_EQ(static_cast<int>(ExitCodeOf(FailureKind::Internal)), 70);
}

}  // namespace
}  // namespace Vorn::Cli
