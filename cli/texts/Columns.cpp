#include "cli/texts/Columns.h"

#include <algorithm>

namespace Vorn::Cli {

namespace {

constexpr std::size_t kNameWidth = 12;

std::vector<std::size_t> WidthsOf(std::vector<Row> const& rows) {
  std::vector<std::size_t> widths(rows.front().size());
  for (Row const& row : rows) {
    for (std::size_t i = 0; i < row.size(); ++i) widths[i] = std::max(widths[i], row[i].size());
  }
  return widths;
}

}  // namespace

std::string Aligned(std::vector<Row> const& rows, std::set<std::string> const& words) {
  std::vector<std::size_t> const widths = WidthsOf(rows);
  std::string text;
  for (Row const& row : rows) {
    std::string line;
    for (std::size_t i = 0; i < row.size(); ++i) {
      std::string const padding(widths[i] - row[i].size(), ' ');
      bool const isWord = words.count(rows.front()[i]) > 0;
      line += (i > 0 ? "  " : "") + (isWord ? row[i] + padding : padding + row[i]);
    }
    line.erase(line.find_last_not_of(' ') + 1);
    text += line + "\n";
  }
  return text;
}

std::string Fact(std::string name, std::string const& text) {
  name.resize(std::max(name.size(), kNameWidth), ' ');
  return name + text + "\n";
}

}  // namespace Vorn::Cli
