#include "io/formats/SvgTransform.h"

#include <algorithm>
#include <cmath>
#include <numbers>
#include <optional>
#include <vector>

#include "io/base/Words.h"
#include "io/formats/LengthUnits.h"
#include "io/formats/SvgNumbers.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

constexpr double kRadians = std::numbers::pi / 180.0;

Affine Turned(double degrees) {
  double const cosine = std::cos(degrees * kRadians);
  double const sine = std::sin(degrees * kRadians);
  return {cosine, sine, -sine, cosine, 0.0, 0.0};
}

Affine Moved(double x, double y) { return {1.0, 0.0, 0.0, 1.0, x, y}; }

/// One function of a transform.
struct Function {
  std::string name;
  std::vector<double> values;

  bool Is(char const* other, std::initializer_list<std::size_t> counts) const {
    return name == other && std::find(counts.begin(), counts.end(), values.size()) != counts.end();
  }
};

std::optional<Affine> MapOf(Function const& function) {
  std::vector<double> const& v = function.values;
  if (function.Is("matrix", {6})) return Affine{v[0], v[1], v[2], v[3], v[4], v[5]};
  if (function.Is("translate", {1})) return Moved(v[0], 0.0);
  if (function.Is("translate", {2})) return Moved(v[0], v[1]);
  if (function.Is("scale", {1, 2})) return Affine{v[0], 0.0, 0.0, v.back(), 0.0, 0.0};
  if (function.Is("rotate", {1})) return Turned(v[0]);
  if (function.Is("rotate", {3})) return Moved(v[1], v[2]) * Turned(v[0]) * Moved(-v[1], -v[2]);
  if (function.Is("skewx", {1})) return Affine{1.0, 0.0, std::tan(v[0] * kRadians), 1.0, 0.0, 0.0};
  if (function.Is("skewy", {1})) return Affine{1.0, std::tan(v[0] * kRadians), 0.0, 1.0, 0.0, 0.0};
  return {};
}

/// How long the unit is in millimetres; nothing for one of the screen or of the page.
std::optional<double> Millimetres(std::string_view unit) {
  constexpr double kPointsPerInch = 72.0;
  constexpr double kPicasPerInch = 6.0;
  if (unit == "mm") return 1.0;
  if (unit == "cm") return 10.0;
  if (unit == "in") return kMillimetresPerInch;
  if (unit == "pt") return kMillimetresPerInch / kPointsPerInch;
  if (unit == "pc") return kMillimetresPerInch / kPicasPerInch;
  return {};
}

/// The size of the page as the file measures: what stands in viewBox, else pixels of a 96th inch.
struct ViewBox {
  double width = 0.0;
  double height = 0.0;
};

std::optional<ViewBox> ReadViewBox(XmlElement const& root) {
  std::optional<std::string_view> const text = root["viewBox"];
  if (!text) return {};
  std::vector<double> const values = SvgNumberList(root, *text);
  constexpr std::size_t kNumbers = 4;
  bool const isGood = values.size() == kNumbers && values[2] > 0.0 && values[3] > 0.0;
  if (!isGood) root.Refuse("viewBox " + Quoted(*text) + " is no box with a width and a height");
  return ViewBox{values[2], values[3]};
}

/// Millimetres for one of the file's own units, as the width or the height has it.
std::optional<double> ScaleOf(XmlElement const& root, char const* side,
                              std::optional<double> inViewBox) {
  constexpr double kPixelsPerInch = 96.0;
  std::optional<std::string_view> const text = root[side];
  if (!text) return {};
  SvgLength const length = ParseSvgLength(root, *text);
  std::optional<double> const unit = Millimetres(length.unit);
  if (!unit) return {};
  if (!(length.value > 0.0)) root.Refuse(std::string(side) + " is not above 0");
  return inViewBox ? length.value * *unit / *inViewBox : kMillimetresPerInch / kPixelsPerInch;
}

bool IsInInches(XmlElement const& root) {
  std::optional<std::string_view> const width = root["width"];
  return width && ParseSvgLength(root, *width).unit == "in";
}

/// 1 where rounding alone makes it something else, so that numbers stay as they are written.
double Snapped(double scale) {
  constexpr double kRounding = 1e-9;
  return std::fabs(scale - 1.0) <= kRounding ? 1.0 : scale;
}

}  // namespace

Affine SvgTransform(XmlElement const& element, std::string_view text) {
  Affine map;
  std::string_view rest = Trimmed(text);
  while (!rest.empty()) {
    std::size_t const open = rest.find('(');
    std::size_t const close = rest.find(')');
    if (open == std::string_view::npos || close == std::string_view::npos || close < open) {
      element.Refuse("transform " + Quoted(rest) + " is no function with its numbers in brackets");
    }
    Function const function = {LowerCase(Trimmed(rest.substr(0, open))),
                               SvgNumberList(element, rest.substr(open + 1, close - open - 1))};
    std::optional<Affine> const next = MapOf(function);
    if (!next) element.Refuse("transform " + Quoted(rest.substr(0, close + 1)) + " is not known");
    map = map * *next;
    std::size_t const begin = rest.find_first_not_of(", \t\r\n", close + 1);
    rest.remove_prefix(std::min(begin, rest.size()));
  }
  return map;
}

SvgLength ParseSvgLength(XmlElement const& element, std::string_view text) {
  std::string_view const trimmed = Trimmed(text);
  std::size_t const digits = trimmed.find_last_of("0123456789.");
  std::size_t const end = digits == std::string_view::npos ? 0 : digits + 1;
  std::optional<double> const value = ParseNumber(trimmed.substr(0, end));
  if (!value || !std::isfinite(*value)) element.Refuse(Quoted(text) + " is not a length");
  return {*value, LowerCase(Trimmed(trimmed.substr(end)))};
}

SvgPage ReadSvgPage(XmlElement const& root) {
  constexpr double kSameScale = 1e-6;
  std::optional<ViewBox> const box = ReadViewBox(root);
  std::optional<double> const x =
      ScaleOf(root, "width", box ? std::optional(box->width) : std::nullopt);
  std::optional<double> const y =
      ScaleOf(root, "height", box ? std::optional(box->height) : std::nullopt);
  if (!x && !y) return {{1.0, 0.0, 0.0, -1.0, 0.0, 0.0}, ""};
  double const scale = std::min(x.value_or(y.value_or(1.0)), y.value_or(x.value_or(1.0)));
  bool const isStretched = x && y && std::fabs(*x - *y) > kSameScale * scale;
  if (isStretched && root["preserveAspectRatio"] == "none") {
    root.Refuse("the page stretches the drawing");
  }
  bool const isInch = IsInInches(root);
  double const snapped = Snapped(isInch ? scale / kMillimetresPerInch : scale);
  return {{snapped, 0.0, 0.0, -snapped, 0.0, 0.0}, isInch ? "inch" : "mm"};
}

}  // namespace Vorn::IO
