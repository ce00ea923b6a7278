#pragma once

#include <new>

#include "gtest/gtest.h"
#include "support/FailingAllocation.h"

namespace Vorn::Testing {

inline constexpr int kMostAllocations = 200000;

/// Runs `call` with its first allocation refused, then its second, and so on until it needs no
/// more. `expectUntouched` looks at the outputs after each failure.
/// @return how many allocations the call makes
template <typename Call, typename Check>
int RefuseEachAllocation(Call const& call, Check const& expectUntouched) {
  for (int number = 0; number < kMostAllocations; ++number) {
    bool hasThrown = false;
    bool hasFailed = false;
    {
      FailingAllocation const failing(number);
      try {
        call();
      } catch (std::bad_alloc const&) {
        hasThrown = true;
      }
      hasFailed = failing.HasFailed();
    }
    EXPECT_EQ(hasThrown, hasFailed) << "allocation " << number;
    if (!hasFailed) return number;
    expectUntouched();
    if (testing::Test::HasFailure()) return number;
  }
  ADD_FAILURE() << "more than " << kMostAllocations << " allocations";
  return kMostAllocations;
}

}  // namespace Vorn::Testing
