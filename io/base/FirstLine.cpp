#include "io/base/FirstLine.h"

#include <algorithm>
#include <iterator>

#include "io/base/Encoding.h"
#include "io/base/TextLines.h"
#include "io/base/Words.h"
#include "vorn/io/Messages.h"

namespace Vorn::IO {

namespace {

constexpr std::string_view kCurves[] = {"srid",         "linestring",    "circularstring",
                                        "multicurve",   "compoundcurve", "multilinestring",
                                        "curvepolygon", "polygon",       "multipolygon"};

bool IsComment(std::string_view line) { return line.starts_with('#'); }

}  // namespace

std::string FirstLine(std::string_view text) {
  TextLines lines(WithoutUtf8Mark(text));
  while (!lines.AtEnd()) {
    std::string_view const line = Trimmed(lines.Take());
    if (!line.empty() && !IsComment(line)) return LowerCase(line);
  }
  return {};
}

bool LooksLikeWkt(std::string_view firstLine) {
  return std::any_of(std::begin(kCurves), std::end(kCurves),
                     [&](std::string_view curve) { return firstLine.starts_with(curve); });
}

bool MayStandInOneLine(std::string_view text) {
  std::string const line = FirstLine(text);
  return line.starts_with('{') || line.starts_with('<') || LooksLikeWkt(line);
}

}  // namespace Vorn::IO
