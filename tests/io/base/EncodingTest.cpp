#include <gtest/gtest.h>

#include "io/base/Encoding.h"

namespace Vorn::IO {
namespace {

using namespace std::string_view_literals;

TEST(Utf8FromUtf16, TakesBothOrdersOfBytes) {
  EXPECT_EQ(Utf8FromUtf16("\xFF\xFEx\0;\0"sv), "x;");
  EXPECT_EQ(Utf8FromUtf16("\xFE\xFF\0x\0;"sv), "x;");
  EXPECT_EQ(Utf8FromUtf16("\xFF\xFE"sv), "");
}

TEST(Utf8FromUtf16, CharactersOfEveryLength) {
  // LATIN SMALL LETTER A WITH DIAERESIS, EURO SIGN, GRINNING FACE
  EXPECT_EQ(Utf8FromUtf16("\xFE\xFF\x00\xE4\x20\xAC\xD8\x3D\xDE\x00"sv),
            "\xC3\xA4\xE2\x82\xAC\xF0\x9F\x98\x80");
}

TEST(Utf8FromUtf16, WhatIsNoCharacterIsReplaced) {
  EXPECT_EQ(Utf8FromUtf16("\xFE\xFF\xD8\x3D"sv), "\xEF\xBF\xBD") << "half a pair at the end";
  EXPECT_EQ(Utf8FromUtf16("\xFE\xFF\xD8\x3D\x00x"sv), "\xEF\xBF\xBDx") << "half a pair";
  EXPECT_EQ(Utf8FromUtf16("\xFE\xFF\xDE\x00\x00x"sv), "\xEF\xBF\xBDx") << "its second half first";
  EXPECT_EQ(Utf8FromUtf16("\xFE\xFF\x00xy"sv), "x") << "half a unit at the end";
}

TEST(Utf8FromUtf16, OtherTextIsNone) {
  for (std::string_view const text : {""sv, "x,y"sv, "\xEF\xBB\xBFx"sv, "\xFF"sv, "\xFE\xFE"sv}) {
    EXPECT_EQ(Utf8FromUtf16(text), std::nullopt);
    EXPECT_FALSE(IsUtf16(text));
  }
}

TEST(Utf8FromEither, KeepsUtf8AndTakesOtherBytesAsLatin1) {
  EXPECT_EQ(Utf8FromEither("L\xC3\xA4nge\t1"), "L\xC3\xA4nge\t1");
  EXPECT_EQ(Utf8FromEither("L\xE4nge"), "L\xC3\xA4nge");
  EXPECT_EQ(Utf8FromEither("\xB5m"), "\xC2\xB5m");
  EXPECT_EQ(Utf8FromEither(""), "");
}

TEST(IsUtf8, RefusesWhatIsCutOverlongOrASurrogate) {
  EXPECT_TRUE(IsUtf8("\xF0\x9F\x98\x80"));
  for (std::string_view const text : {"\xC3"sv, "\xC0\x80"sv, "\xE0\x80\x80"sv, "\xED\xA0\x80"sv,
                                      "\xF5\x80\x80\x80"sv, "\x80"sv}) {
    EXPECT_FALSE(IsUtf8(text));
  }
}

}  // namespace
}  // namespace Vorn::IO
