// Why a step at once is exact. In the binade [2^e, 2^(e+1)) doubles lie on a grid of 2^(e-52), and
// a sum is a whole number of units from 2^52 up to below 2^53.
//
//   1. A term of v units moves a sum at position p to p + v, rounded to the grid while p + v is in
//      the binade: by the nearest whole number w of units, |w - v| <= 1/2, whatever p is. Where v
//      lies half way between two numbers, p + w is the even one: w depends on p being odd.
//   2. Positions after each term, from an even and from an odd start, are sums of whole numbers. As
//      long as they stay below 2^53 in size, integers and doubles hold them exactly.
//   3. If every position on the way is above 2^52 and below 2^53 - 1, then every unrounded sum, at
//      most 1/2 off, is above 2^52 and below 2^53: step 1 applied all along.
#include "geometry/cells/fast/SequenceSum.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <limits>

namespace Vorn::Cells {

namespace {

/// Expansions that take fewer steps are summed term by term: looking for a shortcut would take
/// longer (measured).
constexpr std::size_t kWorthAShortcut = 16;

/// Bits behind the leading one of a double.
constexpr int kFractionBits = std::numeric_limits<double>::digits - 1;

/// A running sum measures from 2^52 up to below 2^53 units of its binade's grid.
constexpr std::int64_t kBinadeBegin = std::int64_t{1} << kFractionBits;
constexpr std::int64_t kBinadeEnd = kBinadeBegin * 2;

/// The exponents of the least and the greatest normal double.
constexpr int kExponentBias = std::numeric_limits<double>::max_exponent - 1;
constexpr int kLeastExponent = 1 - kExponentBias;

/// Shortcuts are taken between these exponents. The grid's unit, 52 binades below, and its inverse
/// are then normal doubles.
constexpr int kLowestExponent = -900;
constexpr int kHighestExponent = 900;

static_assert(kLowestExponent - kFractionBits >= kLeastExponent);
static_assert(kFractionBits - kLowestExponent <= kExponentBias);
static_assert(kFractionBits - kHighestExponent >= kLeastExponent);

/// The bits of the exponent of a double, shifted down.
constexpr std::uint64_t kExponentMask = 0x7FF;

/// The exponent of the binade of a normal double; out of the range above for all others.
int ExponentOf(double value) {
  return static_cast<int>(std::bit_cast<std::uint64_t>(value) >> kFractionBits & kExponentMask) -
         kExponentBias;
}

/// Two to the power of a normal double's exponent.
double PowerOfTwo(int exponent) {
  return std::bit_cast<double>(static_cast<std::uint64_t>(exponent + kExponentBias)
                               << kFractionBits);
}

}  // namespace

SequenceSum::SequenceSum(std::vector<Words const*> const& levels)
    : levels_(levels),
      lengths_(levels.size()),
      costs_(levels.size()),
      totals_(levels.size()),
      movements_(levels.size()) {
  for (std::size_t level = levels.size(); level-- > 0;) MeasureLevel(level);
}

void SequenceSum::MeasureLevel(std::size_t level) {
  Words const& words = *levels_[level];
  std::size_t const letters = words.ends.size();
  lengths_[level].resize(letters);
  costs_[level].resize(letters);
  totals_[level].resize(letters);
  movements_[level].resize(letters);
  for (Letter letter = 0; letter < letters; ++letter) {
    std::size_t length = 0;
    std::size_t cost = 1;
    for (Letter const next : words.Of(letter)) {
      length += IsLast(level) ? 1 : lengths_[level + 1][next];
      cost += IsLast(level) ? 1 : costs_[level + 1][next];
    }
    lengths_[level][letter] = length;
    costs_[level][letter] = length == 0 ? 0 : cost;
  }
}

double SequenceSum::Sum(std::vector<double> const& terms, std::vector<bool> const& isSkipped) {
  terms_ = &terms;
  isSkipped_ = &isSkipped;
  for (auto& ofLevel : movements_) std::fill(ofLevel.begin(), ofLevel.end(), Movement{});
  FindTotals();
  sum_ = 0.0;
  Add({0, 0});
  return sum_;
}

double SequenceSum::TotalOf(Place const& place) const {
  auto const& [level, letter] = place;
  double total = 0.0;
  for (Letter const next : levels_[level]->Of(letter)) {
    if (!IsLast(level)) {
      total += totals_[level + 1][next];
    } else if (!(*isSkipped_)[next]) {
      total += (*terms_)[next];
    }
  }
  return total;
}

void SequenceSum::FindTotals() {
  for (std::size_t level = levels_.size(); level-- > 0;) {
    std::vector<double>& totals = totals_[level];
    for (Letter letter = 0; letter < totals.size(); ++letter) {
      totals[letter] = TotalOf({level, letter});
    }
  }
}

void SequenceSum::Add(Place const& place) {
  auto const& [level, letter] = place;
  if (lengths_[level][letter] == 0) return;
  if (costs_[level][letter] >= kWorthAShortcut && MayStayInBinade(place) && AddAtOnce(place)) {
    return;
  }
  for (Letter const next : levels_[level]->Of(letter)) {
    if (!IsLast(level)) {
      Add({level + 1, next});
    } else if (!(*isSkipped_)[next]) {
      sum_ += (*terms_)[next];
    }
  }
}

bool SequenceSum::MayStayInBinade(Place const& place) const {
  return ExponentOf(sum_ + totals_[place.level][place.letter]) == ExponentOf(sum_);
}

bool SequenceSum::AddAtOnce(Place const& place) {
  int const exponent = ExponentOf(sum_);
  if (exponent < kLowestExponent || exponent > kHighestExponent) return false;
  Movement const& movement = MovementOf(place, exponent);
  if (!movement.isKnown) return false;
  int const gridExponent = exponent - kFractionBits;
  auto const position = static_cast<std::int64_t>(sum_ * PowerOfTwo(-gridExponent));
  Path const& path = movement.From(position);
  std::int64_t const nearestZero =
      position > 0 ? position + path.lowest : -(position + path.highest);
  std::int64_t const farthest = position > 0 ? position + path.highest : -(position + path.lowest);
  if (nearestZero <= kBinadeBegin || farthest >= kBinadeEnd - 1) return false;
  sum_ = static_cast<double>(position + path.total) * PowerOfTwo(gridExponent);
  return true;
}

void SequenceSum::Path::Append(Path const& next) {
  lowest = std::min(lowest, total + next.lowest);
  highest = std::max(highest, total + next.highest);
  total += next.total;
}

bool SequenceSum::Path::FitsBinade() const {
  return highest <= kBinadeEnd && lowest >= -kBinadeEnd;
}

SequenceSum::Movement const& SequenceSum::MovementOf(Place const& place, int exponent) {
  auto const& [level, letter] = place;
  Movement& known = movements_[level][letter];
  if (known.exponent == exponent) return known;
  Movement movement;
  movement.exponent = exponent;
  movement.isKnown = true;
  for (Letter const next : levels_[level]->Of(letter)) {
    Movement const& part =
        IsLast(level) ? TermMovement(next, exponent) : MovementOf({level + 1, next}, exponent);
    movement.isKnown = part.isKnown;
    if (!part.isKnown) break;
    movement.fromEven.Append(part.From(movement.fromEven.total));
    movement.fromOdd.Append(part.From(movement.fromOdd.total + 1));
    movement.isKnown = movement.fromEven.FitsBinade() && movement.fromOdd.FitsBinade();
    if (!movement.isKnown) break;
  }
  known = movement;
  return known;
}

SequenceSum::Movement SequenceSum::TermMovement(Letter letter, int exponent) const {
  Movement movement;
  movement.isKnown = true;
  if ((*isSkipped_)[letter]) return movement;
  double const units = (*terms_)[letter] * PowerOfTwo(kFractionBits - exponent);
  movement.isKnown = std::fabs(units) < static_cast<double>(kBinadeBegin);
  if (!movement.isKnown) return movement;
  auto const whole = static_cast<std::int64_t>(units);
  double const fraction = units - static_cast<double>(whole);
  std::int64_t const away = fraction < 0.0 ? -1 : 1;
  bool const isWholeOdd = (whole & 1) != 0;
  if (std::fabs(fraction) == 0.5) {
    movement.fromEven = Step(isWholeOdd ? whole + away : whole);
    movement.fromOdd = Step(isWholeOdd ? whole : whole + away);
  } else {
    movement.fromEven = Step(std::fabs(fraction) < 0.5 ? whole : whole + away);
    movement.fromOdd = movement.fromEven;
  }
  return movement;
}

SequenceSum::Path SequenceSum::Step(std::int64_t units) {
  return {units, std::min<std::int64_t>(units, 0), std::max<std::int64_t>(units, 0)};
}

}  // namespace Vorn::Cells
