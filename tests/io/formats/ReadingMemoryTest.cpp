#include <gtest/gtest.h>

#include <string>

#include "io/formats/ReadingMemory.h"

namespace Vorn::IO {
namespace {

std::string Repeated(std::string const& text, int times) {
  std::string result;
  for (int i = 0; i < times; ++i) result += text;
  return result;
}

/// Bytes of memory for each of many pieces, without their text.
double ForEach(std::string const& piece, Format format) {
  constexpr int kTimes = 1000;
  std::string const text = Repeated(piece, kTimes);
  return static_cast<double>(MemoryToRead(text, format) - text.size()) / kTimes;
}

// What was measured, see the weights; no estimate is less, and none is more than half as much
// again.
TEST(MemoryToRead, IsNearWhatWasMeasured) {
  struct Measured {
    Format format;
    char const* piece;
    double bytes;
  };
  for (Measured const& one :
       {Measured{Format::Wkt, "100.0000 0.0000,", 310},
        Measured{Format::GCode, "G1 X100.0000 Y0.0000\n", 313},
        Measured{Format::GeoJson, "[100.0000,0.0000],", 393},
        Measured{Format::Svg, "100.0000 0.0000 ", 310}, Measured{Format::Svg, "h1", 327},
        Measured{Format::Svg, R"(<rect x="3" width="1" height="1"/>)", 1237},
        Measured{Format::Dxf, "0\nLINE\n8\n0\n10\n1\n20\n2\n11\n3\n21\n4\n", 786},
        Measured{Format::Json, R"({"kind":"line","start":{"x":1,"y":2},"end":{"x":3,"y":4}},)",
                 1149}}) {
    EXPECT_GE(ForEach(one.piece, one.format), 0.99 * one.bytes) << NameOf(one.format);
    EXPECT_LE(ForEach(one.piece, one.format), 1.5 * one.bytes) << NameOf(one.format);
  }
}

TEST(MemoryToRead, LongNumbersAndCommentsCountAsTextAlone) {
  std::string const number(1000, '1');
  EXPECT_EQ(MemoryToRead(number, Format::Wkt), 1000u);
  EXPECT_EQ(MemoryToRead("(" + number + ")", Format::GCode), 1002u);
  EXPECT_EQ(MemoryToRead("", Format::Json), 0u);
}

TEST(MemoryToRead, AContourOfAMillionMovesFits) {
  std::string const text = Repeated("G1 X123.4567 Y234.5678\n", 2000000);
  EXPECT_GT(text.size(), std::size_t{45000000});
  EXPECT_LT(MemoryToRead(text, Format::GCode), kLargestMemory);
}

}  // namespace
}  // namespace Vorn::IO
