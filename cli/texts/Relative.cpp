#include "cli/texts/Relative.h"

#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

std::string RelativeText(double relative) {
  constexpr double kLargestFixed = 1e9;
  constexpr int kFewestDecimals = 6;
  constexpr int kAllDecimals = 16;  // tell the doubles next to 1 from it
  if (!(relative < kLargestFixed)) return FormatShort(relative);
  int decimals = kFewestDecimals;
  auto const isMisread = [&] {
    return relative != 1.0 && ParseNumber(FormatFixed(relative, decimals)) == 1.0;
  };
  while (decimals < kAllDecimals && isMisread()) ++decimals;
  return FormatFixed(relative, decimals);
}

}  // namespace Vorn::Cli
