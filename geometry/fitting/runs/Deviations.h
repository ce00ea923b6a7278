// Deviations of points from what was fitted to them, and the largest one of several.

#pragma once

#include <cstdint>

namespace Vorn::Fitting {

/// A deviation and the point that has it. Whether it is a distance or a distance divided by the
/// point's tolerance, and what the index counts from, is said by the function that gives it.
struct Deviation {
  double value = -1.0;
  std::int32_t index = -1;
};

/// The largest of the values at the positions 0 .. count - 1, and the first position that has it. A
/// value that is not a number stays when it is the first one and is passed over otherwise. The
/// default deviation for a count below 1. O(count).
template <typename ValueAt>
Deviation FindLargest(std::int32_t count, ValueAt const& valueAt) {
  if (count < 1) return {};
  Deviation largest{valueAt(0), 0};
  for (std::int32_t position = 1; position < count; ++position) {
    double const value = valueAt(position);
    if (value > largest.value) largest = {value, position};
  }
  return largest;
}

/// The largest deviation met over the elements of a contour. The first element always sets it; of
/// equal ones the first stands.
class LargestDeviation {
 public:
  /// Takes the deviation of one more element into account.
  void Take(Deviation const& deviation) {
    if (largest_.value < 0.0 || deviation.value > largest_.value) largest_ = deviation;
  }

  /// The largest one; the default deviation when none was taken.
  Deviation const& Get() const { return largest_; }

 private:
  Deviation largest_;
};

}  // namespace Vorn::Fitting
