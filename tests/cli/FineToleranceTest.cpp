// The program tells before a fit that the tolerances are too fine for its strategy.

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <string>

#include "cli/RunInProcess.h"

namespace Vorn::Cli {
namespace {

/// Thirty points on a straight line, 2 apart.
std::string StraightPoints() {
  std::string text = "x,y\n";
  for (int i = 0; i < 30; ++i) text += std::to_string(2 * i) + ",0\n";
  return text;
}

TEST(FitOfFineTolerances, WarnsAndNamesThePointTheExtentAndTheWayOut) {
  RunResult const run =
      RunInProcess({"fit", "-", "-t", "5e-7", "--strategy", "mixed", "-q"}, StraightPoints());
  EXPECT_EQ(run.err,
            "contour: warning: standard input: the tolerance 5e-07 of point 0 (line 2) is less "
            "than 1e-08 of the contour's extent (58): strategy mixed may take minutes and break "
            "the contour up; --strategy fewest does neither\n");
  EXPECT_EQ(run.code, ExitCode::Ok);
}

TEST(FitOfFineTolerances, OtherTolerancesAndStrategiesAreNotWarnedOf) {
  EXPECT_EQ(
      RunInProcess({"fit", "-", "-t", "6e-7", "--strategy", "mixed", "-q"}, StraightPoints()).err,
      "");
  EXPECT_EQ(RunInProcess({"fit", "-", "-t", "5e-7", "-q"}, StraightPoints()).err, "");
  EXPECT_EQ(
      RunInProcess({"fit", "-", "-t", "5e-7", "--strategy", "fewest", "-q"}, StraightPoints()).err,
      "");
}

TEST(FitOfFineTolerances, ManyFilesAreWarnedOfOneByOne) {
  std::string name = (std::filesystem::temp_directory_path() / "contour-fine-XXXXXX").string();
  std::filesystem::path const folder = mkdtemp(name.data());
  std::ofstream(folder / "a.csv") << StraightPoints();
  std::ofstream(folder / "b.csv") << StraightPoints();
  RunResult const run =
      RunInProcess({"fit", (folder / "a.csv").string(), (folder / "b.csv").string(), "-t", "5e-7",
                    "--strategy", "mixed", "-q"});
  std::filesystem::remove_all(folder);
  EXPECT_EQ(run.code, ExitCode::Ok);
  EXPECT_NE(run.err.find("a.csv: the tolerance 5e-07"), std::string::npos) << run.err;
  EXPECT_NE(run.err.find("b.csv: the tolerance 5e-07"), std::string::npos) << run.err;
}

}  // namespace
}  // namespace Vorn::Cli
