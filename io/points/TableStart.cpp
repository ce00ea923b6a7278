#include "io/points/TableStart.h"

#include <algorithm>
#include <optional>
#include <vector>

#include "io/base/Fields.h"
#include "io/base/TextLines.h"
#include "io/base/Words.h"
#include "io/points/ColumnNames.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

/// No instrument writes a longer preamble.
constexpr std::size_t kMostLines = 500;

/// A longer line is no preamble, and taking it apart would take its time.
constexpr std::size_t kLongestLine = 4096;

struct Row {
  std::size_t line = 0;
  char separator = ',';
  std::vector<std::string_view> fields;

  bool IsData() const {
    return fields.size() >= 2 && std::all_of(fields.begin(), fields.end(), IsNumber);
  }
  bool HasNumbers() const { return std::any_of(fields.begin(), fields.end(), LooksLikeNumber); }
  bool BeginsWithText() const { return !LooksLikeNumber(fields.front()); }
  /// "Profile 7": words between blanks. A point whose x is no number would look the same only if a
  /// word of letters stood in its place.
  bool IsProse() const {
    constexpr std::size_t kLeastLetters = 3;
    std::string const word = LowerCase(fields.front());
    bool const isWord =
        word.size() >= kLeastLetters &&
        std::all_of(word.begin(), word.end(), [](char c) { return c >= 'a' && c <= 'z'; });
    return separator == ' ' && isWord && word != "nan" && word != "inf" && word != "infinity" &&
           word != "null";
  }
  /// A column without a unit has an empty field.
  bool IsUnits() const {
    return std::any_of(fields.begin(), fields.end(), IsUnit) &&
           std::all_of(fields.begin(), fields.end(), [](std::string_view field) {
             return Unquoted(field).empty() || IsUnit(field);
           });
  }

 private:
  static bool IsNumber(std::string_view field) {
    std::string_view const text = Unquoted(field);
    return ParseNumber(text) || ParseNumber(text, DecimalMark::Comma);
  }
};

/// The rows up to the second of two lines of data with equally many fields.
std::vector<Row> RowsToData(std::string_view text) {
  std::vector<Row> rows;
  TextLines lines(text);
  for (std::size_t number = 0; !lines.AtEnd() && number < kMostLines; ++number) {
    std::string_view line = lines.Take();
    line = Trimmed(line.substr(0, FindComment(line)));
    if (line.empty()) continue;
    if (line.size() > kLongestLine) return {};
    Row row;
    row.line = number;
    row.separator = FindSeparator(line);
    SplitFields(line, row.separator, &row.fields);
    rows.push_back(std::move(row));
    std::size_t const count = rows.size();
    bool const isTable = count >= 2 && rows[count - 1].IsData() && rows[count - 2].IsData() &&
                         rows[count - 1].fields.size() == rows[count - 2].fields.size();
    if (isTable) return rows;
  }
  return {};
}

/// Whether the row can be the header of a table with so many columns. The separator may be another
/// one, and tabs at its end be fields.
bool IsHeader(Row const& row, std::size_t columns) {
  return !row.HasNumbers() && row.fields.size() == columns;
}

}  // namespace

bool LooksLikeNumber(std::string_view field) {
  field = Unquoted(field);
  if (ParseNumber(field)) return true;
  std::string_view const digits =
      field.substr(std::min(field.find_first_not_of("+-.,"), field.size()));
  return !digits.empty() && digits.front() >= '0' && digits.front() <= '9';
}

std::size_t FindComment(std::string_view line) {
  std::size_t const hash = line.find('#');
  std::size_t slashes = line.find('/');
  while (slashes < hash) {
    bool const isFree = slashes == 0 || line[slashes - 1] == ' ' || line[slashes - 1] == '\t';
    if (isFree && line.substr(slashes, 2) == "//") return slashes;
    slashes = line.find('/', slashes + 1);
  }
  return hash;
}

TableStart FindTable(std::string_view text) {
  std::vector<Row> const rows = RowsToData(text);
  if (rows.size() < 3) return {};
  std::size_t const data = rows.size() - 2;
  std::size_t const columns = rows[data].fields.size();
  std::size_t first = data;
  bool const hasUnitLine =
      data >= 2 && rows[data - 1].IsUnits() && IsHeader(rows[data - 2], columns);
  if (hasUnitLine) {
    first = data - 2;
  } else if (IsHeader(rows[data - 1], columns)) {
    first = data - 1;
  }
  bool const hasHeader = first < data;
  for (std::size_t i = 0; i < first; ++i) {
    bool const couldBeData =
        rows[i].fields.size() == columns && rows[i].HasNumbers() && !rows[i].IsProse();
    bool const couldBeHeader = rows[i].fields.size() == columns && !rows[i].HasNumbers();
    if (!rows[i].BeginsWithText() || (couldBeData && !hasHeader)) return {};
    if (couldBeHeader && !hasHeader) return {};
  }
  return {rows[first].line, hasUnitLine};
}

}  // namespace Vorn::IO
