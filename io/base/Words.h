#pragma once

#include <string_view>

namespace Vorn::IO {

inline bool IsDigit(char c) { return '0' <= c && c <= '9'; }

inline bool IsBlank(char c) { return c == ' ' || c == '\t' || c == '\r' || c == '\v' || c == '\f'; }

/// Without blanks at both ends.
inline std::string_view Trimmed(std::string_view text) {
  while (!text.empty() && IsBlank(text.front())) text.remove_prefix(1);
  while (!text.empty() && IsBlank(text.back())) text.remove_suffix(1);
  return text;
}

}  // namespace Vorn::IO
