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
  RaiseInstance(ErrorsModule().attr("error_for")(problem.message,
                                                 static_cast<std::int32_t>(problem.code),
                                                 py::tuple(py::cast(problem.indices))));
}

void Raise(IO::Failure const& failure) {
  if (failure.Kind() == IO::FailureKind::File) {
    IO::Place const& place = failure.Where();
    RaiseInstance(
        ErrorsModule().attr("FileError")(failure.what(), place.file, place.line, place.column));
  }
  Raise({CodeOf(failure.Kind()), failure.what(), {}});
}

void RequireOk(ErrorCode code, char const* operation) {
  if (code != ErrorCode::Ok) Raise({code, std::string(operation) + ": " + IO::Describe(code), {}});
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
