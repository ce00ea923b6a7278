#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "vorn/Types.h"
#include "vorn/io/Failure.h"
#include "vorn/io/SpacingFailure.h"

namespace Vorn::Python {

/// What a ContourError of Python tells.
struct Problem {
  ErrorCode code = ErrorCode::Failed;
  std::string message;
  std::vector<std::int64_t> indices;  ///< the points concerned, as positions in the input
};

/// Throws the exception of Python for the code. Needs the interpreter lock.
[[noreturn]] void Raise(Problem const& problem);

/// The same for a failure of the library above the core.
[[noreturn]] void Raise(IO::Failure const& failure);

/// The same for neighbours that are too close, with both distances.
[[noreturn]] void Raise(IO::SpacingFailure const& failure);

/// Throws, for the operation named, unless the code is Ok.
void RequireOk(ErrorCode code, char const* operation);

/// Throws, for the operation named, unless it succeeded.
void RequireSuccess(bool succeeded, char const* operation);

/// Lets every failure leave as an exception of Python; once, when the module is loaded.
void RegisterErrors();

}  // namespace Vorn::Python
