#include "cli/commands/CommandLine.h"

#include <CLI/CLI.hpp>
#include <algorithm>
#include <sstream>

#include "cli/commands/NearestWord.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Messages.h"

namespace Vorn::Cli {

namespace {

[[noreturn]] void RefuseUsage(CLI::App const& program, std::string const& complaint) {
  std::string name;
  for (CLI::App const* command : program.get_subcommands()) name += command->get_name() + " ";
  throw Failure(FailureKind::BadArgument,
                complaint + "\nRun '" + program.get_name() + " " + name + "--help' for the usage.");
}

/// CLI11 itself says only that a command is missing.
void RefuseUnknownCommand(CLI::App const& program, int argc, char const* const* argv) {
  if (argc < 2 || argv[1][0] == '-') return;
  std::string const word = argv[1];
  std::vector<std::string> names;
  for (CLI::App const* command : program.get_subcommands({})) names.push_back(command->get_name());
  if (std::find(names.begin(), names.end(), word) != names.end()) return;
  auto const nearest = NearestWord(word, names);
  RefuseUsage(program, "there is no command " + Quoted(word) +
                           (nearest ? "; did you mean " + Quoted(*nearest) + "?" : ""));
}

/// The first of the names of an option: "-o" of "-o,--output".
std::string FirstName(std::string const& names) { return names.substr(0, names.find(',')); }

CLI::Validator DashForStandardOutput() {
  auto const replace = [](std::string& path) {
    if (path == "/dev/stdout") path = "-";
    return std::string();
  };
  return {replace, ""};
}

/// The text with lines no longer than `width`, but for a word that is longer itself.
std::string Wrapped(std::string const& text, std::size_t width) {
  std::istringstream words(text);
  std::string wrapped;
  std::size_t used = 0;
  for (std::string word; words >> word;) {
    bool const fits = used == 0 || used + 1 + word.size() <= width;
    if (used > 0) wrapped += fits ? ' ' : '\n';
    used = fits && used > 0 ? used + 1 + word.size() : word.size();
    wrapped += word;
  }
  return wrapped;
}

/// Help for terminals of 80 columns.
class NarrowHelp : public CLI::Formatter {
 public:
  std::string make_option_desc(CLI::Option const* option) const override {
    return Wrapped(CLI::Formatter::make_option_desc(option), kColumns - column_width_);
  }

  std::string make_subcommand(CLI::App const* command) const override {
    std::ostringstream entry;
    CLI::detail::format_help(entry, command->get_name(),
                             Wrapped(command->get_description(), kColumns - column_width_),
                             column_width_);
    return entry.str();
  }

 private:
  static constexpr std::size_t kColumns = 80;
};

}  // namespace

Option Option::Require() const { return Option(option_->required()); }

Option Option::Exclude(Option other) const { return Option(option_->excludes(other.option_)); }

Option Option::Need(Option other) const { return Option(option_->needs(other.option_)); }

Option Command::AddText(std::string const& name, std::string* value, std::string const& valueName,
                        std::string const& help) {
  return Option(command_->add_option(name, *value, help)->type_name(valueName));
}

Option Command::AddText(std::string const& name, std::optional<std::string>* value,
                        std::string const& valueName, std::string const& help) {
  return Option(command_->add_option(name, *value, help)->type_name(valueName));
}

Option Command::AddOutput(std::string const& name, std::string* file, std::string const& help) {
  Option const option = AddText(name, file, "FILE", help);
  command_->get_option(FirstName(name))->transform(DashForStandardOutput());
  return option;
}

Option Command::AddOutputs(std::string const& name, std::vector<std::string>* files,
                           std::string const& help) {
  Option const option = AddRepeatable(name, files, "FILE", help);
  command_->get_option(FirstName(name))->transform(DashForStandardOutput());
  return option;
}

Option Command::AddTexts(std::string const& name, std::vector<std::string>* values,
                         std::string const& valueName, std::string const& help) {
  return Option(command_->add_option(name, *values, help)->type_name(valueName));
}

Option Command::AddRepeatable(std::string const& name, std::vector<std::string>* values,
                              std::string const& valueName, std::string const& help) {
  return Option(command_->add_option(name, *values, help)
                    ->expected(1)
                    ->multi_option_policy(CLI::MultiOptionPolicy::TakeAll)
                    ->type_name(valueName));
}

Option Command::AddChecked(std::string const& name,
                           std::function<std::string(std::string const&)> const& complaint,
                           std::function<void(std::string const&)> const& take,
                           std::string const& valueName, std::string const& help) {
  return Option(command_->add_option_function<std::string>(name, take, help)
                    ->check(CLI::Validator(complaint, ""))
                    ->type_name(valueName));
}

Option Command::AddFlag(std::string const& name, bool* value, std::string const& help) {
  return Option(command_->add_flag(name, *value, help));
}

void Command::SetFooter(std::string const& text) { command_->footer(text); }

void Command::OnParsed(std::function<void()> const& call) { command_->callback(call); }

CommandLine::CommandLine(std::string const& name, std::string const& text)
    : program_(std::make_unique<CLI::App>(text, name)) {
  program_->require_subcommand(1);
  // The commands take it over.
  program_->formatter(std::make_shared<NarrowHelp>());
}

CommandLine::~CommandLine() = default;

void CommandLine::SetVersion(std::string const& text) {
  program_->set_version_flag("--version", text);
}

void CommandLine::SetFooter(std::string const& text) { program_->footer(text); }

Command CommandLine::AddCommand(std::string const& name, std::string const& text) {
  return Command(program_->add_subcommand(name, text));
}

std::optional<std::string> CommandLine::Parse(int argc, char const* const* argv) {
  RefuseUnknownCommand(*program_, argc, argv);
  try {
    program_->parse(argc, argv);
  } catch (CLI::ParseError const& error) {
    std::ostringstream answer;
    std::ostringstream complaint;
    if (program_->exit(error, answer, complaint) != 0) RefuseUsage(*program_, error.what());
    return answer.str();
  }
  return std::nullopt;
}

}  // namespace Vorn::Cli
