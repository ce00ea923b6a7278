#include "io/drawing/SvgElements.h"

#include <cmath>

#include "io/drawing/Decimation.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO::Svg {

namespace {

constexpr int kPixelDecimals = 2;

/// Too small to be seen even on paper.
constexpr double kExactCell = 0.1;

}  // namespace

std::string Px(double value) {
  if (!std::isfinite(value)) return "0";
  std::string text = FormatFixed(value, kPixelDecimals);
  text.erase(text.find_last_not_of('0') + 1);
  if (text.back() == '.') text.pop_back();
  return text;
}

std::string Px(Pixel const& pixel) { return Px(pixel.x) + "," + Px(pixel.y); }

std::string Escaped(std::string_view text) {
  std::string escaped;
  for (char const c : text) {
    switch (c) {
      case '&':
        escaped += "&amp;";
        break;
      case '<':
        escaped += "&lt;";
        break;
      case '>':
        escaped += "&gt;";
        break;
      case '"':
        escaped += "&quot;";
        break;
      default:
        if (c < 0 || c >= ' ') escaped += c;
    }
  }
  return escaped;
}

std::string Text(Pixel const& at, std::string const& attributes, std::string_view text) {
  return "<text x=\"" + Px(at.x) + "\" y=\"" + Px(at.y) + "\" " + attributes + ">" + Escaped(text) +
         "</text>\n";
}

std::string LineElement(Pixel const& from, Pixel const& to, std::string const& attributes) {
  return "<line x1=\"" + Px(from.x) + "\" y1=\"" + Px(from.y) + "\" x2=\"" + Px(to.x) + "\" y2=\"" +
         Px(to.y) + "\" " + attributes + "/>\n";
}

std::string CircleElement(Pixel const& center, double radius, std::string const& attributes) {
  return "<circle cx=\"" + Px(center.x) + "\" cy=\"" + Px(center.y) + "\" r=\"" + Px(radius) +
         "\" " + attributes + "/>\n";
}

std::string RectElement(Rect const& rect, std::string const& attributes) {
  return "<rect x=\"" + Px(rect.left) + "\" y=\"" + Px(rect.top) + "\" width=\"" + Px(rect.width) +
         "\" height=\"" + Px(rect.height) + "\" " + attributes + "/>\n";
}

std::string PathElement(std::string const& data, std::string const& attributes) {
  if (data.empty()) return "";
  return "<path d=\"" + data + "\" " + attributes + "/>\n";
}

std::string Dots(std::vector<Pixel> const& at, DotStyle const& style) {
  std::string data;
  // A stroke of next to no length is drawn as its cap, round or square; one of none at all may be
  // left out.
  if (at.size() <= kMostExactDots) {
    for (std::size_t const i : OnePerCell(at, kExactCell)) data += "M" + Px(at[i]) + "h.01";
  } else {
    for (Streak const& streak : StreaksOf(at, style.cell))
      data += "M" + Px(streak.top) + (streak.height > 0.0 ? "v" + Px(streak.height) : "h.01");
  }
  return PathElement(data, "class=\"" + style.name + "\" fill=\"none\" stroke=\"" + style.color +
                               "\" stroke-width=\"" + Px(style.diameter) + "\" stroke-linecap=\"" +
                               (style.isSquare ? "square" : "round") + "\"");
}

}  // namespace Vorn::IO::Svg
