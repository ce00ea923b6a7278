#include <array>
#include <cstddef>
#include <cstdint>

#include "vorn/io/Messages.h"

namespace Vorn::IO {

namespace {

constexpr std::string_view kReplacement = "\xEF\xBF\xBD";

/// A character of UTF-8; a length of 0 says that the bytes are none.
struct Character {
  std::size_t length = 0;
  std::uint32_t code = 0;
};

std::size_t LengthFrom(unsigned char first) {
  if (first < 0x80) return 1;
  if (first >= 0xC2 && first < 0xE0) return 2;
  if (first >= 0xE0 && first < 0xF0) return 3;
  return first >= 0xF0 && first < 0xF5 ? 4 : 0;
}

Character CharacterAt(std::string_view text) {
  auto const byte = [&](std::size_t i) { return static_cast<unsigned char>(text[i]); };
  std::size_t const length = LengthFrom(byte(0));
  if (length == 0 || length > text.size()) return {};
  if (length == 1) return {1, byte(0)};
  // The first byte has as many leading ones as the character has bytes.
  std::uint32_t code = byte(0) & (0x7Fu >> length);
  for (std::size_t i = 1; i < length; ++i) {
    if ((byte(i) & 0xC0u) != 0x80u) return {};
    code = code << 6 | (byte(i) & 0x3Fu);
  }
  constexpr std::array<std::uint32_t, 5> kLeast = {0, 0, 0x80, 0x800, 0x10000};
  bool const isSurrogate = code >= 0xD800 && code < 0xE000;
  if (code < kLeast.at(length) || code > 0x10FFFF || isSurrogate) return {};
  return {length, code};
}

bool IsControl(std::uint32_t code) { return code < 0x20 || (code >= 0x7F && code < 0xA0); }

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
