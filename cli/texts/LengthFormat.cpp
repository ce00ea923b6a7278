#include "cli/texts/LengthFormat.h"

#include <algorithm>
#include <cmath>

#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

namespace {

constexpr int kMostDecimals = 9;
constexpr double kLargestFixed = 1e9;

}  // namespace

LengthFormat::LengthFormat(double smallestTolerance, std::optional<int> wanted) {
  if (wanted) {
    decimals_ = *wanted;
    return;
  }
  double const digits = 2.0 - std::floor(std::log10(smallestTolerance));
  decimals_ = static_cast<int>(std::clamp(digits, 0.0, static_cast<double>(kMostDecimals)));
  isFixed_ = digits <= kMostDecimals;
}

std::string LengthFormat::operator()(double value) const { return Format(value, decimals_); }

std::string LengthFormat::Finer(double value) const { return Format(value, decimals_ + 1); }

std::string LengthFormat::Format(double value, int decimals) const {
  if (isFixed_ && std::fabs(value) < kLargestFixed) return IO::FormatFixed(value, decimals);
  return IO::FormatShort(value, kMostDecimals);
}

}  // namespace Vorn::Cli
