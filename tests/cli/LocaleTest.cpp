// Numbers look the same whatever the language of the machine is: with a decimal comma and groups of
// thousands in the C library and in the streams of C++.

#include <gtest/gtest.h>

#include <clocale>
#include <filesystem>
#include <fstream>
#include <locale>
#include <sstream>

#include "cli/RunInProcess.h"

namespace Vorn::Cli {
namespace {

namespace fs = std::filesystem;

/// 1.234,5 in place of 1234.5.
class CommaNumbers : public std::numpunct<char> {
 protected:
  char do_decimal_point() const override { return ','; }
  char do_thousands_sep() const override { return '.'; }
  std::string do_grouping() const override { return "\3"; }
};

/// While it lives, streams write numbers that way unless they are told otherwise.
class CommaStreams {
 public:
  CommaStreams()
      : before_(std::locale::global(std::locale(std::locale::classic(), new CommaNumbers))) {}
  CommaStreams(CommaStreams const&) = delete;
  CommaStreams& operator=(CommaStreams const&) = delete;
  ~CommaStreams() { std::locale::global(before_); }

 private:
  std::locale before_;
};

/// A folder with points, numbered in the thousands so that groups would show, and a contour.
class Locales : public testing::Test {
 protected:
  Locales() {
    std::string name = (fs::temp_directory_path() / "contour-locale-XXXXXX").string();
    folder_ = mkdtemp(name.data());
    std::ofstream points(In("p.csv"));
    points.imbue(std::locale::classic());
    points << "# units mm\nx,y\n";
    for (int i = 0; i <= 1200; ++i)
      points << 12345.5 + i << "," << (i % 2 == 0 ? 0.25 : 0.0) << "\n";
    std::ofstream(In("c.wkt")) << "COMPOUNDCURVE ((12345.5 0.125, 13545.5 0.125), CIRCULARSTRING "
                                  "(13545.5 0.125, 12945.5 600.125, 12345.5 0.125))\n";
  }

  ~Locales() override { fs::remove_all(folder_); }

  std::string In(std::string const& name) const { return (folder_ / name).string(); }

  /// Every command, its whole answer on the standard output.
  std::vector<std::vector<std::string>> Commands() const {
    std::string const points = In("p.csv");
    std::string const contour = In("c.wkt");
    std::vector<std::vector<std::string>> commands = {
        {"info", points, "-t", "0.3"},
        {"info", points, "--json"},
        {"check", points, contour, "-t", "0.25"},
        {"check", points, contour, "-t", "0.25", "--table", "-"},
        {"check", points, contour, "-t", "0.25", "--json", "-"},
        {"area", contour},
        {"area", contour, "--json"},
        {"intersect", contour, In("c.wkt"), "-o", "-"},
        {"intersect", contour, "--json"},
        {"plot", points, contour, "-t", "0.25", "--to", "svg"},
        {"plot", points, contour, "-t", "0.25", "--to", "html"},
        {"simplify", points, "-t", "0.25", "--spacing", "3.5", "--average"},
    };
    for (char const* format : {"json", "csv", "dxf", "gcode", "wkt", "geojson", "svg", "html"}) {
      commands.push_back({"convert", contour, "--to", format, "-t", "0.001"});
      commands.push_back({"fit", points, "-t", "0.26", "--to", format, "--strategy", "fewest"});
    }
    return commands;
  }

  /// What all of them write, text and messages.
  std::vector<std::string> Answers() const {
    std::vector<std::string> answers;
    for (auto const& command : Commands()) {
      RunResult const run = RunInProcess(command);
      EXPECT_NE(run.out, "") << command[0] << ": " << run.err;
      answers.push_back(run.out + run.err);
    }
    return answers;
  }

  fs::path folder_;
};

TEST_F(Locales, OfTheStreamsChangeNoByte) {
  std::vector<std::string> const expected = Answers();
  CommaStreams const comma;
  std::ostringstream shown;
  shown << 1234.5;
  ASSERT_EQ(shown.str(), "1.234,5") << "else the test would prove nothing";
  std::vector<std::string> const answers = Answers();
  for (std::size_t i = 0; i < answers.size(); ++i) {
    EXPECT_EQ(answers[i], expected[i]) << Commands()[i][0] << " " << Commands()[i].back();
  }
}

TEST_F(Locales, OfTheStreamsDoNotTouchWhatIsRead) {
  CommaStreams const comma;
  EXPECT_EQ(RunInProcess({"area", "-"}, "LINESTRING (0 0, 1500.5 0, 1500.5 2, 0 2, 0 0)")
                .out.find("standard input: 4 pieces, 4 lines, 0 arcs\narea        3001\nsigned "),
            0u);
  RunResult const svg = RunInProcess(
      {"area", "-", "--from", "svg"},
      R"(<svg xmlns="http://www.w3.org/2000/svg" width="10mm" height="10mm" viewBox="0 0 10 10">
         <path d="M1.5,1.5h4v4h-4z"/></svg>)");
  EXPECT_NE(svg.out.find("area        16\n"), std::string::npos) << svg.out << svg.err;
  RunResult const json = RunInProcess(
      {"area", "-"},
      R"({"type": "Polygon", "coordinates": [[[0,0],[1500.5,0],[1500.5,2],[0,2],[0,0]]]})");
  EXPECT_NE(json.out.find("area        3001\n"), std::string::npos) << json.out << json.err;
}

}  // namespace
}  // namespace Vorn::Cli
