#pragma once

#include <gtest/gtest.h>
#include <sys/wait.h>

#include <algorithm>
#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

/// For tests that run the built program as a user does.
namespace Vorn::Cli::Testing {

namespace fs = std::filesystem;

inline std::string Contents(fs::path const& path) {
  std::ifstream file(path, std::ios::binary);
  std::ostringstream text;
  text << file.rdbuf();
  return text.str();
}

/// What a shell adds to the number of the signal that ended a program.
inline constexpr int kSignalled = 128;

struct Ended {
  int code = -1;
  std::string out;
  std::string err;
};

/// A folder of its own for every test; the program runs inside it.
class Program : public testing::Test {
 protected:
  Program() {
    // Tests that run in the background of a shell have interruptions ignored, and would pass that
    // on to the program.
    for (int const signal : {SIGINT, SIGTERM, SIGHUP}) std::signal(signal, SIG_DFL);
    std::string name = (fs::temp_directory_path() / "contour-run-XXXXXX").string();
    folder_ = mkdtemp(name.data());
  }

  ~Program() override { fs::remove_all(folder_); }

  void Write(std::string const& name, std::string const& text) const {
    std::ofstream(folder_ / name, std::ios::binary) << text;
  }

  /// `arguments` as typed into a shell after the name of the program, `before` what goes before it.
  Ended Run(std::string const& arguments, std::string const& before = "",
            std::string const& in = "/dev/null") const {
    return System(before + " '" + CONTOUR_PROGRAM + "' " + arguments + " >.out 2>.err <'" + in +
                  "'");
  }

  /// A line for the shell, in which $CONTOUR is the program; for pipes and redirections.
  Ended RunShell(std::string const& line) const {
    return System("CONTOUR='" CONTOUR_PROGRAM "'; { " + line + "\n} >.out 2>.err </dev/null");
  }

  std::vector<std::string> Files() const {
    std::vector<std::string> names;
    for (auto const& entry : fs::directory_iterator(folder_)) {
      names.push_back(entry.path().filename().string());
    }
    std::sort(names.begin(), names.end());
    return names;
  }

  void ExpectRefusal(std::string const& arguments, int code, std::string const& message) const {
    Ended const ended = Run(arguments);
    EXPECT_EQ(ended.code, code) << arguments;
    EXPECT_EQ(ended.out, "") << arguments;
    EXPECT_EQ(ended.err, "contour: " + message + "\n") << arguments;
  }

  fs::path folder_;

 private:
  Ended System(std::string const& line) const {
    int const status = std::system(("cd '" + folder_.string() + "' && " + line).c_str());
    Ended ended;
    // A shell that makes itself the program ends as the program does.
    ended.code = WIFEXITED(status) ? WEXITSTATUS(status) : kSignalled + WTERMSIG(status);
    ended.out = Contents(folder_ / ".out");
    ended.err = Contents(folder_ / ".err");
    fs::remove(folder_ / ".out");
    fs::remove(folder_ / ".err");
    return ended;
  }
};

/// A corner: ten points along x, ten along y.
inline std::string Corner() {
  std::string text = "x,y\n";
  for (int i = 0; i <= 10; ++i) text += std::to_string(i) + ",0\n";
  for (int i = 1; i <= 10; ++i) text += "10," + std::to_string(i) + "\n";
  return text;
}

}  // namespace Vorn::Cli::Testing
