// Several threads that do the same work without waiting for each other.
#pragma once

#include <cstddef>
#include <functional>
#include <thread>
#include <vector>

namespace Vorn::Testing {

inline constexpr std::size_t kThreads = 3;

/// Calls `work` with 0, 1, 2 on threads of their own and waits for all of them.
inline void RunAtOnce(std::function<void(std::size_t thread)> const& work) {
  std::vector<std::thread> threads;
  for (std::size_t i = 0; i < kThreads; ++i) threads.emplace_back(work, i);
  for (std::thread& thread : threads) thread.join();
}

}  // namespace Vorn::Testing
