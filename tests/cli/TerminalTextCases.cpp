// What reaches the terminal, and where results may go.
#include <sys/stat.h>

#include <nlohmann/json.hpp>

#include "cli/ProgramFixture.h"
#include "support/Sanitizer.h"

namespace Vorn::Cli::Testing {
namespace {

constexpr char const* kSign = "\xEF\xBF\xBD";

bool HasControl(std::string const& text) {
  return std::any_of(text.begin(), text.end(),
                     [](char c) { return (c >= 0 && c < ' ' && c != '\n') || c == '\x7f'; });
}

// What makes a command of the shell fail once it holds more memory. The address sanitizer reserves
// terabytes of address space beforehand and has a limit of its own.
std::string MemoryLimit(int megabytes) {
  if (Vorn::Testing::kIsSanitized) {
    return "ASAN_OPTIONS=$ASAN_OPTIONS:hard_rss_limit_mb=" + std::to_string(megabytes) + " ";
  }
  return "ulimit -v " + std::to_string(megabytes * 1000) + ";";
}

// Each as a single line, or lines, of a point in a few bytes, a little above what 1 GiB holds.
TEST_F(Program, LargeContoursAreRefusedInLittleMemory) {
  struct Large {
    char const* name;
    char const* head;
    char const* unit;
    char const* format;
    std::size_t units;
  };
  for (Large const& large :
       {Large{"a.json", "{\"schemaVersion\":1,\"elements\":[", "{},", "json", 8300000},
        Large{"a.geojson", "{\"type\":\"LineString\",\"coordinates\":[", "[0,1],[1,0],", "geojson",
              1390000},
        Large{"a.wkt", "LINESTRING (", "0 1,1 0,", "wkt", 1710000},
        Large{"a.nc", "G1 X0 Y0\nG1 ", "X1 Y1\nX0\n", "gcode", 1710000}}) {
    std::string text = large.head;
    for (std::size_t i = 0; i < large.units; ++i) text += large.unit;
    Write(large.name, text);
    std::string const wanted = "is too large: to read this " + std::string(large.format) +
                               " would take more than 1 GiB of memory";
    for (std::string const& line :
         {"area " + std::string(large.name), "info " + std::string(large.name)}) {
      Ended const ended = Run(line, MemoryLimit(400));
      EXPECT_EQ(ended.code, 3) << line;
      EXPECT_NE(ended.err.find(wanted), std::string::npos) << ended.err;
    }
  }
}

TEST_F(Program, HelpHasNoLineOfMoreThanAHundredColumns) {
  for (char const* command :
       {"", "fit", "check", "convert", "plot", "info", "simplify", "area", "intersect"}) {
    std::istringstream help(Run(std::string(command) + " --help").out);
    std::size_t lines = 0;
    for (std::string line; std::getline(help, line); ++lines) {
      EXPECT_LE(line.size(), 100U) << command << ": " << line;
      bool const isOptionText = line.starts_with(std::string(30, ' '));
      EXPECT_TRUE(!isOptionText || line.size() <= 80U) << command << ": " << line;
    }
    EXPECT_GT(lines, 10U) << command;
  }
}

TEST_F(Program, NamesThatAreNoUtf8AreShownWithTheUsualSign) {
  std::string const name = "p\xff.csv";
  Write(name, Corner());
  Ended const ended = Run(
      "fit 'p\xff.csv' -t 0.01 -o a.svg -o a.png -o a.html -o a.json -o a.dxf -o a.nc --feed 1");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_EQ(ended.out.find("p" + std::string(kSign) + ".csv,"), 0u) << ended.out;
  for (char const* file : {"a.svg", "a.html", "a.json", "a.dxf", "a.nc"}) {
    EXPECT_EQ(Contents(folder_ / file).find('\xff'), std::string::npos) << file;
  }
  EXPECT_NE(Contents(folder_ / "a.svg").find("p" + std::string(kSign) + ".csv"), std::string::npos);
  EXPECT_TRUE(nlohmann::json::accept(Contents(folder_ / "a.json")));
}

TEST_F(Program, ControlCharactersReachNeitherTerminalNorDrawing) {
  std::string const name = "p\x1b[31m\x01.csv";
  Write(name, "# units m\x1b[1m\n" + Corner());
  Ended const good = Run("fit '" + name + "' -t 0.01 --units 'm\x1b[2m' -o a.svg");
  EXPECT_EQ(good.code, 0) << good.err;
  EXPECT_FALSE(HasControl(good.out)) << good.out;
  EXPECT_FALSE(HasControl(Contents(folder_ / "a.svg")));
  for (std::string const& line : std::vector<std::string>{
           "info '" + name + "'", "fit '" + name + "'", "check '" + name + "' none\x1b[3m.json",
           "fit '" + name + "' 'none\x1b[4m.csv' -t 1", "fit 'none\x1b[4m.csv' -t 1",
           "fti\x1b[5m"}) {
    Ended const ended = Run(line);
    EXPECT_FALSE(HasControl(ended.out)) << ended.out;
    EXPECT_FALSE(HasControl(ended.err)) << ended.err;
  }
}

TEST_F(Program, AMisspeltCommandIsNamedWithTheNearestOne) {
  auto const firstLine = [this](std::string const& arguments) {
    Ended const ended = Run(arguments);
    EXPECT_EQ(ended.code, 2) << arguments;
    return ended.err.substr(0, ended.err.find('\n'));
  };
  EXPECT_EQ(firstLine("fti p.csv"), "contour: there is no command 'fti'; did you mean 'fit'?");
  EXPECT_EQ(firstLine("convrt"), "contour: there is no command 'convrt'; did you mean 'convert'?");
  EXPECT_EQ(firstLine("p.csv"), "contour: there is no command 'p.csv'");
}

TEST_F(Program, AFormatWithoutAFileGoesToTheStandardOutput) {
  Write("p.csv", Corner());
  Ended const fit = Run("fit p.csv -t 0.01 --to json");
  EXPECT_EQ(fit.code, 0) << fit.err;
  EXPECT_EQ(nlohmann::json::parse(fit.out).at("elements").size(), 2u);
  Write("p.wkt", "LINESTRING (0 0, 1 0)\n");
  EXPECT_EQ(Run("convert p.wkt --to wkt").out, "LINESTRING (0 0, 1 0)\n");
  EXPECT_EQ(Run("plot p.csv --to svg").out.substr(0, 5), "<?xml");
}

TEST_F(Program, DevicesAndPipesAreWritten) {
  Write("p.csv", Corner());
  Ended const null = Run("fit p.csv -t 0.01 --to json -o /dev/null");
  EXPECT_EQ(null.code, 0) << null.err;
  ASSERT_EQ(mkfifo((folder_ / "pipe").c_str(), 0600), 0);
  Ended const pipe = Run("fit p.csv -t 0.01 --to json -o pipe",
                         "(timeout 20 cat pipe >read.json 2>&1 &); timeout 20");
  EXPECT_EQ(pipe.code, 0) << pipe.err;
  Run("--version", "sleep 0.3;");
  EXPECT_TRUE(nlohmann::json::accept(Contents(folder_ / "read.json")));
}

TEST_F(Program, ALinkToNothingIsRefusedAsALink) {
  Write("p.csv", Corner());
  fs::create_symlink("nowhere/a.json", folder_ / "a.json");
  ExpectRefusal("fit p.csv -t 0.01 -o a.json", 3,
                "a.json: cannot be written: is a link to nowhere/a.json, which is not there");
  EXPECT_TRUE(fs::is_symlink(folder_ / "a.json"));
}

TEST_F(Program, AnAbsurdToleranceGivesShortNumbers) {
  Write("p.csv", "0,0\n1,0.1\n2,0\n3,0.2\n4,0\n5,0.3\n6,0.1\n");
  for (char const* line : {"fit p.csv -t 1e-300", "fit p.csv -t 1e-300 -o a.nc --feed 1"}) {
    Ended const ended = Run(line);
    EXPECT_EQ(ended.out.find(std::string(40, '0')), std::string::npos) << ended.out;
  }
  ASSERT_EQ(Run("fit p.csv -t 0.2 -o a.json").code, 0);
  std::string const out = Run("check p.csv a.json -t 1e-300").out;
  std::istringstream lines(out);
  for (std::string line; std::getline(lines, line);) EXPECT_LT(line.size(), 200u) << line;
}

TEST_F(Program, InputsWithoutEndEndInAMessage) {
  Ended const zero = Run("info /dev/zero", MemoryLimit(8000));
  EXPECT_EQ(zero.code, 3);
  EXPECT_EQ(zero.err, "contour: /dev/zero: is not text: byte 0 is zero\n");
  ASSERT_EQ(mkfifo((folder_ / "pipe").c_str(), 0600), 0);
  Ended const endless = Run("info -", "(yes 1,2 >pipe 2>&1 &);", "pipe");
  EXPECT_EQ(endless.code, 3);
  EXPECT_EQ(endless.err, "contour: standard input: is too large: more than 512 MiB\n");
}

TEST_F(Program, AnEndlessLineIsRefusedBeforeItIsRead) {
  // The program needs some 60 MB for itself, and 64 MiB while it looks.
  ASSERT_EQ(mkfifo((folder_ / "pipe").c_str(), 0600), 0);
  Ended const piped = Run(
      "info -",
      "(head -c 400000000 /dev/zero | tr '\\0' 1 >pipe 2>/dev/null &);" + MemoryLimit(300), "pipe");
  Ended const filed = Run("info long.csv",
                          "head -c 400000000 /dev/zero | tr '\\0' 1 >long.csv;" + MemoryLimit(300));
  fs::remove(folder_ / "long.csv");
  for (Ended const& ended : {piped, filed}) {
    EXPECT_EQ(ended.code, 3);
    EXPECT_NE(ended.err.find(":1: the line is longer than 16 MiB"), std::string::npos) << ended.err;
  }
}

TEST_F(Program, AnEndlessLineBehindOthersIsRefusedBeforeItIsRead) {
  struct {
    char const* file;
    char const* lines;
    char const* command;
  } const cases[] = {
      {"table.csv", "x,y\\n1,2\\n", "info"},
      {"pieces.csv", "type,start_x,start_y,end_x,end_y\\nline,0,0,1,1\\n", "area"},
      {"path.nc", "G21\\nG0 X0 Y0\\n", "area"},
      {"drawing.dxf", "0\\nSECTION\\n", "area"},
  };
  for (auto const& [file, lines, command] : cases) {
    Ended const ended =
        Run(std::string(command) + " " + file,
            "(printf '" + std::string(lines) + "'; head -c 400000000 /dev/zero | tr '\\0' 1) >" +
                file + ";" + MemoryLimit(300));
    fs::remove(folder_ / file);
    EXPECT_EQ(ended.code, 3) << file;
    EXPECT_NE(ended.err.find(std::string(file) + ":3: the line is longer than 16 MiB"),
              std::string::npos)
        << ended.err;
  }
}

}  // namespace
}  // namespace Vorn::Cli::Testing
