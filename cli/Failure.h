#pragma once

#include <stdexcept>
#include <string>

namespace Vorn::Cli {

/// How the program ends. Scripts rely on the numbers.
enum class ExitCode : int {
  Ok = 0,
  OutsideTolerance = 1,
  Usage = 2,
  File = 3,
  PointsTooClose = 4,
  NoFit = 5,
  Internal = 70,
  Interrupted = 130,
};

/// Ends the program with a message for the user and the exit code that goes with it.
class Failure : public std::runtime_error {
 public:
  Failure(ExitCode code, std::string const& message) : std::runtime_error(message), code_(code) {}

  ExitCode Code() const { return code_; }

 private:
  ExitCode code_;
};

}  // namespace Vorn::Cli
