#include "benchmarks/AllocationMeter.h"

#include <malloc.h>

#include <algorithm>
#include <cstdlib>
#include <new>

namespace {

bool isWatching = false;
std::int64_t bytes = 0;
std::int64_t peakBytes = 0;

void* Allocate(std::size_t size) {
  void* const memory = std::malloc(size == 0 ? 1 : size);
  if (isWatching && memory != nullptr) {
    bytes += static_cast<std::int64_t>(malloc_usable_size(memory));
    peakBytes = std::max(peakBytes, bytes);
  }
  return memory;
}

void Release(void* memory) {
  if (isWatching && memory != nullptr) {
    bytes -= static_cast<std::int64_t>(malloc_usable_size(memory));
  }
  std::free(memory);
}

}  // namespace

// Every form is replaced, not only the ones that the others call: a sanitizer brings its own.
void* operator new(std::size_t size) {
  void* const memory = Allocate(size);
  if (memory == nullptr) throw std::bad_alloc();
  return memory;
}

void* operator new[](std::size_t size) { return operator new(size); }

void* operator new(std::size_t size, std::nothrow_t const&) noexcept { return Allocate(size); }

void* operator new[](std::size_t size, std::nothrow_t const&) noexcept { return Allocate(size); }

void operator delete(void* memory) noexcept { Release(memory); }

void operator delete(void* memory, std::size_t) noexcept { Release(memory); }

void operator delete[](void* memory) noexcept { Release(memory); }

void operator delete[](void* memory, std::size_t) noexcept { Release(memory); }

namespace Vorn::Benchmarks {

AllocationMeter::AllocationMeter() {
  bytes = 0;
  peakBytes = 0;
  isWatching = true;
}

AllocationMeter::~AllocationMeter() { isWatching = false; }

std::int64_t AllocationMeter::PeakBytes() const { return peakBytes; }

}  // namespace Vorn::Benchmarks
