#include <array>
#include <cstddef>
#include <cstdint>

#include "vorn/io/Messages.h"

namespace Vorn::IO {

namespace {

constexpr std::string_view kReplacement = "\xEF\xBF\xBD";

/// Where the first bytes of characters of 1, 2, 3 and 4 bytes end or begin. 0xC0 and 0xC1 begin
/// none, as they would write ASCII in two bytes; from 0xF5 on the codes would be too large.
constexpr unsigned char kEndOfSingle = 0x80;
constexpr unsigned char kFirstOfTwo = 0xC2;
constexpr unsigned char kFirstOfThree = 0xE0;
constexpr unsigned char kFirstOfFour = 0xF0;
constexpr unsigned char kEndOfFour = 0xF5;

/// A byte after the first has the mark 10 in its upper two bits, and six bits of the code below.
constexpr std::uint32_t kMarkBits = 0xC0;
constexpr std::uint32_t kMark = 0x80;
constexpr std::uint32_t kCodeBits = 0x3F;
constexpr std::uint32_t kFirstCodeBits = 0x7F;

constexpr std::uint32_t kLargestCode = 0x10FFFF;

/// The control characters above ASCII's printable ones: delete and those of ISO 6429.
constexpr std::uint32_t kDelete = 0x7F;
constexpr std::uint32_t kEndOfControls = 0xA0;

/// A character of UTF-8; a length of 0 says that the bytes are none.
struct Character {
  std::size_t length = 0;
  std::uint32_t code = 0;
};

std::size_t LengthFrom(unsigned char first) {
  if (first < kEndOfSingle) return 1;
  if (first >= kFirstOfTwo && first < kFirstOfThree) return 2;
  if (first >= kFirstOfThree && first < kFirstOfFour) return 3;
  return first >= kFirstOfFour && first < kEndOfFour ? 4 : 0;
}

Character CharacterAt(std::string_view text) {
  auto const byte = [&](std::size_t i) { return static_cast<unsigned char>(text[i]); };
  std::size_t const length = LengthFrom(byte(0));
  if (length == 0 || length > text.size()) return {};
  if (length == 1) return {1, byte(0)};
  // The first byte has as many leading ones as the character has bytes.
  std::uint32_t code = byte(0) & (kFirstCodeBits >> length);
  for (std::size_t i = 1; i < length; ++i) {
    if ((byte(i) & kMarkBits) != kMark) return {};
    code = code << 6 | (byte(i) & kCodeBits);
  }
  constexpr std::array<std::uint32_t, 5> kLeast = {0, 0, 0x80, 0x800, 0x10000};
  bool const isSurrogate = code >= 0xD800 && code < 0xE000;
  if (code < kLeast.at(length) || code > kLargestCode || isSurrogate) return {};
  return {length, code};
}

bool IsControl(std::uint32_t code) {
  return code < 0x20 || (code >= kDelete && code < kEndOfControls);
}

}  // namespace

std::string Printable(std::string_view text) {
  std::string result;
  while (!text.empty()) {
    Character const character = CharacterAt(text);
    bool const isGood = character.length > 0 && !IsControl(character.code);
    std::size_t const length = character.length > 0 ? character.length : 1;
    result += isGood ? text.substr(0, length) : kReplacement;
    text.remove_prefix(length);
  }
  return result;
}

}  // namespace Vorn::IO
