#pragma once

#include <functional>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "cli/commands/CommandLine.h"
#include "vorn/io/Formats.h"

/// Kinds of options that several commands have.
namespace Vorn::Cli {

/// An option whose value is a finite number above zero, read independently of the locale.
Option AddPositiveNumber(Command& command, std::string const& name, std::optional<double>* value,
                         std::string const& valueName, std::string const& help);

/// An option whose value is a finite number.
Option AddNumber(Command& command, std::string const& name, std::optional<double>* value,
                 std::string const& valueName, std::string const& help);

/// The whole numbers that an option takes.
struct WholeNumbers {
  int least = 0;
  int most = 0;
  std::string valueName = "N";  ///< in the help
};

/// An option whose value is one of the numbers.
Option AddWholeNumber(Command& command, std::string const& name, std::optional<int>* value,
                      WholeNumbers const& numbers, std::string const& help);

/// An option whose value is one of the words, which are in small letters; `take` is called with the
/// one that was given, in small or capital letters.
Option AddWord(Command& command, std::string const& name, std::vector<std::string> const& words,
               std::function<void(std::string const&)> const& take, std::string const& help);

/// An option whose value is a format by any name that FormatNamed takes, which are the endings of
/// its files as well. `names` has one for each format that it takes.
Option AddFormat(Command& command, std::string const& name, std::vector<std::string> const& names,
                 std::optional<Format>* format, std::string const& help);

/// Adds --from, which says as what contours are read.
Option AddContourFormat(Command& command, std::optional<Format>* from, std::string const& help);

/// An option whose value is one of a few names, each standing for a value.
template <typename Value>
Option AddChoice(Command& command, std::string const& name, Value* value,
                 std::vector<std::pair<std::string, Value>> const& choices,
                 std::string const& help) {
  std::vector<std::string> words;
  words.reserve(choices.size());
  for (auto const& choice : choices) words.push_back(choice.first);
  return AddWord(
      command, name, words,
      [value, choices](std::string const& word) {
        for (auto const& choice : choices) {
          if (choice.first == word) *value = choice.second;
        }
      },
      help);
}

}  // namespace Vorn::Cli
