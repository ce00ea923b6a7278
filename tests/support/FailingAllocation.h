#pragma once

namespace Vorn::Testing {

/// While alive, the allocation with the given number (0 is the next one) of this thread throws
/// std::bad_alloc, as do all later ones. Covers everything that goes through operator new, the
/// shared library included.
class FailingAllocation {
 public:
  explicit FailingAllocation(int number);
  ~FailingAllocation();
  FailingAllocation(FailingAllocation const&) = delete;
  FailingAllocation& operator=(FailingAllocation const&) = delete;

  /// Whether an allocation has been refused.
  bool HasFailed() const;
};

}  // namespace Vorn::Testing
