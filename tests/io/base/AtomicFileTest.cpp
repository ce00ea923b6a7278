#include <gtest/gtest.h>
#include <sys/stat.h>

#include <filesystem>
#include <fstream>
#include <sstream>

#include "vorn/io/Failure.h"
#include "vorn/io/Files.h"

namespace Vorn::IO {
namespace {

namespace fs = std::filesystem;

class AtomicFileTest : public testing::Test {
 protected:
  AtomicFileTest() {
    std::string name = (fs::temp_directory_path() / "contour-test-XXXXXX").string();
    folder_ = mkdtemp(name.data());
  }

  ~AtomicFileTest() override { fs::remove_all(folder_); }

  std::string In(std::string const& name) const { return (folder_ / name).string(); }

  static std::string Contents(std::string const& path) {
    std::ifstream file(path, std::ios::binary);
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
  }

  static void Write(std::string const& path, std::string const& text) {
    std::ofstream(path, std::ios::binary) << text;
  }

  std::size_t FileCount() const {
    return static_cast<std::size_t>(
        std::distance(fs::directory_iterator(folder_), fs::directory_iterator()));
  }

  fs::path folder_;
};

template <typename Action>
std::string RefusalOf(Action const& action) {
  try {
    action();
  } catch (Failure const& failure) {
    EXPECT_EQ(failure.Kind(), FailureKind::File);
    return failure.what();
  }
  return "";
}

TEST_F(AtomicFileTest, AppearsOnlyWithCommit) {
  std::string const contents("all of\0it", 9);
  AtomicFile file(In("a.json"), contents);
  EXPECT_FALSE(fs::exists(In("a.json")));
  file.Commit();
  EXPECT_EQ(Contents(In("a.json")), contents);
  EXPECT_EQ(FileCount(), 1u) << "no temporary file is left";
}

TEST_F(AtomicFileTest, DroppedFileLeavesTheOldOneAndNothingElse) {
  Write(In("a.json"), "old");
  { AtomicFile const file(In("a.json"), "new"); }
  EXPECT_EQ(Contents(In("a.json")), "old");
  EXPECT_EQ(FileCount(), 1u);
}

TEST_F(AtomicFileTest, ReplacedFileKeepsItsPermissions) {
  Write(In("a.json"), "old");
  fs::permissions(In("a.json"), fs::perms(0640));
  AtomicFile(In("a.json"), "new").Commit();
  EXPECT_EQ(Contents(In("a.json")), "new");
  EXPECT_EQ(fs::status(In("a.json")).permissions(), fs::perms(0640));
}

TEST_F(AtomicFileTest, NewFileHasTheUsualPermissions) {
  mode_t const before = umask(027);
  AtomicFile(In("a.json"), "new").Commit();
  umask(before);
  EXPECT_EQ(fs::status(In("a.json")).permissions(), fs::perms(0640));
}

TEST_F(AtomicFileTest, SymbolicLinkStaysALink) {
  Write(In("real.json"), "old");
  fs::create_symlink("real.json", In("link.json"));
  AtomicFile(In("link.json"), "new").Commit();
  EXPECT_TRUE(fs::is_symlink(In("link.json")));
  EXPECT_EQ(Contents(In("real.json")), "new");
}

TEST_F(AtomicFileTest, RefusalNamesTheFile) {
  std::string const missing = In("none/a.json");
  EXPECT_EQ(RefusalOf([&] { RequireWritable(missing); }),
            missing + ": cannot be written: No such file or directory");
  EXPECT_EQ(RefusalOf([&] { AtomicFile(missing, ""); }),
            missing + ": cannot be written: No such file or directory");
  std::string const folder = folder_.string();
  EXPECT_EQ(RefusalOf([&] { AtomicFile(folder, ""); }),
            folder + ": cannot be written: is a directory");
  EXPECT_EQ(RefusalOf([&] { AtomicFile("/dev/null", "").Commit(); }), "") << "takes anything";
  EXPECT_NE(RefusalOf([&] { AtomicFile("", ""); }), "");
}

TEST_F(AtomicFileTest, FailedCommitNamesTheFileAndLeavesNothing) {
  {
    AtomicFile file(In("a.json"), "new");
    fs::create_directory(In("a.json"));
    EXPECT_EQ(RefusalOf([&] { file.Commit(); }),
              In("a.json") + ": cannot be written: Is a directory");
  }
  EXPECT_EQ(FileCount(), 1u);
}

TEST_F(AtomicFileTest, WhatIsStagedCanBeRemovedWhenTheProgramEnds) {
  Write(In("kept.txt"), "old");
  AtomicFile const first(In("kept.txt"), "new");
  AtomicFile const second(In("other.txt"), "text");
  EXPECT_EQ(FileCount(), 3u);
  RemoveTemporaries();
  EXPECT_EQ(FileCount(), 1u);
  EXPECT_EQ(Contents(In("kept.txt")), "old");
}

}  // namespace
}  // namespace Vorn::IO
