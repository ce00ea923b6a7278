#include "io/formats/SvgNumbers.h"

#include <algorithm>
#include <optional>

#include "io/base/Words.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

constexpr std::string_view kBlanks = " \t\r\n\f";
constexpr std::string_view kDigits = "0123456789";

}  // namespace

void SvgNumbers::SkipBlanks() {
  at_ = std::min(text_.find_first_not_of(kBlanks, at_), text_.size());
}

void SvgNumbers::SkipComma() {
  SkipBlanks();
  if (at_ < text_.size() && text_[at_] == ',') ++at_;
  SkipBlanks();
}

bool SvgNumbers::AtEnd() {
  SkipBlanks();
  return at_ == text_.size();
}

bool SvgNumbers::IsNumberNext() {
  SkipBlanks();
  return at_ < text_.size() &&
         (IsDigit(text_[at_]) || text_[at_] == '.' || text_[at_] == '+' || text_[at_] == '-');
}

char SvgNumbers::Take() {
  if (AtEnd()) Refuse("");
  return text_[at_++];
}

/// Just behind the sign, digits, point and exponent that belong together.
std::size_t SvgNumbers::EndOfNumber() const {
  std::size_t end = at_;
  auto const skipDigits = [&] {
    end = std::min(text_.find_first_not_of(kDigits, end), text_.size());
  };
  auto const isAt = [&](std::size_t place, std::string_view signs) {
    return place < text_.size() && signs.find(text_[place]) != std::string_view::npos;
  };
  if (isAt(end, "+-")) ++end;
  skipDigits();
  if (isAt(end, ".")) ++end;
  skipDigits();
  if (!isAt(end, "eE")) return end;
  std::size_t const digits = isAt(end + 1, "+-") ? end + 2 : end + 1;
  if (!isAt(digits, kDigits)) return end;
  end = digits;
  skipDigits();
  return end;
}

double SvgNumbers::Number() {
  SkipBlanks();
  std::size_t const end = EndOfNumber();
  std::optional<double> const value = ParseNumber(text_.substr(at_, end - at_));
  if (!value) Refuse("is not a number");
  if (!IsUsable(*value)) Refuse("is too large");
  at_ = end;
  SkipComma();
  return *value;
}

bool SvgNumbers::Flag() {
  SkipBlanks();
  bool const isFlag = at_ < text_.size() && (text_[at_] == '0' || text_[at_] == '1');
  if (!isFlag) Refuse("is neither 0 nor 1");
  bool const flag = text_[at_++] == '1';
  SkipComma();
  return flag;
}

void SvgNumbers::Refuse(std::string const& message) {
  SkipBlanks();
  if (at_ == text_.size()) element_.Refuse("the text of an attribute stops early");
  std::string_view const rest = text_.substr(at_);
  std::size_t const end = std::max<std::size_t>(1, rest.find_first_of(" ,\t\r\n"));
  element_.Refuse(Quoted(rest.substr(0, end)) + ", character " + std::to_string(at_ + 1) +
                  " of an attribute, " + message);
}

std::vector<double> SvgNumberList(XmlElement const& element, std::string_view text) {
  SvgNumbers numbers(element, text);
  std::vector<double> values;
  while (!numbers.AtEnd()) values.push_back(numbers.Number());
  return values;
}

}  // namespace Vorn::IO
