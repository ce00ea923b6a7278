// Counts what a fit spends its time on. The linker sends the library's own calls of its costly
// steps through counters (see step_tests in CMakeLists.txt), so that a bound on the cost is held by
// numbers that are the same on every machine.

#pragma once

#include <cstdint>

namespace Vorn::Testing {

/// Steps since the last ResetSteps, of the whole program.
struct Steps {
  /// A cell of lines or circles is narrowed by another one.
  std::int64_t narrowings = 0;
  /// A triangle of a cell is cut by another triangle.
  std::int64_t overlaps = 0;
  /// A circle is measured against a point, in the search of the fewest pieces.
  std::int64_t measurements = 0;
};

/// Sets the counters to zero.
void ResetSteps();

/// What has been counted.
Steps CountedSteps();

}  // namespace Vorn::Testing
