
#include <cerrno>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <istream>
#include <string_view>

#include "io/base/Encoding.h"
#include "io/base/TextLines.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Files.h"

namespace Vorn::IO {

namespace {

constexpr std::size_t kMebibyte = std::size_t{1} << 20;

constexpr std::size_t kFirstBlock = std::size_t{64} * 1024;

/// What is read before a line without an end can be told. A multiple of the first block by a power
/// of two, so that blocks of doubled size come to it.
constexpr std::size_t kFirstLook = 2 * kLongestTableLine;

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

/// Only tables of points begin with a number, and these have no such lines: what else there may be
/// need not be read.
void RefuseEndlessLine(std::string const& path, std::string_view text) {
  constexpr std::string_view kNumberBegins = "+-.,0123456789";
  bool const isTable = kNumberBegins.find(text.front()) != std::string_view::npos;
  if (!isTable || text.find_first_of("\r\n") <= kLongestTableLine) return;
  throw Failure(FailureKind::File, {InputName(path), 1}, kLineTooLong);
}

std::string ReadAll(std::string const& path, std::istream& in, std::size_t expected) {
  std::size_t const largest = expected == kFirstBlock ? kLargestStream : kLargestText;
  std::string text;
  std::size_t size = 0;
  std::size_t room = std::min(expected, kFirstLook);
  for (; in; room = room < expected ? expected : 2 * room) {
    if (size >= largest) {
      Refuse(path, "is too large: more than " + std::to_string(largest / kMebibyte) + " MiB");
    }
    text.resize(std::min(room, largest + 1));
    in.read(text.data() + size, static_cast<std::streamsize>(text.size() - size));
    auto const count = static_cast<std::size_t>(in.gcount());
    if (expected == kFirstBlock && !IsUtf16(text)) {
      RefuseBinary(path, std::string_view(text).substr(size, count), size);
    }
    bool const isFirstLook = size < kFirstLook && size + count >= kFirstLook;
    size += count;
    if (isFirstLook) RefuseEndlessLine(path, std::string_view(text).substr(0, size));
  }
  if (in.bad()) Refuse(path, "cannot be read");
  text.resize(size);
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
