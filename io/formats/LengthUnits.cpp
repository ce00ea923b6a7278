#include "io/formats/LengthUnits.h"

#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

bool IsInch(std::string const& units) {
  std::string const lower = LowerCase(units);
  return lower == "in" || lower == "inch" || lower == "inches";
}

bool IsMillimetre(std::string const& units) {
  std::string const lower = LowerCase(units);
  return lower == "mm" || lower == "millimetre" || lower == "millimeter";
}

}  // namespace Vorn::IO
