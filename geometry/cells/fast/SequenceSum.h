#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "geometry/cells/fast/CellSequence.h"

namespace Vorn::Cells {

/// Sums over the sequence that a chain of words stands for, term by term in order, with the very
/// rounding of a plain loop, but without running through all copies.
///
/// While a running sum stays in one binade [2^e, 2^(e+1)), adding v moves it by v rounded to the
/// grid of that binade, always the same whole number of units. Only where v lies exactly between
/// two grid points does the movement depend on the sum, and then on nothing but whether that is odd
/// or even: such ties go to the even side. The movement of a whole word, from an even and from an
/// odd sum, is then a sum of integers, which is found once and applied in one step wherever the sum
/// provably stays inside the binade; elsewhere the word is run through letter by letter.
class SequenceSum {
 public:
  /// The words from the first level to the last one, whose letters the terms belong to.
  explicit SequenceSum(std::vector<CellSequence::Words const*> const& chain);

  /// The sum over all letters of the last level. A letter whose term is skipped adds nothing, not
  /// even a zero.
  double Sum(std::vector<double> const& terms, std::vector<bool> const& isSkipped);

 private:
  /// How far a letter's expansion moves a sum, in units of a grid, and between which bounds on the
  /// way.
  struct Path {
    std::int64_t total = 0;
    std::int64_t lowest = 0;
    std::int64_t highest = 0;

    void Append(Path const& next);
  };

  /// What a letter's expansion does to a running sum in one binade.
  struct Movement {
    int exponent = kNoExponent;
    /// Whether it can be told.
    bool isKnown = false;
    Path fromEven;
    Path fromOdd;

    Path const& From(std::int64_t position) const {
      return (position & 1) == 0 ? fromEven : fromOdd;
    }
  };

  static constexpr int kNoExponent = INT32_MIN;

  void FindTotals();
  void Add(std::size_t level, std::uint32_t letter);
  bool MayStayInBinade(std::size_t level, std::uint32_t letter) const;
  bool AddAtOnce(std::size_t level, std::uint32_t letter);
  Movement const& MovementOf(std::size_t level, std::uint32_t letter, int exponent);
  Movement TermMovement(std::uint32_t letter, int exponent) const;
  static Path Step(std::int64_t units);
  static bool IsWithinBinade(Path const& path);

  std::vector<CellSequence::Words const*> chain_;
  /// For each level and letter, how many terms its expansion holds.
  std::vector<std::vector<std::size_t>> lengths_;
  /// And how many steps it takes to run through them.
  std::vector<std::vector<std::size_t>> costs_;
  /// The sum of each expansion, roughly: it only tells what is worth trying.
  std::vector<std::vector<double>> totals_;
  std::vector<std::vector<Movement>> movements_;
  std::vector<double> const* terms_ = nullptr;
  std::vector<bool> const* isSkipped_ = nullptr;
  double sum_ = 0.0;
};

}  // namespace Vorn::Cells
