// Tables that are damaged, large or not there.
#include <gtest/gtest.h>

#include <random>
#include <sstream>

#include "io/PointTables.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {
namespace {

using namespace PointTables;

TEST(CsvReader, BinaryFilesAreRefusedByTheirFirstZeroByte) {
  EXPECT_EQ(TableRefusal(std::string_view("\x7f"
                                          "ELF\x02\x00\x01\n1,2\n",
                                          12)),
            "p.csv: is not text: byte 5 is zero");
}

TEST(CsvReader, DamagedFilesAreRefusedOrRead) {
  constexpr std::uint64_t kSeed = 23;
  SCOPED_TRACE(kSeed);
  std::mt19937_64 engine(kSeed);
  constexpr std::string_view kLikely = "0123456789.,;\t -+eE\n\r\"#/xyw";
  int refused = 0;
  constexpr int kRounds = 3000;
  for (int round = 0; round < kRounds; ++round) {
    std::string text = "x,y\n1.5,-2\n3,4.25\n5e0,6\n";
    for (auto damages = 1 + engine() % 4; damages > 0; --damages) {
      bool const isLikely = engine() % 4 != 0;
      text[engine() % text.size()] =
          isLikely ? kLikely[engine() % kLikely.size()] : static_cast<char>(engine() % 256);
    }
    text.resize(engine() % 2 == 0 ? text.size() : engine() % text.size());
    try {
      PointFile const file = Parse(text);
      EXPECT_GE(file.points.size(), 2u);
      EXPECT_EQ(file.points.size(), file.lines.size());
    } catch (Failure const& failure) {
      EXPECT_EQ(failure.Kind(), FailureKind::File);
      ++refused;
    }
  }
  EXPECT_GT(refused, kRounds / 10);
  EXPECT_GT(kRounds - refused, kRounds / 50);
}

TEST(CsvReader, AMillionColumnsAreRefusedInOneLine) {
  std::string text = "1";
  for (int i = 1; i < 1'000'000; ++i) text += ",1";
  EXPECT_EQ(TableRefusal(text),
            "p.csv:1:7: 1000000 columns without a header; expected x,y or x,y,w");
  std::string header = "a";
  for (int i = 1; i < 1'000'000; ++i) header += ",a";
  EXPECT_EQ(TableRefusal(header + "\n" + text, {Use::Required, "t"}),
            "p.csv:1:1: no column 't'; the header has 'a', 'a', 'a', 'a', 'a', 'a', 'a', 'a' and "
            "999992 more");
  EXPECT_EQ(TableRefusal("1,2\n" + text).substr(0, 49),
            "p.csv:2:5: expected 2 columns, found 1000000: '1,");
}

TEST(CsvReader, CarriageReturnsAloneAreNotSearchedOverAndOver) {
  // Quadratic work on these lines would take minutes.
  std::string text;
  for (int i = 0; i < 200'000; ++i) text += "1.5,2.5\r";
  PointFile const file = Parse(text + "1,2\n3,4");
  EXPECT_EQ(file.points.size(), 200'002u);
  EXPECT_EQ(file.lines.back(), 200'002u);
}

TEST(CsvReader, EveryPointOfALargeFileComesBackExactly) {
  constexpr int kPoints = 200'000;
  auto const x = [](int i) { return 0.01 * i; };
  auto const y = [](int i) { return 1.0 / (1.0 + i); };
  std::string text = "x,y\n";
  for (int i = 0; i < kPoints; ++i) text += FormatExact(x(i)) + "," + FormatExact(y(i)) + "\n";
  PointFile const file = Parse(text);
  ASSERT_EQ(file.points.size(), static_cast<std::size_t>(kPoints));
  ASSERT_EQ(file.lines.size(), file.points.size());
  int wrong = 0;
  for (int i = 0; i < kPoints; ++i) {
    WPoint const& point = file.points[i];
    if (point.x != x(i) || point.y != y(i) || file.lines[i] != i + 2u) ++wrong;
  }
  EXPECT_EQ(wrong, 0);
}

TEST(CsvReader, StandardInputIsReadForADash) {
  std::istringstream in("1,2\n3,4\n");
  PointFile const file = ReadPoints("-", in, {});
  EXPECT_EQ(file.path, "standard input");
  EXPECT_EQ(file.points.size(), 2u);
  std::istringstream bad("1,2\n3,x\n");
  try {
    ReadPoints("-", bad, {});
    FAIL() << "accepted";
  } catch (Failure const& failure) {
    EXPECT_STREQ(failure.what(), "standard input:2:3: y is not a number: 'x'");
  }
}

TEST(CsvReader, PointsAreNamedByIndexAndLine) {
  EXPECT_EQ(Parse("x,y\n1,2\n\n3,4\n").NameOf(1), "point 1 (line 4)");
}

TEST(NameOf, IsShorterForPointsOfNoFile) {
  PointFile file;
  file.points = {{0.0, 0.0}, {1.0, 0.0}};
  EXPECT_EQ(file.NameOf(1), "point 1");
}

TEST(CsvReader, MissingFileAndDirectoryAreRefused) {
  auto refusal = [](std::string const& path) -> std::string {
    try {
      std::istringstream none;
      ReadPoints(path, none, {});
    } catch (Failure const& failure) {
      EXPECT_EQ(failure.Kind(), FailureKind::File);
      return failure.what();
    }
    return "";
  };
  EXPECT_EQ(refusal("no/such/file.csv"), "no/such/file.csv: No such file or directory");
  EXPECT_EQ(refusal("."), ".: is a directory");
}

}  // namespace
}  // namespace Vorn::IO
