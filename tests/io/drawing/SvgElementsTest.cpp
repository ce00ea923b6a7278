#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>

#include "io/drawing/Decimation.h"
#include "io/drawing/SvgElements.h"

namespace Vorn::IO::Svg {
namespace {

std::size_t Count(std::string const& text, char wanted) {
  std::size_t count = 0;
  for (char const c : text) count += c == wanted ? 1 : 0;
  return count;
}

TEST(Px, HasTwoDecimalsAndNoneInVain) {
  EXPECT_EQ(Px(12.5), "12.5");
  EXPECT_EQ(Px(12.0), "12");
  EXPECT_EQ(Px(12.346), "12.35");
  EXPECT_EQ(Px(100.0), "100");
  EXPECT_EQ(Px(-0.001), "0");
  EXPECT_EQ(Px(Pixel{1.25, -3}), "1.25,-3");
}

TEST(Px, WhatIsNoPlaceIsWrittenAsZero) {
  for (double const value : {std::nan(""), std::numeric_limits<double>::infinity(),
                             -std::numeric_limits<double>::infinity()}) {
    EXPECT_EQ(Px(value), "0");
  }
}

TEST(Escaped, LeavesNoMarkupAndNoControlCharacters) {
  EXPECT_EQ(Escaped("a<b>&\"c\"\x01\n"), "a&lt;b&gt;&amp;&quot;c&quot;");
}

TEST(Escaped, EveryByteIsItselfOrAnEntityOrLeftOut) {
  for (int byte = 0; byte < 256; ++byte) {
    std::string const c(1, static_cast<char>(byte));
    std::string const escaped = Escaped(c);
    if (c == "&" || c == "<" || c == ">" || c == "\"") {
      EXPECT_TRUE(escaped.front() == '&' && escaped.back() == ';') << byte;
    } else if (byte < 32) {
      EXPECT_EQ(escaped, "") << byte;
    } else {
      EXPECT_EQ(escaped, c) << byte;
    }
  }
}

TEST(Text, StandsInItsElementEscaped) {
  EXPECT_EQ(Text({1, 2.5}, "class=\"a\"", "R < 3"),
            "<text x=\"1\" y=\"2.5\" class=\"a\">R &lt; 3</text>\n");
}

TEST(Elements, AreWrittenWithTheirPlaces) {
  EXPECT_EQ(LineElement({0, 1}, {2, 3}, "a=\"b\""),
            "<line x1=\"0\" y1=\"1\" x2=\"2\" y2=\"3\" a=\"b\"/>\n");
  EXPECT_EQ(CircleElement({1, 2}, 3.5, "c"), "<circle cx=\"1\" cy=\"2\" r=\"3.5\" c/>\n");
  EXPECT_EQ(RectElement({1, 2, 3, 4}, "d"), "<rect x=\"1\" y=\"2\" width=\"3\" height=\"4\" d/>\n");
  EXPECT_EQ(PathElement("M0 0", "e"), "<path d=\"M0 0\" e/>\n");
  EXPECT_EQ(PathElement("", "e"), "");
}

TEST(Dots, AreOneElementWithADotEach) {
  DotStyle style;
  style.name = "point";
  style.color = "#123456";
  style.isSquare = true;
  std::string const text = Dots({{1, 1}, {5, 5}, {9, 9}}, style);
  EXPECT_EQ(Count(text, 'M'), 3u);
  EXPECT_EQ(Count(text, '<'), 1u);
  EXPECT_NE(text.find("stroke-linecap=\"square\""), std::string::npos);
  EXPECT_NE(text.find("class=\"point\""), std::string::npos);
  EXPECT_EQ(Dots({}, style), "");
}

TEST(Dots, InOnePlaceAreDrawnOnce) {
  EXPECT_EQ(Count(Dots({{1.01, 1.01}, {1.02, 1.02}, {1.21, 1.01}}, {}), 'M'), 2u);
}

TEST(Dots, BeyondTheMostExactOnesCellsAreMerged) {
  std::vector<Pixel> column;
  for (std::size_t i = 0; i <= kMostExactDots; ++i) {
    column.push_back({10.2, 0.2 * static_cast<double>(i)});
  }
  EXPECT_EQ(Count(Dots(column, {}), 'M'), 1u) << "one streak";
  column.pop_back();
  EXPECT_EQ(Count(Dots(column, {}), 'M'), kMostExactDots) << "exact places";
}

TEST(OnePerCell, KeepsTheFirstMarkOfEachCell) {
  std::vector<Pixel> const at = {{0.1, 0.1}, {0.2, 0.2}, {1.1, 0.1}, {-0.1, 0.1}, {0.15, 0.1}};
  EXPECT_EQ(OnePerCell(at, 1.0), (std::vector<std::size_t>{0, 2, 3}));
}

TEST(OnePerCell, LeavesOutWhatIsNowhere) {
  double const nan = std::nan("");
  EXPECT_EQ(OnePerCell({{nan, 0}, {0, HUGE_VAL}, {1e300, 0}, {5, 5}}, 1.0),
            (std::vector<std::size_t>{3}));
}

TEST(StreaksOf, JoinsCellsOneAboveTheOther) {
  std::vector<Streak> const runs = StreaksOf({{0.5, 2.5}, {0.5, 0.5}, {0.2, 1.7}, {0.5, 9.0}}, 1.0);
  ASSERT_EQ(runs.size(), 2u);
  EXPECT_EQ(runs[0].top.y, 0.5);
  EXPECT_EQ(runs[0].height, 2.0);
  EXPECT_EQ(runs[1].top.y, 9.5);
  EXPECT_EQ(runs[1].height, 0.0);
}

TEST(OnePerCell, KeepsWhatTheStreaksCover) {
  std::mt19937_64 engine(30);
  std::uniform_real_distribution<double> unit(-20.0, 20.0);
  for (int round = 0; round < 50; ++round) {
    std::vector<Pixel> at;
    for (int i = 0; i < 200; ++i) at.push_back({unit(engine), unit(engine)});
    std::size_t cells = 0;
    double previous = -1e9;
    for (Streak const& streak : StreaksOf(at, 2.0)) {
      EXPECT_GE(streak.top.x, previous) << "from left to right";
      previous = streak.top.x;
      cells += 1 + static_cast<std::size_t>(std::lround(streak.height / 2.0));
    }
    EXPECT_EQ(OnePerCell(at, 2.0).size(), cells);
  }
}

TEST(StreaksOf, BeginInTheMiddleOfTheirFirstCell) {
  std::vector<Streak> const streaks = StreaksOf({{-0.5, -0.5}, {-0.5, 0.5}, {-0.5, 2.5}}, 1.0);
  ASSERT_EQ(streaks.size(), 2u);
  EXPECT_EQ(streaks[0].top.x, -0.5);
  EXPECT_EQ(streaks[0].top.y, -0.5);
  EXPECT_EQ(streaks[0].height, 1.0);
  EXPECT_EQ(streaks[1].top.y, 2.5);
  EXPECT_EQ(streaks[1].height, 0.0);
}

TEST(StreaksOf, MarksFarOffThePageAreLeftOut) {
  double const infinity = std::numeric_limits<double>::infinity();
  EXPECT_TRUE(StreaksOf({{1e6, 0}, {0, -1e6}, {infinity, 0}, {std::nan(""), 0}}, 0.5).empty());
  EXPECT_EQ(StreaksOf({{999999.0, 0}}, 0.5).size(), 1u);
}

}  // namespace
}  // namespace Vorn::IO::Svg
