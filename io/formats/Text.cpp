#include "io/formats/Text.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <optional>

#include "io/base/Encoding.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

Lines::Lines(std::string_view text) : lines_(WithoutUtf8Mark(text)) {}

bool Lines::Next(std::string_view* line) {
  if (lines_.AtEnd()) return false;
  *line = lines_.Take();
  ++number_;
  return true;
}

void RefuseFile(std::string const& path, std::string const& message) {
  throw Failure(FailureKind::File, {path}, message);
}

void RefuseLine(std::string const& path, std::size_t line, std::string const& message) {
  throw Failure(FailureKind::File, {path, line}, message);
}

std::string DescribeArc(Piece const& arc) {
  auto const text = [](XY const& at) {
    return "(" + FormatShort(at.x) + ", " + FormatShort(at.y) + ")";
  };
  return "an arc from " + text(arc.start) + " to " + text(arc.end);
}

void RefuseArc(Piece const& arc, Place const& place) {
  throw Failure(FailureKind::File, place, DescribeArc(arc), Remedy::FlattenCurves);
}

double RequireNumber(std::string_view text, std::string const& what, std::string const& path,
                     std::size_t line) {
  std::optional<double> const value = ParseNumber(text);
  if (!value) RefuseLine(path, line, what + " " + Quoted(text) + " is not a number");
  if (!std::isfinite(*value)) {
    RefuseLine(path, line, what + " " + Quoted(text) + " is not finite");
  }
  if (!IsUsable(*value)) RefuseLine(path, line, what + " " + Quoted(text) + " is too large");
  return *value;
}

std::string FormatPlain(double value) {
  // The smallest double has 324 digits after the point before 17 that count.
  std::array<char, 400> buffer{};
  std::to_chars_result const result =
      std::to_chars(buffer.data(), buffer.data() + buffer.size(), value, std::chars_format::fixed);
  std::string text(buffer.data(), result.ptr);
  return text.find('.') == std::string::npos ? text + ".0" : text;
}

std::string OneLine(std::string text) {
  std::replace_if(
      text.begin(), text.end(), [](char c) { return c == '\n' || c == '\r'; }, ' ');
  return text;
}

Place PlaceIn(std::string_view text, std::size_t offset, std::string const& path) {
  std::string_view const before = text.substr(0, offset);
  auto const line = static_cast<std::size_t>(std::count(before.begin(), before.end(), '\n')) + 1;
  std::size_t const lineEnd = before.rfind('\n');
  std::size_t const column =
      lineEnd == std::string_view::npos ? before.size() + 1 : before.size() - lineEnd;
  return {path, line, column};
}

}  // namespace Vorn::IO
