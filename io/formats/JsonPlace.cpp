#include "io/formats/JsonPlace.h"

#include <algorithm>
#include <charconv>

namespace Vorn::IO {

namespace {

constexpr std::string_view kBlanks = " \t\r\n";

/// Goes through a document that is known to be good.
class Walker {
 public:
  explicit Walker(std::string_view text) : text_(text) { SkipBlanks(); }

  /// Where the next value begins.
  std::size_t At() const { return at_; }

  /// To what the object here holds under the key; stays where there is none. The last of several
  /// counts, as for the reader of the document.
  void EnterKey(std::string_view key) {
    std::size_t found = at_;
    ForEachItem('{', [&] {
      std::size_t const begin = at_;
      SkipString();
      bool const isWanted = text_.substr(begin + 1, at_ - begin - 2) == key;
      SkipTo(':');
      if (isWanted) found = at_;
    });
    at_ = found;
  }

  /// To the item of the array here; stays where there is none.
  void EnterItem(std::size_t index) {
    std::size_t found = at_;
    std::size_t count = 0;
    ForEachItem('[', [&] {
      if (count++ == index) found = at_;
    });
    at_ = found;
  }

 private:
  bool IsAt(char c) const { return at_ < text_.size() && text_[at_] == c; }

  void SkipBlanks() { at_ = std::min(text_.find_first_not_of(kBlanks, at_), text_.size()); }

  void SkipTo(char c) {
    SkipBlanks();
    if (IsAt(c)) ++at_;
    SkipBlanks();
  }

  void SkipString() {
    for (++at_; at_ < text_.size() && text_[at_] != '"'; ++at_) {
      if (text_[at_] == '\\') ++at_;
    }
    ++at_;
  }

  /// Calls at the start of each item; the call may go on up to the value of the item.
  template <typename Call>
  void ForEachItem(char open, Call const& call) {
    if (!IsAt(open)) return;
    SkipTo(open);
    while (at_ < text_.size() && !IsAt(']') && !IsAt('}')) {
      call();
      SkipValue();
      SkipTo(',');
    }
  }

  void SkipValue() {
    std::size_t depth = 0;
    do {
      if (IsAt('"')) {
        SkipString();
        continue;
      }
      if (IsAt('[') || IsAt('{')) ++depth;
      if (IsAt(']') || IsAt('}')) --depth;
      ++at_;
    } while (at_ < text_.size() && (depth > 0 || !IsBehindValue()));
    SkipBlanks();
  }

  bool IsBehindValue() const {
    char const c = text_[at_];
    return c == ',' || c == ']' || c == '}' || kBlanks.find(c) != std::string_view::npos;
  }

  std::string_view text_;
  std::size_t at_ = 0;
};

}  // namespace

std::size_t OffsetInJson(std::string_view text, std::string_view path) {
  Walker walker(text);
  while (!path.empty()) {
    if (path.front() == '[') {
      std::size_t index = 0;
      std::from_chars(path.data() + 1, path.data() + path.size(), index);
      walker.EnterItem(index);
      path.remove_prefix(path.find(']') + 1);
    } else {
      if (path.front() == '.') path.remove_prefix(1);
      std::size_t const end = std::min(path.find_first_of(".["), path.size());
      walker.EnterKey(path.substr(0, end));
      path.remove_prefix(end);
    }
  }
  return walker.At();
}

}  // namespace Vorn::IO
