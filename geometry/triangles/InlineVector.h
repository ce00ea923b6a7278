// A vector of fixed capacity, for overlaps: they are computed thousands of times, and none may
// allocate.

#pragma once

#include <cstddef>
#include <type_traits>

#include "math/Assert.h"

namespace Vorn::Triangles {

/// A vector of fixed capacity on the stack, for plain records. Room is left as it is until it is
/// used: most overlaps need less time than clearing it would take.
template <typename T, std::size_t kCapacity>
class InlineVector {
  static_assert(std::is_trivially_copyable_v<T>);

 public:
  /// An empty vector.
  InlineVector() {}  // NOLINT(modernize-use-equals-default): the union has no default

  /// Appends a value; there must be room.
  void push_back(T const& value) {
    VORN_ASSERT(size_ < kCapacity);
    items_[size_++] = value;
  }

  /// Drops the values from a size on; there must be as many.
  void resize(std::size_t size) {
    VORN_ASSERT(size <= size_);
    size_ = size;
  }

  /// Drops all values.
  void clear() { size_ = 0; }

  /// The number of values.
  std::size_t size() const { return size_; }

  /// Whether there is no value.
  bool empty() const { return size_ == 0; }

  /// The value at a position, which must hold one.
  T& operator[](std::size_t i) { return items_[i]; }
  /// As above.
  T const& operator[](std::size_t i) const { return items_[i]; }

  /// The first value; the others follow it.
  T* data() { return items_; }
  /// As above.
  T const* data() const { return items_; }

  /// The first value.
  T* begin() { return items_; }
  /// As above.
  T const* begin() const { return items_; }
  /// Behind the last value.
  T* end() { return items_ + size_; }
  /// As above.
  T const* end() const { return items_ + size_; }

 private:
  union {
    // NOLINTNEXTLINE(readability-identifier-naming): a private member of the class
    T items_[kCapacity];
  };
  std::size_t size_ = 0;
};

}  // namespace Vorn::Triangles
