#pragma once

#include <string_view>

namespace Vorn::IO {

/// Without blanks at both ends.
std::string_view Trimmed(std::string_view text);

}  // namespace Vorn::IO
