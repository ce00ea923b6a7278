#include <gtest/gtest.h>

#include <cmath>
#include <nlohmann/json.hpp>
#include <random>
#include <string>

#include "cli/ProgramFixture.h"

/// `contour fit --strategy fewest` as a user runs it.
namespace Vorn::Cli::Testing {
namespace {

/// Two straight runs with a corner, a point every hundredth with noise of two: neighbours step
/// backwards.
std::string DenseCorner() {
  std::mt19937 engine(7);
  std::uniform_real_distribution<double> noise(-0.02, 0.02);
  std::string text = "x,y\n";
  for (int i = 0; i <= 2000; ++i) {
    double const along = 0.01 * i;
    double const x = std::min(along, 10.0) + noise(engine);
    double const y = std::max(along - 10.0, 0.0) + noise(engine);
    text += std::to_string(x) + "," + std::to_string(y) + "\n";
  }
  return text;
}

std::string WithoutTime(std::string const& out) { return out.substr(0, out.find("\ntime ")); }

TEST_F(Program, FewestTakesScansDenserThanTheirTolerance) {
  Write("scan.csv", DenseCorner());
  EXPECT_EQ(Run("fit scan.csv -t 0.04 --strategy mixed").code, 4);
  Ended const ended = Run("fit scan.csv -t 0.04");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_EQ(ended.err, "");
  EXPECT_NE(ended.out.find("\nstrategy    fewest\n"), std::string::npos) << ended.out;
  EXPECT_NE(ended.out.find("\npieces      2 (proven the fewest): 2 lines, 0 arcs\n"),
            std::string::npos)
      << ended.out;
  EXPECT_NE(ended.out.find("\nresult      within tolerance\n"), std::string::npos) << ended.out;
}

TEST_F(Program, FewestWritesEveryFormatAndEachKeepsTheTolerance) {
  Write("scan.csv", DenseCorner());
  std::string outputs;
  std::vector<std::string> const holdContour = {"json", "csv", "dxf", "nc", "wkt"};
  for (std::string const& ending : holdContour) outputs.append(" -o f.").append(ending);
  Ended const ended =
      Run("fit scan.csv -t 0.04 --strategy fewest --feed 100" + outputs + " -o f.svg -o f.html");
  ASSERT_EQ(ended.code, 0) << ended.err;
  for (std::string const& ending : holdContour) {
    EXPECT_EQ(Run("check scan.csv f." + ending + " -t 0.04").code, 0) << ending;
  }
  for (char const* drawn : {"f.svg", "f.html"}) {
    EXPECT_NE(Contents(folder_ / drawn).find("2 pieces, proven the fewest"), std::string::npos)
        << drawn;
  }
}

TEST_F(Program, FewestFitsManyFilesToTheSameBytes) {
  for (char const* name : {"a.csv", "b.csv", "c.csv"}) Write(name, DenseCorner());
  Write("d.csv", "0,0\n0.001,0\n0,0.001\n");
  std::string const fit = "fit a.csv b.csv c.csv d.csv -t 0.04 --strategy fewest --no-time ";
  Ended const one = Run(fit + "-j 1 --out-dir one");
  Ended const four = Run(fit + "-j 4 --out-dir four");
  EXPECT_EQ(one.code, 5);
  EXPECT_EQ(one.err, "contour: d.csv: no fit: all points coincide within their tolerances\n");
  EXPECT_EQ(one.out, four.out);
  EXPECT_NE(one.out.find("  2 (fewest)  "), std::string::npos) << one.out;
  for (char const* name : {"a.json", "b.json", "c.json"}) {
    std::string const text = Contents(folder_ / "one" / name);
    EXPECT_EQ(text, Contents(folder_ / "four" / name));
    EXPECT_EQ(nlohmann::json::parse(text).at("counts").at("isFewest"), true);
  }
}

TEST_F(Program, FewestReadsTheStandardInputAndGivesTheSameTwice) {
  Write("scan.csv", DenseCorner());
  std::string const in = (folder_ / "scan.csv").string();
  std::string const fit = "fit - -t 0.03 --strategy fewest --effort wide --largest-step 30";
  Ended const first = Run(fit, "", in);
  EXPECT_EQ(first.code, 0) << first.err;
  EXPECT_EQ(WithoutTime(first.out), WithoutTime(Run(fit, "", in).out));
}

}  // namespace
}  // namespace Vorn::Cli::Testing
