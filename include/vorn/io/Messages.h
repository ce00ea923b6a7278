#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "vorn/io/Export.h"

/// How the messages of this library are put, for programs that add their own.
namespace Vorn::IO {

/// With small letters in place of A to Z, in any locale.
VORN_IO_EXPORT std::string LowerCase(std::string_view text);

/// Text from a file as it may stand in a message: quoted, cut when long, control characters
/// replaced.
VORN_IO_EXPORT std::string Quoted(std::string_view text);

/// One word on a command line, in single quotes where a shell needs them.
VORN_IO_EXPORT std::string ShellQuoted(std::string const& text);

/// The text as it may stand in a terminal, a drawing or a document: bytes that are not UTF-8 and
/// control characters, line ends and tabs included, become U+FFFD, one for each.
VORN_IO_EXPORT std::string Printable(std::string_view text);

/// "1 line", "2 lines".
VORN_IO_EXPORT std::string Counted(std::size_t count, std::string const& noun);

}  // namespace Vorn::IO
