#pragma once

#include <cstddef>
#include <string_view>

#include "vorn/io/Formats.h"

namespace Vorn::IO {

/// No contour file is read that would take more memory than this, 1 GiB.
inline constexpr std::size_t kLargestMemory = std::size_t{1} << 30;

/// About how much memory it takes to read a contour from the text and to work on it, the text
/// itself included: a file of few long numbers may be ten times as long as one of short ones.
std::size_t MemoryToRead(std::string_view text, Format format);

}  // namespace Vorn::IO
