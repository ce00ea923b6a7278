#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace Vorn::IO {

/// A column of many numbers as text of some three characters a number, which a page unpacks.
///
/// Each number is rounded to a multiple of 10^-decimals. The multiples are replaced by the
/// differences of neighbours, `order` times over; the first of each row stays, as a difference
/// from 0. A difference d becomes 2d, or -2d - 1 if it is negative, and is written in bytes of
/// seven bits, the lowest first, each but the last with its top bit set. After a difference of 0
/// the number of further ones that follow it is written in the same way, once for the whole run.
/// The bytes stand as base64.
///
/// @note Property: a number with no more than `decimals` digits behind its point comes back as the
///       very same double, multiple / 10^decimals being the correctly rounded quotient of two exact
///       numbers.
struct PackedColumn {
  int decimals = 0;       ///< may be negative: multiples of ten, of a hundred
  int order = 0;          ///< 0, 1 or 2: whichever takes the least room
  std::size_t count = 0;  ///< of numbers
  std::string bytes;      ///< base64
};

/// The fewest decimals whose last digit is worth no more than `step`, which is above 0.
int DecimalsOfStep(double step);

/// The most decimals that a number of this size may have: the multiples stay below 2^50, so that
/// the page reads them exactly, and 10^decimals is exact, which it is up to 22.
int MostDecimals(double largest);

/// Packs finite numbers no larger than kLargestPacked; `decimals` is at most MostDecimals of the
/// largest of them.
PackedColumn Pack(std::vector<double> const& numbers, int decimals);

/// Beyond this size no decimals would do.
inline constexpr double kLargestPacked = 1e30;

}  // namespace Vorn::IO
