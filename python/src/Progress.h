#pragma once

#include <pybind11/pybind11.h>

#include <chrono>
#include <cstdint>

#include "vorn/Types.h"

namespace Vorn::Python {

/// Tells a callable of Python the percentage of a fit, each value once and never a smaller one, and
/// lets signals such as an interruption from the keyboard end the fit. Lives in a call that has
/// given the interpreter lock away, and takes it for as long as Python has something to do. What
/// Python raises is thrown through the fit.
class Progress final : public ExecutionState {
 public:
  /// @param callable None for no reporting
  explicit Progress(pybind11::object const& callable);

  void SetProgress(std::int32_t percent) override;

 private:
  using Clock = std::chrono::steady_clock;

  void LookForSignals();

  pybind11::object const& callable_;
  bool hasCallable_;
  std::int32_t largest_ = 0;
  Clock::time_point nextLook_;
};

}  // namespace Vorn::Python
