#include "cli/Progress.h"

#include <unistd.h>

#include <algorithm>
#include <string>

namespace Vorn::Cli {

namespace {

constexpr std::int32_t kWidth = 40;
constexpr char const* kWipeLine = "\r\x1b[K";

}  // namespace

ProgressBar::ProgressBar(std::FILE* stream)
    : stream_(stream), isTerminal_(isatty(fileno(stream)) != 0) {}

ProgressBar::~ProgressBar() {
  if (shown_ < 0) return;
  std::fputs(kWipeLine, stream_);
  std::fflush(stream_);
}

void ProgressBar::SetProgress(std::int32_t percent) {
  std::int32_t const value = std::clamp(percent, 0, kFull);
  if (!isTerminal_ || value == shown_) return;
  shown_ = value;
  auto const filled = static_cast<std::size_t>(kWidth * value / kFull);
  std::string const bar = std::string(filled, '#') + std::string(kWidth - filled, '.');
  std::fprintf(stream_, "\rfitting [%s] %3d %%", bar.c_str(), static_cast<int>(value));
  std::fflush(stream_);
}

}  // namespace Vorn::Cli
