#include "Errors.h"

#include <pybind11/pybind11.h>
#include <pybind11/stl.h>

#include <string>
#include <utility>

#include "vorn/io/FitReport.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/Spacing.h"

namespace py = pybind11;

namespace Vorn::Python {

namespace {

[[noreturn]] void RaiseInstance(py::object const& error) {
  PyErr_SetObject(py::type::of(error).ptr(), error.ptr());
  throw py::error_already_set();
}

/// What a message quotes of a file need not be UTF-8.
py::object TextOf(std::string const& message) {
  return py::reinterpret_steal<py::object>(PyUnicode_DecodeUTF8(
      message.data(), static_cast<py::ssize_t>(message.size()), "backslashreplace"));
}

py::object ErrorsModule() { return py::module_::import("vorn.errors"); }

ErrorCode CodeOf(IO::FailureKind kind) {
  switch (kind) {
    case IO::FailureKind::PointsTooClose:
      return ErrorCode::PointsTooClose;
    case IO::FailureKind::NoFit:
      return ErrorCode::NoFit;
    case IO::FailureKind::BadArgument:
    case IO::FailureKind::File:
    case IO::FailureKind::Internal:
      break;
  }
  return ErrorCode::Failed;
}

/// Two lengths with so many digits that they do not read as the same if they are not.
std::pair<std::string, std::string> TextsOf(double a, double b) {
  constexpr int kUsualDigits = 6;
  constexpr int kMostDigits = 17;
  int digits = kUsualDigits;
  while (digits < kMostDigits && a != b &&
         IO::FormatShort(a, digits) == IO::FormatShort(b, digits)) {
    ++digits;
  }
  return {IO::FormatShort(a, digits), IO::FormatShort(b, digits)};
}

/// The message of the library names points by what the file calls them, and the options of the
/// program; here points come as numbers.
std::string DescribeTooClose(IO::ClosePair const& pair) {
  std::string const points =
      "points " + std::to_string(pair.first) + " and " + std::to_string(pair.second);
  if (!(pair.needed > 0.0)) {
    return points + " lie in one place, so no tolerance follows from their spacing; leave one out";
  }
  auto const [distance, needed] = TextsOf(pair.distance, pair.needed);
  return points + " are " + distance + " apart, which must be more than " + needed +
         " for their tolerances; the strategy \"fewest\" takes points of any density";
}

}  // namespace

void Raise(Problem const& problem) {
  RaiseInstance(ErrorsModule().attr("error_for")(TextOf(problem.message),
                                                 static_cast<std::int32_t>(problem.code),
                                                 py::tuple(py::cast(problem.indices))));
}

void Raise(IO::Failure const& failure) {
  if (failure.Kind() == IO::FailureKind::File) {
    IO::Place const& place = failure.Where();
    RaiseInstance(ErrorsModule().attr("FileError")(TextOf(failure.what()), TextOf(place.file),
                                                   place.line, place.column));
  }
  Raise({CodeOf(failure.Kind()), failure.what(), {}});
}

void Raise(IO::SpacingFailure const& failure) {
  IO::ClosePair const& pair = failure.Neighbours().pair;
  RaiseInstance(ErrorsModule().attr("PointsTooCloseError")(
      DescribeTooClose(pair), static_cast<std::int32_t>(ErrorCode::PointsTooClose),
      py::make_tuple(pair.first, pair.second), pair.distance, pair.needed));
}

void RequireOk(ErrorCode code, char const* operation) {
  if (code == ErrorCode::Ok) return;
  std::string const why =
      code == ErrorCode::Failed ? "there is no answer for this input" : IO::Describe(code);
  Raise({code, std::string(operation) + ": " + why, {}});
}

void RequireSuccess(bool succeeded, char const* operation) {
  if (!succeeded) RequireOk(ErrorCode::Failed, operation);
}

namespace {

/// Makes the exception of Python that of the interpreter.
template <typename Thrown>
void Restore(Thrown const& failure) {
  try {
    Raise(failure);
  } catch (py::error_already_set& error) {
    error.restore();
  }
}

}  // namespace

void RegisterErrors() {
  // By value, because that is the type of a translator.
  // NOLINTNEXTLINE(performance-unnecessary-value-param)
  py::register_local_exception_translator([](std::exception_ptr thrown) {
    try {
      if (thrown) std::rethrow_exception(thrown);
    } catch (IO::SpacingFailure const& failure) {
      Restore(failure);
    } catch (IO::Failure const& failure) {
      Restore(failure);
    }
  });
}

}  // namespace Vorn::Python
