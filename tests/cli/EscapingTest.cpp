// Texts that come from outside (names of files, units, fields, names of columns) reach no reader as
// anything but text: neither as markup, nor as commands of a terminal, nor as lines of their own.

#include <gtest/gtest.h>

#include <nlohmann/json.hpp>
#include <sstream>
#include <string>
#include <vector>

#include "cli/ProgramFixture.h"

namespace Vorn::Cli::Testing {
namespace {

constexpr char const* kMarkup = "<script>alert(1)</script>&amp;\"'";
constexpr char const* kEscape = "\x1b]0;owned\x07\x1b[31m\x9b\x7f";
constexpr char const* kLines = "1\nG0 X99\r\n  0\nSECTION";

/// Every byte that a terminal would not print, but for the line break; and the two-byte forms of
/// the control characters above ASCII.
bool HasControl(std::string const& text) {
  for (std::size_t i = 0; i < text.size(); ++i) {
    auto const byte = static_cast<unsigned char>(text[i]);
    if ((byte < 0x20 && byte != '\n') || byte == 0x7f) return true;
    bool const isSecond = i > 0 && static_cast<unsigned char>(text[i - 1]) == 0xC2;
    if (isSecond && byte < 0xA0) return true;
  }
  return false;
}

std::string Quote(std::string const& text) {
  std::string quoted = "'";
  for (char const c : text) quoted += c == '\'' ? std::string("'\\''") : std::string(1, c);
  return quoted + "'";
}

class Escaping : public Program {
 protected:
  /// Fits a file of this name, with the text as units and as field, into every format.
  void FitWith(std::string const& text) const {
    std::string name = text;
    for (char& c : name) {
      if (c == '/') c = '|';
    }
    Write(name, Corner());
    std::string const fit =
        "fit " + Quote(name) + " -t 0.01 --strategy mixed --field part=" + Quote(text);
    Write("head.txt", "(name {name})\n");
    // Tool paths know two units only, so their name alone carries the text there.
    for (std::string const& line : {fit + " --feed 1 --header head.txt -o a.nc",
                                    fit + " --units " + Quote(text) +
                                        " -o a.svg -o a.html -o a.json -o a.dxf -o a.wkt "
                                        "-o a.csv -o a.geojson"}) {
      Ended const ended = Run(line);
      EXPECT_EQ(ended.code, 0) << ended.err;
      EXPECT_FALSE(HasControl(ended.out)) << ended.out;
      EXPECT_FALSE(HasControl(ended.err)) << ended.err;
    }
  }

  std::string Fitted(std::string const& name) const { return Contents(folder_ / name); }
};

TEST_F(Escaping, MarkupStaysText) {
  FitWith(kMarkup);
  std::string const page = Fitted("a.html");
  EXPECT_EQ(page.find("<script>alert"), std::string::npos);
  EXPECT_NE(page.find("&lt;script&gt;alert(1)"), std::string::npos);
  std::string const drawing = Fitted("a.svg");
  EXPECT_EQ(drawing.find("<script"), std::string::npos);
  EXPECT_NE(drawing.find("&lt;script&gt;alert(1)"), std::string::npos);
  EXPECT_NE(drawing.find("&amp;amp;&quot;"), std::string::npos) << "what looks escaped is text too";
}

TEST_F(Escaping, DataOfThePageCannotEndItsScript) {
  FitWith(kMarkup);
  std::string const page = Fitted("a.html");
  std::size_t open = 0;
  std::size_t closed = 0;
  for (std::size_t at = 0; (at = page.find("<script", at)) != std::string::npos; ++at) ++open;
  for (std::size_t at = 0; (at = page.find("</script", at)) != std::string::npos; ++at) ++closed;
  EXPECT_EQ(open, closed) << "each end belongs to a script of the page itself";
}

TEST_F(Escaping, CommandsOfTheTerminalReachNoFile) {
  FitWith(kEscape);
  for (char const* name : {"a.svg", "a.html", "a.dxf", "a.nc", "a.wkt", "a.csv"}) {
    EXPECT_EQ(Fitted(name).find('\x1b'), std::string::npos) << name;
    EXPECT_EQ(Fitted(name).find('\x07'), std::string::npos) << name;
    EXPECT_EQ(Fitted(name).find('\x7f'), std::string::npos) << name;
  }
  auto const json = nlohmann::json::parse(Fitted("a.json"));
  EXPECT_EQ(json.at("elements").size(), 2u);
}

TEST_F(Escaping, LineBreaksBeginNoLineOfAFile) {
  FitWith("0 0");
  std::vector<std::size_t> counts;
  auto const linesOf = [this](char const* name) {
    std::string const text = Fitted(name);
    return std::count(text.begin(), text.end(), '\n');
  };
  for (char const* name : {"a.dxf", "a.nc", "a.csv", "a.wkt"}) {
    counts.push_back(static_cast<std::size_t>(linesOf(name)));
  }
  FitWith(kLines);
  std::size_t i = 0;
  for (char const* name : {"a.dxf", "a.nc", "a.csv", "a.wkt"}) {
    EXPECT_EQ(static_cast<std::size_t>(linesOf(name)), counts[i++]) << name << Fitted(name);
    EXPECT_EQ(Fitted(name).find("\nG0 X99"), std::string::npos) << name;
  }
  for (char const* name : {"a.dxf", "a.nc", "a.json", "a.csv"}) {
    Ended const area = Run(std::string("area --close ") + name);
    EXPECT_EQ(area.code, 0) << name << ": " << area.err;
    EXPECT_NE(area.out.find("area        50.01"), std::string::npos) << name << area.out;
  }
}

TEST_F(Escaping, CommentsOfToolPathsAreNotEndedByTheirText) {
  // A closing parenthesis would end the comment, and what follows it would be cut.
  FitWith("part) G0 X99 Y99 (");
  Ended const area = Run("area --close a.nc");
  EXPECT_EQ(area.code, 0) << area.err;
  EXPECT_NE(area.out.find("area        50.01"), std::string::npos) << area.out << Fitted("a.nc");
  EXPECT_NE(area.out.find("3 pieces, 3 lines"), std::string::npos) << area.out;
  EXPECT_EQ(Fitted("a.nc").rfind("(name part] G0 X99 Y99 [)\n", 0), 0u) << Fitted("a.nc");
}

TEST_F(Escaping, TextsOfTheInputReachMessagesWithoutTheirCommands) {
  std::string const escape = kEscape;
  Write("cell.csv", "x,y\n1,2\n3," + escape + "\n");
  Write("header.csv", "a" + escape + ",b,c\n1,2,3\n4,5,6\n");
  Write("units.csv", "# units " + escape + "\nx,y\n1,2\n3,4\n");
  Write("tolerance.csv", "x,y,w\n1,2," + escape + "\n3,4,1\n");
  Write("type.csv", "type,start_x,start_y,end_x,end_y\n" + escape + ",0,0,1,1\n");
  Write("word.wkt", escape + " (0 0)");
  Write("word.nc", "G21\nG1 X1" + escape + "\n");
  Write("kind.json", R"({"schemaVersion": 1, "elements": [{"kind": ")"
                     "\\u001b[31m\"}]}");
  Write("tag.svg", "<svg><path d=\"M0 0" + std::string("&#27;") + "\"/></svg>");
  Write("code.dxf", "0\nSECTION\n2\nENTITIES\n0\nLINE\n10\n" + escape + "\n");
  for (std::string const name : {"cell.csv", "header.csv", "units.csv", "tolerance.csv"}) {
    Ended const ended = Run("fit " + name);
    EXPECT_FALSE(HasControl(ended.out + ended.err)) << name << ended.out << ended.err;
    EXPECT_NE(ended.code, 0) << name;
    EXPECT_FALSE(HasControl(Run("info " + name).out)) << name;
  }
  for (std::string const name :
       {"type.csv", "word.wkt", "word.nc", "kind.json", "tag.svg", "code.dxf"}) {
    Ended const ended = Run("area " + name);
    EXPECT_EQ(ended.code, 3) << name << ended.out;
    EXPECT_NE(ended.err, "") << name;
    EXPECT_FALSE(HasControl(ended.out + ended.err)) << name << ended.err;
  }
}

TEST_F(Escaping, WordsOfTheCommandLineReachMessagesWithoutTheirCommands) {
  Write("p.csv", Corner());
  std::string const word = Quote(kEscape);
  for (std::string const& line : std::vector<std::string>{
           word, "fit " + word, "fit p.csv -t " + word, "fit p.csv --strategy " + word,
           "fit p.csv -t 1 -o " + word, "fit p.csv -t 1 --to " + word, "fit p.csv --field " + word,
           "fit p.csv --columns " + word, "fit p.csv --tolerance-column " + word,
           "fit p.csv -t 1 --out-dir p.csv/" + word, "fit p.csv p.csv --summary " + word,
           "plot p.csv -t 1 -o " + word, "convert " + word + " -o a.json", "--" + word}) {
    Ended const ended = Run(line);
    EXPECT_NE(ended.code, 0) << line;
    EXPECT_NE(ended.err, "") << line;
    EXPECT_FALSE(HasControl(ended.out + ended.err)) << ended.err;
  }
}

TEST_F(Escaping, TablesForSpreadsheetsQuoteTheirFields) {
  Write("a,\"b\".csv", Corner());
  Write("c.csv", Corner());
  Ended const ended = Run("fit 'a,\"b\".csv' c.csv -t 0.01 --summary s.csv");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_NE(Fitted("s.csv").find("\n\"a,\"\"b\"\".csv\",within tolerance,21,2,0,"),
            std::string::npos)
      << Fitted("s.csv");
}

}  // namespace
}  // namespace Vorn::Cli::Testing
