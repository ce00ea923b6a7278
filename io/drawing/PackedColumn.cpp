#include "io/drawing/PackedColumn.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

#include "io/base/Base64.h"

namespace Vorn::IO {

namespace {

constexpr int kMostExactPower = 22;  // 10^22 is the largest power of ten that is a double
constexpr int kHighestOrder = 2;     // differences of differences
constexpr double kRounding = 1e-9;   // of a logarithm

/// 2^50: differences of differences are four times larger at most, twice that with the sign in the
/// lowest bit, and the page reads integers exactly up to 2^53.
constexpr double kMostMultiple = 1125899906842624.0;

using Integers = std::vector<std::int64_t>;

Integers Multiples(std::vector<double> const& numbers, int decimals) {
  double const power = std::pow(10.0, std::abs(decimals));
  Integers multiples;
  multiples.reserve(numbers.size());
  for (double const number : numbers) {
    multiples.push_back(std::llround(decimals >= 0 ? number * power : number / power));
  }
  return multiples;
}

/// Neighbours' differences in place of numbers; the first is left as it is.
Integers Differences(Integers const& numbers) {
  Integers differences = numbers;
  for (std::size_t i = numbers.size(); i-- > 1;) differences[i] -= differences[i - 1];
  return differences;
}

void AppendUnsigned(std::uint64_t number, std::string* bytes) {
  constexpr std::uint64_t kMore = 0x80;
  for (; number >= kMore; number >>= 7U) *bytes += static_cast<char>(number % kMore | kMore);
  *bytes += static_cast<char>(number);
}

std::uint64_t WithoutSign(std::int64_t number) {
  auto const magnitude = static_cast<std::uint64_t>(number < 0 ? -(number + 1) : number);
  return 2 * magnitude + (number < 0 ? 1 : 0);
}

std::string BytesOf(Integers const& numbers) {
  std::string bytes;
  for (std::size_t i = 0; i < numbers.size(); ++i) {
    AppendUnsigned(WithoutSign(numbers[i]), &bytes);
    if (numbers[i] != 0) continue;
    std::size_t const first = i;
    while (i + 1 < numbers.size() && numbers[i + 1] == 0) ++i;
    AppendUnsigned(i - first, &bytes);
  }
  return bytes;
}

}  // namespace

int DecimalsOfStep(double step) {
  return static_cast<int>(std::ceil(-std::log10(step) - kRounding));
}

int MostDecimals(double largest) {
  if (!(largest > 0.0)) return kMostExactPower;
  auto const most = static_cast<int>(std::floor(std::log10(kMostMultiple / largest) - kRounding));
  return std::min(most, kMostExactPower);
}

PackedColumn Pack(std::vector<double> const& numbers, int decimals) {
  Integers integers = Multiples(numbers, decimals);
  std::string shortest = BytesOf(integers);
  int order = 0;
  for (int tried = 1; tried <= kHighestOrder; ++tried) {
    integers = Differences(integers);
    std::string bytes = BytesOf(integers);
    if (bytes.size() >= shortest.size()) continue;
    shortest = std::move(bytes);
    order = tried;
  }
  return {decimals, order, numbers.size(), Base64(shortest)};
}

}  // namespace Vorn::IO
