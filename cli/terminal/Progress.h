#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <string>

#include "cli/base/Library.h"
#include "vorn/Types.h"

namespace Vorn::Cli {

/// A bar that fills as the fit moves through the points, with their rate and the time left, redrawn
/// in one line of a terminal and wiped off at the end. Anywhere else than on a terminal it stays
/// silent, and so on a dumb one.
class ProgressBar final : public ExecutionState {
 public:
  static constexpr std::int32_t kFull = 100;

  /// @param points how many there are to fit
  ProgressBar(std::FILE* stream, std::size_t points, bool isQuiet = false);
  /// It owns its line of the terminal.
  ProgressBar(ProgressBar const&) = delete;
  ProgressBar& operator=(ProgressBar const&) = delete;
  /// Wipes the bar off.
  ~ProgressBar();

  /// Draws when the value is larger than the one shown, or a second later: the fit reports far more
  /// often than a bar can change, and goes back when it shortens a run.
  void SetProgress(std::int32_t percent) override;

 private:
  using Clock = std::chrono::steady_clock;

  /// Draws the bar as it stands.
  void Draw(Clock::time_point now);

  std::FILE* stream_;
  std::size_t points_;
  bool isShown_;
  std::int32_t shown_ = -1;
  Clock::time_point begin_ = Clock::now();
  Clock::time_point drawn_ = begin_;
};

/// The line for `percent` in a terminal of so many columns: bar and pace get shorter or go as the
/// room does.
std::string ProgressLine(std::int32_t percent, std::string const& pace, std::size_t columns);

/// "12000 points/s, 3 s left": what follows from `percent` of the points in so many seconds. Empty
/// while nothing can be said.
std::string DescribePace(std::size_t points, std::int32_t percent, double seconds);

}  // namespace Vorn::Cli
