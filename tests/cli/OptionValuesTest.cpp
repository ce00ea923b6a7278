// Every option of every command with values that it does not take: the message names the option,
// the value and what would be right, and nothing is read.

#include <gtest/gtest.h>

#include <map>
#include <string>
#include <vector>

#include "cli/RunInProcess.h"

namespace Vorn::Cli {
namespace {

using Words = std::vector<std::string>;

/// The shortest good line of each command; none of the files is there.
std::map<std::string, Words> const kLines = {
    {"fit", {"fit", "no.csv"}},
    {"check", {"check", "no.csv", "no.json"}},
    {"info", {"info", "no.csv"}},
    {"plot", {"plot", "no.csv", "--to", "svg"}},
    {"area", {"area", "no.json"}},
    {"intersect", {"intersect", "no.json"}},
    {"convert", {"convert", "no.json", "--to", "csv"}},
    {"simplify", {"simplify", "no.csv", "--drop-close"}},
};

/// What the program says, but for the pointer to the help.
std::string Complaint(std::string const& command, Words const& more) {
  Words words = kLines.at(command);
  words.insert(words.end(), more.begin(), more.end());
  RunResult const run = RunInProcess(words);
  EXPECT_EQ(run.code, ExitCode::Usage) << command << " " << more[0] << ": " << run.err;
  EXPECT_EQ(run.out, "") << command;
  std::string const pointer = "\nRun 'contour " + command + " --help' for the usage.\n";
  EXPECT_TRUE(run.err.ends_with(pointer)) << command << " " << more[0] << ": " << run.err;
  std::string const begin = "contour: ";
  EXPECT_TRUE(run.err.starts_with(begin)) << run.err;
  return run.err.substr(begin.size(), run.err.size() - begin.size() - pointer.size());
}

/// An option and the commands that have it.
struct OptionOf {
  char const* name;
  std::vector<std::string> commands;
};

std::vector<std::string> const kWithPoints = {"fit", "check", "info", "plot", "simplify"};
std::vector<std::string> const kThatWrite = {"fit", "convert"};

std::vector<OptionOf> const kPositive = {
    {"--tolerance", {"fit", "check", "info", "plot", "simplify", "convert"}},
    {"--tolerance-per-point", kWithPoints},
    {"--flatten", {"fit", "check", "info", "plot", "simplify", "convert", "area", "intersect"}},
    {"--max-radius", {"fit"}},
    {"--chords", kThatWrite},
    {"--feed", kThatWrite},
    {"--dpi", {"plot"}},
    {"--spacing", {"simplify"}},
    {"--outliers", {"simplify"}},
};

TEST(OptionValues, PositiveNumbersAreFiniteAndAboveZero) {
  for (OptionOf const& option : kPositive) {
    for (std::string const& command : option.commands) {
      for (std::string const bad :
           {"0", "-0", "-1", "nan", "inf", "-inf", "1e999", "1,5", "1 2", "0x10", "1e", "--"}) {
        std::string const name = option.name;
        EXPECT_EQ(Complaint(command, {name + "=" + bad}),
                  name + ": '" + bad + "' is not a finite number above 0")
            << command;
      }
    }
  }
}

TEST(OptionValues, LimitsOfTheFewestPiecesMayBeZero) {
  for (std::string const name : {"--min-radius", "--between"}) {
    for (std::string const bad : {"-1", "nan", "inf", "-inf", "1e999", "1,5", "--"}) {
      EXPECT_EQ(Complaint("fit", {name + "=" + bad}),
                name + ": '" + bad + "' is not a finite number of 0 or more");
    }
    Words const zero = {"fit", "no.csv", "--strategy", "fewest", name + "=0"};
    EXPECT_EQ(RunInProcess(zero).code, ExitCode::File) << name;
  }
}

TEST(OptionValues, PositiveNumbersAreTakenInEveryForm) {
  for (OptionOf const& option : kPositive) {
    for (std::string const& command : option.commands) {
      for (std::string const good : {"1", ".5", "5.", "1e-300", "+3", "2.5E+1"}) {
        Words words = kLines.at(command);
        words.push_back(std::string(option.name) + "=" + good);
        if (command == "fit") words.insert(words.end(), {"--strategy", "fewest"});
        RunResult const run = RunInProcess(words);
        EXPECT_EQ(run.code, ExitCode::File) << command << " " << words.back() << ": " << run.err;
      }
    }
  }
}

/// An option with whole numbers.
struct WholeOption {
  char const* name;
  std::vector<std::string> commands;
  std::string range;
  std::vector<std::string> bad;
};

TEST(OptionValues, WholeNumbersHaveARange) {
  std::vector<WholeOption> const options = {
      {"--outline",
       {"fit", "check", "info", "plot", "simplify", "convert", "area", "intersect"},
       "1 to 1000000",
       {"0", "-1", "1000001", "1.5", "nan", "inf", "one"}},
      {"--outline-b", {"intersect"}, "1 to 1000000", {"0", "1e7", "0.5"}},
      {"--start", {"fit"}, "0 to 2147483647", {"-1", "2147483648", "0.5", "1e30"}},
      {"--jobs", {"fit"}, "1 to 1024", {"0", "1025", "-8", "all"}},
      {"--digits", {"fit"}, "0 to 15", {"-1", "16", "3.5"}},
      {"--gcode-decimals", kThatWrite, "0 to 12", {"-1", "13", "4.5", "x"}},
      {"--width", {"plot"}, "1 to 30000", {"0", "30001", "-5", "100.5"}},
  };
  for (WholeOption const& option : options) {
    for (std::string const& command : option.commands) {
      for (std::string const& bad : option.bad) {
        std::string const name = option.name;
        EXPECT_EQ(Complaint(command, {name + "=" + bad}),
                  name + ": '" + bad + "' is not a whole number from " + option.range)
            << command;
      }
    }
  }
}

/// An option that takes one of some words.
struct WordOption {
  char const* name;
  std::vector<std::string> commands;
  std::string words;
};

std::vector<WordOption> const kWordOptions = {
    {"--strategy", {"fit"}, "fewest, mixed, cells, arc"},
    {"--effort", {"fit"}, "quick, wide, full"},
    {"--closed", {"fit", "check", "info", "simplify"}, "auto, yes, no"},
    {"--points-from", kWithPoints, "csv, dxf, gcode, wkt, geojson, svg, json"},
    {"--from",
     {"check", "area", "intersect", "convert"},
     "json, csv, dxf, gcode, wkt, geojson, svg"},
    {"--to", {"plot"}, "svg, png, html"},
    {"--to", {"convert"}, "json, csv, dxf, gcode, wkt, geojson, svg, png, html"},
    {"--dxf-version", kThatWrite, "r12, r2000"},
    {"--plane", kThatWrite, "xy, xz"},
    {"--end", kThatWrite, "m2, m30, none"},
};

TEST(OptionValues, WordsAreThoseOfAList) {
  for (WordOption const& option : kWordOptions) {
    std::string const first = option.words.substr(0, option.words.find(','));
    for (std::string const& command : option.commands) {
      // A second --to would be one too many for the line that has one.
      if (option.name == std::string("--to")) continue;
      for (std::string const& bad : {std::string("best"), first + "x"}) {
        EXPECT_EQ(Complaint(command, {std::string(option.name) + "=" + bad}),
                  std::string(option.name) + ": '" + bad + "' is none of " + option.words)
            << command;
      }
    }
  }
  EXPECT_EQ(RunInProcess({"plot", "no.csv", "--to", "dxf"}).err,
            "contour: --to: 'dxf' is none of svg, png, html\n"
            "Run 'contour plot --help' for the usage.\n");
  EXPECT_EQ(RunInProcess({"convert", "no.wkt", "--to", "step"}).err,
            "contour: --to: 'step' is none of json, csv, dxf, gcode, wkt, geojson, svg, png, html\n"
            "Run 'contour convert --help' for the usage.\n");
}

/// The words of a list as they stand there, and each once more in capital letters.
std::vector<std::string> InBothCases(std::string const& list) {
  std::vector<std::string> words;
  for (std::size_t at = 0; at != std::string::npos;) {
    std::size_t const end = list.find(", ", at);
    words.push_back(list.substr(at, end == std::string::npos ? end : end - at));
    words.push_back(words.back());
    for (char& c : words.back()) c = static_cast<char>(c >= 'a' && c <= 'z' ? c - 'a' + 'A' : c);
    at = end == std::string::npos ? end : end + 2;
  }
  return words;
}

TEST(OptionValues, EveryWordOfAListIsTakenInSmallAndCapitalLetters) {
  for (WordOption const& option : kWordOptions) {
    for (std::string const& command : option.commands) {
      for (std::string const& word : InBothCases(option.words)) {
        Words words = {kLines.at(command)};
        words.resize(command == "check" ? 3 : 2);
        if (command == "simplify") words.push_back("--drop-close");
        if (command == "convert" && option.name != std::string("--to")) {
          words.insert(words.end(), {"--to", "csv"});
        }
        if (command == "plot" && option.name != std::string("--to")) {
          words.insert(words.end(), {"--to", "svg"});
        }
        if (option.name == std::string("--effort")) {
          words.insert(words.end(), {"--strategy", "fewest"});
        }
        words.insert(words.end(), {option.name, word});
        EXPECT_EQ(RunInProcess(words).code, ExitCode::File)
            << command << " " << option.name << word;
      }
    }
  }
}

TEST(OptionValues, AFormatMayBeNamedByAnyEndingOfItsFiles) {
  for (std::string const word : {"nc", "NC", "ngc", "gcode", "GCode"}) {
    EXPECT_EQ(RunInProcess({"fit", "no.csv", "--to", word}).code, ExitCode::File) << word;
    EXPECT_EQ(RunInProcess({"convert", "no.json", "--to", word}).code, ExitCode::File) << word;
    EXPECT_EQ(RunInProcess({"check", "no.csv", "no", "--from", word}).code, ExitCode::File) << word;
    EXPECT_EQ(RunInProcess({"info", "no", "--points-from", word}).code, ExitCode::File) << word;
  }
  for (std::string const word : {"htm", "HTM"}) {
    EXPECT_EQ(RunInProcess({"plot", "no.csv", "--to", word}).code, ExitCode::File) << word;
  }
}

TEST(OptionValues, FormatsOfAFitAreAListWithoutDoubles) {
  for (std::string const bad : {"step", "json,", ",json", "json,json", "json,best"}) {
    EXPECT_EQ(Complaint("fit", {"--to=" + bad}),
              "--to: '" + bad +
                  "' names none of json, csv, dxf, gcode, wkt, geojson, svg, png, html, or one of "
                  "them twice");
  }
}

TEST(OptionValues, ColumnsAreTwoOrThreeDifferentOnes) {
  for (std::string const& command : kWithPoints) {
    for (std::string const bad : {"1", "1,1", "a,a", "1,2,2", "1,2,3,4", ",", "1,", "0,1,0"}) {
      EXPECT_EQ(Complaint(command, {"--columns=" + bad}),
                "--columns: '" + bad + "' is not two or three different columns")
          << command;
    }
  }
}

TEST(OptionValues, AnglesOfTheLargestStepEndAtHalfATurn) {
  for (std::string const bad : {"0", "-1", "180.001", "nan", "inf", "x"}) {
    EXPECT_EQ(Complaint("fit", {"--largest-step=" + bad}),
              "--largest-step: '" + bad + "' is not an angle above 0 and up to 180 degrees");
  }
}

TEST(OptionValues, MagnificationIsAutoOrAPositiveNumber) {
  for (std::string const bad : {"0", "-3", "nan", "inf", "Auto"}) {
    EXPECT_EQ(Complaint("plot", {"--magnify=" + bad}),
              "--magnify: '" + bad + "' is neither auto nor a number above 0");
  }
  for (std::string const good : {"auto", "1", "0.5", "1e6"}) {
    EXPECT_EQ(RunInProcess({"plot", "no.csv", "--to", "svg", "--magnify", good}).code,
              ExitCode::File)
        << good;
  }
}

TEST(OptionValues, HeightsAreFiniteAndMayBeBelowZero) {
  for (std::string const& command : kThatWrite) {
    for (char const* name : {"--safe-height", "--cut-height"}) {
      std::string const other =
          name == std::string("--safe-height") ? "--cut-height" : "--safe-height";
      for (std::string const bad : {"nan", "inf", "x"}) {
        EXPECT_EQ(Complaint(command, {std::string(name) + "=" + bad, other + "=1"}),
                  std::string(name) + ": '" + bad + "' is not a finite number");
      }
    }
    Words words = kLines.at(command);
    words.insert(words.end(), {"--safe-height=0", "--cut-height=-2.5"});
    EXPECT_EQ(RunInProcess(words).code, ExitCode::File) << command;
  }
}

}  // namespace
}  // namespace Vorn::Cli
