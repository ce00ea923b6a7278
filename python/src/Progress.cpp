#include "Progress.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

/// Short for a person at the keyboard, long beside the microsecond that the lock costs.
constexpr std::chrono::milliseconds kBetweenLooks(50);

}  // namespace

Progress::Progress(py::object const& callable)
    : callable_(callable),
      hasCallable_(!callable.is_none()),
      nextLook_(Clock::now() + kBetweenLooks) {}

void Progress::SetProgress(std::int32_t percent) {
  LookForSignals();
  if (!hasCallable_ || percent <= largest_) return;
  largest_ = percent;
  py::gil_scoped_acquire const lock;
  callable_(percent);
}

void Progress::LookForSignals() {
  Clock::time_point const now = Clock::now();
  if (now < nextLook_) return;
  nextLook_ = now + kBetweenLooks;
  py::gil_scoped_acquire const lock;
  if (PyErr_CheckSignals() != 0) throw py::error_already_set();
}

}  // namespace Vorn::Python
