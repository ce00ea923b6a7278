#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

#include "io/base/TextLines.h"

namespace Vorn::IO {
namespace {

std::vector<std::string> LinesOf(std::string_view text) {
  std::vector<std::string> lines;
  for (TextLines walk(text); !walk.AtEnd();) lines.emplace_back(walk.Take());
  return lines;
}

/// Character by character.
std::vector<std::string> PlainLinesOf(std::string_view text) {
  std::vector<std::string> lines;
  std::string line;
  for (std::size_t i = 0; i < text.size(); ++i) {
    if (text[i] != '\r' && text[i] != '\n') {
      line += text[i];
      continue;
    }
    if (text.substr(i, 2) == "\r\n") ++i;
    lines.push_back(std::exchange(line, ""));
  }
  if (!line.empty()) lines.push_back(line);
  return lines;
}

TEST(TextLines, EndWithLfCrLfOrCr) {
  EXPECT_EQ(LinesOf("a\nb\r\nc\rd"), (std::vector<std::string>{"a", "b", "c", "d"}));
  EXPECT_EQ(LinesOf("\n\r\n\r"), (std::vector<std::string>{"", "", ""}));
  EXPECT_EQ(LinesOf("\r\r\n\n"), (std::vector<std::string>{"", "", ""}));
  EXPECT_EQ(LinesOf(""), std::vector<std::string>{});
}

TEST(TextLines, AgreeWithAPlainWalkOverEveryShortText) {
  constexpr std::string_view kCharacters = "a\r\n";
  for (int code = 0; code < 6561; ++code) {
    std::string text;
    for (int rest = code; rest > 0; rest /= 3) {
      text += kCharacters[static_cast<std::size_t>(rest % 3)];
    }
    EXPECT_EQ(LinesOf(text), PlainLinesOf(text)) << code;
  }
}

TEST(TextLines, PositionIsWhereTheNextLineBegins) {
  TextLines walk("ab\r\nc\n");
  walk.Take();
  EXPECT_EQ(walk.Position(), 4u);
  walk.Take();
  EXPECT_EQ(walk.Position(), 6u);
}

}  // namespace
}  // namespace Vorn::IO
