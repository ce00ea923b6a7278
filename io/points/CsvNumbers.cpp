#include "io/points/CsvNumbers.h"

#include "vorn/io/Messages.h"

namespace Vorn::IO {

void CsvNumbers::LearnMark(std::string_view text, std::size_t line) {
  std::size_t const at = text.find_first_of(".,");
  if (at == std::string_view::npos) return;
  mark_ = text[at] == ',' ? DecimalMark::Comma : DecimalMark::Point;
  lineOfMark_ = line;
}

void CsvNumbers::Refuse(std::string_view name, std::string_view field,
                        CsvPlace const& place) const {
  if (field.empty()) place.RefuseAt(field, std::string(name) + " is missing");
  if (ParseNumber(Unquoted(field), mark_)) {
    place.RefuseAt(field, std::string(name) + " is not a finite number: " + Quoted(field));
  }
  place.RefuseAt(field, std::string(name) + " is not a number: " + Quoted(field) +
                            MarkOfEarlierLine(field, place.Line()));
}

std::string CsvNumbers::MarkOfEarlierLine(std::string_view field, std::size_t line) const {
  char const otherMark = mark_ == DecimalMark::Comma ? '.' : ',';
  if (lineOfMark_ == line || field.find(otherMark) == std::string_view::npos) return "";
  std::string const mark = mark_ == DecimalMark::Comma ? "comma" : "point";
  return " (line " + std::to_string(lineOfMark_) + " has a decimal " + mark + ")";
}

}  // namespace Vorn::IO
