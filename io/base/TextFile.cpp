#include <algorithm>
#include <cerrno>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <istream>
#include <string_view>

#include "io/base/Encoding.h"
#include "io/base/LongLines.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Files.h"

namespace Vorn::IO {

namespace {

constexpr std::size_t kMebibyte = std::size_t{1} << 20;

constexpr std::size_t kFirstBlock = std::size_t{64} * 1024;

/// Of a line without an end no more is read than one block behind the longest that may be.
constexpr std::size_t kLargestBlock = std::size_t{16} << 20;

/// Far above any measurement.
constexpr std::size_t kLargestText = std::size_t{4} << 30;

/// The same for what does not say how long it is: a pipe or a device without an end must not fill
/// the memory.
constexpr std::size_t kLargestStream = std::size_t{512} << 20;

[[noreturn]] void Refuse(std::string const& path, std::string const& message) {
  throw Failure(FailureKind::File, {InputName(path)}, message);
}

/// One byte more than the file holds, so that its end is seen without another block.
std::size_t SizeToExpect(std::string const& path) {
  std::error_code error;
  std::uintmax_t const size = std::filesystem::file_size(path, error);
  return error || size == 0 || size >= kLargestText ? kFirstBlock
                                                    : static_cast<std::size_t>(size) + 1;
}

/// Binary files need not be read to their end to be told from text. Half of the bytes of UTF-16 are
/// zero as a rule.
void RefuseBinary(std::string const& path, std::string_view block, std::size_t offset) {
  std::size_t const zero = block.find('\0');
  if (zero == std::string_view::npos) return;
  Refuse(path, "is not text: byte " + std::to_string(offset + zero) + " is zero");
}

/// How much is read next. What does not say how long it is comes in blocks of doubled size.
std::size_t NextBlock(std::size_t size, std::size_t expected) {
  if (size < expected) return std::min(expected - size, kLargestBlock);
  return std::clamp(size, kFirstBlock, kLargestBlock);
}

std::string ReadAll(std::string const& path, std::istream& in, std::size_t expected) {
  std::size_t const largest = expected == kFirstBlock ? kLargestStream : kLargestText;
  LongLines lines(InputName(path));
  std::string text;
  std::size_t size = 0;
  while (in) {
    if (size >= largest) {
      Refuse(path, "is too large: more than " + std::to_string(largest / kMebibyte) + " MiB");
    }
    text.resize(std::min(size + NextBlock(size, expected), largest + 1));
    in.read(text.data() + size, static_cast<std::streamsize>(text.size() - size));
    text.resize(size + static_cast<std::size_t>(in.gcount()));
    if (expected == kFirstBlock && !IsUtf16(text)) {
      RefuseBinary(path, std::string_view(text).substr(size), size);
    }
    size = text.size();
    lines.Look(text);
  }
  if (in.bad()) Refuse(path, "cannot be read");
  return text;
}

}  // namespace

std::string InputName(std::string const& path) {
  return path == kStandardInput ? "standard input" : path;
}

std::string ReadTextFile(std::string const& path, std::istream& in) {
  if (path == kStandardInput) return ReadAll(path, in, kFirstBlock);
  std::error_code ignored;
  if (std::filesystem::is_directory(path, ignored)) Refuse(path, "is a directory");
  errno = 0;
  std::ifstream file(path, std::ios::binary);
  if (!file) Refuse(path, std::strerror(errno));
  return ReadAll(path, file, SizeToExpect(path));
}

}  // namespace Vorn::IO
