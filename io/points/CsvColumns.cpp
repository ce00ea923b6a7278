#include "io/points/CsvColumns.h"

#include <algorithm>
#include <iterator>

#include "io/base/Encoding.h"
#include "io/base/Fields.h"
#include "io/base/Words.h"
#include "io/points/ColumnNames.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Messages.h"

namespace Vorn::IO {

namespace {

using Use = ToleranceColumn::Use;

constexpr std::size_t kMostNamesInMessage = 8;
constexpr std::size_t kLongestColumnNumber = 9;

std::string LowerName(std::string_view field) {
  return LowerCase(Trimmed(Utf8FromEither(Unquoted(field))));
}

/// The index of the column with this number, counted from 1; nothing for other text.
std::optional<std::size_t> IndexOfNumber(std::string_view text) {
  bool const isNumber = !text.empty() && text.size() <= kLongestColumnNumber &&
                        text.find_first_not_of("0123456789") == std::string_view::npos;
  if (!isNumber) return {};
  std::size_t const number = std::stoul(std::string(text));
  if (number == 0) return {};
  return number - 1;
}

/// The tolerance's column by either of the two ways to name it.
ToleranceColumn WantedTolerance(ToleranceColumn const& tolerance, ColumnChoice const& choice) {
  if (choice.w.empty()) return tolerance;
  if (tolerance.use == Use::Required) {
    throw Failure(FailureKind::BadArgument, "two columns for the tolerance: " + Quoted(choice.w) +
                                                " and " + Quoted(tolerance.name));
  }
  if (tolerance.use == Use::Ignore) return tolerance;
  return {Use::Required, choice.w};
}

/// The first names of a header, for a message.
std::string NamesIn(CsvColumns::Fields const& header) {
  std::string list;
  for (std::size_t i = 0; i < std::min(header.size(), kMostNamesInMessage); ++i) {
    list += (i == 0 ? "" : ", ") + Quoted(header[i]);
  }
  if (header.size() <= kMostNamesInMessage) return list;
  return list + " and " + std::to_string(header.size() - kMostNamesInMessage) + " more";
}

}  // namespace

CsvColumns::CsvColumns(ToleranceColumn const& tolerance, ColumnChoice const& choice)
    : wanted_(WantedTolerance(tolerance, choice)), choice_(choice) {}

void CsvColumns::TakeHeader(Fields const& fields, CsvPlace const& place) {
  TakeCount(fields, place);
  std::transform(fields.begin(), fields.end(), std::back_inserter(names_), LowerName);
  if (choice_.IsGiven()) ChooseGiven(fields, place);
  if (wanted_.use == Use::Required) {
    tolerance_ = IndexOf(wanted_.name, fields, place);
  } else if (wanted_.use == Use::IfPresent) {
    tolerance_ = FindName(wanted_.name);
  }
  if (!choice_.IsGiven()) ChooseByName(fields, place);
}

void CsvColumns::TakeFirstLine(Fields const& fields, CsvPlace const& place) {
  TakeCount(fields, place);
  if (choice_.IsGiven()) {
    ChooseGiven(fields, place);
  } else if (count_ > 3) {
    place.RefuseAt(fields[3],
                   std::to_string(count_) + " columns without a header; expected x,y or x,y,w",
                   Remedy::ChooseColumns);
  }
  bool const isThird =
      !choice_.IsGiven() && count_ == 3 && !fields[2].empty() && LowerCase(wanted_.name) == "w";
  if (wanted_.use == Use::Required) {
    tolerance_ = isThird ? 2 : IndexOf(wanted_.name, fields, place);
  } else if (wanted_.use == Use::IfPresent && isThird) {
    tolerance_ = 2;
  }
}

void CsvColumns::TakeCount(Fields const& fields, CsvPlace const& place) {
  count_ = fields.size();
  if (count_ >= 2) return;
  place.RefuseAt(fields.front(),
                 "only one column, " + Quoted(fields.front()) + "; expected x,y or x,y,w");
}

void CsvColumns::ChooseByName(Fields const& fields, CsvPlace const& place) {
  std::vector<ColumnName> names;
  std::transform(fields.begin(), fields.end(), std::back_inserter(names), ReadColumnName);
  std::optional<PointColumns> const columns =
      FindPointColumns(names, tolerance_ ? tolerance_ : FindName("w"));
  if (!columns) {
    place.RefuseAt(
        fields.front(),
        "cannot tell which two columns hold the points: the header has " + NamesIn(fields),
        Remedy::ChooseColumns);
  }
  x_ = columns->x;
  y_ = columns->y;
}

void CsvColumns::ChooseGiven(Fields const& fields, CsvPlace const& place) {
  x_ = IndexOf(choice_.x, fields, place);
  y_ = IndexOf(choice_.y, fields, place);
}

std::optional<std::size_t> CsvColumns::FindName(std::string const& name) const {
  auto const found = std::find(names_.begin(), names_.end(), LowerCase(name));
  if (found == names_.end()) return {};
  return static_cast<std::size_t>(found - names_.begin());
}

std::size_t CsvColumns::IndexOf(std::string const& column, Fields const& fields,
                                CsvPlace const& place) const {
  if (std::optional<std::size_t> const named = FindName(column)) return *named;
  std::optional<std::size_t> const numbered = IndexOfNumber(column);
  if (numbered && *numbered < count_) return *numbered;
  std::string const reason = numbered         ? "there are " + std::to_string(count_)
                             : names_.empty() ? "the file has no header"
                                              : "the header has " + NamesIn(fields);
  place.RefuseAt(fields.front(), "no column " + Quoted(column) + "; " + reason);
}

std::string CsvColumns::Describe() const {
  std::string const text = DescribeColumn(x_) + " and " + DescribeColumn(y_);
  return tolerance_ ? text + ", the tolerance in " + DescribeColumn(*tolerance_) : text;
}

std::string CsvColumns::DescribeColumn(std::size_t index) const {
  std::string const number = std::to_string(index + 1);
  return names_.empty() ? number : number + " (" + Printable(names_[index]) + ")";
}

}  // namespace Vorn::IO
