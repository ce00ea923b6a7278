#include "geometry/cells/fast/SequenceSum.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <span>

namespace Vorn::Cells {

namespace {

/// Expansions that take fewer steps are summed term by term: looking for a shortcut would take
/// longer.
constexpr std::size_t kWorthAShortcut = 16;

/// Bits behind the leading one of a double.
constexpr int kFractionBits = 52;

/// A running sum of a binade measures [2^52, 2^53) units of its grid.
constexpr std::int64_t kBinadeBegin = std::int64_t{1} << kFractionBits;
constexpr std::int64_t kBinadeEnd = kBinadeBegin * 2;

/// Below this exponent the grid's unit would be subnormal; above the other one, its inverse.
constexpr int kLowestExponent = -900;
constexpr int kHighestExponent = 900;

constexpr int kExponentBias = 1023;

/// The exponent of the binade of a normal double; out of the range above for all others.
int ExponentOf(double value) {
  return static_cast<int>(std::bit_cast<std::uint64_t>(value) >> kFractionBits & 0x7FF) -
         kExponentBias;
}

/// Two to the power of a normal double's exponent.
double PowerOfTwo(int exponent) {
  return std::bit_cast<double>(static_cast<std::uint64_t>(exponent + kExponentBias)
                               << kFractionBits);
}

}  // namespace

SequenceSum::SequenceSum(std::vector<CellSequence::Words const*> const& chain)
    : chain_(chain),
      lengths_(chain.size()),
      costs_(chain.size()),
      totals_(chain.size()),
      movements_(chain.size()) {
  // The word lists of a level replace the letters of the level before; those of the first level
  // hold one word, the sequence that the cell began with.
  for (std::size_t level = chain.size(); level-- > 0;) {
    CellSequence::Words const& words = *chain[level];
    std::size_t const letters = words.ends.size();
    lengths_[level].resize(letters);
    costs_[level].resize(letters);
    totals_[level].resize(letters);
    movements_[level].resize(letters);
    for (std::uint32_t letter = 0; letter < letters; ++letter) {
      std::size_t length = 0;
      std::size_t cost = 1;
      for (std::uint32_t const next : words.Of(letter)) {
        bool const isLast = level + 1 == chain.size();
        length += isLast ? 1 : lengths_[level + 1][next];
        cost += isLast ? 1 : costs_[level + 1][next];
      }
      lengths_[level][letter] = length;
      costs_[level][letter] = length == 0 ? 0 : cost;
    }
  }
}

double SequenceSum::Sum(std::vector<double> const& terms, std::vector<bool> const& isSkipped) {
  terms_ = &terms;
  isSkipped_ = &isSkipped;
  for (auto& ofLevel : movements_) std::fill(ofLevel.begin(), ofLevel.end(), Movement{});
  FindTotals();
  sum_ = 0.0;
  Add(0, 0);
  return sum_;
}

void SequenceSum::FindTotals() {
  for (std::size_t level = chain_.size(); level-- > 0;) {
    bool const isLast = level + 1 == chain_.size();
    for (std::uint32_t letter = 0; letter < totals_[level].size(); ++letter) {
      double total = 0.0;
      for (std::uint32_t const next : chain_[level]->Of(letter)) {
        if (!isLast) {
          total += totals_[level + 1][next];
        } else if (!(*isSkipped_)[next]) {
          total += (*terms_)[next];
        }
      }
      totals_[level][letter] = total;
    }
  }
}

void SequenceSum::Add(std::size_t level, std::uint32_t letter) {
  if (lengths_[level][letter] == 0) return;
  if (costs_[level][letter] >= kWorthAShortcut && MayStayInBinade(level, letter) &&
      AddAtOnce(level, letter)) {
    return;
  }
  bool const isLast = level + 1 == chain_.size();
  for (std::uint32_t const next : chain_[level]->Of(letter)) {
    if (!isLast) {
      Add(level + 1, next);
    } else if (!(*isSkipped_)[next]) {
      sum_ += (*terms_)[next];
    }
  }
}

bool SequenceSum::MayStayInBinade(std::size_t level, std::uint32_t letter) const {
  return ExponentOf(sum_ + totals_[level][letter]) == ExponentOf(sum_);
}

/// Moves the sum by a whole expansion. False, sum unchanged, where that could differ from adding
/// the terms one by one.
bool SequenceSum::AddAtOnce(std::size_t level, std::uint32_t letter) {
  int const exponent = ExponentOf(sum_);
  if (exponent < kLowestExponent || exponent > kHighestExponent) return false;
  Movement const& movement = MovementOf(level, letter, exponent);
  if (!movement.isKnown) return false;
  int const gridExponent = exponent - kFractionBits;
  auto const position = static_cast<std::int64_t>(sum_ * PowerOfTwo(-gridExponent));
  Path const& path = movement.From(position);
  std::int64_t const nearestZero =
      position > 0 ? position + path.lowest : -(position + path.highest);
  std::int64_t const farthest = position > 0 ? position + path.highest : -(position + path.lowest);
  // Strictly inside: the unrounded sums stay in the binade as well.
  if (nearestZero <= kBinadeBegin || farthest >= kBinadeEnd - 1) return false;
  sum_ = static_cast<double>(position + path.total) * PowerOfTwo(gridExponent);
  return true;
}

void SequenceSum::Path::Append(Path const& next) {
  lowest = std::min(lowest, total + next.lowest);
  highest = std::max(highest, total + next.highest);
  total += next.total;
}

SequenceSum::Movement const& SequenceSum::MovementOf(std::size_t level, std::uint32_t letter,
                                                     int exponent) {
  Movement& known = movements_[level][letter];
  if (known.exponent == exponent) return known;
  Movement movement;
  movement.exponent = exponent;
  movement.isKnown = true;
  bool const isLast = level + 1 == chain_.size();
  for (std::uint32_t const next : chain_[level]->Of(letter)) {
    Movement const& part =
        isLast ? TermMovement(next, exponent) : MovementOf(level + 1, next, exponent);
    movement.isKnown = part.isKnown;
    if (!part.isKnown) break;
    movement.fromEven.Append(part.From(movement.fromEven.total));
    movement.fromOdd.Append(part.From(movement.fromOdd.total + 1));
    // More than a binade holds; also keeps the integers far from overflow.
    movement.isKnown = IsWithinBinade(movement.fromEven) && IsWithinBinade(movement.fromOdd);
    if (!movement.isKnown) break;
  }
  known = movement;
  return known;
}

SequenceSum::Movement SequenceSum::TermMovement(std::uint32_t letter, int exponent) const {
  Movement movement;
  movement.exponent = exponent;
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

bool SequenceSum::IsWithinBinade(Path const& path) {
  return path.highest <= kBinadeEnd && path.lowest >= -kBinadeEnd;
}

}  // namespace Vorn::Cells
