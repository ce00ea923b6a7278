#include <gtest/gtest.h>

#include <string>

#include "io/base/Base64.h"

namespace Vorn::IO {
namespace {

// The test vectors of RFC 4648.
TEST(Base64, FillsUpTheLastGroup) {
  EXPECT_EQ(Base64(""), "");
  EXPECT_EQ(Base64("f"), "Zg==");
  EXPECT_EQ(Base64("fo"), "Zm8=");
  EXPECT_EQ(Base64("foo"), "Zm9v");
  EXPECT_EQ(Base64("foob"), "Zm9vYg==");
  EXPECT_EQ(Base64("foobar"), "Zm9vYmFy");
}

TEST(Base64, TakesAnyByte) {
  EXPECT_EQ(Base64(std::string(3, '\0')), "AAAA");
  EXPECT_EQ(Base64("\xFF\xFE\xFD"), "//79");
}

}  // namespace
}  // namespace Vorn::IO
