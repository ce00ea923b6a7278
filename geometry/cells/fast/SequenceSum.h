// Sums over the sequence that words stand for. It stands for a plain loop over all copies.

#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "geometry/cells/fast/Words.h"

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
  /// The words from the first level to the last one, whose letters the terms belong to. They must
  /// outlive this.
  explicit SequenceSum(std::vector<Words const*> const& levels);

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

    /// Goes on along another path.
    void Append(Path const& next);

    /// Whether the path could lie within a binade. Also keeps the integers far from overflow: of
    /// two such paths one after the other, no position is beyond 2^54 units.
    bool FitsBinade() const;
  };

  /// What a letter's expansion does to a running sum in one binade.
  struct Movement {
    int exponent = kNoExponent;
    /// Whether it can be told.
    bool isKnown = false;
    Path fromEven;
    Path fromOdd;

    /// The path from a position on the grid.
    Path const& From(std::int64_t position) const {
      return (position & 1) == 0 ? fromEven : fromOdd;
    }
  };

  static constexpr int kNoExponent = INT32_MIN;

  /// A letter of a level, whose expansion is added.
  struct Place {
    std::size_t level;
    Letter letter;
  };

  /// Fills lengths_ and costs_ of one level from those of the next.
  void MeasureLevel(std::size_t level);

  /// The sum of the expansion of a letter by that of the next level, which must be in totals_.
  double TotalOf(Place const& place) const;

  /// Fills totals_.
  void FindTotals();

  /// Adds the expansion of a letter to the sum.
  void Add(Place const& place);

  /// Whether the sum is likely to stay in its binade while an expansion is added.
  bool MayStayInBinade(Place const& place) const;

  /// Moves the sum by a whole expansion. False, sum unchanged, where that could differ from adding
  /// the terms one by one.
  bool AddAtOnce(Place const& place);

  /// What the expansion of a letter does to a sum in a binade; found once for each binade.
  Movement const& MovementOf(Place const& place, int exponent);

  /// What the term of a letter of the last level does.
  Movement TermMovement(Letter letter, int exponent) const;

  /// The path of a single step.
  static Path Step(std::int64_t units);

  /// Whether the letters of a level are replaced by terms.
  bool IsLast(std::size_t level) const { return level + 1 == levels_.size(); }

  std::vector<Words const*> levels_;
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
