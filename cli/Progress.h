#pragma once

#include <cstdint>
#include <cstdio>

#include "vorn/Types.h"

namespace Vorn::Cli {

/// A bar that fills as the fit moves through the points, redrawn in one line of a terminal and
/// wiped off at the end. Anywhere else than on a terminal it stays silent.
class ProgressBar final : public ExecutionState {
 public:
  static constexpr std::int32_t kFull = 100;

  explicit ProgressBar(std::FILE* stream);
  ProgressBar(ProgressBar const&) = delete;
  ProgressBar& operator=(ProgressBar const&) = delete;
  ~ProgressBar();

  /// Draws only when the value differs from the one shown: the fit reports far more often than
  /// a bar can change.
  void SetProgress(std::int32_t percent) override;

 private:
  std::FILE* stream_;
  bool isTerminal_;
  std::int32_t shown_ = -1;
};

}  // namespace Vorn::Cli
