#include <algorithm>
#include <cmath>
#include <istream>
#include <utility>

#include "io/base/Encoding.h"
#include "io/base/Fields.h"
#include "io/base/TextLines.h"
#include "io/base/Words.h"
#include "io/points/ColumnNames.h"
#include "io/points/CsvColumns.h"
#include "io/points/CsvNumbers.h"
#include "io/points/CsvPlace.h"
#include "io/points/TableEnd.h"
#include "io/points/TableStart.h"
#include "vorn/io/Files.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/Points.h"

namespace Vorn::IO {

namespace {

constexpr std::size_t kShortestLine = 4;  // 1,2 and its end

std::string_view TakeWord(std::string_view* text) {
  *text = Trimmed(*text);
  std::size_t const end = std::min(text->find_first_of(" \t:="), text->size());
  std::string_view const word = text->substr(0, end);
  text->remove_prefix(end);
  *text = text->substr(std::min(text->find_first_not_of(" \t:="), text->size()));
  return word;
}

void RefuseOtherThanText(std::string_view text, CsvPlace const& place) {
  std::size_t const zero = text.find('\0');
  if (zero == std::string_view::npos) return;
  place.Refuse("is not text: byte " + std::to_string(zero) + " is zero");
}

class Parser {
 public:
  Parser(std::string const& path, ToleranceColumn const& tolerance, ColumnChoice const& choice)
      : place_(path), columns_(tolerance, choice) {
    file_.path = place_.Path();
  }

  PointFile Parse(std::string_view bytes) {
    std::optional<std::string> const decoded = Utf8FromUtf16(bytes);
    std::string_view const text = WithoutUtf8Mark(decoded ? *decoded : bytes);
    RefuseOtherThanText(text, place_);
    ReservePoints(text);
    table_ = FindTable(text);
    TextLines lines(text);
    while (!lines.AtEnd()) {
      std::size_t const begin = lines.Position();
      std::string_view const line = lines.Take();
      place_.Enter(line);
      if (IsFooterFrom(line, text.substr(begin))) {
        SkipFooter(&lines);
        break;
      }
      ParseLine(line);
    }
    RefuseTooFewPoints();
    file_.columns = columns_.Describe();
    file_.hasTolerances = columns_.HaveTolerances();
    if (file_.hasTolerances) file_.toleranceColumn = columns_.ToleranceName();
    return std::move(file_);
  }

 private:
  void ReservePoints(std::string_view text) {
    auto const lineFeeds = static_cast<std::size_t>(std::count(text.begin(), text.end(), '\n'));
    std::size_t const most = std::min(lineFeeds, text.size() / kShortestLine) + 1;
    file_.points.reserve(most);
    file_.lines.reserve(most);
  }

  void ParseLine(std::string_view whole) {
    if (whole.size() > kLongestTableLine) place_.RefuseLine(kLineTooLong);
    std::size_t const comment = FindComment(whole);
    std::string_view const line = whole.substr(0, comment);
    if (comment != std::string_view::npos && file_.points.empty()) {
      ParseComment(whole.substr(comment));
    }
    if (place_.Line() <= table_.first) return ParsePreamble(Trimmed(line));
    std::string_view const words = Trimmed(line);
    if (words.empty() || (file_.points.empty() && IsRule(words))) return;
    if (isUnitLineNext_) return ParseUnits(words);
    columns_.Count() == 0 ? ParseFirstLine(words) : ParseLineOfData(line, words);
  }

  /// Whether no points come any more, only the footer of an instrument. Rows that begin with texts
  /// themselves cannot be told from one.
  bool IsFooterFrom(std::string_view line, std::string_view text) const {
    if (file_.points.size() < 2 || !doRowsBeginWithNumbers_) return false;
    return !MayBePoint(line) && IsFooter(text, {separator_, columns_.Count(), file_.points.size()});
  }

  /// Whether a line begins like a number and is no rule, or holds nothing but a comment.
  static bool MayBePoint(std::string_view line) {
    // Most lines: no search for a comment is needed to tell.
    std::size_t const sign = line.substr(0, 1) == "-" ? 1 : 0;
    if (sign < line.size() && IsDigit(line[sign])) return true;
    std::string_view const words = Trimmed(line.substr(0, FindComment(line)));
    if (words.empty() || IsDigit(words.front())) return true;
    return std::string_view("+-.").find(words.front()) != std::string_view::npos && !IsRule(words);
  }

  /// Goes to the last line that is not empty, and tells which ones were skipped.
  void SkipFooter(TextLines* lines) {
    std::size_t const first = place_.Line();
    std::size_t last = first;
    while (!lines->AtEnd()) {
      std::string_view const line = lines->Take();
      place_.Enter(line);
      if (!Trimmed(line).empty()) last = place_.Line();
    }
    file_.skipped = first == last
                        ? "line " + std::to_string(first)
                        : "lines " + std::to_string(first) + " to " + std::to_string(last);
    file_.skipped += " behind the table";
  }

  /// A line ahead of the table: "Units: mm", "Einheit;mm". A comment goes before it.
  void ParsePreamble(std::string_view line) {
    if (file_.units.empty()) file_.units = Printable(UnitInPreamble(line));
  }

  /// The header, or the first line of data where there is none.
  void ParseFirstLine(std::string_view line) {
    separator_ = FindSeparator(line);
    SplitFields(line, separator_, &fields_);
    if (std::any_of(fields_.begin(), fields_.end(), LooksLikeNumber)) {
      columns_.TakeFirstLine(fields_, place_);
      return ParsePoint();
    }
    columns_.TakeHeader(fields_, place_);
    TakeUnits(ReadColumnName(fields_[columns_.X()]).unit,
              ReadColumnName(fields_[columns_.Y()]).unit);
    isUnitLineNext_ = table_.hasUnitLine;
  }

  /// The line below the header, of units alone.
  void ParseUnits(std::string_view line) {
    isUnitLineNext_ = false;
    SplitFields(line, FindSeparator(line), &fields_);
    if (!columns_.Fit(fields_)) return;
    auto const unit = [](std::string const& axis, std::string_view field) {
      return ReadColumnName(axis + ' ' + std::string(Unquoted(field))).unit;
    };
    TakeUnits(unit("x", fields_[columns_.X()]), unit("y", fields_[columns_.Y()]));
  }

  /// Those that header or unit line give for the two coordinates. A comment goes before them.
  void TakeUnits(std::string const& ofX, std::string const& ofY) {
    if (ofX.empty() || ofY.empty()) return;
    if (ofX != ofY) {
      place_.RefuseAt(fields_.front(), "one coordinate is in " + Quoted(ofX) + ", the other in " +
                                           Quoted(ofY) + ": a contour needs one unit");
    }
    if (file_.units.empty()) file_.units = Printable(ofX);
  }

  /// A line with the blanks at its ends, and without them.
  void ParseLineOfData(std::string_view line, std::string_view words) {
    if (file_.points.empty()) AdoptSeparatorOfData(words);
    // A tab at the end of a line is an empty field if the columns ask for one, and else nothing.
    SplitFields(separator_ == '\t' ? line : words, separator_, &fields_);
    if (separator_ == '\t' && !columns_.Fit(fields_)) SplitFields(words, separator_, &fields_);
    // Separators at the end of the lines of data, but not of the header.
    while (fields_.size() > columns_.Count() && fields_.back().empty()) fields_.pop_back();
    ParsePoint();
  }

  /// The data may have another separator than the header.
  void AdoptSeparatorOfData(std::string_view firstLine) {
    char const separator = FindSeparator(firstLine);
    SplitFields(firstLine, separator, &fields_);
    if (columns_.Fit(fields_)) separator_ = separator;
  }

  void ParseComment(std::string_view comment) {
    comment.remove_prefix(comment.front() == '#' ? 1 : 2);
    std::string const key = LowerCase(TakeWord(&comment));
    if (key == "units" || key == "unit") file_.units = Printable(TakeWord(&comment));
    if (key != "tolerance") return;
    std::string_view const word = TakeWord(&comment);
    std::optional<double> value = ParseNumber(word);
    if (!value) value = ParseNumber(word, DecimalMark::Comma);
    // A sentence that merely begins with the word is no statement of a tolerance.
    if (!value) return;
    if (!IsTolerance(*value)) RefuseTolerance("tolerance in the comment", word);
    file_.tolerance = *value;
  }

  void ParsePoint() {
    if (!columns_.Fit(fields_)) RefuseColumnCount();
    WPoint point;
    point.x = numbers_.Read("x", fields_[columns_.X()], place_);
    point.y = numbers_.Read("y", fields_[columns_.Y()], place_);
    if (columns_.HaveTolerances()) {
      std::string_view const field = fields_[columns_.Tolerance()];
      point.w = numbers_.Read(columns_.ToleranceName(), field, place_);
      if (!IsTolerance(point.w)) RefuseTolerance("tolerance " + Quoted(field), field);
    }
    if (file_.points.empty()) doRowsBeginWithNumbers_ = LooksLikeNumber(fields_.front());
    file_.points.push_back(point);
    file_.lines.push_back(place_.Line());
  }

  static bool IsTolerance(double value) { return value > 0.0 && std::isfinite(value); }

  [[noreturn]] void RefuseTolerance(std::string const& what, std::string_view at) const {
    place_.RefuseAt(at, what + " must be a finite number above 0");
  }

  [[noreturn]] void RefuseColumnCount() const {
    std::string_view const where =
        fields_.size() > columns_.Count() ? fields_[columns_.Count()] : fields_.front();
    char const* const begin = fields_.front().data();
    char const* const end = fields_.back().data() + fields_.back().size();
    place_.RefuseAt(where, "expected " + std::to_string(columns_.Count()) + " columns, found " +
                               std::to_string(fields_.size()) + ": " +
                               Quoted({begin, static_cast<std::size_t>(end - begin)}));
  }

  void RefuseTooFewPoints() const {
    if (file_.points.size() >= 2) return;
    if (columns_.Count() == 0) place_.Refuse("holds no points");
    if (file_.points.empty()) place_.Refuse("holds a header but no points");
    place_.Refuse("holds one point only; a contour needs two");
  }

  CsvPlace place_;
  CsvColumns columns_;
  CsvNumbers numbers_;
  PointFile file_;
  std::vector<std::string_view> fields_;  ///< of the current line; kept for its memory
  char separator_ = ',';
  TableStart table_;
  bool isUnitLineNext_ = false;
  bool doRowsBeginWithNumbers_ = false;
};

}  // namespace

std::optional<ColumnChoice> ParseColumnChoice(std::string_view text) {
  std::vector<std::string_view> names;
  SplitFields(text, ',', &names);
  if (names.size() < 2 || names.size() > 3) return {};
  names.resize(3);
  ColumnChoice const choice{std::string(Unquoted(names[0])), std::string(Unquoted(names[1])),
                            std::string(Unquoted(names[2]))};
  bool const anyEmpty =
      choice.x.empty() || choice.y.empty() || (choice.w.empty() && names[2].data() != nullptr);
  bool const anyTwice = choice.x == choice.y || choice.x == choice.w || choice.y == choice.w;
  if (anyEmpty || anyTwice) return {};
  return choice;
}

PointFile ParsePoints(std::string_view text, std::string const& path,
                      ToleranceColumn const& tolerance, ColumnChoice const& columns) {
  return Parser(path, tolerance, columns).Parse(text);
}

PointFile ReadPoints(std::string const& path, std::istream& in, ToleranceColumn const& tolerance,
                     ColumnChoice const& columns) {
  return ParsePoints(ReadTextFile(path, in), path, tolerance, columns);
}

}  // namespace Vorn::IO
