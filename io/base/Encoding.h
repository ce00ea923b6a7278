#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

/// Texts in other encodings than UTF-8, as programs of other systems save them.
namespace Vorn::IO {

/// A character of UTF-8; a length of 0 says that the bytes are none.
struct Utf8Character {
  std::size_t length = 0;
  std::uint32_t code = 0;
};

/// That at the beginning of a text that is not empty.
Utf8Character FirstCharacter(std::string_view text);

/// Whether all of the text is UTF-8.
bool IsUtf8(std::string_view text);

/// Without the byte order mark of UTF-8 that may stand ahead of the text.
std::string_view WithoutUtf8Mark(std::string_view text);

/// Whether the text begins with a byte order mark of UTF-16.
bool IsUtf16(std::string_view text);

/// A text of UTF-16 with its byte order mark as UTF-8 without one; what is no character becomes
/// U+FFFD. Nothing for any other text.
std::optional<std::string> Utf8FromUtf16(std::string_view text);

/// The text itself when it is UTF-8, else each byte taken as a character of ISO 8859-1, in which
/// older instruments write letters with accents and the sign for micro.
std::string Utf8FromEither(std::string_view text);

}  // namespace Vorn::IO
