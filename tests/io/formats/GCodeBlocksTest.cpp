#include <gtest/gtest.h>

#include "io/FormatContours.h"
#include "io/formats/GCodeBlocks.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;

GCodeBlock Read(std::string_view line) { return ReadGCodeBlock(line, 12, "p.nc"); }

std::string Complaint(std::string const& line) {
  return Refusal([&] { Read(line); });
}

/// The codes as they stand: "G1 M3".
std::string Codes(GCodeBlock const& block) {
  std::string codes;
  for (GCodeWord const& word : block.codes) {
    codes += (codes.empty() ? "" : " ") + std::string(word.text);
  }
  return codes;
}

TEST(ReadGCodeBlock, SortsWordsByTheirLetters) {
  GCodeBlock const block = Read("N10 G1 X1.5 Y-2 F300");
  EXPECT_EQ(Codes(block), "G1");
  EXPECT_EQ(block['N'], 10.0);
  EXPECT_EQ(block['X'], 1.5);
  EXPECT_EQ(block['Y'], -2.0);
  EXPECT_EQ(block['F'], 300.0);
  EXPECT_FALSE(block['Z']);
}

TEST(ReadGCodeBlock, BlanksAndCaseDoNotMatter) {
  for (char const* line : {"G1X1Y2", "g1 x1 y2", " G 1\tX 1  Y 2 ", "g1x+1.y2.0"}) {
    GCodeBlock const block = Read(line);
    ASSERT_EQ(block.codes.size(), 1u) << line;
    EXPECT_EQ(block.codes[0].letter, 'G') << line;
    EXPECT_EQ(block.codes[0].value, 1.0) << line;
    EXPECT_EQ(block['X'], 1.0) << line;
    EXPECT_EQ(block['Y'], 2.0) << line;
  }
}

TEST(ReadGCodeBlock, GAndMMayBeRepeatedAndNothingElse) {
  EXPECT_EQ(Codes(Read("G17 G90 G91.1 M3 M8")), "G17 G90 G91.1 M3 M8");
  EXPECT_EQ(Complaint("X1 Y2 X3"), "p.nc:12: 'X3' is the second such word in its line");
  EXPECT_EQ(Complaint("G1 F1 f2"), "p.nc:12: 'f2' is the second such word in its line");
}

TEST(ReadGCodeBlock, CommentsAreNoWords) {
  EXPECT_EQ(Codes(Read("(X9) G1 (in between) X1 ; X2 ( G3")), "G1");
  EXPECT_EQ(Read("(X9) G1 (in between) X1 ; X2 ( G3")['X'], 1.0);
  for (char const* line : {"", "   ", "; all of it", "(one)(two)", "%", " % \r"}) {
    GCodeBlock const block = Read(line);
    EXPECT_TRUE(block.codes.empty()) << line;
  }
  EXPECT_EQ(Complaint("G1 (no end"), "p.nc:12: '(no end' is a comment without end");
}

TEST(ReadGCodeBlock, WhatIsNoWordIsRefused) {
  EXPECT_EQ(Complaint("G1 X"), "p.nc:12: 'X' is no word of G-code");
  EXPECT_EQ(Complaint("G1 XY2"), "p.nc:12: 'XY2' is no word of G-code");
  EXPECT_EQ(Complaint("#100=3"), "p.nc:12: '#100=3' is no word of G-code");
  EXPECT_EQ(Complaint("X1.2.3"), "p.nc:12: 'X1.2.3' is no word of G-code");
  EXPECT_EQ(Complaint("X--1"), "p.nc:12: 'X--1' is no word of G-code");
  EXPECT_EQ(Complaint("X1%"), "p.nc:12: '%' is no word of G-code");
  EXPECT_EQ(Complaint("X[1+2]"), "p.nc:12: 'X[1+2]' is no word of G-code");
}

TEST(ReadGCodeBlock, LettersThatMeanMotionsOfOtherKindsAreNotSupported) {
  for (char const letter : {'A', 'B', 'C', 'E', 'U', 'V', 'W'}) {
    std::string const word = std::string(1, letter) + "5";
    EXPECT_EQ(Complaint("G1 " + word), "p.nc:12: '" + word + "' is not supported");
  }
}

TEST(ReadGCodeBlock, NumbersEndWhereCoordinatesDo) {
  EXPECT_EQ(Read("X" + std::string(150, '9'))['X'], 1e150);
  std::string const huge = "X1" + std::string(151, '0');
  EXPECT_NE(Complaint(huge).find("is too large"), std::string::npos);
}

TEST(ReadGCodeBlock, AnExponentIsNoPartOfANumber) {
  // E is a letter of its own in G-code.
  EXPECT_EQ(Complaint("X1E3"), "p.nc:12: 'E3' is not supported");
}

}  // namespace
}  // namespace Vorn::IO
