#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "geometry/cells/CellSequence.h"

namespace Vorn::Cells {

/// Sums over the sequence that a chain of words stands for, term by term in order, with the very
/// rounding of a plain loop, but without running through all copies.
///
/// While a running sum stays in one binade [2^e, 2^(e+1)), adding v moves it by v rounded to the
/// grid of that binade, always the same whole number of units, unless v lies exactly between two
/// grid points (a tie, which rounds to even and so depends on the sum). The movement of a whole
/// word is then a sum of integers, which is found once and applied in one step wherever the sum
/// provably stays inside the binade; elsewhere the word is run through letter by letter.
class SequenceSum {
 public:
  /// The words from the first level to the last one, whose letters the terms belong to.
  explicit SequenceSum(std::vector<CellSequence::Words const*> const& chain);

  /// The sum over all letters of the last level. A letter whose term is skipped adds nothing, not
  /// even a zero.
  double Sum(std::vector<double> const& terms, std::vector<bool> const& isSkipped);

 private:
  /// What a letter's expansion does to a running sum in one binade, in units of its grid.
  struct Movement {
    int exponent = kNoExponent;
    bool isFixed = false;
    std::int64_t total = 0;
    std::int64_t lowest = 0;
    std::int64_t highest = 0;
  };

  static constexpr int kNoExponent = INT32_MIN;

  void Add(std::size_t level, std::uint32_t letter);
  bool AddAtOnce(std::size_t level, std::uint32_t letter);
  Movement const& MovementOf(std::size_t level, std::uint32_t letter, int exponent);
  Movement TermMovement(std::uint32_t letter, int exponent) const;

  std::vector<CellSequence::Words const*> chain_;
  /// For each level and letter, how many terms its expansion holds.
  std::vector<std::vector<std::size_t>> lengths_;
  std::vector<std::vector<Movement>> movements_;
  std::vector<double> const* terms_ = nullptr;
  std::vector<bool> const* isSkipped_ = nullptr;
  double sum_ = 0.0;
};

}  // namespace Vorn::Cells
