#pragma once

#include <string>
#include <string_view>

namespace Vorn::IO {

/// Bytes as text of the 64 characters A-Z, a-z, 0-9, + and /, four for three bytes, filled up with
/// = at the end (RFC 4648). That of GLib, which is linked anyway, ends the program when memory runs
/// out.
std::string Base64(std::string_view bytes);

}  // namespace Vorn::IO
