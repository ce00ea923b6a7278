#include "io/base/Encoding.h"

#include <array>

namespace Vorn::IO {

namespace {

/// Where the first bytes of characters of 1, 2, 3 and 4 bytes end or begin. 0xC0 and 0xC1 begin
/// none, as they would write ASCII in two bytes; from 0xF5 on the codes would be too large.
constexpr unsigned char kEndOfSingle = 0x80;
constexpr unsigned char kFirstOfTwo = 0xC2;
constexpr unsigned char kFirstOfThree = 0xE0;
constexpr unsigned char kFirstOfFour = 0xF0;
constexpr unsigned char kEndOfFour = 0xF5;

/// A byte after the first has the mark 10 in its upper two bits, and six bits of the code below.
constexpr std::uint32_t kMarkBits = 0xC0;
constexpr std::uint32_t kMark = 0x80;
constexpr std::uint32_t kCodeBits = 0x3F;
constexpr std::uint32_t kFirstCodeBits = 0x7F;
constexpr int kBitsPerByte = 6;
/// Shifted by the number of bytes behind it, the lower eight bits are the mark of a first byte: as
/// many ones as the character has bytes, and a zero.
constexpr std::uint32_t kLeadingOnes = 0xFF80;

/// The least code that takes three bytes.
constexpr std::uint32_t kFirstCodeOfThree = 0x800;
constexpr std::uint32_t kLargestCode = 0x10FFFF;

constexpr std::string_view kUtf8Mark = "\xEF\xBB\xBF";
constexpr std::string_view kLittleEndianMark = "\xFF\xFE";
constexpr std::string_view kBigEndianMark = "\xFE\xFF";

constexpr std::uint32_t kReplacement = 0xFFFD;

/// Codes above 0xFFFF are two units: the first carries the upper ten bits, the second the lower.
constexpr std::uint32_t kFirstOfPair = 0xD800;
constexpr std::uint32_t kSecondOfPair = 0xDC00;
constexpr std::uint32_t kEndOfPairs = 0xE000;
constexpr std::uint32_t kFirstPairedCode = 0x10000;

std::size_t LengthFrom(unsigned char first) {
  if (first < kEndOfSingle) return 1;
  if (first >= kFirstOfTwo && first < kFirstOfThree) return 2;
  if (first >= kFirstOfThree && first < kFirstOfFour) return 3;
  return first >= kFirstOfFour && first < kEndOfFour ? 4 : 0;
}

void AppendUtf8(std::uint32_t code, std::string* text) {
  auto const append = [text](std::uint32_t byte) { text->push_back(static_cast<char>(byte)); };
  if (code < kEndOfSingle) return append(code);
  int const bytesBehind = code < kFirstCodeOfThree ? 1 : code < kFirstPairedCode ? 2 : 3;
  append((kLeadingOnes >> bytesBehind) | code >> (kBitsPerByte * bytesBehind));
  for (int i = bytesBehind; i-- > 0;) append(kMark | (code >> (kBitsPerByte * i) & kCodeBits));
}

/// The units of a text behind its mark.
class Units {
 public:
  Units(std::string_view bytes, bool isLittleEndian)
      : bytes_(bytes), isLittleEndian_(isLittleEndian) {}

  bool AtEnd() const { return at_ + 1 >= bytes_.size(); }

  /// The next character, from one unit or a pair of them.
  std::uint32_t Take() {
    std::uint32_t const unit = UnitAt(at_);
    at_ += 2;
    if (unit < kFirstOfPair || unit >= kEndOfPairs) return unit;
    if (unit >= kSecondOfPair || AtEnd()) return kReplacement;
    std::uint32_t const second = UnitAt(at_);
    if (second < kSecondOfPair || second >= kEndOfPairs) return kReplacement;
    at_ += 2;
    return kFirstPairedCode + ((unit - kFirstOfPair) << 10 | (second - kSecondOfPair));
  }

 private:
  std::uint32_t UnitAt(std::size_t at) const {
    auto const first = static_cast<unsigned char>(bytes_[at]);
    auto const second = static_cast<unsigned char>(bytes_[at + 1]);
    return isLittleEndian_ ? first | std::uint32_t{second} << 8
                           : second | std::uint32_t{first} << 8;
  }

  std::string_view bytes_;
  std::size_t at_ = 0;
  bool isLittleEndian_;
};

}  // namespace

Utf8Character FirstCharacter(std::string_view text) {
  auto const byte = [&](std::size_t i) { return static_cast<unsigned char>(text[i]); };
  std::size_t const length = LengthFrom(byte(0));
  if (length == 0 || length > text.size()) return {};
  if (length == 1) return {1, byte(0)};
  // The first byte has as many leading ones as the character has bytes.
  std::uint32_t code = byte(0) & (kFirstCodeBits >> length);
  for (std::size_t i = 1; i < length; ++i) {
    if ((byte(i) & kMarkBits) != kMark) return {};
    code = code << kBitsPerByte | (byte(i) & kCodeBits);
  }
  constexpr std::array<std::uint32_t, 5> kLeast = {0, 0, kEndOfSingle, kFirstCodeOfThree,
                                                   kFirstPairedCode};
  bool const isSurrogate = code >= kFirstOfPair && code < kEndOfPairs;
  if (code < kLeast.at(length) || code > kLargestCode || isSurrogate) return {};
  return {length, code};
}

bool IsUtf8(std::string_view text) {
  while (!text.empty()) {
    std::size_t const length = FirstCharacter(text).length;
    if (length == 0) return false;
    text.remove_prefix(length);
  }
  return true;
}

std::string_view WithoutUtf8Mark(std::string_view text) {
  if (text.starts_with(kUtf8Mark)) text.remove_prefix(kUtf8Mark.size());
  return text;
}

bool IsUtf16(std::string_view text) {
  return text.starts_with(kLittleEndianMark) || text.starts_with(kBigEndianMark);
}

std::optional<std::string> Utf8FromUtf16(std::string_view text) {
  if (!IsUtf16(text)) return {};
  Units units(text.substr(kLittleEndianMark.size()), text.starts_with(kLittleEndianMark));
  std::string result;
  result.reserve(text.size() / 2);
  while (!units.AtEnd()) AppendUtf8(units.Take(), &result);
  return result;
}

std::string Utf8FromEither(std::string_view text) {
  if (IsUtf8(text)) return std::string(text);
  std::string result;
  for (char const c : text) AppendUtf8(static_cast<unsigned char>(c), &result);
  return result;
}

}  // namespace Vorn::IO
