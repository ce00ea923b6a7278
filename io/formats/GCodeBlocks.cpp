#include "io/formats/GCodeBlocks.h"

#include <algorithm>
#include <utility>

#include "io/base/Words.h"
#include "io/formats/Text.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

/// Takes a line apart.
class Scanner {
 public:
  Scanner(std::string_view line, std::size_t number, std::string path)
      : line_(line), number_(number), path_(std::move(path)) {}

  GCodeBlock Read() {
    GCodeBlock block;
    for (SkipComments(); at_ < line_.size(); SkipComments()) Sort(NextWord(), &block);
    return block;
  }

 private:
  [[noreturn]] void Refuse(std::string_view text, std::string const& complaint) const {
    RefuseLine(path_, number_, Quoted(text) + " " + complaint);
  }

  void SkipBlanks() { at_ = std::min(line_.find_first_not_of(" \t", at_), line_.size()); }

  void SkipComments() {
    for (SkipBlanks(); at_ < line_.size(); SkipBlanks()) {
      if (line_[at_] == ';' || (line_[at_] == '%' && Trimmed(line_) == "%")) {
        at_ = line_.size();
      } else if (line_[at_] == '(') {
        std::size_t const end = line_.find(')', at_);
        if (end == std::string_view::npos) Refuse(line_.substr(at_), "is a comment without end");
        at_ = end + 1;
      } else {
        return;
      }
    }
  }

  GCodeWord NextWord() {
    std::size_t const begin = at_;
    char const letter = LowerCase(line_.substr(at_, 1)).front();
    if (letter < 'a' || letter > 'z') Refuse(line_.substr(begin), "is no word of G-code");
    ++at_;
    SkipBlanks();
    std::size_t const digits = at_;
    at_ = std::min(line_.find_first_not_of("+-.0123456789", at_), line_.size());
    std::string_view const text = line_.substr(begin, at_ - begin);
    std::optional<double> const value = ParseNumber(line_.substr(digits, at_ - digits));
    if (!value) Refuse(text.size() > 1 ? text : line_.substr(begin), "is no word of G-code");
    if (!IsUsable(*value)) Refuse(text, "is too large");
    return {static_cast<char>(letter - 'a' + 'A'), *value, text};
  }

  void Sort(GCodeWord const& word, GCodeBlock* block) const {
    constexpr std::string_view kKnown = "DFGHIJKLMNOPQRSTXYZ";
    if (kKnown.find(word.letter) == std::string_view::npos) Refuse(word.text, "is not supported");
    if (word.letter == 'G' || word.letter == 'M') {
      block->codes.push_back(word);
      return;
    }
    std::optional<double>& value = (*block)[word.letter];
    if (value) Refuse(word.text, "is the second such word in its line");
    value = word.value;
  }

  std::string_view line_;
  std::size_t number_;
  std::string path_;
  std::size_t at_ = 0;
};

}  // namespace

GCodeBlock ReadGCodeBlock(std::string_view line, std::size_t number, std::string const& path) {
  return Scanner(line, number, path).Read();
}

}  // namespace Vorn::IO
