#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Vorn::IO {

/// What a column of a table holds, as far as its name tells.
enum class ColumnKind {
  Unknown,
  X,
  Y,
  Z,
  Other,  ///< known to be none of a point's coordinates: a number, a time, a nominal value
};

/// A name from a header taken apart: "X-Pos [mm]" is of kind X with the unit mm.
struct ColumnName {
  ColumnKind kind = ColumnKind::Unknown;
  std::string unit;  ///< as written; empty: none
};

/// Understands what instruments write in English, German and French: an axis by its letter alone or
/// with words such as pos, coordinate, Achse, Istwert or valeur; length and height, abscissa and
/// ordinate, Rechtswert and Hochwert; numbers and times as what they are. Units may stand in
/// brackets or behind a slash, an underscore or a blank.
ColumnName ReadColumnName(std::string_view field);

/// Whether the field is a unit of length and nothing else: "mm", "[mm]".
bool IsUnit(std::string_view field);

/// The two columns that hold the points.
struct PointColumns {
  std::size_t x = 0;
  std::size_t y = 1;
};

/// By the names x and y, x and z, or y and z, each there once and the third axis not at all; else
/// the two columns left over when those of another kind and that of the tolerance are left out,
/// unless their names speak against their order. Nothing when the names do not tell.
std::optional<PointColumns> FindPointColumns(std::vector<ColumnName> const& names,
                                             std::optional<std::size_t> tolerance);

}  // namespace Vorn::IO
