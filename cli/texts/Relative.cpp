#include "cli/texts/Relative.h"

#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

std::string RelativeText(double relative) {
  constexpr double kLargestFixed = 1e9;
  constexpr int kDecimals = 6;
  return relative < kLargestFixed ? FormatFixed(relative, kDecimals) : FormatShort(relative);
}

}  // namespace Vorn::Cli
