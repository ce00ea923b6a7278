#include <cstddef>
#include <cstdint>

#include "io/base/Encoding.h"
#include "vorn/io/Messages.h"

namespace Vorn::IO {

namespace {

constexpr std::string_view kReplacement = "\xEF\xBF\xBD";

/// The control characters above ASCII's printable ones: delete and those of ISO 6429.
constexpr std::uint32_t kDelete = 0x7F;
constexpr std::uint32_t kEndOfControls = 0xA0;

bool IsControl(std::uint32_t code) {
  return code < 0x20 || (code >= kDelete && code < kEndOfControls);
}

}  // namespace

std::string Printable(std::string_view text) {
  std::string result;
  while (!text.empty()) {
    Utf8Character const character = FirstCharacter(text);
    bool const isGood = character.length > 0 && !IsControl(character.code);
    std::size_t const length = character.length > 0 ? character.length : 1;
    result += isGood ? text.substr(0, length) : kReplacement;
    text.remove_prefix(length);
  }
  return result;
}

}  // namespace Vorn::IO
