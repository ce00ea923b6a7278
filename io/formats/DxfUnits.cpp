#include "io/formats/DxfUnits.h"

#include "io/formats/LengthUnits.h"
#include "vorn/io/Messages.h"

namespace Vorn::IO::Dxf {

namespace {

struct Known {
  std::string_view number;
  char const* name;
};

constexpr Known kKnown[] = {{"1", "inch"}, {"2", "ft"}, {"4", "mm"}, {"5", "cm"}, {"6", "m"}};

}  // namespace

std::string UnitsNamed(std::string_view number) {
  for (Known const& known : kKnown) {
    if (known.number == number) return known.name;
  }
  return {};
}

std::string NumberOfUnits(std::string const& units) {
  std::string name = LowerCase(units);
  if (IsInch(units)) name = "inch";
  if (IsMillimetre(units)) name = "mm";
  for (Known const& known : kKnown) {
    if (known.name == name) return std::string(known.number);
  }
  return "0";
}

}  // namespace Vorn::IO::Dxf
