#include "support/FailingAllocation.h"

#include <cstdlib>
#include <new>

namespace {

constexpr int kNever = -1;

thread_local int allocationsLeft = kNever;
thread_local bool hasFailed = false;

void* Allocate(std::size_t size) {
  if (allocationsLeft == 0) {
    hasFailed = true;
    return nullptr;
  }
  if (allocationsLeft > 0) --allocationsLeft;
  return std::malloc(size == 0 ? 1 : size);
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

void operator delete(void* memory) noexcept { std::free(memory); }

void operator delete(void* memory, std::size_t) noexcept { std::free(memory); }

void operator delete[](void* memory) noexcept { std::free(memory); }

void operator delete[](void* memory, std::size_t) noexcept { std::free(memory); }

namespace Vorn::Testing {

FailingAllocation::FailingAllocation(int number) {
  hasFailed = false;
  allocationsLeft = number;
}

FailingAllocation::~FailingAllocation() { allocationsLeft = kNever; }

bool FailingAllocation::HasFailed() const { return hasFailed; }

}  // namespace Vorn::Testing
