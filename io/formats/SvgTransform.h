#pragma once

#include <string>
#include <string_view>

#include "io/formats/Affine.h"
#include "io/formats/Xml.h"

namespace Vorn::IO {

/// What the attribute `transform` says: matrix, translate, scale, rotate, skewX and skewY, the last
/// of which is done first.
/// @throws Failure (FailureKind::File) naming the element.
Affine SvgTransform(XmlElement const& element, std::string_view text);

/// A length of SVG.
struct SvgLength {
  double value = 0.0;
  std::string unit;  ///< "mm", "px", "%" and so on, in lower case; empty for a bare number
};

/// Takes a number and the unit behind it apart.
/// @throws Failure (FailureKind::File) naming the element.
SvgLength ParseSvgLength(XmlElement const& element, std::string_view text);

/// From the coordinates of the file to those of the contour: true to the page, y pointing up.
struct SvgPage {
  Affine map;
  std::string units;  ///< empty when the page tells no true size
};

/// What the outermost element says of the page.
/// @throws Failure (FailureKind::File) naming the element.
SvgPage ReadSvgPage(XmlElement const& root);

}  // namespace Vorn::IO
