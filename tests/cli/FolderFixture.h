#pragma once

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

#include "cli/RunInProcess.h"

/// For tests that run the program inside the test, with files in a folder of their own.
namespace Vorn::Cli::Testing {

class InFolder : public testing::Test {
 protected:
  InFolder() {
    std::string name = (std::filesystem::temp_directory_path() / "contour-in-XXXXXX").string();
    folder_ = mkdtemp(name.data());
  }

  ~InFolder() override { std::filesystem::remove_all(folder_); }

  std::string PathOf(std::string const& name) const { return (folder_ / name).string(); }

  /// @return the path of the file
  std::string Write(std::string const& name, std::string const& text) const {
    std::ofstream(folder_ / name, std::ios::binary) << text;
    return PathOf(name);
  }

  std::string Contents(std::string const& name) const {
    std::ifstream file(folder_ / name, std::ios::binary);
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
  }

 private:
  std::filesystem::path folder_;
};

/// What stands behind the word in the first line that begins with it; empty when there is none.
inline std::string FactOf(std::string const& text, std::string const& word) {
  std::istringstream lines(text);
  for (std::string line; std::getline(lines, line);) {
    if (!line.starts_with(word + " ")) continue;
    return line.substr(line.find_first_not_of(' ', word.size()));
  }
  return "";
}

/// Points as a table without a header, each number with all its digits.
inline std::string TableOf(std::vector<std::pair<double, double>> const& points) {
  std::ostringstream text;
  text.precision(17);
  for (auto const& [x, y] : points) text << x << ',' << y << '\n';
  return text.str();
}

}  // namespace Vorn::Cli::Testing
