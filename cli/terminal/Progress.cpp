#include "cli/terminal/Progress.h"

#include <sys/ioctl.h>
#include <unistd.h>

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <string_view>

#include "cli/terminal/Interruption.h"
#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

namespace {

constexpr std::size_t kWidth = 30;
constexpr std::size_t kUsualColumns = 80;
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

/// Nothing is drawn on a terminal that cannot go back in its line.
bool CanRedraw(std::FILE* stream) {
  char const* const term = std::getenv("TERM");
  return isatty(fileno(stream)) != 0 && (term == nullptr || std::string_view(term) != "dumb");
}

std::size_t ColumnsOf(std::FILE* stream) {
  winsize size{};
  bool const isKnown = ioctl(fileno(stream), TIOCGWINSZ, &size) == 0 && size.ws_col > 0;
  return isKnown ? size.ws_col : kUsualColumns;
}

}  // namespace

std::string ProgressLine(std::int32_t percent, std::string const& pace, std::size_t columns) {
  std::string const number = std::to_string(percent);
  std::string const share =
      std::string(3 - std::min<std::size_t>(3, number.size()), ' ') + number + " %";
  // The last column stays empty: a terminal may go on to the next line behind it.
  std::size_t const room = columns > 0 ? columns - 1 : 0;
  std::string const head = "fitting ";
  std::size_t const fixed = head.size() + share.size() + 3;
  std::size_t const paceRoom = pace.empty() ? 0 : pace.size() + 1;
  constexpr std::size_t kLeastWidth = 5;
  bool const hasPace = fixed + kLeastWidth + paceRoom <= room;
  if (fixed + kLeastWidth > room) return share.substr(0, room);
  std::size_t const width = std::min(kWidth, room - fixed - (hasPace ? paceRoom : 0));
  std::size_t const filled = width * static_cast<std::size_t>(percent) / ProgressBar::kFull;
  std::string const bar = std::string(filled, '#') + std::string(width - filled, '.');
  return head + "[" + bar + "] " + share + (hasPace && !pace.empty() ? " " + pace : "");
}

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
    : stream_(stream), points_(points), isShown_(!isQuiet && CanRedraw(stream)) {}

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
  std::string const pace =
      DescribePace(points_, shown_, std::chrono::duration<double>(now - begin_).count());
  // An interruption in the middle of this would leave the rest of the line behind the wipe.
  auto const lock = HoldOffInterruption();
  NoteTerminalLine(fileno(stream_));
  std::fprintf(stream_, "\r%s\x1b[K", ProgressLine(shown_, pace, ColumnsOf(stream_)).c_str());
  std::fflush(stream_);
}

}  // namespace Vorn::Cli
