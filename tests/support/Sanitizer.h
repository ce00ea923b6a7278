// Tells tests whether they run under the address sanitizer.
#pragma once

namespace Vorn::Testing {

#if defined(__SANITIZE_ADDRESS__)
inline constexpr bool kIsSanitized = true;
#elif defined(__has_feature)
inline constexpr bool kIsSanitized = __has_feature(address_sanitizer);
#else
inline constexpr bool kIsSanitized = false;
#endif

}  // namespace Vorn::Testing
