#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "cli/base/Library.h"

namespace CLI {
class App;
class Option;
}  // namespace CLI

/// What may stand on the command line, in our own words. CommandLine.cpp alone knows the library
/// that parses it, which takes longer to compile than all that a command does.
namespace Vorn::Cli {

/// An option or an operand of a command.
class Option {
 public:
  /// Stands for an option that was added.
  explicit Option(CLI::Option* option) : option_(option) {}

  /// It must be given.
  Option Require() const;

  /// It cannot be given together with the other.
  Option Exclude(Option other) const;

  /// It can be given only together with the other.
  Option Need(Option other) const;

 private:
  CLI::Option* option_;
};

/// A command with its options and operands. The name of an option has dashes, "-o,--output" is two
/// names of one; the name of an operand has none. `valueName` is what the help calls the value.
class Command {
 public:
  /// Stands for a command that was added.
  explicit Command(CLI::App* command) : command_(command) {}

  /// An option or argument with a text.
  Option AddText(std::string const& name, std::string* value, std::string const& valueName,
                 std::string const& help);
  /// The same, which knows whether it was given.
  Option AddText(std::string const& name, std::optional<std::string>* value,
                 std::string const& valueName, std::string const& help);

  /// A file to write. The name /dev/stdout is taken for "-": the program must know that a result
  /// goes there, and print nothing else.
  Option AddOutput(std::string const& name, std::string* file, std::string const& help);
  /// Such a file each time it is given.
  Option AddOutputs(std::string const& name, std::vector<std::string>* files,
                    std::string const& help);

  /// Takes one word or several in a row.
  Option AddTexts(std::string const& name, std::vector<std::string>* values,
                  std::string const& valueName, std::string const& help);

  /// Takes one word each time it is given.
  Option AddRepeatable(std::string const& name, std::vector<std::string>* values,
                       std::string const& valueName, std::string const& help);

  /// `complaint` tells what is wrong with a word and is empty for a good one, which `take` gets.
  Option AddChecked(std::string const& name,
                    std::function<std::string(std::string const&)> const& complaint,
                    std::function<void(std::string const&)> const& take,
                    std::string const& valueName, std::string const& help);

  /// An option without a value.
  Option AddFlag(std::string const& name, bool* value, std::string const& help);

  /// The end of its help.
  void SetFooter(std::string const& text);

  /// Called when the command line has been read and asks for this command.
  void OnParsed(std::function<void()> const& call);

 private:
  CLI::App* command_;
};

/// The command line of the program: one of its commands, or a question for help or the version.
class CommandLine {
 public:
  /// A program without commands yet.
  CommandLine(std::string const& name, std::string const& text);
  /// Out of line, because what is owned is incomplete here.
  ~CommandLine();
  /// Commands point to it, so it stays where it is.
  CommandLine(CommandLine const&) = delete;
  CommandLine& operator=(CommandLine const&) = delete;

  /// What --version prints.
  void SetVersion(std::string const& text);
  /// What ends the help of the program.
  void SetFooter(std::string const& text);
  /// Adds a command; the text begins its help.
  Command AddCommand(std::string const& name, std::string const& text);

  /// Sets what the words say, and calls what is to be called.
  /// @return the answer to a question for help or the version
  /// @throws Failure (FailureKind::BadArgument) when they are not understood or contradict
  /// themselves.
  std::optional<std::string> Parse(int argc, char const* const* argv);

 private:
  std::unique_ptr<CLI::App> program_;
};

}  // namespace Vorn::Cli
