#pragma once

#include <string>
#include <string_view>

/// The numbers that $INSUNITS has for units of length.
namespace Vorn::IO::Dxf {

/// The units with this number; empty for others than inch, ft, mm, cm and m.
std::string UnitsNamed(std::string_view number);

/// The number of the units, "0" for none that are known.
std::string NumberOfUnits(std::string const& units);

}  // namespace Vorn::IO::Dxf
