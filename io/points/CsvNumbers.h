#pragma once

#include <cmath>
#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

#include "io/base/Fields.h"
#include "io/points/CsvPlace.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

/// Reads the numbers of a points file, which all have the same decimal mark: the first number with
/// either mark decides, because the other one, met later, may group thousands.
class CsvNumbers {
 public:
  /// The finite number in a field of the current line; `name` is that of its column. Anything else
  /// is refused.
  double Read(std::string_view name, std::string_view field, CsvPlace const& place) {
    std::string_view const text = Unquoted(field);
    if (lineOfMark_ == 0) LearnMark(text, place.Line());
    std::optional<double> const value = ParseNumber(text, mark_);
    if (!value || !std::isfinite(*value)) Refuse(name, field, place);
    return *value;
  }

 private:
  /// Takes the decimal mark of the number in the text, if it has one.
  void LearnMark(std::string_view text, std::size_t line);
  /// Says what is wrong with a field that holds no finite number.
  [[noreturn]] void Refuse(std::string_view name, std::string_view field,
                           CsvPlace const& place) const;
  /// " (line 2 has a decimal comma)" where the field has the other mark; else nothing.
  std::string MarkOfEarlierLine(std::string_view field, std::size_t line) const;

  DecimalMark mark_ = DecimalMark::Point;
  std::size_t lineOfMark_ = 0;  ///< where the decimal mark was seen first; 0: not yet
};

}  // namespace Vorn::IO
