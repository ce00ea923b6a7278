#include "cli/commands/NearestWord.h"

#include <algorithm>

namespace Vorn::Cli {

namespace {

std::size_t EditsBetween(std::string const& a, std::string const& b) {
  std::vector<std::vector<std::size_t>> edits(a.size() + 1, std::vector<std::size_t>(b.size() + 1));
  for (std::size_t i = 0; i <= a.size(); ++i) {
    for (std::size_t k = 0; k <= b.size(); ++k) {
      if (i == 0 || k == 0) {
        edits[i][k] = i + k;
        continue;
      }
      std::size_t const replaced = edits[i - 1][k - 1] + (a[i - 1] == b[k - 1] ? 0 : 1);
      edits[i][k] = std::min({edits[i - 1][k] + 1, edits[i][k - 1] + 1, replaced});
      bool const areExchanged = i > 1 && k > 1 && a[i - 1] == b[k - 2] && a[i - 2] == b[k - 1];
      if (areExchanged) edits[i][k] = std::min(edits[i][k], edits[i - 2][k - 2] + 1);
    }
  }
  return edits[a.size()][b.size()];
}

}  // namespace

std::optional<std::string> NearestWord(std::string const& text,
                                       std::vector<std::string> const& words) {
  constexpr std::size_t kLongestText = 40;
  if (text.size() > kLongestText) return {};
  std::optional<std::string> nearest;
  std::size_t least = 0;
  for (std::string const& word : words) {
    std::size_t const edits = EditsBetween(text, word);
    if (edits > std::max<std::size_t>(1, word.size() / 3)) continue;
    if (nearest && edits >= least) continue;
    least = edits;
    nearest = word;
  }
  return nearest;
}

}  // namespace Vorn::Cli
