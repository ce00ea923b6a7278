#pragma once

#if defined(__SANITIZE_THREAD__)
#define VORN_THREAD_SANITIZER
#elif defined(__has_feature)
#if __has_feature(thread_sanitizer)
#define VORN_THREAD_SANITIZER
#endif
#endif

#if defined(VORN_THREAD_SANITIZER)
#include <sanitizer/tsan_interface.h>
#endif

namespace Vorn::Cli {

/// Work that one thread hands over to another by means of a library. The thread sanitizer does not
/// see into libraries that were built without it, so this tells it what they guarantee; in every
/// other build it is nothing.
class Handover {
 public:
  /// What this thread has done so far is to be seen by those that take.
  void Give() {
#if defined(VORN_THREAD_SANITIZER)
    __tsan_release(this);
#endif
  }

  /// What others have done before they gave is seen by this thread.
  void Take() {
#if defined(VORN_THREAD_SANITIZER)
    __tsan_acquire(this);
#endif
  }
};

}  // namespace Vorn::Cli
