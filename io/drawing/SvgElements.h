#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "io/drawing/Layout.h"

/// The words of SVG that the drawing uses.
namespace Vorn::IO::Svg {

/// A coordinate or a length on the page.
std::string Px(double value);

/// "12.5,30".
std::string Px(Pixel const& pixel);

/// Safe inside an element or an attribute; control characters are left out.
std::string Escaped(std::string_view text);

/// One text element; `attributes` are written as they are.
std::string Text(Pixel const& at, std::string const& attributes, std::string_view text);

/// A straight line.
std::string LineElement(Pixel const& from, Pixel const& to, std::string const& attributes);

/// A full circle.
std::string CircleElement(Pixel const& center, double radius, std::string const& attributes);

/// A rectangle.
std::string RectElement(Rect const& rect, std::string const& attributes);

/// Nothing without data.
std::string PathElement(std::string const& data, std::string const& attributes);

struct DotStyle {
  std::string name;  ///< class of the element
  std::string color;
  double diameter = 2.0;
  bool isSquare = false;
  double cell = 0.5;  ///< dots in the same square of this size are merged when there are many
};

/// Dots of one kind as a single element, which keeps thousands of them small.
std::string Dots(std::vector<Pixel> const& at, DotStyle const& style);

}  // namespace Vorn::IO::Svg
