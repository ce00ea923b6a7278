#pragma once

#include <sstream>
#include <string>
#include <vector>

#include "cli/Program.h"

namespace Vorn::Cli {

/// How a run of the program ended, and what it wrote.
struct RunResult {
  ExitCode code = ExitCode::Internal;
  std::string out;
  std::string err;
};

/// Runs the program inside the test with these words after its name and this standard input.
inline RunResult RunInProcess(std::vector<std::string> const& words, std::string const& in = "") {
  std::vector<char const*> line = {"contour"};
  for (std::string const& word : words) line.push_back(word.c_str());
  std::istringstream input(in);
  std::ostringstream out;
  std::ostringstream err;
  RunResult result;
  result.code = RunProgram(static_cast<int>(line.size()), line.data(), input, out, err);
  result.out = out.str();
  result.err = err.str();
  return result;
}

}  // namespace Vorn::Cli
