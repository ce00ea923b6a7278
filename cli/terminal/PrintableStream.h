#pragma once

#include <ostream>
#include <streambuf>
#include <string>

#include "cli/base/Library.h"

namespace Vorn::Cli {

/// A stream for messages: what the terminal would take for a command, or could not show, is
/// replaced before it gets there, line by line.
class PrintableStream final : public std::ostream {
 public:
  /// Writes to the target, which must outlive it.
  explicit PrintableStream(std::ostream& target) : std::ostream(nullptr), buffer_(target) {
    rdbuf(&buffer_);
  }

 private:
  /// Keeps a line until it ends.
  class Buffer final : public std::streambuf {
   public:
    /// Writes to the target when a line ends, on a flush and at its own end.
    explicit Buffer(std::ostream& target) : target_(target) {}
    Buffer(Buffer const&) = delete;
    Buffer& operator=(Buffer const&) = delete;
    ~Buffer() override { WriteLine(); }

   private:
    /// Takes one more character; a line end writes the line.
    int_type overflow(int_type character) override;
    /// Writes what there is of a line, so that a flush shows it.
    int sync() override;
    /// Writes what has come of the line so far in its printable form, and forgets it.
    void WriteLine();

    std::ostream& target_;
    std::string line_;
  };

  Buffer buffer_;
};

}  // namespace Vorn::Cli
