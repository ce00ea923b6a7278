#pragma once

#include <cstdint>
#include <map>

namespace Vorn::Benchmarks {

/// Leaves out sizes of a series that would take too long, judged by how the time grew so far.
class TimeBudget {
 public:
  explicit TimeBudget(double seconds) : seconds_(seconds) {}

  /// Whether one run of this size is expected to end in time.
  bool Allows(std::int64_t size) const;

  /// Records how long one run of this size took.
  void Note(std::int64_t size, double seconds);

  double Seconds() const { return seconds_; }

 private:
  double seconds_;
  std::map<std::int64_t, double> taken_;
};

}  // namespace Vorn::Benchmarks
