#pragma once

#include <cstddef>
#include <string_view>

namespace Vorn::IO {

/// Where in a good JSON document the value stands that a path such as `elements[2].end.x` leads to,
/// in bytes from its start. What is not there stands where the value stands that should hold it.
/// @param path keys without brackets and dots, and indexes, as JsonField names its values; empty:
///             the document
std::size_t OffsetInJson(std::string_view text, std::string_view path);

}  // namespace Vorn::IO
