#pragma once

#include <stdexcept>
#include <string>

#include "vorn/io/Export.h"

namespace Vorn::IO {

/// What went wrong, for a caller who acts on it.
enum class FailureKind {
  BadArgument,     ///< what the caller asks for cannot be, whatever the files hold
  File,            ///< a file cannot be read or written, or holds something else than it should
  PointsTooClose,  ///< two neighbouring points are too close for their tolerances
  NoFit,           ///< the points have no contour within their tolerances
  Internal,        ///< a defect of this library
};

/// The exception with which every operation of this library fails. Its message is for the user.
class VORN_IO_EXPORT Failure : public std::runtime_error {
 public:
  Failure(FailureKind kind, std::string const& message)
      : std::runtime_error(message), kind_(kind) {}

  FailureKind Kind() const { return kind_; }

 private:
  FailureKind kind_;
};

}  // namespace Vorn::IO
