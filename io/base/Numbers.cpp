#include "vorn/io/Numbers.h"

#include <fast_float/fast_float.h>

#include <algorithm>
#include <array>
#include <charconv>
#include <cstdio>

#include "io/base/Words.h"
#include "vorn/io/Messages.h"

namespace Vorn::IO {

namespace {

constexpr std::size_t kLongestQuote = 40;

/// No double has more digits behind the point, so further ones would all be zeros.
constexpr int kMostDigits = 1074;

/// Sign, point, exponent and the end of the text.
constexpr int kBesideDigits = 16;

bool EveryCommaHasADigitBehind(std::string_view text) {
  for (std::size_t i = 0; i < text.size(); ++i) {
    if (text[i] != ',') continue;
    if (i + 1 == text.size() || !IsDigit(text[i + 1])) return false;
  }
  return true;
}

std::string WithoutMinusOnZero(std::string text) {
  bool const isZero = text.find_first_not_of("-0.") == std::string::npos;
  if (isZero && text.front() == '-') text.erase(0, 1);
  return text;
}

}  // namespace

std::optional<double> ParseNumber(std::string_view text, DecimalMark mark) {
  if (text.size() > 1 && text.front() == '+' && text[1] != '-') text.remove_prefix(1);
  if (mark == DecimalMark::Comma && !EveryCommaHasADigitBehind(text)) return {};
  double value = 0.0;
  char const* const end = text.data() + text.size();
  fast_float::parse_options const options(fast_float::chars_format::general,
                                          mark == DecimalMark::Comma ? ',' : '.');
  fast_float::from_chars_result const result =
      fast_float::from_chars_advanced(text.data(), end, value, options);
  if (text.empty() || result.ptr != end || result.ec == std::errc::invalid_argument) return {};
  return value;
}

std::string FormatShort(double value, int digits) {
  int const precision = std::clamp(digits, 1, kMostDigits);
  std::array<char, kMostDigits + kBesideDigits> buffer{};
  std::snprintf(buffer.data(), buffer.size(), "%.*g", precision, value);
  return WithoutMinusOnZero(buffer.data());
}

std::string FormatFixed(double value, int decimals) {
  // The largest double has 309 digits ahead of the point.
  constexpr std::size_t kLongestWhole = 309;
  int const precision = std::clamp(decimals, 0, kMostDigits);
  std::array<char, kLongestWhole + kMostDigits + kBesideDigits> buffer{};
  std::snprintf(buffer.data(), buffer.size(), "%.*f", precision, value);
  return WithoutMinusOnZero(buffer.data());
}

std::string FormatRelative(double value) {
  constexpr int kFewest = 4;
  constexpr int kAll = 17;
  int digits = kFewest;
  while (digits < kAll && value != 1.0 && FormatShort(value, digits) == "1") ++digits;
  return FormatShort(value, digits);
}

std::string FormatExact(double value) {
  std::array<char, 64> buffer{};
  std::to_chars_result const result =
      std::to_chars(buffer.data(), buffer.data() + buffer.size(), value);
  return {buffer.data(), result.ptr};
}

std::string LowerCase(std::string_view text) {
  std::string lower(text);
  std::transform(lower.begin(), lower.end(), lower.begin(), [](char c) {
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
  });
  return lower;
}

std::string Quoted(std::string_view text) {
  bool const cut = text.size() > kLongestQuote;
  std::string quoted(text.substr(0, kLongestQuote));
  std::replace_if(
      quoted.begin(), quoted.end(), [](char c) { return (c >= 0 && c < ' ') || c == '\x7f'; }, '?');
  return "'" + quoted + (cut ? "...'" : "'");
}

std::string ShellQuoted(std::string const& text) {
  constexpr std::string_view kPlain =
      "abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ0123456789_-./+:,@%";
  if (!text.empty() && text.find_first_not_of(kPlain) == std::string::npos) return text;
  std::string quoted = "'";
  for (char const c : text) quoted += c == '\'' ? "'\\''" : std::string(1, c);
  return quoted + "'";
}

std::string Counted(std::size_t count, std::string const& noun) {
  return std::to_string(count) + " " + noun + (count == 1 ? "" : "s");
}

}  // namespace Vorn::IO
