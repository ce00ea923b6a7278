// Every exit code that the help of a command lists, each by a line that ends with it, and no other
// code by what is not listed.

#include <array>
#include <set>

#include "cli/FolderFixture.h"

namespace Vorn::Cli::Testing {
namespace {

using Words = std::vector<std::string>;

/// A line of a command, in which @name is the path of a file, and how it ends.
struct Case {
  int code;
  Words words;
};

std::vector<Case> const kCases = {
    {0, {"fit", "@good.csv", "-t", "0.01"}},
    {1, {"fit", "@good.csv", "-t", "0.3", "--strategy", "arc"}},
    {2, {"fit", "@good.csv"}},
    {3, {"fit", "@none.csv", "-t", "1"}},
    {3, {"fit", "@words.csv", "-t", "1"}},
    {3, {"fit", "@good.csv", "-t", "0.01", "-o", "@none/a.json"}},
    {4, {"fit", "@good.csv", "-t", "0.4", "--strategy", "mixed"}},
    {5, {"fit", "@two.csv", "-t", "0.1", "--strategy", "arc"}},
    {0, {"check", "@good.csv", "@corner.wkt"}},
    {0, {"check", "@good.csv", "@corner.wkt", "-t", "0.1"}},
    {1, {"check", "@good.csv", "@line.wkt", "-t", "0.1"}},
    {2, {"check", "@good.csv"}},
    {2, {"check", "@good.csv", "@corner.wkt", "--outline", "2"}},
    {3, {"check", "@good.csv", "@none.wkt"}},
    {3, {"check", "@words.csv", "@corner.wkt"}},
    {4, {"check", "@same.csv", "@corner.wkt", "--tolerance-per-point", "1"}},
    {0, {"info", "@good.csv"}},
    {0, {"info", "@same.csv", "-t", "9"}},
    {2, {"info"}},
    {3, {"info", "@words.csv"}},
    {0, {"plot", "@good.csv", "@line.wkt", "-t", "0.1", "-o", "@a.svg"}},
    {2, {"plot", "@good.csv", "-o", "@a.json"}},
    {3, {"plot", "@none.csv", "-o", "@a.svg"}},
    {3, {"plot", "@good.csv", "-o", "@none/a.svg"}},
    {4, {"plot", "@same.csv", "@line.wkt", "--tolerance-per-point", "1", "-o", "@a.svg"}},
    {0, {"area", "@square.wkt"}},
    {2, {"area", "@line.wkt"}},
    {2, {"area", "@square.wkt", "--outline", "2"}},
    {3, {"area", "@none.wkt"}},
    {3, {"area", "@words.csv"}},
    {0, {"intersect", "@square.wkt", "@line.wkt"}},
    {0, {"intersect", "@line.wkt", "--fail-if-any"}},
    {1, {"intersect", "@square.wkt", "@line.wkt", "--fail-if-any"}},
    {2, {"intersect"}},
    {3, {"intersect", "@square.wkt", "@words.csv"}},
    {3, {"intersect", "@square.wkt", "-o", "@none/a.csv"}},
    {0, {"convert", "@square.wkt", "-o", "@a.dxf"}},
    {1, {"convert", "@fine.wkt", "-o", "@a.nc", "--gcode-decimals", "1", "-t", "0.001"}},
    {2, {"convert", "@square.wkt", "-o", "@a.nc", "--units", "m"}},
    {2, {"convert", "@square.wkt", "-o", "@a.xyz"}},
    {3, {"convert", "@none.wkt", "-o", "@a.dxf"}},
    {3, {"convert", "@square.wkt", "-o", "@none/a.dxf"}},
    {0, {"simplify", "@good.csv", "--drop-close", "-t", "0.01"}},
    {2, {"simplify", "@good.csv"}},
    {3, {"simplify", "@words.csv", "--drop-close"}},
    {3, {"simplify", "@good.csv", "--drop-close", "-o", "@none/a.csv"}},
    {4, {"simplify", "@same.csv", "--drop-close"}},
};

class ExitCodes : public InFolder {
 protected:
  ExitCodes() {
    std::string corner = "x,y\n";
    for (int i = 0; i <= 10; ++i) corner += std::to_string(i) + ",0\n";
    for (int i = 1; i <= 10; ++i) corner += "10," + std::to_string(i) + "\n";
    Write("good.csv", corner);
    Write("words.csv", "x,y\n1,2\nthree,four\n");
    Write("two.csv", "0,0\n3,4\n");
    Write("same.csv", "1,1\n1,1\n1,1\n");
    Write("corner.wkt", "LINESTRING (0 0, 10 0, 10 10)");
    Write("line.wkt", "LINESTRING (0 0, 10 0)");
    Write("square.wkt", "LINESTRING (0 0, 4 0, 4 3, 0 3, 0 0)");
    Write("fine.wkt", "LINESTRING (0 0, 1.234567 0.05)");
  }

  RunResult Ended(Words words) const {
    for (std::string& word : words) {
      if (word[0] == '@') word = PathOf(word.substr(1));
    }
    return RunInProcess(words);
  }
};

TEST_F(ExitCodes, AreThoseOfTheHelp) {
  for (Case const& one : kCases) {
    RunResult const run = Ended(one.words);
    std::string line;
    for (std::string const& word : one.words) line += word + " ";
    EXPECT_EQ(static_cast<int>(run.code), one.code) << line << run.err;
    bool const isComplaint = one.code >= 2;
    if (isComplaint) {
      EXPECT_TRUE(run.err.starts_with("contour: ")) << line << run.err;
      EXPECT_EQ(run.out, "") << line;
    }
  }
}

/// The codes that the help of a command lists.
std::set<int> ListedBy(std::string const& command) {
  std::istringstream lines(RunInProcess({command, "--help"}).out);
  std::set<int> codes;
  bool isList = false;
  for (std::string line; std::getline(lines, line);) {
    if (line.ends_with("Exit codes:")) {
      isList = true;
    } else if (isList && line.empty()) {
      break;
    } else if (isList && line.size() > 2 && line[2] >= '0' && line[2] <= '9') {
      codes.insert(std::stoi(line));
    }
  }
  return codes;
}

TEST_F(ExitCodes, EveryListedOneIsReachedAndNoOther) {
  for (std::string const command :
       {"fit", "check", "info", "plot", "area", "intersect", "convert", "simplify"}) {
    std::set<int> reached;
    for (Case const& one : kCases) {
      if (one.words[0] == command) reached.insert(one.code);
    }
    // Faults of the program itself and interruptions have tests of their own.
    reached.insert({70, 130});
    EXPECT_EQ(ListedBy(command), reached) << command;
  }
}

TEST_F(ExitCodes, OfTheProgramItself) {
  EXPECT_EQ(RunInProcess({"--help"}).code, ExitCode::Ok);
  EXPECT_EQ(RunInProcess({"--version"}).code, ExitCode::Ok);
  EXPECT_EQ(RunInProcess({}).code, ExitCode::Usage);
  EXPECT_EQ(RunInProcess({"--colour"}).code, ExitCode::Usage);
  EXPECT_EQ(RunInProcess({"bend"}).code, ExitCode::Usage);
  EXPECT_EQ(RunInProcess({"fit", "info", "-t", "1"}).code, ExitCode::File) << "a file named info";
}

/// A stream that fails after so many bytes.
class FailingBuffer : public std::streambuf {
 protected:
  int_type overflow(int_type) override { return traits_type::eof(); }
};

TEST_F(ExitCodes, OutputThatCannotBeWrittenIsAFileThatFails) {
  FailingBuffer buffer;
  std::ostream out(&buffer);
  std::istringstream in;
  std::ostringstream err;
  std::array const line = {"contour", "--version"};
  EXPECT_EQ(RunProgram(2, line.data(), in, out, err), ExitCode::File);
  EXPECT_EQ(err.str(), "contour: standard output: cannot be written\n");
}

/// A stream that has no memory, and one that fails in a way of its own.
template <typename Fault>
class ThrowingBuffer : public std::streambuf {
 protected:
  int_type underflow() override { throw Fault(); }
};

struct Unforeseen : std::exception {
  char const* what() const noexcept override { return "the unforeseen"; }
};

template <typename Fault>
RunResult RunWithThrowingInput() {
  ThrowingBuffer<Fault> buffer;
  std::istream in(&buffer);
  in.exceptions(std::ios::badbit);
  std::ostringstream out;
  std::ostringstream err;
  std::array const line = {"contour", "info", "-"};
  RunResult result;
  result.code = RunProgram(3, line.data(), in, out, err);
  result.out = out.str();
  result.err = err.str();
  return result;
}

TEST_F(ExitCodes, SeventyIsForFaultsOfTheProgram) {
  RunResult const memory = RunWithThrowingInput<std::bad_alloc>();
  EXPECT_EQ(memory.code, ExitCode::Internal);
  EXPECT_EQ(memory.err, "contour: the memory does not suffice\n");
  RunResult const other = RunWithThrowingInput<Unforeseen>();
  EXPECT_EQ(other.code, ExitCode::Internal);
  EXPECT_EQ(other.err, "contour: internal error: the unforeseen\n");
  EXPECT_EQ(other.out, "");
}

}  // namespace
}  // namespace Vorn::Cli::Testing
