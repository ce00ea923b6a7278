// The thread sanitizer is at work in this very program: without it, or with a data race that it
// overlooks, the other tests here would prove nothing.
#include <cstdlib>
#include <thread>

#include "gtest/gtest.h"

namespace Vorn::Testing {
namespace {

int shared = 0;

void Count() {
  for (int i = 0; i < 1000; ++i) ++shared;
}

/// Two threads that write to one place, neither waiting for the other.
void Race() {
  std::thread other(Count);
  Count();
  other.join();
  // The sanitizer puts its own exit code in the place of this one when it has reported something.
  std::exit(EXIT_SUCCESS);
}

TEST(ThreadSanitizerDeathTest, ReportsADataRace) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  constexpr int kReported = 66;
  EXPECT_EXIT(Race(), testing::ExitedWithCode(kReported), "data race");
}

}  // namespace
}  // namespace Vorn::Testing
