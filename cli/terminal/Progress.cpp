#include "cli/terminal/Progress.h"

#include <unistd.h>

#include <algorithm>
#include <cmath>

#include "cli/terminal/Interruption.h"
#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

namespace {

constexpr std::int32_t kWidth = 30;
constexpr auto kRedrawn = std::chrono::seconds(1);

/// "45 s", "2 min 05 s", "3 h 07 min".
std::string Duration(double seconds) {
  auto const whole = static_cast<long>(std::ceil(seconds));
  auto const twoDigits = [](long value) { return (value < 10 ? "0" : "") + std::to_string(value); };
  constexpr long kMinute = 60;
  constexpr long kHour = 60 * kMinute;
  if (whole < kMinute) return std::to_string(whole) + " s";
  if (whole < kHour) {
    return std::to_string(whole / kMinute) + " min " + twoDigits(whole % kMinute) + " s";
  }
  return std::to_string(whole / kHour) + " h " + twoDigits(whole % kHour / kMinute) + " min";
}

}  // namespace

std::string DescribePace(std::size_t points, std::int32_t percent, double seconds) {
  constexpr double kTooShort = 0.2;
  constexpr int kDigits = 2;
  constexpr int kWhole = 15;  // the rounded rate is written whole, without a power of ten
  if (percent <= 0 || seconds < kTooShort) return "";
  double const part = static_cast<double>(percent) / ProgressBar::kFull;
  double const rate = part * static_cast<double>(points) / seconds;
  double const scale = std::pow(10.0, std::max(0.0, std::floor(std::log10(rate)) - (kDigits - 1)));
  std::string speed = FormatShort(std::round(rate / scale) * scale, kWhole) + " points/s";
  if (percent >= ProgressBar::kFull) return speed;
  return speed + ", " + Duration(seconds * (1.0 - part) / part) + " left";
}

ProgressBar::ProgressBar(std::FILE* stream, std::size_t points, bool isQuiet)
    : stream_(stream), points_(points), isShown_(!isQuiet && isatty(fileno(stream)) != 0) {}

ProgressBar::~ProgressBar() {
  if (shown_ < 0) return;
  NoteTerminalLine(-1);
  std::fputs(kWipeLine, stream_);
  std::fflush(stream_);
}

void ProgressBar::SetProgress(std::int32_t percent) {
  if (!isShown_) return;
  Clock::time_point const now = Clock::now();
  std::int32_t const value = std::clamp(percent, 0, kFull);
  if (value <= shown_ && now - drawn_ < kRedrawn) return;
  shown_ = std::max(shown_, value);
  Draw(now);
}

void ProgressBar::Draw(Clock::time_point now) {
  drawn_ = now;
  auto const filled = static_cast<std::size_t>(kWidth * shown_ / kFull);
  std::string const bar = std::string(filled, '#') + std::string(kWidth - filled, '.');
  std::string const pace =
      DescribePace(points_, shown_, std::chrono::duration<double>(now - begin_).count());
  // An interruption in the middle of this would leave the rest of the line behind the wipe.
  auto const lock = HoldOffInterruption();
  NoteTerminalLine(fileno(stream_));
  std::fprintf(stream_, "\rfitting [%s] %3d %% %s\x1b[K", bar.c_str(), static_cast<int>(shown_),
               pace.c_str());
  std::fflush(stream_);
}

}  // namespace Vorn::Cli
