#include "io/base/Base64.h"

#include <algorithm>
#include <cstdint>

namespace Vorn::IO {

namespace {

constexpr std::string_view kCharacters =
    "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
constexpr std::size_t kGroup = 3;        // bytes
constexpr std::uint32_t kLowest = 0x3F;  // six bits
constexpr unsigned kShift = 6;           // bits of a character
constexpr unsigned kFirstShift = 3 * kShift;

/// Up to three bytes as 24 bits, missing ones as 0.
std::uint32_t BitsOf(std::string_view bytes) {
  std::uint32_t bits = 0;
  for (std::size_t i = 0; i < kGroup; ++i) {
    bits = bits << 8U | (i < bytes.size() ? static_cast<unsigned char>(bytes[i]) : 0U);
  }
  return bits;
}

}  // namespace

std::string Base64(std::string_view bytes) {
  std::string text;
  text.reserve((bytes.size() + 2) / kGroup * 4);
  for (; !bytes.empty(); bytes.remove_prefix(std::min(kGroup, bytes.size()))) {
    std::string_view const group = bytes.substr(0, kGroup);
    std::uint32_t const bits = BitsOf(group);
    for (unsigned i = 0; i < 4; ++i) {
      bool const isFilled = i <= group.size();
      text += isFilled ? kCharacters[bits >> (kFirstShift - kShift * i) & kLowest] : '=';
    }
  }
  return text;
}

}  // namespace Vorn::IO
