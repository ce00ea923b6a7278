#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "io/formats/Xml.h"

namespace Vorn::IO {

/// Takes the numbers of an attribute one after the other; they are set apart by blanks, a comma, a
/// sign or a second point.
class SvgNumbers {
 public:
  /// Element and text must outlive it.
  SvgNumbers(XmlElement const& element, std::string_view text) : element_(element), text_(text) {}

  /// Whether nothing but blanks is left.
  bool AtEnd();

  /// Whether a number comes next.
  bool IsNumberNext();

  /// The sign that comes next, which is taken when it is a letter or a bracket.
  char Take();

  /// The number that comes next; refused when there is none or it is too large for a coordinate.
  double Number();

  /// A 0 or a 1, which needs nothing between it and what follows.
  bool Flag();

  /// Ends the reading with a message about what comes next.
  [[noreturn]] void Refuse(std::string const& message);

 private:
  /// Passes over white space.
  void SkipBlanks();
  /// Passes over white space with at most one comma in it.
  void SkipComma();
  /// Just behind the number that begins here.
  std::size_t EndOfNumber() const;

  XmlElement const& element_;
  std::string_view text_;
  std::size_t at_ = 0;
};

/// All numbers of an attribute.
std::vector<double> SvgNumberList(XmlElement const& element, std::string_view text);

}  // namespace Vorn::IO
