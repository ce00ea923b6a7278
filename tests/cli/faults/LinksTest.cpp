// Outputs that are no plain files: symbolic links, devices, pipes, sockets, folders.

#include <gtest/gtest.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>

#include <cstring>
#include <nlohmann/json.hpp>

#include "cli/ProgramFixture.h"

namespace Vorn::Cli::Testing {
namespace {

class SpecialFiles : public Program {
 protected:
  SpecialFiles() {
    Write("p.csv", Corner());
    EXPECT_EQ(Run("fit p.csv -t 0.01 -o plain.json").code, 0);
    json_ = Contents(folder_ / "plain.json");
    EXPECT_EQ(nlohmann::json::parse(json_).at("elements").size(), 2u);
    fs::remove(folder_ / "plain.json");
  }

  void Link(std::string const& name, std::string const& target) const {
    fs::create_symlink(target, folder_ / name);
  }

  Ended FitInto(std::string const& name) const { return Run("fit p.csv -t 0.01 -o " + name); }

  /// The file is refused for the reason, and nothing is changed.
  void ExpectRefused(std::string const& name, std::string const& reason) const {
    std::vector<std::string> const before = Files();
    ExpectRefusal("fit p.csv -t 0.01 --to json -o " + name, 3,
                  name + ": cannot be written: " + reason);
    EXPECT_EQ(Files(), before) << name;
  }

  std::string json_;
};

TEST_F(SpecialFiles, ALinkStaysALinkAndItsFileIsReplaced) {
  fs::create_directory(folder_ / "deep");
  Write("deep/real.json", "old");
  Link("first.json", "deep/real.json");
  Link("second.json", "first.json");
  Ended const ended = FitInto("second.json");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_EQ(fs::read_symlink(folder_ / "second.json"), "first.json");
  EXPECT_EQ(fs::read_symlink(folder_ / "first.json"), "deep/real.json");
  EXPECT_FALSE(fs::is_symlink(folder_ / "deep/real.json"));
  EXPECT_EQ(Contents(folder_ / "deep/real.json"), json_);
  EXPECT_EQ(Files(), (std::vector<std::string>{"deep", "first.json", "p.csv", "second.json"}));
}

TEST_F(SpecialFiles, ALinkedFolderIsAFolder) {
  fs::create_directory(folder_ / "deep");
  Link("way", "deep");
  Ended const ended = FitInto("way/a.json");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_EQ(Contents(folder_ / "deep/a.json"), json_);
  EXPECT_TRUE(fs::is_symlink(folder_ / "way"));
}

TEST_F(SpecialFiles, ALinkThatLeadsToNoFileIsRefused) {
  fs::create_directory(folder_ / "deep");
  Link("folder.json", "deep");
  Link("nowhere.json", "none/a.json");
  Link("loop.json", "loop.json");
  Link("there.json", "back.json");
  Link("back.json", "there.json");
  ExpectRefused("folder.json", "is a directory");
  ExpectRefused("nowhere.json", "is a link to none/a.json, which is not there");
  ExpectRefused("loop.json", "Too many levels of symbolic links");
  ExpectRefused("there.json", "Too many levels of symbolic links");
  Link("through.json", "p.csv/a.json");
  ExpectRefused("through.json", "is a link to p.csv/a.json, which is not there");
}

TEST_F(SpecialFiles, AFolderOrASocketIsRefused) {
  fs::create_directory(folder_ / "deep.json");
  ExpectRefused("deep.json", "is a directory");
  ExpectRefused("deep.json/", "is a directory");
  ExpectRefused("new.json/", "names no file");
  int const descriptor = socket(AF_UNIX, SOCK_STREAM, 0);
  sockaddr_un address{};
  address.sun_family = AF_UNIX;
  std::string const path = (folder_ / "socket.json").string();
  ASSERT_LT(path.size(), sizeof address.sun_path);
  std::memcpy(address.sun_path, path.c_str(), path.size());
  ASSERT_EQ(bind(descriptor, reinterpret_cast<sockaddr*>(&address), sizeof address), 0);
  ExpectRefused("socket.json", "is not a regular file");
  close(descriptor);
}

TEST_F(SpecialFiles, AnotherNameOfAFileKeepsTheOldContents) {
  Write("a.json", "old");
  fs::create_hard_link(folder_ / "a.json", folder_ / "copy.json");
  EXPECT_EQ(FitInto("a.json").code, 0);
  EXPECT_EQ(Contents(folder_ / "a.json"), json_);
  EXPECT_EQ(Contents(folder_ / "copy.json"), "old");
}

TEST_F(SpecialFiles, AReplacedFileKeepsItsPermissions) {
  Write("a.json", "old");
  fs::permissions(folder_ / "a.json", fs::perms(0604));
  EXPECT_EQ(FitInto("a.json").code, 0);
  EXPECT_EQ(fs::status(folder_ / "a.json").permissions(), fs::perms(0604));
  Ended const ended = Run("fit p.csv -t 0.01 -o new.json", "umask 037;");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_EQ(fs::status(folder_ / "new.json").permissions(), fs::perms(0640));
}

TEST_F(SpecialFiles, DevicesTakeWhatTheyAreGiven) {
  Link("nothing.json", "/dev/null");
  for (char const* name : {"/dev/null", "nothing.json"}) {
    Ended const ended = Run(std::string("fit p.csv -t 0.01 --to json -o a.json -o ") + name);
    EXPECT_EQ(ended.code, 0) << ended.err;
    EXPECT_EQ(Contents(folder_ / "a.json"), json_);
  }
  EXPECT_TRUE(fs::is_symlink(folder_ / "nothing.json"));
  EXPECT_TRUE(fs::is_character_file("/dev/null"));
}

TEST_F(SpecialFiles, AFullDeviceIsNamed) {
  ExpectRefused("/dev/full", "No space left on device");
  Write("line.wkt", "LINESTRING (0 0, 10 0, 10 10)");
  for (std::string const command :
       {"info p.csv", "fit p.csv -t 0.01", "fit p.csv -t 0.01 -o - --to json", "fit --help",
        "fit p.csv p.csv -t 0.01", "plot p.csv --to svg", "simplify p.csv -t 0.1 --drop-close",
        "check p.csv line.wkt -t 1", "convert line.wkt --to dxf", "area line.wkt --close",
        "intersect line.wkt"}) {
    Ended const ended = RunShell("\"$CONTOUR\" " + command + " >/dev/full");
    EXPECT_EQ(ended.code, 3) << command;
    std::string const complaint = "contour: standard output: cannot be written\n";
    EXPECT_TRUE(ended.err.ends_with(complaint)) << command << ": " << ended.err;
  }
}

TEST_F(SpecialFiles, AFailingDeviceComesAfterTheFiles) {
  // What a device took cannot be taken back, so the files are complete before it gets anything.
  Ended const ended = Run("fit p.csv -t 0.01 --to json -o /dev/full -o a.json");
  EXPECT_EQ(ended.code, 3);
  EXPECT_EQ(ended.err, "contour: /dev/full: cannot be written: No space left on device\n");
  EXPECT_EQ(Contents(folder_ / "a.json"), json_);
}

TEST_F(SpecialFiles, TheNameOfTheStandardOutputIsTakenForADash) {
  for (char const* command :
       {"fit p.csv -t 0.01 --to json -o /dev/stdout", "fit p.csv -t 0.01 --json /dev/stdout"}) {
    Ended const ended = Run(command);
    EXPECT_EQ(ended.code, 0) << ended.err;
    EXPECT_EQ(ended.out, json_) << "no table behind it";
  }
  ExpectRefusal("fit p.csv -t 0.01 --to json -o - -o /dev/stdout", 2,
                "two --output name the standard output");
}

TEST_F(SpecialFiles, AFileThatTheShellAppendsToIsNotReplaced) {
  Write("log", "before\n");
  Ended const ended = RunShell("\"$CONTOUR\" fit p.csv -t 0.01 --to json -o /dev/stdout >>log");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_EQ(Contents(folder_ / "log"), "before\n" + json_);
}

TEST_F(SpecialFiles, APipeOfTheShellIsWritten) {
  // What a shell makes of >(cat): a link below /dev/fd that leads to no name.
  Ended const ended = RunShell(
      "{ \"$CONTOUR\" fit p.csv -t 0.01 --to json -o /dev/fd/3 3>&1 >/dev/null; } | cat >through");
  EXPECT_EQ(ended.err, "");
  EXPECT_EQ(Contents(folder_ / "through"), json_);
}

}  // namespace
}  // namespace Vorn::Cli::Testing
