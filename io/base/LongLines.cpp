#include "io/base/LongLines.h"

#include <optional>

#include "io/base/Encoding.h"
#include "io/base/FirstLine.h"
#include "io/base/TextLines.h"
#include "vorn/io/Failure.h"

namespace Vorn::IO {

namespace {

/// No contour is read that takes more than 1 GiB of memory, and each byte of JSON, SVG or
/// well-known text that holds geometry takes five at least.
constexpr std::size_t kLongestOnlyLine = std::size_t{256} << 20;
constexpr char const* kOnlyLineTooLong =
    "the line is longer than 256 MiB: too large for a contour in one line";

/// Counted from 1.
std::size_t NumberOfLineAt(std::string_view text, std::size_t begin) {
  // Of UTF-16 the second byte of a line feed may lie behind.
  std::string_view const before = text.substr(0, IsUtf16(text) ? begin + begin % 2 : begin);
  std::optional<std::string> const decoded = Utf8FromUtf16(before);
  std::size_t number = 1;
  for (TextLines lines(decoded ? *decoded : before); !lines.AtEnd(); lines.Take()) ++number;
  return number;
}

}  // namespace

void LongLines::Look(std::string_view text) {
  if (longest_ == 0) longest_ = IsUtf16(text) ? 2 * kLongestTableLine : kLongestTableLine;
  while (text.size() - lineBegin_ > longest_) {
    std::size_t const end = text.substr(lineBegin_, longest_ + 1).find_last_of("\r\n");
    if (end == std::string_view::npos) {
      Judge(text);
    } else {
      lineBegin_ += end + 1;
    }
  }
}

void LongLines::Judge(std::string_view text) {
  bool const isOnlyLine = longest_ == kLongestOnlyLine;
  if (!isOnlyLine && MayStandInOneLine(text)) {
    longest_ = kLongestOnlyLine;
    return;
  }
  throw Failure(FailureKind::File, {path_, NumberOfLineAt(text, lineBegin_)},
                isOnlyLine ? kOnlyLineTooLong : kLineTooLong);
}

}  // namespace Vorn::IO
