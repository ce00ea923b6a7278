#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

#include "cli/RunInProcess.h"
#include "io/FormatContours.h"
#include "io/formats/CsvPieces.h"
#include "io/formats/JsonPieces.h"
#include "vorn/io/Formats.h"

namespace Vorn::Cli {
namespace {

using namespace FormatContours;

/// A folder that goes away after the test.
class Convert : public testing::Test {
 protected:
  Convert() {
    std::string name = (std::filesystem::temp_directory_path() / "convert-XXXXXX").string();
    folder_ = mkdtemp(name.data());
  }
  ~Convert() override { std::filesystem::remove_all(folder_); }

  std::string Path(std::string const& name) const { return folder_ + "/" + name; }

  std::string Contents(std::string const& name) const {
    std::ifstream file(Path(name), std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
  }

  void Write(std::string const& name, std::string const& text) const {
    std::ofstream(Path(name), std::ios::binary) << text;
  }

  std::string folder_;
};

WriteOptions WithFeed(double feed, std::optional<int> decimals) {
  WriteOptions options;
  options.gcode.feed = feed;
  options.gcode.decimals = decimals;
  return options;
}

TEST_F(Convert, WritesSeveralFilesAndSaysWhatTheyHold) {
  Write("p.json", ToJson(Wedge()));
  RunResult const result = RunInProcess(
      {"convert", Path("p.json"), "-o", Path("p.csv"), "--output", Path("p.nc"), "--feed", "600"});
  EXPECT_EQ(result.code, ExitCode::Ok);
  EXPECT_EQ(result.err, "");
  EXPECT_EQ(result.out, "pieces      3 pieces: 2 lines, 1 arc; closed\nwrote       " +
                            Path("p.csv") + "\nwrote       " + Path("p.nc") + "\n");
  EXPECT_EQ(Contents("p.csv"), ToCsv(Wedge()));
  EXPECT_EQ(Contents("p.nc"), ToText(Wedge(), Format::GCode, WithFeed(600.0, {})));
}

TEST_F(Convert, EveryFormatToEveryFormatKeepsTheContour) {
  std::vector<std::string> const endings = {"json", "csv", "dxf", "gcode", "wkt"};
  for (std::string const& from : endings) {
    Write("p." + from, ToText(Wedge(), *FormatNamed(from), {}));
    for (std::string const& to : endings) {
      RunResult const result =
          RunInProcess({"convert", Path("p." + from), "-o", Path("q." + to), "--units", "mm"});
      EXPECT_EQ(result.code, ExitCode::Ok) << from << " to " << to << ": " << result.err;
      ContourFile const read = ParseContour(Contents("q." + to), "q." + to);
      EXPECT_EQ(read.pieces.size(), 3u) << from << " to " << to;
      EXPECT_TRUE(read.isClosed) << from << " to " << to;
      EXPECT_LE(Apart(Wedge().pieces, read.pieces), 1e-14) << from << " to " << to;
    }
  }
}

TEST(ConvertCommand, StandardInputAndOutputHoldNothingElse) {
  RunResult const result =
      RunInProcess({"convert", "-", "-o", "-", "--to", "csv"}, ToJson(Wedge()));
  EXPECT_EQ(result.code, ExitCode::Ok);
  EXPECT_EQ(result.out, ToCsv(Wedge()));
  EXPECT_EQ(result.err, "");
}

TEST(ConvertCommand, TheInputFormatMayBeTold) {
  std::string const ambiguous = "G0 X0 Y0\nG1 X1\n";
  std::vector<std::string> words = {"convert", "-", "-o", "-", "--to", "wkt", "--from", "gcode"};
  EXPECT_EQ(RunInProcess(words, ambiguous).out, "LINESTRING (0 0, 1 0)\n");
  words.back() = "csv";
  RunResult const result = RunInProcess(words, ambiguous);
  EXPECT_EQ(result.code, ExitCode::File);
  EXPECT_EQ(result.err, "contour: standard input:1: the header has no column 'type': 'G0 X0 Y0'\n");
}

TEST_F(Convert, DrawingsShowThePiecesAndNoPointThatNobodyMeasured) {
  Write("p.json", ToJson(Wedge()));
  RunResult const result = RunInProcess(
      {"convert", Path("p.json"), "-o", Path("p.svg"), "-o", Path("p.png"), "-o", Path("p.html")});
  ASSERT_EQ(result.code, ExitCode::Ok) << result.err;
  std::string const svg = Contents("p.svg");
  for (char const* shown :
       {"class=\"pieces\"", "class=\"joints\"", "2 lines and 1 arc", "p.json"}) {
    EXPECT_NE(svg.find(shown), std::string::npos) << shown;
  }
  for (char const* absent :
       {"class=\"points", "class=\"worst", "class=\"whiskers", "deviation", "point", "nan"}) {
    EXPECT_EQ(svg.find(absent), std::string::npos) << absent;
  }
  EXPECT_EQ(Contents("p.png").substr(1, 3), "PNG");
  EXPECT_GT(Contents("p.png").size(), 5000u);
  std::string const html = Contents("p.html");
  EXPECT_NE(html.find("\"points\":{\"x\":[],\"y\":[],\"w\":null}"), std::string::npos);
  EXPECT_EQ(html.find("\"deviations\":"), std::string::npos);
}

TEST(ConvertCommand, ADrawingMayGoToTheStandardOutput) {
  RunResult const result =
      RunInProcess({"convert", "-", "-o", "-", "--to", "svg"}, ToJson(Wedge()));
  EXPECT_EQ(result.code, ExitCode::Ok);
  EXPECT_TRUE(result.out.starts_with("<?xml"));
  EXPECT_TRUE(result.out.ends_with("</svg>\n"));
  EXPECT_NE(result.out.find(">standard input<"), std::string::npos);
}

TEST(ConvertCommand, GapsAreReportedAndKept) {
  RunResult const result =
      RunInProcess({"convert", "-", "-o", "-", "--to", "csv"}, ToJson(WithGap()));
  EXPECT_EQ(result.code, ExitCode::Ok);
  EXPECT_EQ(result.err, "contour: standard input: pieces 1 and 2 do not meet: the gap is 0.5\n");
  EXPECT_EQ(result.out, ToCsv(WithGap()));
}

TEST(ConvertCommand, OptionsReachTheWriters) {
  auto const out = [](std::vector<std::string> words) {
    words.insert(words.begin(), {"convert", "-", "-o", "-"});
    return RunInProcess(words, ToJson(Wedge())).out;
  };
  WriteOptions entities;
  entities.dxfEntities = true;
  EXPECT_EQ(out({"--to", "dxf", "--dxf-entities"}), ToText(Wedge(), Format::Dxf, entities));
  EXPECT_EQ(out({"--to", "gcode", "--gcode-decimals", "2", "--feed", "1.5"}),
            ToText(Wedge(), Format::GCode, WithFeed(1.5, 2)));
  EXPECT_TRUE(out({"--to", "gcode", "--units", "inch"}).starts_with("G20\n"));
  EXPECT_TRUE(out({"--to", "csv", "--units", "ft"}).starts_with("# units ft\n"));
}

TEST(ConvertCommand, WrongUsageIsRefused) {
  auto const complaint = [](std::vector<std::string> words) {
    words.insert(words.begin(), "convert");
    RunResult const result = RunInProcess(words, ToJson(Wedge()));
    EXPECT_EQ(result.code, ExitCode::Usage);
    EXPECT_EQ(result.out, "");
    return result.err.substr(0, result.err.find('\n'));
  };
  EXPECT_EQ(complaint({"p.json"}), "contour: --output is required, or --to");
  EXPECT_EQ(complaint({"-", "-o", "-"}),
            "contour: the standard output: --to must say which format to write");
  EXPECT_EQ(complaint({"-", "-o", "p.txt"}), "contour: p.txt: --to must say which format to write");
  EXPECT_EQ(complaint({"p.csv", "-o", "p.csv"}),
            "contour: CONTOUR and --output name the same file: p.csv");
  EXPECT_EQ(complaint({"-", "-o", "-", "--to", "gcode", "--units", "m"}),
            "contour: standard input: G-code is in mm or inch, and the contour is in 'm'; see "
            "--units");
  for (std::vector<std::string> const& words :
       {std::vector<std::string>{"-", "-o", "-", "--to", "step"},
        {"-", "-o", "-", "--to", "gcode", "--feed", "0"},
        {"-", "-o", "-", "--to", "gcode", "--gcode-decimals", "13"}}) {
    EXPECT_NE(complaint(words), "") << words.back();
  }
}

TEST_F(Convert, WhatCannotBeReadOrWrittenChangesNothing) {
  Write("broken.json", "{");
  Write("q.csv", "kept");
  RunResult const broken = RunInProcess({"convert", Path("broken.json"), "-o", Path("q.csv")});
  EXPECT_EQ(broken.code, ExitCode::File);
  EXPECT_EQ(Contents("q.csv"), "kept");
  EXPECT_EQ(RunInProcess({"convert", Path("none.json"), "-o", Path("q.csv")}).code, ExitCode::File);
  Write("p.json", ToJson(Wedge()));
  RunResult const nowhere =
      RunInProcess({"convert", Path("p.json"), "-o", Path("q.csv"), "-o", Path("none/q.csv")});
  EXPECT_EQ(nowhere.code, ExitCode::File);
  EXPECT_EQ(Contents("q.csv"), "kept");
}

}  // namespace
}  // namespace Vorn::Cli
