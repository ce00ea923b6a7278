#include <cerrno>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <istream>

#include "vorn/io/Failure.h"
#include "vorn/io/Files.h"

namespace Vorn::IO {

namespace {

constexpr std::size_t kFirstBlock = 64 * 1024;

/// Far above any measurement; a device without an end must not fill the memory.
constexpr std::size_t kLargestText = std::size_t{4} << 30;

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

std::string ReadAll(std::string const& path, std::istream& in, std::size_t expected) {
  std::string text;
  std::size_t size = 0;
  for (std::size_t room = expected; in; room = 2 * room) {
    if (room > kLargestText) Refuse(path, "is too large");
    text.resize(room);
    in.read(text.data() + size, static_cast<std::streamsize>(room - size));
    size += static_cast<std::size_t>(in.gcount());
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
