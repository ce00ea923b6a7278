#include "cli/terminal/PrintableStream.h"

#include "vorn/io/Messages.h"

namespace Vorn::Cli {

PrintableStream::Buffer::int_type PrintableStream::Buffer::overflow(int_type character) {
  if (traits_type::eq_int_type(character, traits_type::eof())) {
    return traits_type::not_eof(character);
  }
  if (character == '\n') {
    WriteLine();
    target_ << '\n';
  } else {
    line_ += traits_type::to_char_type(character);
  }
  return character;
}

int PrintableStream::Buffer::sync() {
  WriteLine();
  target_.flush();
  return 0;
}

void PrintableStream::Buffer::WriteLine() {
  target_ << Printable(line_);
  line_.clear();
}

}  // namespace Vorn::Cli
