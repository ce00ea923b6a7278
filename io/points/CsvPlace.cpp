#include "io/points/CsvPlace.h"

#include <algorithm>

#include "vorn/io/Files.h"
#include "vorn/io/Messages.h"

namespace Vorn::IO {

namespace {

/// The number of characters in UTF-8 text, as editors count them.
std::size_t CountCharacters(std::string_view text) {
  constexpr unsigned kContinuation = 0x80;
  constexpr unsigned kContinuationMask = 0xC0;
  return static_cast<std::size_t>(std::count_if(text.begin(), text.end(), [](char c) {
    return (static_cast<unsigned char>(c) & kContinuationMask) != kContinuation;
  }));
}

}  // namespace

CsvPlace::CsvPlace(std::string const& path) : path_(Printable(InputName(path))) {}

void CsvPlace::Refuse(std::string const& message) const {
  throw Failure(FailureKind::File, {path_}, message);
}

void CsvPlace::RefuseLine(std::string const& message) const {
  throw Failure(FailureKind::File, {path_, line_}, message);
}

void CsvPlace::RefuseAt(std::string_view field, std::string const& message, Remedy help) const {
  auto const begin = static_cast<std::size_t>(field.data() - lineText_.data());
  std::size_t const column = 1 + CountCharacters(lineText_.substr(0, begin));
  throw Failure(FailureKind::File, {path_, line_, column}, message, help);
}

}  // namespace Vorn::IO
