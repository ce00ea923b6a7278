// The program under other languages of the machine (LC_ALL) writes the same bytes.

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "cli/ProgramFixture.h"

namespace Vorn::Cli::Testing {
namespace {

/// Languages are made in a folder of the test; where localedef or its sources are missing there are
/// none.
class Languages : public Program {
 protected:
  bool MakeGerman() const {
    fs::create_directory(folder_ / "locales");
    Ended const made =
        RunShell("localedef --no-archive -i de_DE -f UTF-8 \"$PWD/locales/de_DE.UTF-8\"");
    // Else the tests below would hold whatever the program did.
    return made.code == 0 && RunShell("env " + German() + " printf %.1f 1,5").out == "1,5";
  }

  std::string German() const { return In("de_DE.UTF-8"); }

  std::string In(std::string const& language) const {
    return "LC_ALL=" + language + " LOCPATH='" + (folder_ / "locales").string() + "'";
  }

  /// What a script writes under a language: its output, its messages and its files.
  std::vector<std::string> Results(std::string const& language) const {
    std::string const script =
        "p() { " + In(language) +
        " \"$CONTOUR\" \"$@\"; };"
        "p fit p.csv -t 0.01 -o a.json -o a.dxf -o a.svg -o a.html -o a.nc -o a.wkt -o a.png "
        "-o a.csv -o a.geojson --feed 1200.5 | grep -v '^time';"
        "p info p.csv; p check p.csv a.json -t 0.01; p area a.json --close;"
        "p simplify p.csv --spacing 2.5; p intersect a.json; p fit none.csv -t 1; p fit p.csv -t "
        "1,5;"
        "p info comma.csv";
    Ended const ended = RunShell(script);
    std::vector<std::string> results = {ended.out, ended.err};
    for (char const* name :
         {"a.json", "a.dxf", "a.svg", "a.html", "a.nc", "a.wkt", "a.png", "a.csv", "a.geojson"}) {
      results.push_back(Contents(folder_ / name));
      EXPECT_NE(results.back(), "") << name;
      fs::remove(folder_ / name);
    }
    return results;
  }
};

TEST_F(Languages, ChangeNoByte) {
  if (!MakeGerman()) GTEST_SKIP() << "localedef cannot make de_DE.UTF-8 (package locales)";
  Write("p.csv", Corner());
  Write("comma.csv", "x;y\n0,5;1,25\n1.000,5;2\n");
  std::vector<std::string> const expected = Results("C");
  EXPECT_NE(expected[0].find("10.000"), std::string::npos) << expected[0];
  EXPECT_NE(expected[1].find("No such file"), std::string::npos) << expected[1];
  for (char const* language : {"de_DE.UTF-8", "C.UTF-8", "xx_XX.none"}) {
    EXPECT_EQ(Results(language), expected) << language;
  }
}

}  // namespace
}  // namespace Vorn::Cli::Testing
