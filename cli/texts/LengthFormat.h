#pragma once

#include <optional>
#include <string>

namespace Vorn::Cli {

/// How coordinates and lengths of a table are printed: to a hundredth of the smallest tolerance, as
/// long as that gives columns of a readable width.
class LengthFormat {
 public:
  /// @param wanted digits after the point in place of those
  explicit LengthFormat(double smallestTolerance, std::optional<int> wanted = {});

  /// The length with as many digits as the table has.
  std::string operator()(double value) const;

  /// The same with one digit more, for what is smaller than the tolerance.
  std::string Finer(double value) const;

 private:
  /// The value with so many digits after the point.
  std::string Format(double value, int decimals) const;

  int decimals_ = 0;
  bool isFixed_ = true;
};

}  // namespace Vorn::Cli
