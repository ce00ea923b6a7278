#include "Errors.h"

#include <pybind11/pybind11.h>
#include <pybind11/stl.h>

#include "vorn/io/FitReport.h"

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

void RequireOk(ErrorCode code, char const* operation) {
  if (code == ErrorCode::Ok) return;
  std::string const why =
      code == ErrorCode::Failed ? "there is no answer for this input" : IO::Describe(code);
  Raise({code, std::string(operation) + ": " + why, {}});
}

void RequireSuccess(bool succeeded, char const* operation) {
  if (!succeeded) RequireOk(ErrorCode::Failed, operation);
}

void RegisterErrors() {
  // By value, because that is the type of a translator.
  // NOLINTNEXTLINE(performance-unnecessary-value-param)
  py::register_local_exception_translator([](std::exception_ptr thrown) {
    try {
      if (thrown) std::rethrow_exception(thrown);
    } catch (IO::Failure const& failure) {
      try {
        Raise(failure);
      } catch (py::error_already_set& error) {
        error.restore();
      }
    }
  });
}

}  // namespace Vorn::Python
