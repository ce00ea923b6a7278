#pragma once

#include <cstdint>

namespace Vorn::Benchmarks {

/// While it lives, watches how much memory is allocated on top of what was there at its start. The
/// whole program allocates through it, the shared library included; one at a time, one thread.
class AllocationMeter {
 public:
  AllocationMeter();
  ~AllocationMeter();
  AllocationMeter(AllocationMeter const&) = delete;
  AllocationMeter& operator=(AllocationMeter const&) = delete;

  std::int64_t PeakBytes() const;
};

}  // namespace Vorn::Benchmarks
