#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <sstream>

#include "cli/commands/Outputs.h"

namespace Vorn::Cli {
namespace {

namespace fs = std::filesystem;

/// What the refusal says; empty when there is none.
std::string Refusal(std::vector<NamedFile> const& read, std::vector<NamedFile> const& written) {
  try {
    RefuseSharedFiles(read, written);
  } catch (Failure const& failure) {
    EXPECT_EQ(failure.Kind(), FailureKind::BadArgument);
    return failure.what();
  }
  return "";
}

TEST(RefuseSharedFiles, NamesBothOptionsAndTheFile) {
  EXPECT_EQ(Refusal({}, {{"-o", "a"}, {"--json", "b"}, {"-o", "./a"}}),
            "two -o name the same file: ./a");
  EXPECT_EQ(Refusal({{"POINTS", "x/../a"}}, {{"-o", "a"}}), "POINTS and -o name the same file: a");
  EXPECT_EQ(Refusal({{"POINTS", "a"}}, {{"-o", "b"}, {"-o", "c"}}), "");
}

TEST(RefuseSharedFiles, StandardOutputTakesOneResultAndIsNotTheInput) {
  EXPECT_EQ(Refusal({{"POINTS", "-"}}, {{"-o", "-"}}), "");
  EXPECT_EQ(Refusal({}, {{"-o", "-"}, {"-o", "-"}}), "two -o name the standard output");
}

TEST(Outputs, WritesEveryFileOrNone) {
  std::string name = (fs::temp_directory_path() / "contour-outputs-XXXXXX").string();
  fs::path const folder = mkdtemp(name.data());
  std::istringstream in;
  std::ostringstream out;
  std::ostringstream err;
  Outputs good;
  good.Add((folder / "a").string(), "first");
  good.Add("-", "second");
  good.Write({in, out, err});
  EXPECT_EQ(out.str(), "second");
  std::string text;
  std::getline(std::ifstream(folder / "a"), text);
  EXPECT_EQ(text, "first");

  Outputs bad;
  bad.Add((folder / "b").string(), "third");
  bad.Add((folder / "none" / "c").string(), "fourth");
  bad.Add("-", "fifth");
  EXPECT_THROW(bad.Write({in, out, err}), Failure);
  EXPECT_FALSE(fs::exists(folder / "b"));
  EXPECT_EQ(out.str(), "second");
  fs::remove_all(folder);
}

}  // namespace
}  // namespace Vorn::Cli
