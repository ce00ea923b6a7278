// What every harness is made of.
#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>

/// Tries one input. Aborts when an invariant does not hold.
/// @return 0
extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size);

namespace Vorn::Fuzz {

/// Ends the program, so that the fuzzer keeps the input, unless the claim holds.
inline void Require(bool holds, char const* claim) {
  if (holds) return;
  std::fprintf(stderr, "does not hold: %s\n", claim);
  std::abort();
}

}  // namespace Vorn::Fuzz
