#include "io/points/TableStart.h"

#include <algorithm>
#include <cstddef>
#include <iterator>
#include <string>
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

bool IsNumber(std::string_view field) {
  std::string_view const text = Unquoted(field);
  return ParseNumber(text) || ParseNumber(text, DecimalMark::Comma);
}

/// A line taken apart.
struct Row {
  std::size_t line = 0;
  char separator = ',';
  std::vector<std::string_view> fields;  ///< without empty ones at the end
  std::vector<bool> areNumbers;          ///< for each field

  /// Numbers alone, two at least.
  bool IsData() const {
    return fields.size() >= 2 &&
           std::all_of(areNumbers.begin(), areNumbers.end(), [](bool is) { return is; });
  }
  /// Two numbers at least, beside names or times.
  bool MayBeData() const {
    constexpr std::ptrdiff_t kFewestNumbers = 2;
    return std::count(areNumbers.begin(), areNumbers.end(), true) >= kFewestNumbers;
  }
  bool HasNumbers() const { return std::any_of(fields.begin(), fields.end(), LooksLikeNumber); }
  bool BeginsWithText() const { return fields.empty() || !LooksLikeNumber(fields.front()); }
  /// "Profile 7": words between blanks. A point whose x is no number would look the same only if a
  /// word of letters stood in its place.
  bool IsProse() const {
    constexpr std::size_t kLeastLetters = 3;
    if (fields.empty()) return false;
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
  /// Names of columns that tell by an axis which ones hold the points.
  bool NamesAxes() const {
    if (HasNumbers()) return false;
    std::vector<ColumnName> names;
    std::transform(fields.begin(), fields.end(), std::back_inserter(names), ReadColumnName);
    return FindPointColumns(names, {}) &&
           std::any_of(names.begin(), names.end(), [](ColumnName const& name) {
             return name.kind == ColumnKind::X || name.kind == ColumnKind::Y ||
                    name.kind == ColumnKind::Z;
           });
  }
};

Row RowOf(std::string_view line, std::size_t number) {
  Row row;
  row.line = number;
  row.separator = FindSeparator(line);
  SplitFields(line, row.separator, &row.fields);
  while (!row.fields.empty() && row.fields.back().empty()) row.fields.pop_back();
  std::transform(row.fields.begin(), row.fields.end(), std::back_inserter(row.areNumbers),
                 IsNumber);
  return row;
}

/// Whether the last row is the second of two of one table. Rows of numbers alone tell by
/// themselves; others only where numbers and texts stand in the same columns and the header ahead
/// of them names the axes.
bool EndInTable(std::vector<Row> const& rows) {
  constexpr std::size_t kWithHeader = 3;
  if (rows.size() < 2) return false;
  Row const& last = rows.back();
  Row const& before = rows[rows.size() - 2];
  if (last.areNumbers != before.areNumbers) return false;
  if (last.IsData()) return true;
  if (!last.MayBeData() || rows.size() < kWithHeader) return false;
  Row const* header = &rows[rows.size() - kWithHeader];
  if (header->IsUnits() && rows.size() > kWithHeader) --header;
  return header->NamesAxes() && header->fields.size() == last.fields.size();
}

/// The rows up to the second of two lines of data with equally many fields.
std::vector<Row> RowsToData(std::string_view text) {
  std::vector<Row> rows;
  TextLines lines(text);
  for (std::size_t number = 0; !lines.AtEnd() && number < kMostLines; ++number) {
    std::string_view line = lines.Take();
    line = Trimmed(line.substr(0, FindComment(line)));
    if (line.empty() || IsRule(line)) continue;
    if (line.size() > kLongestLine) return {};
    rows.push_back(RowOf(line, number));
    if (EndInTable(rows)) return rows;
  }
  return {};
}

/// Whether the row can be the header of a table with so many columns. The separator may be another
/// one, and tabs at its end be fields.
bool IsHeader(Row const& row, std::size_t columns) {
  return !row.HasNumbers() && row.fields.size() == columns;
}

/// Whether the row may stand ahead of a table whose header names the axes: anything but a point.
bool MayPrecedeAxes(Row const& row, std::size_t columns) {
  return !row.IsData() || row.fields.size() != columns;
}

/// The same ahead of any other table: what begins with text and looks like no data gone wrong.
bool MayPrecede(Row const& row, std::size_t columns, bool hasHeader) {
  if (!row.BeginsWithText()) return false;
  return hasHeader || row.fields.size() != columns || (row.HasNumbers() && row.IsProse());
}

}  // namespace

bool LooksLikeNumber(std::string_view field) {
  field = Unquoted(field);
  if (ParseNumber(field)) return true;
  std::string_view const digits =
      field.substr(std::min(field.find_first_not_of("+-.,"), field.size()));
  return !digits.empty() && IsDigit(digits.front());
}

bool IsRule(std::string_view line) {
  constexpr std::string_view kStrokes = "-=_*";
  line = Trimmed(line);
  bool const begins = line.size() >= 3 && kStrokes.find(line[0]) != std::string_view::npos &&
                      line[1] == line[0] && line[2] == line[0];
  return begins && line.find_first_not_of("-=_*+|;, \t") == std::string_view::npos;
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
  bool const namesAxes = hasHeader && rows[first].NamesAxes();
  for (std::size_t i = 0; i < first; ++i) {
    bool const isPreamble =
        namesAxes ? MayPrecedeAxes(rows[i], columns) : MayPrecede(rows[i], columns, hasHeader);
    if (!isPreamble) return {};
  }
  return {rows[first].line, hasUnitLine};
}

std::string UnitInPreamble(std::string_view line) {
  constexpr std::string_view kBetween = " \t:;=,";
  std::size_t const end = std::min(line.find_first_of(kBetween), line.size());
  std::string const key = LowerCase(Unquoted(line.substr(0, end)));
  bool const isKey = key == "units" || key == "unit" || key == "einheit" || key == "einheiten" ||
                     key == "unite" || key == "unit\xC3\xA9";
  std::size_t const begin = std::min(line.find_first_not_of(kBetween, end), line.size());
  std::string_view const value = line.substr(begin, line.find_first_of(";,", begin) - begin);
  return isKey && IsUnit(value) ? ReadColumnName("x " + std::string(Unquoted(value))).unit : "";
}

}  // namespace Vorn::IO
