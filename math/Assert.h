// The assertion macro of the library.

#pragma once

#include <cstdio>
#include <cstdlib>

/// States what must hold at a place in the code, whatever the caller passed: a bound that a proof
/// in a comment promises, room in an array of fixed size. Where the build defines VORN_ASSERTIONS
/// (option VORN_ASSERTIONS of CMake, on in the presets dev and sanitize) a condition that is false
/// ends the program with a line that tells file, line and condition. Elsewhere the condition is
/// compiled but not evaluated. Bad input is never asserted against: it is answered.
#if defined(VORN_ASSERTIONS)
#define VORN_ASSERT(condition) \
  ((condition) ? static_cast<void>(0) : ::Vorn::EndProgram(#condition, __FILE__, __LINE__))
#else
#define VORN_ASSERT(condition) static_cast<void>(sizeof(!(condition)))
#endif

namespace Vorn {

/// Tells on standard error which assertion failed and ends the program. The only place where the
/// library writes anything, and only in builds with assertions.
[[noreturn]] inline void EndProgram(char const* condition, char const* file, int line) {
  static_cast<void>(std::fprintf(stderr, "%s:%d: assertion failed: %s\n", file, line, condition));
  std::abort();
}

}  // namespace Vorn
