#include <gtest/gtest.h>

#include <string>

#include "io/formats/JsonPlace.h"

namespace Vorn::IO {
namespace {

/// What stands where the path leads to.
std::string Behind(std::string const& text, std::string const& path) {
  return text.substr(OffsetInJson(text, path));
}

TEST(OffsetInJson, FindsValuesOfObjectsAndArrays) {
  std::string const text = R"( {"a": [1, {"x" :2}, [3, 4]], "b":{"c":"d"} })";
  EXPECT_EQ(Behind(text, ""), text.substr(1));
  EXPECT_EQ(Behind(text, "a[0]"), text.substr(text.find('1')));
  EXPECT_EQ(Behind(text, "a[1].x"), text.substr(text.find('2')));
  EXPECT_EQ(Behind(text, "a[2]"), text.substr(text.find("[3")));
  EXPECT_EQ(Behind(text, "a[2][1]"), text.substr(text.find('4')));
  EXPECT_EQ(Behind(text, "b.c"), text.substr(text.find("\"d\"")));
}

TEST(OffsetInJson, IsNotMisledByStrings) {
  std::string const text = R"({"n":"],}\"{[","m\\":"\\","a":[",", "]", 7]})";
  EXPECT_EQ(Behind(text, "a[2]"), "7]}");
  EXPECT_EQ(Behind(text, "n"), text.substr(5));
}

TEST(OffsetInJson, TakesTheLastOfSeveralKeys) { EXPECT_EQ(Behind(R"({"a":1,"a":2})", "a"), "2}"); }

TEST(OffsetInJson, OfWhatIsMissingIsWhereItShouldBe) {
  EXPECT_EQ(Behind(R"({"a":[1]})", "a[5]"), "[1]}");
  EXPECT_EQ(Behind(R"({"a":{}})", "a.b"), "{}}");
  EXPECT_EQ(Behind(R"({"a":7})", "a.b"), "7}");
  EXPECT_EQ(Behind("[]", "x"), "[]");
}

}  // namespace
}  // namespace Vorn::IO
