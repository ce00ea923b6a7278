#pragma once

#include <mutex>
#include <string>

/// The temporary files of an AtomicFile, known to the whole process, so that a program that is
/// ended from outside can remove them.
namespace Vorn::IO {

/// While the lock is held no other thread makes, renames or removes a staged file. A thread may
/// hold it more than once.
std::unique_lock<std::recursive_mutex> LockStagedFiles();

/// A file that RemoveTemporaries() removes from now on.
void NoteTemporary(std::string const& path);

/// The same file is none any longer.
void ForgetTemporary(std::string const& path);

/// Removes the files of all that are staged; to be called just before the process ends.
void RemoveTemporaries();

}  // namespace Vorn::IO
