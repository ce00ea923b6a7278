#include "io/base/TextLines.h"

#include <algorithm>

namespace Vorn::IO {

std::string_view TextLines::Take() {
  if (nextLineFeed_ != std::string_view::npos && nextLineFeed_ < position_) {
    nextLineFeed_ = text_.find('\n', position_);
  }
  std::size_t const lineFeed = std::min(nextLineFeed_, text_.size());
  std::string_view const upToLineFeed = text_.substr(position_, lineFeed - position_);
  std::size_t const length = std::min(upToLineFeed.find('\r'), upToLineFeed.size());
  std::size_t const end = position_ + length;
  bool const isPair = end < lineFeed && end + 1 == lineFeed && lineFeed < text_.size();
  position_ = std::min(end + (isPair ? 2 : 1), text_.size());
  return upToLineFeed.substr(0, length);
}

}  // namespace Vorn::IO
