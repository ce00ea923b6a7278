#include "io/formats/ReadingMemory.h"

#include <array>

#include "io/base/Words.h"

namespace Vorn::IO {

namespace {

/// Bytes of memory for each sign of a text.
using Weights = std::array<std::size_t, 256>;

std::size_t Weighed(std::string_view text, Weights const& weights) {
  std::size_t sum = 0;
  for (char const c : text) sum += weights[static_cast<unsigned char>(c)];
  return sum;
}

/// The weights are what was measured as the largest resident set of `contour area` on files of
/// 200,000 to a million pieces with four digits behind the point, without the text, over the number
/// of signs: 310 bytes for a piece of WKT, which has one comma, 313 for a line of G-code, 393 for a
/// point of GeoJSON with its two commas and a bracket, 1149 for a line piece of JSON with 5 commas
/// and 7 colons, 411 for a vertex of DXF in four lines and 786 for a LINE in twelve.
Weights WeightsOf(Format format) {
  Weights weights{};
  switch (format) {
    case Format::Json:
    case Format::GeoJson:
      weights[','] = weights['['] = 131;
      weights[':'] = 71;
      break;
    case Format::Wkt:
      weights[','] = 313;
      break;
    case Format::Dxf:
      weights['\n'] = 85;
      break;
    default:
      weights['\n'] = 313;
  }
  return weights;
}

/// Of the points of SVG every second number is a piece, and numbers need not be parted by signs: so
/// many bytes for each, of which 310 were measured for a point of a path.
constexpr std::size_t kForNumber = 155;

/// The ways along one axis are pieces of one number: 327 bytes were measured for each h and v.
constexpr std::size_t kForAxisWay = 175;

/// A rectangle has four pieces and may have two numbers alone: 1237 bytes were measured for one
/// with three, 752 for a circle with two. The letters of width and height count as ways, too.
constexpr std::size_t kForElement = 700;

bool IsOfNumber(char c) { return IsDigit(c) || c == '.'; }

std::size_t CountNumbers(std::string_view text) {
  std::size_t count = 0;
  bool wasOfNumber = false;
  for (char const c : text) {
    bool const isOfNumber = IsOfNumber(c);
    if (isOfNumber && !wasOfNumber) ++count;
    wasOfNumber = isOfNumber;
  }
  return count;
}

std::size_t MemoryOfSvg(std::string_view text) {
  Weights weights{};
  weights['h'] = weights['v'] = weights['H'] = weights['V'] = kForAxisWay;
  weights['<'] = kForElement;
  return kForNumber * CountNumbers(text) + Weighed(text, weights);
}

}  // namespace

std::size_t MemoryToRead(std::string_view text, Format format) {
  if (format == Format::Svg) return text.size() + MemoryOfSvg(text);
  return text.size() + Weighed(text, WeightsOf(format));
}

}  // namespace Vorn::IO
