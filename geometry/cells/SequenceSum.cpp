#include "geometry/cells/SequenceSum.h"

#include <algorithm>
#include <cmath>
#include <span>

namespace Vorn::Cells {

namespace {

/// Shorter expansions are summed term by term: looking for a shortcut would take longer.
constexpr std::size_t kWorthAShortcut = 64;

/// Bits behind the leading one of a double.
constexpr int kFractionBits = 52;

/// A running sum of a binade measures [2^52, 2^53) units of its grid.
constexpr std::int64_t kBinadeBegin = std::int64_t{1} << kFractionBits;
constexpr std::int64_t kBinadeEnd = kBinadeBegin * 2;

/// Below this exponent the grid's unit would be subnormal.
constexpr int kLowestExponent = -900;
constexpr int kHighestExponent = 900;

}  // namespace

SequenceSum::SequenceSum(std::vector<CellSequence::Words const*> const& chain)
    : chain_(chain), lengths_(chain.size()), movements_(chain.size()) {
  // The word lists of a level replace the letters of the level before; those of the first level
  // hold one word, the sequence that the cell began with.
  for (std::size_t level = chain.size(); level-- > 0;) {
    CellSequence::Words const& words = *chain[level];
    std::size_t const letters = words.ends.size();
    lengths_[level].resize(letters);
    movements_[level].resize(letters);
    for (std::uint32_t letter = 0; letter < letters; ++letter) {
      std::size_t length = 0;
      for (std::uint32_t const next : words.Of(letter)) {
        length += level + 1 < chain.size() ? lengths_[level + 1][next] : 1;
      }
      lengths_[level][letter] = length;
    }
  }
}

double SequenceSum::Sum(std::vector<double> const& terms, std::vector<bool> const& isSkipped) {
  terms_ = &terms;
  isSkipped_ = &isSkipped;
  for (auto& ofLevel : movements_) std::fill(ofLevel.begin(), ofLevel.end(), Movement{});
  sum_ = 0.0;
  Add(0, 0);
  return sum_;
}

void SequenceSum::Add(std::size_t level, std::uint32_t letter) {
  if (lengths_[level][letter] >= kWorthAShortcut && AddAtOnce(level, letter)) return;
  bool const isLast = level + 1 == chain_.size();
  for (std::uint32_t const next : chain_[level]->Of(letter)) {
    if (!isLast) {
      Add(level + 1, next);
    } else if (!(*isSkipped_)[next]) {
      sum_ += (*terms_)[next];
    }
  }
}

/// Moves the sum by a whole expansion. False, sum unchanged, where that could differ from adding
/// the terms one by one.
bool SequenceSum::AddAtOnce(std::size_t level, std::uint32_t letter) {
  if (sum_ == 0.0 || !std::isfinite(sum_)) return false;
  int const exponent = std::ilogb(sum_);
  if (exponent < kLowestExponent || exponent > kHighestExponent) return false;
  Movement const& movement = MovementOf(level, letter, exponent);
  if (!movement.isFixed) return false;
  int const gridExponent = exponent - kFractionBits;
  auto const position = static_cast<std::int64_t>(std::scalbn(sum_, -gridExponent));
  std::int64_t const nearestZero =
      position > 0 ? position + movement.lowest : -(position + movement.highest);
  std::int64_t const farthest =
      position > 0 ? position + movement.highest : -(position + movement.lowest);
  // Strictly inside: the unrounded sums stay in the binade as well.
  if (nearestZero <= kBinadeBegin || farthest >= kBinadeEnd - 1) return false;
  sum_ = std::scalbn(static_cast<double>(position + movement.total), gridExponent);
  return true;
}

SequenceSum::Movement const& SequenceSum::MovementOf(std::size_t level, std::uint32_t letter,
                                                     int exponent) {
  Movement& known = movements_[level][letter];
  if (known.exponent == exponent) return known;
  Movement movement;
  movement.exponent = exponent;
  movement.isFixed = true;
  bool const isLast = level + 1 == chain_.size();
  for (std::uint32_t const next : chain_[level]->Of(letter)) {
    Movement const& part =
        isLast ? TermMovement(next, exponent) : MovementOf(level + 1, next, exponent);
    if (!part.isFixed) {
      movement.isFixed = false;
      break;
    }
    movement.lowest = std::min(movement.lowest, movement.total + part.lowest);
    movement.highest = std::max(movement.highest, movement.total + part.highest);
    movement.total += part.total;
    // More than a binade holds; also keeps the integers far from overflow.
    if (movement.highest > kBinadeEnd || movement.lowest < -kBinadeEnd) {
      movement.isFixed = false;
      break;
    }
  }
  known = movement;
  return known;
}

SequenceSum::Movement SequenceSum::TermMovement(std::uint32_t letter, int exponent) const {
  Movement movement;
  movement.exponent = exponent;
  movement.isFixed = true;
  if ((*isSkipped_)[letter]) return movement;
  double const units = std::scalbn((*terms_)[letter], kFractionBits - exponent);
  bool const isInBinade = std::fabs(units) < static_cast<double>(kBinadeBegin);
  if (!isInBinade || std::fabs(units - std::trunc(units)) == 0.5) {
    movement.isFixed = false;
    return movement;
  }
  movement.total = std::llrint(units);
  movement.lowest = std::min<std::int64_t>(movement.total, 0);
  movement.highest = std::max<std::int64_t>(movement.total, 0);
  return movement;
}

}  // namespace Vorn::Cells
