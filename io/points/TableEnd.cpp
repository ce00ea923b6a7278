#include "io/points/TableEnd.h"

#include <algorithm>
#include <array>
#include <string>
#include <vector>

#include "io/base/Fields.h"
#include "io/base/TextLines.h"
#include "io/base/Words.h"
#include "io/points/TableStart.h"
#include "vorn/io/Messages.h"

namespace Vorn::IO {

namespace {

using Fields = std::vector<std::string_view>;

/// Bytes of letters that are not ASCII count as letters.
bool IsLetter(char c) {
  constexpr unsigned char kFirstBeyondAscii = 0x80;
  return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') ||
         static_cast<unsigned char>(c) >= kFirstBeyondAscii;
}

/// What instruments write in place of a value that they did not get.
bool IsMissingValue(std::string const& word) {
  constexpr std::array<std::string_view, 13> kWords = {
      "nan",   "inf",  "infinity", "null",  "none",      "missing", "invalid",
      "error", "over", "overflow", "under", "underflow", "fehler"};
  return std::find(kWords.begin(), kWords.end(), word) != kWords.end();
}

/// Whether the text begins with a word of three letters at least that stands for no value. Fewer
/// letters may be the name of a point, "P17", whose coordinates were cut off.
bool BeginsWithWord(std::string_view text) {
  constexpr std::size_t kLeastLetters = 3;
  std::string_view const word =
      text.substr(0, static_cast<std::size_t>(std::find_if_not(text.begin(), text.end(), IsLetter) -
                                              text.begin()));
  return word.size() >= kLeastLetters && !IsMissingValue(LowerCase(word));
}

bool AreDifferent(Fields fields) {
  std::sort(fields.begin(), fields.end());
  return std::adjacent_find(fields.begin(), fields.end()) == fields.end();
}

/// "Points;500" below a table of 500 points in two columns.
bool TellsCount(Fields const& fields, TableFacts const& table) {
  return fields.size() == 2 && Unquoted(fields[1]) == std::to_string(table.points);
}

/// Whether a line with as many fields as the table is no data gone wrong all the same.
bool IsNoRow(Fields const& fields, TableFacts const& table) {
  if (TellsCount(fields, table)) return true;
  return table.separator == ' ' && AreDifferent(fields) &&
         std::none_of(fields.begin(), fields.end(), LooksLikeNumber);
}

bool IsFooterLine(std::string_view line, TableFacts const& table) {
  Fields fields;
  SplitFields(line, table.separator, &fields);
  while (!fields.empty() && fields.back().empty()) fields.pop_back();
  if (fields.empty()) return true;
  if (IsRule(line)) return fields.size() != table.columns;
  if (!BeginsWithWord(Unquoted(fields.front()))) return false;
  return fields.size() != table.columns || IsNoRow(fields, table);
}

}  // namespace

bool IsFooter(std::string_view text, TableFacts const& table) {
  TextLines lines(text);
  while (!lines.AtEnd()) {
    std::string_view const line = lines.Take();
    std::string_view const words = Trimmed(line.substr(0, FindComment(line)));
    if (!words.empty() && !IsFooterLine(words, table)) return false;
  }
  return true;
}

}  // namespace Vorn::IO
