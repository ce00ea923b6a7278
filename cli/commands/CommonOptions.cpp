#include "cli/commands/CommonOptions.h"

#include <CLI/CLI.hpp>
#include <algorithm>
#include <cmath>

#include "cli/Numbers.h"

namespace Vorn::Cli {

namespace {

CLI::Validator PositiveNumber() {
  return CLI::Validator(
      [](std::string& text) -> std::string {
        std::optional<double> const value = ParseNumber(text);
        bool const isGood = value && std::isfinite(*value) && *value > 0.0;
        return isGood ? "" : Quoted(text) + " is not a finite number above 0";
      },
      "");
}

CLI::Validator WholeNumber(int least, int most) {
  return CLI::Validator(
      [least, most](std::string& text) -> std::string {
        std::optional<double> const value = ParseNumber(text);
        bool const isGood =
            value && *value >= least && *value <= most && *value == std::floor(*value);
        return isGood ? ""
                      : Quoted(text) + " is not a whole number from " + std::to_string(least) +
                            " to " + std::to_string(most);
      },
      "");
}

CLI::Validator OneOf(std::vector<std::string> const& words) {
  return CLI::Validator(
      [words](std::string& text) -> std::string {
        if (std::find(words.begin(), words.end(), text) != words.end()) return "";
        std::string list;
        for (std::string const& word : words) list += (list.empty() ? "" : ", ") + word;
        return Quoted(text) + " is none of " + list;
      },
      "");
}

}  // namespace

CLI::Option* AddPositiveNumber(CLI::App& app, std::string const& name, std::optional<double>* value,
                               std::string const& valueName, std::string const& help) {
  return app
      .add_option_function<std::string>(
          name, [value](std::string const& text) { *value = ParseNumber(text); }, help)
      ->check(PositiveNumber())
      ->type_name(valueName);
}

CLI::Option* AddWholeNumber(CLI::App& app, std::string const& name, std::optional<int>* value,
                            int least, int most, std::string const& valueName,
                            std::string const& help) {
  return app
      .add_option_function<std::string>(
          name, [value](std::string const& text) { *value = static_cast<int>(*ParseNumber(text)); },
          help)
      ->check(WholeNumber(least, most))
      ->type_name(valueName);
}

CLI::Option* AddWord(CLI::App& app, std::string const& name, std::vector<std::string> const& words,
                     std::function<void(std::string const&)> const& take, std::string const& help) {
  return app.add_option_function<std::string>(name, take, help)
      ->check(OneOf(words))
      ->type_name("NAME");
}

}  // namespace Vorn::Cli
