#include <algorithm>
#include <cmath>
#include <istream>
#include <iterator>
#include <utility>

#include "io/base/Fields.h"
#include "io/base/TextLines.h"
#include "io/base/Words.h"
#include "io/points/ColumnNames.h"
#include "io/points/TableStart.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Files.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/Points.h"

namespace Vorn::IO {

namespace {

constexpr std::string_view kUtf8Mark = "\xEF\xBB\xBF";
constexpr std::string_view kUtf16Marks[] = {"\xFF\xFE", "\xFE\xFF"};
constexpr std::size_t kMostNamesInMessage = 8;
constexpr std::size_t kLongestColumnNumber = 9;
constexpr std::size_t kShortestLine = 4;  // 1,2 and its end

/// A million columns fit; taking a longer line apart would take many times its memory.
constexpr std::size_t kLongestLine = std::size_t{16} << 20;

std::string_view TakeWord(std::string_view* text) {
  *text = Trimmed(*text);
  std::size_t const end = std::min(text->find_first_of(" \t:="), text->size());
  std::string_view const word = text->substr(0, end);
  text->remove_prefix(end);
  *text = text->substr(std::min(text->find_first_not_of(" \t:="), text->size()));
  return word;
}

std::string LowerName(std::string_view field) { return LowerCase(Trimmed(Unquoted(field))); }

/// The index of the column with this number, counted from 1; nothing for other text.
std::optional<std::size_t> IndexOfNumber(std::string_view text) {
  bool const isNumber = !text.empty() && text.size() <= kLongestColumnNumber &&
                        text.find_first_not_of("0123456789") == std::string_view::npos;
  if (!isNumber) return {};
  std::size_t const number = std::stoul(std::string(text));
  if (number == 0) return {};
  return number - 1;
}

class Parser {
 public:
  Parser(std::string const& path, ToleranceColumn const& tolerance, ColumnChoice const& columns)
      : tolerance_(tolerance), columns_(columns) {
    file_.path = Printable(InputName(path));
    if (columns.w.empty()) return;
    if (tolerance.use == ToleranceColumn::Use::Required) {
      throw Failure(
          FailureKind::BadArgument,
          "two columns for the tolerance: " + Quoted(columns.w) + " and " + Quoted(tolerance.name));
    }
    if (tolerance.use == ToleranceColumn::Use::Ignore) return;
    tolerance_ = {ToleranceColumn::Use::Required, columns.w};
  }

  PointFile Parse(std::string_view text) {
    if (text.substr(0, kUtf8Mark.size()) == kUtf8Mark) text.remove_prefix(kUtf8Mark.size());
    RefuseOtherThanText(text);
    auto const lineFeeds = static_cast<std::size_t>(std::count(text.begin(), text.end(), '\n'));
    std::size_t const mostPoints = std::min(lineFeeds, text.size() / kShortestLine) + 1;
    file_.points.reserve(mostPoints);
    file_.lines.reserve(mostPoints);
    table_ = FindTable(text);
    TextLines lines(text);
    while (!lines.AtEnd()) {
      ++line_;
      lineText_ = lines.Take();
      ParseLine();
    }
    RefuseTooFewPoints();
    file_.columns = DescribeColumns();
    return std::move(file_);
  }

 private:
  void ParseLine() {
    if (lineText_.size() > kLongestLine) {
      throw Failure(FailureKind::File, file_.path + ":" + std::to_string(line_) +
                                           ": the line is longer than 16 MiB: no points file has "
                                           "such lines");
    }
    std::size_t const comment = FindComment(lineText_);
    std::string_view line = lineText_.substr(0, comment);
    if (comment != std::string_view::npos && file_.points.empty()) {
      ParseComment(lineText_.substr(comment));
    }
    if (Trimmed(line).empty() || line_ <= table_.first) return;
    if (isUnitLineNext_) return ParseUnits(line);
    if (columnCount_ != 0) return ParseLineOfData(line);
    separator_ = FindSeparator(Trimmed(line));
    SplitFields(Trimmed(line), separator_, &fields_);
    bool const isHeader = std::none_of(fields_.begin(), fields_.end(), LooksLikeNumber);
    columnCount_ = fields_.size();
    if (columnCount_ < 2) RefuseOneColumn();
    isHeader ? ParseHeader() : ChooseColumnsWithoutHeader();
    if (!isHeader) ParsePoint();
    isUnitLineNext_ = isHeader && table_.hasUnitLine;
  }

  /// The line below the header, of units alone.
  void ParseUnits(std::string_view line) {
    isUnitLineNext_ = false;
    SplitFields(Trimmed(line), FindSeparator(Trimmed(line)), &fields_);
    if (!HasAllFields()) return;
    std::string const unit = ReadColumnName("x " + std::string(Unquoted(fields_[xColumn_]))).unit;
    TakeUnits(unit, ReadColumnName("y " + std::string(Unquoted(fields_[yColumn_]))).unit);
  }

  /// Those that header or unit line give for the two coordinates. A comment goes before them.
  void TakeUnits(std::string const& ofX, std::string const& ofY) {
    if (ofX.empty() || ofY.empty()) return;
    if (ofX != ofY) {
      RefuseAt(fields_.front(), "one coordinate is in " + Quoted(ofX) + ", the other in " +
                                    Quoted(ofY) + ": a contour needs one unit");
    }
    if (file_.units.empty()) file_.units = Printable(ofX);
  }

  void ParseLineOfData(std::string_view line) {
    if (file_.points.empty()) AdoptSeparatorOfData(Trimmed(line));
    // A tab at the end of a line is an empty field if the columns ask for one, and else nothing.
    SplitFields(separator_ == '\t' ? line : Trimmed(line), separator_, &fields_);
    if (separator_ == '\t' && !HasAllFields()) SplitFields(Trimmed(line), separator_, &fields_);
    ParsePoint();
  }

  /// The data may have another separator than the header.
  void AdoptSeparatorOfData(std::string_view firstLine) {
    char const separator = FindSeparator(firstLine);
    SplitFields(firstLine, separator, &fields_);
    if (HasAllFields()) separator_ = separator;
  }

  bool HasAllFields() const { return fields_.size() == columnCount_; }

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
    file_.tolerance = CheckedTolerance(*value, "tolerance in the comment", word);
  }

  void ParseHeader() {
    std::transform(fields_.begin(), fields_.end(), std::back_inserter(names_), LowerName);
    if (columns_.IsGiven()) ChooseGivenColumns();
    if (tolerance_.use == ToleranceColumn::Use::Required) {
      ChooseTolerance(IndexOf(tolerance_.name));
    } else if (tolerance_.use == ToleranceColumn::Use::IfPresent && FindName(tolerance_.name)) {
      ChooseTolerance(*FindName(tolerance_.name));
    }
    if (!columns_.IsGiven()) ChooseColumnsByName();
    TakeUnits(ReadColumnName(fields_[xColumn_]).unit, ReadColumnName(fields_[yColumn_]).unit);
  }

  void ChooseColumnsByName() {
    std::vector<ColumnName> names;
    std::transform(fields_.begin(), fields_.end(), std::back_inserter(names), ReadColumnName);
    std::optional<std::size_t> tolerance = FindName("w");
    if (file_.hasTolerances) tolerance = wColumn_;
    std::optional<PointColumns> const columns = FindPointColumns(names, tolerance);
    if (!columns) {
      RefuseAt(fields_.front(), "cannot tell which two columns hold the points: the header has " +
                                    NamesInHeader() + "; say it with --columns X,Y");
    }
    xColumn_ = columns->x;
    yColumn_ = columns->y;
  }

  /// "1 (x) and 2 (y)", numbers alone without a header.
  std::string DescribeColumns() const {
    auto const column = [this](std::size_t index) {
      std::string const number = std::to_string(index + 1);
      return names_.empty() ? number : number + " (" + Printable(names_[index]) + ")";
    };
    std::string const text = column(xColumn_) + " and " + column(yColumn_);
    return file_.hasTolerances ? text + ", the tolerance in " + column(wColumn_) : text;
  }

  void ChooseColumnsWithoutHeader() {
    if (columns_.IsGiven()) {
      ChooseGivenColumns();
    } else if (columnCount_ > 3) {
      RefuseAt(fields_[3], std::to_string(columnCount_) +
                               " columns without a header; expected x,y or x,y,w, or --columns "
                               "with the numbers of those to take");
    }
    bool const isThird = !columns_.IsGiven() && columnCount_ == 3 && !fields_[2].empty() &&
                         LowerCase(tolerance_.name) == "w";
    if (tolerance_.use == ToleranceColumn::Use::Required) {
      ChooseTolerance(isThird ? 2 : IndexOf(tolerance_.name));
    } else if (tolerance_.use == ToleranceColumn::Use::IfPresent && isThird) {
      ChooseTolerance(2);
    }
  }

  void ChooseGivenColumns() {
    xColumn_ = IndexOf(columns_.x);
    yColumn_ = IndexOf(columns_.y);
  }

  void ChooseTolerance(std::size_t column) {
    wColumn_ = column;
    file_.hasTolerances = true;
    file_.toleranceColumn = tolerance_.name;
  }

  std::optional<std::size_t> FindName(std::string const& name) const {
    auto const found = std::find(names_.begin(), names_.end(), LowerCase(name));
    if (found == names_.end()) return {};
    return static_cast<std::size_t>(found - names_.begin());
  }

  /// A column that the user named or numbered.
  std::size_t IndexOf(std::string const& column) const {
    if (std::optional<std::size_t> const named = FindName(column)) return *named;
    std::optional<std::size_t> const numbered = IndexOfNumber(column);
    if (numbered && *numbered < columnCount_) return *numbered;
    std::string const reason = numbered         ? "there are " + std::to_string(columnCount_)
                               : names_.empty() ? "the file has no header"
                                                : "the header has " + NamesInHeader();
    RefuseAt(fields_.front(), "no column " + Quoted(column) + "; " + reason);
  }

  std::string NamesInHeader() const {
    std::string list;
    for (std::size_t i = 0; i < std::min(fields_.size(), kMostNamesInMessage); ++i) {
      list += (i == 0 ? "" : ", ") + Quoted(fields_[i]);
    }
    return fields_.size() > kMostNamesInMessage
               ? list + " and " + std::to_string(fields_.size() - kMostNamesInMessage) + " more"
               : list;
  }

  void ParsePoint() {
    if (!HasAllFields()) RefuseColumnCount();
    WPoint point;
    point.x = ParseField("x", fields_[xColumn_]);
    point.y = ParseField("y", fields_[yColumn_]);
    if (file_.hasTolerances) {
      std::string_view const field = fields_[wColumn_];
      point.w =
          CheckedTolerance(ParseField(tolerance_.name, field), "tolerance " + Quoted(field), field);
    }
    file_.points.push_back(point);
    file_.lines.push_back(line_);
  }

  double ParseField(std::string_view name, std::string_view field) {
    std::string_view const text = Unquoted(field);
    if (lineOfMark_ == 0) LearnDecimalMark(text);
    std::optional<double> const value = ParseNumber(text, mark_);
    if (!value) RefuseNumber(std::string(name), field);
    if (!std::isfinite(*value)) {
      RefuseAt(field, std::string(name) + " is not a finite number: " + Quoted(field));
    }
    return *value;
  }

  /// The first number with either mark decides: the other one, met later, may group thousands.
  void LearnDecimalMark(std::string_view text) {
    std::size_t const at = text.find_first_of(".,");
    if (at == std::string_view::npos) return;
    mark_ = text[at] == ',' ? DecimalMark::Comma : DecimalMark::Point;
    lineOfMark_ = line_;
  }

  [[noreturn]] void RefuseNumber(std::string const& name, std::string_view field) const {
    if (field.empty()) RefuseAt(field, name + " is missing");
    char const otherMark = mark_ == DecimalMark::Comma ? '.' : ',';
    bool const isOther = lineOfMark_ != line_ && field.find(otherMark) != std::string_view::npos;
    std::string const mark = mark_ == DecimalMark::Comma ? "comma" : "point";
    RefuseAt(field,
             name + " is not a number: " + Quoted(field) +
                 (isOther ? " (line " + std::to_string(lineOfMark_) + " has a decimal " + mark + ")"
                          : ""));
  }

  double CheckedTolerance(double value, std::string const& what, std::string_view at) const {
    if (!(value > 0.0) || !std::isfinite(value)) {
      RefuseAt(at, what + " must be a finite number above 0");
    }
    return value;
  }

  [[noreturn]] void RefuseOneColumn() const {
    RefuseAt(fields_.front(),
             "only one column, " + Quoted(fields_.front()) + "; expected x,y or x,y,w");
  }

  [[noreturn]] void RefuseColumnCount() const {
    std::string_view const where =
        fields_.size() > columnCount_ ? fields_[columnCount_] : fields_.front();
    char const* const begin = fields_.front().data();
    char const* const end = fields_.back().data() + fields_.back().size();
    RefuseAt(where, "expected " + std::to_string(columnCount_) + " columns, found " +
                        std::to_string(fields_.size()) + ": " +
                        Quoted({begin, static_cast<std::size_t>(end - begin)}));
  }

  void RefuseOtherThanText(std::string_view text) {
    for (std::string_view const mark : kUtf16Marks) {
      if (text.substr(0, mark.size()) == mark) Refuse("is UTF-16 text; save it as UTF-8");
    }
    std::size_t const zero = text.find('\0');
    if (zero == std::string_view::npos) return;
    Refuse("is not text: byte " + std::to_string(zero) + " is zero");
  }

  void RefuseTooFewPoints() const {
    if (file_.points.size() >= 2) return;
    if (columnCount_ == 0) Refuse("holds no points");
    if (file_.points.empty()) Refuse("holds a header but no points");
    Refuse("holds one point only; a contour needs two");
  }

  [[noreturn]] void Refuse(std::string const& message) const {
    throw Failure(FailureKind::File, {file_.path}, message);
  }

  /// `field` is part of the current line.
  [[noreturn]] void RefuseAt(std::string_view field, std::string const& message) const {
    throw Failure(FailureKind::File, {file_.path, line_, ColumnOf(field.data())}, message);
  }

  /// Counted in characters, as editors do.
  std::size_t ColumnOf(char const* place) const {
    constexpr unsigned kContinuation = 0x80;
    constexpr unsigned kContinuationMask = 0xC0;
    return 1 + static_cast<std::size_t>(std::count_if(lineText_.data(), place, [](char c) {
             return (static_cast<unsigned char>(c) & kContinuationMask) != kContinuation;
           }));
  }

  ToleranceColumn tolerance_;
  ColumnChoice columns_;
  PointFile file_;
  std::size_t line_ = 0;
  std::string_view lineText_;
  std::vector<std::string_view> fields_;  ///< of the current line; kept for its memory
  std::vector<std::string> names_;        ///< of the columns, in lower case
  char separator_ = ',';
  std::size_t columnCount_ = 0;
  std::size_t xColumn_ = 0;
  std::size_t yColumn_ = 1;
  std::size_t wColumn_ = 2;
  TableStart table_;
  bool isUnitLineNext_ = false;
  DecimalMark mark_ = DecimalMark::Point;
  std::size_t lineOfMark_ = 0;  ///< where the decimal mark was seen first; 0: not yet
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
