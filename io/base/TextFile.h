#pragma once

#include <iosfwd>
#include <string>

namespace Vorn::IO {

/// The path that stands for standard input.
inline constexpr char const* kStandardInput = "-";

/// How a file that is read is called in messages: its path, or "standard input".
std::string InputName(std::string const& path);

/// The whole contents of a file, read in one go; those of `in` for the path `-`.
/// @throws Failure (FailureKind::File) naming the file when it cannot be read or is a directory.
std::string ReadTextFile(std::string const& path, std::istream& in);

}  // namespace Vorn::IO
