#include "io/points/CsvNumbers.h"

#include "vorn/io/Messages.h"

namespace Vorn::IO {

/// Takes the decimal mark of the number in `text`, if it has one.
void CsvNumbers::LearnMark(std::string_view text, std::size_t line) {
  std::size_t const at = text.find_first_of(".,");
  if (at == std::string_view::npos) return;
  mark_ = text[at] == ',' ? DecimalMark::Comma : DecimalMark::Point;
  lineOfMark_ = line;
}

/// Says what is wrong with a field that holds no finite number.
void CsvNumbers::Refuse(std::string_view name, std::string_view field,
                        CsvPlace const& place) const {
  if (field.empty()) place.RefuseAt(field, std::string(name) + " is missing");
  if (ParseNumber(Unquoted(field), mark_)) {
    place.RefuseAt(field, std::string(name) + " is not a finite number: " + Quoted(field));
  }
  place.RefuseAt(field, std::string(name) + " is not a number: " + Quoted(field) +
                            MarkOfEarlierLine(field, place.Line()));
}

/// " (line 2 has a decimal comma)" where the field has the other mark; else nothing.
std::string CsvNumbers::MarkOfEarlierLine(std::string_view field, std::size_t line) const {
  char const otherMark = mark_ == DecimalMark::Comma ? '.' : ',';
  if (lineOfMark_ == line || field.find(otherMark) == std::string_view::npos) return "";
  std::string const mark = mark_ == DecimalMark::Comma ? "comma" : "point";
  return " (line " + std::to_string(lineOfMark_) + " has a decimal " + mark + ")";
}

}  // namespace Vorn::IO
