#include "cli/commands/CommonOptions.h"

#include <algorithm>
#include <cmath>

#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

namespace {

/// Tells what is wrong with a word; empty for a good one.
using Complaint = std::function<std::string(std::string const& text)>;

Complaint PositiveNumber() {
  return [](std::string const& text) -> std::string {
    std::optional<double> const value = ParseNumber(text);
    bool const isGood = value && std::isfinite(*value) && *value > 0.0;
    return isGood ? "" : Quoted(text) + " is not a finite number above 0";
  };
}

Complaint FiniteNumber() {
  return [](std::string const& text) -> std::string {
    std::optional<double> const value = ParseNumber(text);
    bool const isGood = value && std::isfinite(*value);
    return isGood ? "" : Quoted(text) + " is not a finite number";
  };
}

Complaint WholeNumber(int least, int most) {
  return [least, most](std::string const& text) -> std::string {
    std::optional<double> const value = ParseNumber(text);
    bool const isGood = value && *value >= least && *value <= most && *value == std::floor(*value);
    return isGood ? ""
                  : Quoted(text) + " is not a whole number from " + std::to_string(least) + " to " +
                        std::to_string(most);
  };
}

/// `nameOf` gives the name under which a text goes; empty for one without meaning.
Complaint OneOf(std::vector<std::string> const& words,
                std::function<std::string(std::string const&)> const& nameOf) {
  return [words, nameOf](std::string const& text) -> std::string {
    if (std::find(words.begin(), words.end(), nameOf(text)) != words.end()) return "";
    std::string list;
    for (std::string const& word : words) list += (list.empty() ? "" : ", ") + word;
    return Quoted(text) + " is none of " + list;
  };
}

/// Words are ASCII, so that no language of the system changes them.
std::string InSmallLetters(std::string text) {
  for (char& c : text) {
    if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
  }
  return text;
}

std::string FormatName(std::string const& text) {
  std::optional<Format> const format = FormatNamed(text);
  return format ? NameOf(*format) : "";
}

}  // namespace

Option AddPositiveNumber(Command& command, std::string const& name, std::optional<double>* value,
                         std::string const& valueName, std::string const& help) {
  auto const take = [value](std::string const& text) { *value = ParseNumber(text); };
  return command.AddChecked(name, PositiveNumber(), take, valueName, help);
}

Option AddNumber(Command& command, std::string const& name, std::optional<double>* value,
                 std::string const& valueName, std::string const& help) {
  auto const take = [value](std::string const& text) { *value = ParseNumber(text); };
  return command.AddChecked(name, FiniteNumber(), take, valueName, help);
}

Option AddWholeNumber(Command& command, std::string const& name, std::optional<int>* value,
                      WholeNumbers const& numbers, std::string const& help) {
  auto const take = [value](std::string const& text) {
    *value = static_cast<int>(*ParseNumber(text));
  };
  return command.AddChecked(name, WholeNumber(numbers.least, numbers.most), take, numbers.valueName,
                            help);
}

Option AddWord(Command& command, std::string const& name, std::vector<std::string> const& words,
               std::function<void(std::string const&)> const& take, std::string const& help) {
  auto const takeSmall = [take](std::string const& text) { take(InSmallLetters(text)); };
  return command.AddChecked(name, OneOf(words, InSmallLetters), takeSmall, "NAME", help);
}

Option AddFormat(Command& command, std::string const& name, std::vector<std::string> const& names,
                 std::optional<Format>* format, std::string const& help) {
  auto const take = [format](std::string const& text) { *format = FormatNamed(text); };
  return command.AddChecked(name, OneOf(names, FormatName), take, "NAME", help);
}

Option AddContourFormat(Command& command, std::optional<Format>* from, std::string const& help) {
  return AddFormat(command, "--from", {"json", "csv", "dxf", "gcode", "wkt", "geojson", "svg"},
                   from, help);
}

}  // namespace Vorn::Cli
