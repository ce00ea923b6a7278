#include "cli/CsvReader.h"

#include <algorithm>
#include <cerrno>
#include <cmath>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <sstream>

#include "cli/Failure.h"
#include "cli/Numbers.h"

namespace Vorn::Cli {

namespace {

constexpr std::string_view kUtf8Mark = "\xEF\xBB\xBF";
constexpr std::string_view kUtf16Marks[] = {"\xFF\xFE", "\xFE\xFF"};

[[noreturn]] void Refuse(std::string const& path, std::string const& message) {
  throw Failure(ExitCode::File, path + ": " + message);
}

[[noreturn]] void RefuseLine(std::string const& path, std::size_t line,
                             std::string const& message) {
  throw Failure(ExitCode::File, path + ":" + std::to_string(line) + ": " + message);
}

/// Cuts the next line off the text; a line ends with LF, CR LF or CR.
std::string_view TakeLine(std::string_view* text) {
  std::size_t const end = text->find_first_of("\r\n");
  std::string_view const line = text->substr(0, end);
  if (end == std::string_view::npos) {
    *text = {};
    return line;
  }
  bool const isPair = text->substr(end, 2) == "\r\n";
  text->remove_prefix(end + (isPair ? 2 : 1));
  return line;
}

std::string_view TakeWord(std::string_view* text) {
  *text = Trimmed(*text);
  std::size_t const end = std::min(text->find_first_of(" \t:="), text->size());
  std::string_view const word = text->substr(0, end);
  text->remove_prefix(end);
  *text = text->substr(std::min(text->find_first_not_of(" \t:="), text->size()));
  return word;
}

char FindSeparator(std::string_view line) {
  for (char const separator : {';', '\t', ','}) {
    if (line.find(separator) != std::string_view::npos) return separator;
  }
  return ' ';
}

std::vector<std::string_view> SplitAtBlanks(std::string_view line) {
  std::vector<std::string_view> fields;
  while (!(line = Trimmed(line)).empty()) {
    std::size_t const end = std::min(line.find_first_of(" \t"), line.size());
    fields.push_back(line.substr(0, end));
    line.remove_prefix(end);
  }
  return fields;
}

std::vector<std::string_view> Split(std::string_view line, char separator) {
  if (separator == ' ') return SplitAtBlanks(line);
  std::vector<std::string_view> fields;
  for (std::size_t end = 0; end != std::string_view::npos;) {
    end = line.find(separator);
    fields.push_back(Trimmed(line.substr(0, end)));
    if (end != std::string_view::npos) line.remove_prefix(end + 1);
  }
  return fields;
}

/// Also what begins like a number without being one, such as 1,5 or 3mm: it is meant as data and
/// must not pass for the name of a column.
bool LooksLikeNumber(std::string_view field) {
  if (ParseNumber(field)) return true;
  std::string_view const digits =
      field.substr(std::min(field.find_first_not_of("+-."), field.size()));
  return !digits.empty() && digits.front() >= '0' && digits.front() <= '9';
}

std::string ColumnName(std::string_view field) {
  if (field.size() >= 2 && field.front() == '"' && field.back() == '"') {
    field = field.substr(1, field.size() - 2);
  }
  return LowerCase(Trimmed(field));
}

class Parser {
 public:
  Parser(std::string const& path, ToleranceColumn const& column) : column_(column) {
    file_.path = path;
  }

  PointFile Parse(std::string_view text) {
    if (text.substr(0, kUtf8Mark.size()) == kUtf8Mark) text.remove_prefix(kUtf8Mark.size());
    for (std::string_view const mark : kUtf16Marks) {
      if (text.substr(0, mark.size()) == mark) {
        Refuse(file_.path, "is UTF-16 text; save it as UTF-8");
      }
    }
    while (!text.empty()) {
      ++line_;
      ParseLine(TakeLine(&text));
    }
    RefuseTooFewPoints();
    return std::move(file_);
  }

 private:
  void ParseLine(std::string_view line) {
    std::size_t const comment = line.find('#');
    if (comment != std::string_view::npos) {
      if (file_.points.empty()) ParseComment(line.substr(comment + 1));
      line = line.substr(0, comment);
    }
    line = Trimmed(line);
    if (line.empty()) return;
    if (columnCount_ != 0) return ParsePoint(Split(line, separator_));
    separator_ = FindSeparator(line);
    std::vector<std::string_view> const fields = Split(line, separator_);
    bool const isHeader = std::none_of(fields.begin(), fields.end(), LooksLikeNumber);
    isHeader ? ParseHeader(fields) : ChooseColumnsWithoutHeader(fields);
    columnCount_ = fields.size();
    if (!isHeader) ParsePoint(fields);
  }

  void ParseComment(std::string_view comment) {
    std::string const key = LowerCase(TakeWord(&comment));
    if (key == "units" || key == "unit") file_.units = std::string(TakeWord(&comment));
    if (key != "tolerance") return;
    std::optional<double> const value = ParseNumber(TakeWord(&comment));
    // A sentence that merely begins with the word is no statement of a tolerance.
    if (!value) return;
    file_.tolerance = CheckedTolerance(*value, "tolerance in the comment");
  }

  void ParseHeader(std::vector<std::string_view> const& fields) {
    if (fields.size() < 2) RefuseOneColumn(fields.front());
    std::vector<std::string> names;
    std::transform(fields.begin(), fields.end(), std::back_inserter(names), ColumnName);
    auto find = [&](std::string const& name) {
      return static_cast<std::size_t>(std::find(names.begin(), names.end(), LowerCase(name)) -
                                      names.begin());
    };
    if (find("x") < names.size() && find("y") < names.size()) {
      xColumn_ = find("x");
      yColumn_ = find("y");
    }
    if (column_.use == ToleranceColumn::Use::Ignore) return;
    wColumn_ = find(column_.name);
    file_.hasTolerances = wColumn_ < names.size();
    if (!file_.hasTolerances && column_.use == ToleranceColumn::Use::Required) {
      std::string list;
      for (std::string_view const field : fields)
        list += (list.empty() ? "" : ", ") + Quoted(field);
      RefuseLine(file_.path, line_,
                 "no column " + Quoted(column_.name) + "; the header has " + list);
    }
  }

  void ChooseColumnsWithoutHeader(std::vector<std::string_view> const& fields) {
    if (fields.size() < 2) RefuseOneColumn(fields.front());
    if (fields.size() > 3) {
      RefuseLine(
          file_.path, line_,
          std::to_string(fields.size()) + " columns without a header; expected x,y or x,y,w");
    }
    if (column_.use == ToleranceColumn::Use::Ignore) return;
    file_.hasTolerances = fields.size() == 3 && LowerCase(column_.name) == "w";
    if (!file_.hasTolerances && column_.use == ToleranceColumn::Use::Required) {
      RefuseLine(file_.path, line_,
                 "no column " + Quoted(column_.name) + "; the file has no header");
    }
  }

  void ParsePoint(std::vector<std::string_view> const& fields) {
    if (fields.size() != columnCount_) {
      RefuseLine(file_.path, line_,
                 "expected " + std::to_string(columnCount_) + " columns, found " +
                     std::to_string(fields.size()) + ": " + QuotedFields(fields));
    }
    WPoint point;
    point.x = ParseField("x", fields[xColumn_]);
    point.y = ParseField("y", fields[yColumn_]);
    if (file_.hasTolerances) {
      point.w = CheckedTolerance(ParseField(column_.name, fields[wColumn_]),
                                 "tolerance " + Quoted(fields[wColumn_]));
    }
    file_.points.push_back(point);
    file_.lines.push_back(line_);
  }

  double ParseField(std::string const& name, std::string_view field) const {
    std::optional<double> const value = ParseNumber(field);
    if (!value) {
      bool const decimalComma = field.find(',') != std::string_view::npos;
      RefuseLine(
          file_.path, line_,
          (field.empty() ? name + " is missing" : name + " is not a number: " + Quoted(field)) +
              (decimalComma ? " (write a decimal point, not a comma)" : ""));
    }
    if (!std::isfinite(*value)) {
      RefuseLine(file_.path, line_, name + " is not a finite number: " + Quoted(field));
    }
    return *value;
  }

  double CheckedTolerance(double value, std::string const& what) const {
    if (!(value > 0.0) || !std::isfinite(value)) {
      RefuseLine(file_.path, line_, what + " must be a finite number above 0");
    }
    return value;
  }

  [[noreturn]] void RefuseOneColumn(std::string_view field) const {
    RefuseLine(file_.path, line_, "only one column, " + Quoted(field) + "; expected x,y or x,y,w");
  }

  std::string QuotedFields(std::vector<std::string_view> const& fields) const {
    char const* const begin = fields.front().data();
    char const* const end = fields.back().data() + fields.back().size();
    return Quoted({begin, static_cast<std::size_t>(end - begin)});
  }

  void RefuseTooFewPoints() const {
    if (file_.points.size() >= 2) return;
    if (columnCount_ == 0) Refuse(file_.path, "holds no points");
    if (file_.points.empty()) Refuse(file_.path, "holds a header but no points");
    Refuse(file_.path, "holds one point only; a fit needs two");
  }

  ToleranceColumn column_;
  PointFile file_;
  std::size_t line_ = 0;
  char separator_ = ',';
  std::size_t columnCount_ = 0;
  std::size_t xColumn_ = 0;
  std::size_t yColumn_ = 1;
  std::size_t wColumn_ = 2;
};

}  // namespace

std::string PointFile::NameOf(std::size_t index) const {
  return "point " + std::to_string(index) + " (line " + std::to_string(lines[index]) + ")";
}

PointFile ParsePoints(std::string_view text, std::string const& path,
                      ToleranceColumn const& column) {
  return Parser(path, column).Parse(text);
}

PointFile ReadPoints(std::string const& path, ToleranceColumn const& column) {
  std::error_code ignored;
  if (std::filesystem::is_directory(path, ignored)) Refuse(path, "is a directory");
  errno = 0;
  std::ifstream file(path, std::ios::binary);
  if (!file) Refuse(path, std::strerror(errno));
  std::ostringstream text;
  text << file.rdbuf();
  if (file.bad()) Refuse(path, "cannot be read");
  return ParsePoints(text.str(), path, column);
}

}  // namespace Vorn::Cli
