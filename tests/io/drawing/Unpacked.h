#pragma once

#include <cmath>
#include <cstdint>
#include <string>
#include <vector>

#include "io/drawing/PackedColumn.h"

/// The plainest reader of packed columns, for the tests.
namespace Vorn::IO {

inline std::vector<unsigned> FromBase64(std::string const& text) {
  std::string const characters = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
  std::vector<unsigned> bytes;
  unsigned bits = 0;
  unsigned count = 0;
  for (char const c : text) {
    if (c == '=') break;
    bits = (bits << 6U | static_cast<unsigned>(characters.find(c))) & 0xFFFFFFU;
    count += 6;
    if (count < 8) continue;
    count -= 8;
    bytes.push_back(bits >> count & 0xFFU);
  }
  return bytes;
}

inline std::vector<std::uint64_t> UnsignedNumbers(std::vector<unsigned> const& bytes) {
  std::vector<std::uint64_t> numbers;
  std::uint64_t number = 0;
  unsigned shift = 0;
  for (unsigned const byte : bytes) {
    number |= static_cast<std::uint64_t>(byte & 0x7FU) << shift;
    shift += 7;
    if ((byte & 0x80U) != 0) continue;
    numbers.push_back(number);
    number = 0;
    shift = 0;
  }
  return numbers;
}

inline std::vector<double> Unpacked(PackedColumn const& column) {
  std::vector<std::uint64_t> const codes = UnsignedNumbers(FromBase64(column.bytes));
  std::vector<std::int64_t> numbers;
  for (std::size_t i = 0; i < codes.size(); ++i) {
    auto const half = static_cast<std::int64_t>(codes[i] / 2);
    numbers.push_back(codes[i] % 2 == 1 ? -half - 1 : half);
    if (codes[i] != 0) continue;
    ++i;
    numbers.insert(numbers.end(), codes[i], 0);
  }
  for (int pass = 0; pass < column.order; ++pass) {
    for (std::size_t i = 1; i < numbers.size(); ++i) numbers[i] += numbers[i - 1];
  }
  std::vector<double> values;
  double const power = std::pow(10.0, std::abs(column.decimals));
  for (std::int64_t const number : numbers) {
    auto const multiple = static_cast<double>(number);
    values.push_back(column.decimals >= 0 ? multiple / power : multiple * power);
  }
  return values;
}

}  // namespace Vorn::IO
