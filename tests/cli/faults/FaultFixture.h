#pragma once

#include <map>
#include <string>
#include <vector>

#include "cli/ProgramFixture.h"

namespace Vorn::Cli::Testing {

/// Runs the program with a call of the system that goes wrong (FaultyCalls.cpp) while it replaces
/// three old files by three new ones.
class FaultyProgram : public Program {
 protected:
  FaultyProgram() {
    Write("p.csv", Corner());
    Ended const ended = Run(Command());
    EXPECT_EQ(ended.code, 0) << ended.err;
    for (std::string const& name : Outputs()) new_[name] = Contents(folder_ / name);
    Restore();
  }

  static std::vector<std::string> Outputs() { return {"a.json", "b.dxf", "c.svg"}; }

  static std::string Command() { return "fit p.csv -t 0.01 -o a.json -o b.dxf -o c.svg"; }

  /// @param fault which call and what happens there, such as "write:full"
  /// @param file how the name of the file begins that it concerns; empty for any
  Ended RunWithFault(std::string const& fault, std::string const& file,
                     std::string const& arguments = Command()) const {
    std::string const log = (folder_ / ".faults").string();
    std::string const before = std::string("LD_PRELOAD='") + CONTOUR_FAULTY_CALLS +
                               "' CONTOUR_FAULT=" + fault + " CONTOUR_FAULT_FILE=" + file +
                               " CONTOUR_FAULT_LOG='" + log + "'";
    Ended const ended = Run(arguments, before);
    EXPECT_NE(Contents(log), "") << fault << " " << file << ": never got there";
    fs::remove(log);
    return ended;
  }

  bool IsOld(std::string const& name) const { return Contents(folder_ / name) == "old " + name; }
  bool IsNew(std::string const& name) const { return Contents(folder_ / name) == new_.at(name); }

  void ExpectAllOld(std::string const& what) const {
    for (std::string const& name : Outputs()) EXPECT_TRUE(IsOld(name)) << what << ": " << name;
    ExpectNothingElse(what);
  }

  void ExpectAllNew(std::string const& what) const {
    for (std::string const& name : Outputs()) EXPECT_TRUE(IsNew(name)) << what << ": " << name;
    ExpectNothingElse(what);
  }

  void ExpectNothingElse(std::string const& what) const {
    EXPECT_EQ(Files(), (std::vector<std::string>{"a.json", "b.dxf", "c.svg", "p.csv"})) << what;
  }

  /// Puts the old files back and takes away what a killed program left.
  void Restore() const {
    for (std::string const& name : Files()) {
      if (name != "p.csv") fs::remove_all(folder_ / name);
    }
    for (std::string const& name : Outputs()) Write(name, "old " + name);
  }

 private:
  std::map<std::string, std::string> new_;
};

}  // namespace Vorn::Cli::Testing
