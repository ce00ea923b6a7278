#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "io/points/CsvPlace.h"
#include "vorn/io/Points.h"

namespace Vorn::IO {

/// Which columns of a points file hold the coordinates and the tolerances.
class CsvColumns {
 public:
  using Fields = std::vector<std::string_view>;

  /// Columns that are not known yet. Two columns for the tolerance are refused.
  CsvColumns(ToleranceColumn const& tolerance, ColumnChoice const& choice);

  /// Takes the columns from the fields of the header, or refuses a header that does not tell.
  void TakeHeader(Fields const& fields, CsvPlace const& place);

  /// Takes the columns from the first line of data, where the file has no header.
  void TakeFirstLine(Fields const& fields, CsvPlace const& place);

  /// How many columns there are; 0: not known yet.
  std::size_t Count() const { return count_; }

  /// Whether a line of data has as many fields as there are columns.
  bool Fit(Fields const& fields) const { return fields.size() == count_; }

  /// The column of the first coordinate, counted from 0.
  std::size_t X() const { return x_; }

  /// The column of the second coordinate.
  std::size_t Y() const { return y_; }

  /// Whether a column holds each point's tolerance.
  bool HaveTolerances() const { return tolerance_.has_value(); }

  /// The column of the tolerance, where there is one.
  std::size_t Tolerance() const { return *tolerance_; }

  /// What the column of the tolerance was asked for by: a name or a number.
  std::string const& ToleranceName() const { return wanted_.name; }

  /// "1 (x) and 2 (y)", numbers alone without a header.
  std::string Describe() const;

 private:
  /// Counts the columns; one alone cannot hold points.
  void TakeCount(Fields const& fields, CsvPlace const& place);
  /// Takes the columns of the coordinates from what the header calls them.
  void ChooseByName(Fields const& fields, CsvPlace const& place);
  /// Takes them as the user named or numbered them.
  void ChooseGiven(Fields const& fields, CsvPlace const& place);
  /// The column that the header calls so, in small or capital letters.
  std::optional<std::size_t> FindName(std::string const& name) const;
  /// A column that the user named or numbered; without it the line is refused.
  std::size_t IndexOf(std::string const& column, Fields const& fields, CsvPlace const& place) const;
  /// "2 (y)", the number alone without a header.
  std::string DescribeColumn(std::size_t index) const;

  ToleranceColumn wanted_;
  ColumnChoice choice_;
  std::vector<std::string> names_;  ///< from the header, in lower case
  std::size_t count_ = 0;
  std::size_t x_ = 0;
  std::size_t y_ = 1;
  std::optional<std::size_t> tolerance_;
};

}  // namespace Vorn::IO
