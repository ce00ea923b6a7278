#include "vorn/io/Failure.h"

#include <utility>

namespace Vorn::IO {

namespace {

/// "scan.csv:3:7: ", as compilers and editors know it.
std::string Prefix(Place const& place) {
  if (place.file.empty()) return "";
  std::string text = place.file;
  if (place.line > 0) text += ":" + std::to_string(place.line);
  if (place.line > 0 && place.column > 0) text += ":" + std::to_string(place.column);
  return text + ": ";
}

}  // namespace

Failure::Failure(FailureKind kind, std::string const& message) : Failure(kind, Place{}, message) {}

Failure::Failure(FailureKind kind, Place place, std::string const& message, Remedy help)
    : std::runtime_error(Prefix(place) + message),
      kind_(kind),
      place_(std::move(place)),
      message_(message),
      help_(help) {}

Failure::~Failure() = default;

}  // namespace Vorn::IO
