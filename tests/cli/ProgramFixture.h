#pragma once

#include <gtest/gtest.h>
#include <sys/wait.h>

#include <algorithm>
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

struct Ended {
  int code = -1;
  std::string out;
  std::string err;
};

/// A folder of its own for every test; the program runs inside it.
class Program : public testing::Test {
 protected:
  Program() {
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
    std::string const command = "cd '" + folder_.string() + "' && " + before + " '" +
                                CONTOUR_PROGRAM + "' " + arguments + " >.out 2>.err <'" + in + "'";
    int const status = std::system(command.c_str());
    Ended ended;
    ended.code = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    ended.out = Contents(folder_ / ".out");
    ended.err = Contents(folder_ / ".err");
    fs::remove(folder_ / ".out");
    fs::remove(folder_ / ".err");
    return ended;
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
};

/// A corner: ten points along x, ten along y.
inline std::string Corner() {
  std::string text = "x,y\n";
  for (int i = 0; i <= 10; ++i) text += std::to_string(i) + ",0\n";
  for (int i = 1; i <= 10; ++i) text += "10," + std::to_string(i) + "\n";
  return text;
}

}  // namespace Vorn::Cli::Testing
