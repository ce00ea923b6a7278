#pragma once

#include <cstdint>

#include "vorn/Types.h"

/// The progress of a fit in phases.
namespace Vorn::Fewest {

/// Tells the caller's sink of percentages that never fall.
class Progress {
 public:
  /// `total` is the number of points; a null state or a maxPercent below 1 reports nothing.
  Progress(ExecutionState* state, std::int32_t maxPercent, std::int32_t total)
      : state_(state), maxPercent_(maxPercent), total_(total) {}

  /// `done` points of a phase that runs from one percentage of the whole to another.
  void Tell(std::int32_t from, std::int32_t to, std::int32_t done) {
    std::int64_t const share = from + static_cast<std::int64_t>(to - from) * done / total_;
    Report(static_cast<std::int32_t>(share * maxPercent_ / kWhole));
  }

  /// All is done.
  void Finish() { Report(maxPercent_); }

 private:
  static constexpr std::int64_t kWhole = 100;

  /// Tells a percentage that is above all told before.
  void Report(std::int32_t percent) {
    if (state_ == nullptr || percent <= last_) return;
    last_ = percent;
    state_->SetProgress(percent);
  }

  ExecutionState* state_;
  std::int32_t maxPercent_;
  std::int32_t total_;
  std::int32_t last_ = 0;
};

}  // namespace Vorn::Fewest
