// The program is ended from outside in the middle of writing.

#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>

#include "cli/faults/FaultFixture.h"

namespace Vorn::Cli::Testing {
namespace {

constexpr int kInterrupted = 130;

TEST_F(FaultyProgram, KilledBeforeItsLastByteLeavesEveryOldFile) {
  for (char const* call : {"write:kill", "fchmod:kill", "fsync:kill", "close:kill"}) {
    for (std::string const& file : Outputs()) {
      Ended const ended = RunWithFault(call, file);
      EXPECT_EQ(ended.code, kSignalled + SIGKILL) << call << " " << file;
      for (std::string const& name : Outputs()) {
        EXPECT_TRUE(IsOld(name)) << call << " " << file << ": " << name;
      }
      Restore();
    }
  }
}

TEST_F(FaultyProgram, KilledBetweenTwoNamesLeavesEveryFileWhole) {
  std::vector<std::string> const files = Outputs();
  for (std::size_t killed = 0; killed < files.size(); ++killed) {
    Ended const ended = RunWithFault("exchange:kill", files[killed]);
    EXPECT_EQ(ended.code, kSignalled + SIGKILL) << files[killed];
    for (std::size_t i = 0; i < files.size(); ++i) {
      EXPECT_TRUE(i < killed ? IsNew(files[i]) : IsOld(files[i])) << files[i];
    }
    Restore();
  }
}

TEST_F(FaultyProgram, KilledOnceWorksTheNextTime) {
  RunWithFault("fsync:kill", "b.dxf");
  Ended const ended = Run(Command());
  EXPECT_EQ(ended.code, 0) << ended.err;
  for (std::string const& name : Outputs()) EXPECT_TRUE(IsNew(name)) << name;
}

TEST_F(FaultyProgram, InterruptedInTheMiddleOfAFileLeavesAllAsTheyWere) {
  for (char const* call : {"write:int", "write:term", "write:hup", "fsync:int", "fchmod:term"}) {
    for (std::string const& file : Outputs()) {
      Ended const ended = RunWithFault(call, file);
      EXPECT_EQ(ended.code, kInterrupted) << call << " " << file;
      EXPECT_EQ(ended.out, "") << call << " " << file;
      ExpectAllOld(std::string(call) + " " + file);
    }
  }
}

TEST_F(FaultyProgram, InterruptedWhileItNamesTheFilesNamesAllOfThem) {
  for (std::string const& file : Outputs()) {
    Ended const ended = RunWithFault("exchange:slow", file);
    // The interruption waits for the names; whether the summary still comes is a matter of chance.
    EXPECT_TRUE(ended.code == kInterrupted || ended.code == 0) << ended.code;
    ExpectAllNew(file);
    Restore();
  }
}

TEST_F(FaultyProgram, InterruptedWhileItMakesAFileForgetsNone) {
  for (std::string const& file : Outputs()) {
    Ended const ended = RunWithFault("mkstemp:slow", file);
    EXPECT_TRUE(ended.code == kInterrupted || ended.code == 0) << ended.code;
    if (IsNew("a.json")) {
      ExpectAllNew(file);
    } else {
      ExpectAllOld(file);
    }
    Restore();
  }
}

TEST_F(FaultyProgram, WhoseInterruptionsAreIgnoredGoesOn) {
  // As under nohup: what the one who started it ignores stays ignored.
  Ended const ended =
      Run(Command(), std::string("trap '' INT; LD_PRELOAD='") + CONTOUR_FAULTY_CALLS +
                         "' CONTOUR_FAULT=exchange:slow CONTOUR_FAULT_FILE=a.json");
  EXPECT_EQ(ended.code, 0) << ended.err;
  ExpectAllNew("ignored");
}

/// Runs the program in the folder, its standard output a pipe that nobody reads.
int RunWithoutReader(fs::path const& folder, std::vector<std::string> words) {
  int ends[2] = {-1, -1};
  if (pipe(ends) != 0) return -1;
  close(ends[0]);
  pid_t const child = fork();
  if (child == 0) {
    std::signal(SIGPIPE, SIG_DFL);
    dup2(ends[1], STDOUT_FILENO);
    dup2(open("/dev/null", O_WRONLY), STDERR_FILENO);
    if (chdir(folder.c_str()) != 0) _exit(99);
    std::vector<char*> arguments = {const_cast<char*>(CONTOUR_PROGRAM)};
    for (std::string& word : words) arguments.push_back(word.data());
    arguments.push_back(nullptr);
    execv(CONTOUR_PROGRAM, arguments.data());
    _exit(99);
  }
  close(ends[1]);
  int status = 0;
  waitpid(child, &status, 0);
  return WIFEXITED(status) ? WEXITSTATUS(status) : kSignalled + WTERMSIG(status);
}

TEST_F(FaultyProgram, WithoutAReaderOfItsOutputHasWrittenItsFiles) {
  EXPECT_EQ(RunWithoutReader(folder_, {"fit", "p.csv", "-t", "0.01", "-o", "a.json", "-o", "b.dxf",
                                       "-o", "c.svg"}),
            kSignalled + SIGPIPE);
  ExpectAllNew("the table could not be printed");
}

TEST_F(FaultyProgram, WithoutAReaderOfOneResultHasWrittenTheOthers) {
  EXPECT_EQ(RunWithoutReader(folder_, {"fit", "p.csv", "-t", "0.01", "-o", "-", "--to", "json",
                                       "-o", "b.dxf", "-o", "c.svg", "-o", "a.json"}),
            kSignalled + SIGPIPE);
  ExpectAllNew("one result went into a pipe");
}

TEST_F(FaultyProgram, WithoutAReaderOfManyLinesLeavesNoHalfFile) {
  Write("q.csv", Corner());
  int const code = RunWithoutReader(
      folder_, {"fit", "p.csv", "q.csv", "-t", "0.01", "--out-dir", "out", "--to", "json,dxf"});
  EXPECT_EQ(code, kSignalled + SIGPIPE);
  for (auto const& entry : fs::directory_iterator(folder_ / "out")) {
    std::string const ending = entry.path().extension().string();
    EXPECT_TRUE(ending == ".json" || ending == ".dxf") << entry.path();
  }
}

}  // namespace
}  // namespace Vorn::Cli::Testing
