#pragma once

#include <mutex>
#include <string>

/// The temporary files of an AtomicFile, known to the whole process, so that a program that is
/// ended from outside can remove them.
namespace Vorn::IO {

/// A file that RemoveTemporaries() removes from now on.
void NoteTemporary(std::string const& path);

/// The same file is none any longer.
void ForgetTemporary(std::string const& path);

}  // namespace Vorn::IO
