#include <gtest/gtest.h>

#include "vorn/io/Failure.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Points.h"

namespace Vorn::IO {
namespace {

/// The failure of an operation; one without a message when there is none.
template <typename Operation>
Failure FailureOf(Operation const& operation) {
  try {
    operation();
  } catch (Failure const& failure) {
    return failure;
  }
  return {FailureKind::Internal, ""};
}

TEST(Failure, MessageBeginsWithThePlaceAsFarAsItIsKnown) {
  EXPECT_STREQ(Failure(FailureKind::NoFit, "why").what(), "why");
  EXPECT_STREQ(Failure(FailureKind::File, {"a.csv"}, "why").what(), "a.csv: why");
  EXPECT_STREQ(Failure(FailureKind::File, {"a.csv", 3}, "why").what(), "a.csv:3: why");
  EXPECT_STREQ(Failure(FailureKind::File, {"a.csv", 3, 7}, "why").what(), "a.csv:3:7: why");
  EXPECT_STREQ(Failure(FailureKind::File, {"a.csv", 0, 7}, "why").what(), "a.csv: why");
}

TEST(Failure, HoldsItsParts) {
  Failure const failure(FailureKind::PointsTooClose, {"a.csv", 3, 7}, "why");
  EXPECT_EQ(failure.Kind(), FailureKind::PointsTooClose);
  EXPECT_EQ(failure.Where().file, "a.csv");
  EXPECT_EQ(failure.Where().line, 3u);
  EXPECT_EQ(failure.Where().column, 7u);
  EXPECT_EQ(failure.Message(), "why");
}

TEST(Failure, OfPointsNamesLineAndColumn) {
  Failure const failure = FailureOf([] { ParsePoints("x,y\n1,2\n3,four\n", "scan.csv", {}); });
  EXPECT_EQ(failure.Kind(), FailureKind::File);
  EXPECT_EQ(failure.Where().file, "scan.csv");
  EXPECT_EQ(failure.Where().line, 3u);
  EXPECT_EQ(failure.Where().column, 3u);
}

TEST(Failure, OfContoursNamesThePlaceInEveryFormat) {
  struct Case {
    char const* path;
    char const* text;
    std::size_t line;
    std::size_t column;
  };
  for (Case const& one :
       {Case{"a.json", "{\n  \"closed\": tru\n}", 2, 16},
        Case{"a.csv", "type,start_x,start_y,end_x,end_y\nline,0,0,1,y\n", 2, 0},
        Case{"a.dxf", "0\nSECTION\nx\n", 3, 0}, Case{"a.nc", "G0 X0 Y0\nG1 Xa\n", 2, 0},
        Case{"a.wkt", "LINESTRING (0 0,\n1 b)", 2, 3}}) {
    Failure const failure = FailureOf([&] { ParseContour(one.text, one.path); });
    EXPECT_EQ(failure.Kind(), FailureKind::File) << one.path;
    EXPECT_EQ(failure.Where().file, one.path);
    EXPECT_EQ(failure.Where().line, one.line) << failure.what();
    EXPECT_EQ(failure.Where().column, one.column) << failure.what();
  }
}

}  // namespace
}  // namespace Vorn::IO
