#pragma once

#include <mutex>
#include <string>

/// What the program leaves behind when it is interrupted: nothing.
///
/// The core tells its progress to a callback that may throw, but a single step of it may take long,
/// and reading and writing have no callback at all. So one thread of its own waits for the signals,
/// removes what is staged and ends the program. It is no signal handler, which could neither wait
/// for a lock nor see a file between its making and its being noted.
namespace Vorn::Cli {

/// From now on SIGINT, SIGTERM and SIGHUP end the program with ExitCode::Interrupted: temporary
/// files are removed and the line of the terminal is wiped. Signals that were ignored stay so.
/// To be called once, before any other thread is started.
void EndCleanlyOnSignals();

/// While the lock is held no interruption happens. A thread may hold it more than once.
std::unique_lock<std::recursive_mutex> HoldOffInterruption();

/// Whether a line on the terminal behind this descriptor is to be wiped; -1: none.
void NoteTerminalLine(int descriptor);

/// Goes to the begin of the line and erases it.
inline constexpr char const* kWipeLine = "\r\x1b[K";

}  // namespace Vorn::Cli
