#include "geometry/cells/fast/SequenceCentre.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>
#include <memory>
#include <utility>
#include <vector>

#include "geometry/cells/Centres.h"
#include "geometry/cells/fast/RoundingBound.h"
#include "geometry/cells/fast/SequenceSum.h"

namespace Vorn::Cells {

namespace {

using Sums = std::array<double, 3>;

/// What a letter adds to three sums, if anything.
struct Summand {
  Sums terms;
  bool isSkipped;
};

/// Between these bounds of a cell's total area and of its weighted sums nothing that matters is
/// lost to subnormal numbers, and nothing overflows.
constexpr double kLeastRoughArea = 1e-250;
constexpr double kLargestRoughSum = 1e250;

// How far the rough centre and the exact one can be apart, for n triangles in k letters with
// centres of coordinates up to L. Errors relative, in units of kRounding; sums of terms of one sign
// (areas) and sums of their products with coordinates are off by as many roundings of L times the
// area as each term takes part in.
//   the exact centre:  sum of n areas                         n - 1
//                      sum of n weighted coordinates          1 + (n - 1)
//                      their quotient                         1              together 2 n
//   the rough centre:  areas times counts                     1, or 0 where all counts are 1
//                      sum of k areas                         k - 1
//                      times a coordinate, and their sum      1, or 2, + (k - 1)
//                      their quotient                         1
//                      together 2 k with k = n, or 2 k + 2 with k <= n - 1: not above 2 n
// So a coordinate differs by 4 n roundings of L at most, and the point by sqrt(2) times that, which
// is below 6 n; products of roundings and their number up to some 10^5 add nothing to speak of.

/// The roundings that a rough centre may be off by for each triangle: 6, and some to spare.
constexpr double kRoughRoundings = 8.0;

/// How many letters of an expansion are run through in the time that the shortcuts take for one
/// letter of the words (measured; they look at it once for every binade that the sums pass).
constexpr std::size_t kShortcutCost = 20;

/// The letters that the last words of a chain replace, in order.
class LettersBeforeLast {
 public:
  explicit LettersBeforeLast(WordChain const& chain)
      : letters_(std::make_unique_for_overwrite<Letter[]>(chain.widest)),
        next_(std::make_unique_for_overwrite<Letter[]>(chain.widest)) {
    letters_[0] = 0;
    for (std::size_t level = 0; level + 1 < chain.levels.size(); ++level) {
      Replace(*chain.levels[level]);
    }
  }

  Letter const* begin() const { return letters_.get(); }
  Letter const* end() const { return letters_.get() + size_; }

 private:
  /// Replaces every letter by its word.
  void Replace(Words const& words) {
    std::size_t nextSize = 0;
    for (Letter const letter : *this) {
      for (Letter const replacement : words.Of(letter)) next_[nextSize++] = replacement;
    }
    size_ = nextSize;
    letters_.swap(next_);
  }

  std::unique_ptr<Letter[]> letters_;
  std::unique_ptr<Letter[]> next_;
  std::size_t size_ = 1;
};

/// The sums over the sequence, each taken term by term in order.
Sums RunThrough(WordChain const& chain, std::vector<Summand> const& summands) {
  Words const& last = *chain.levels.back();
  Sums sums{};
  for (Letter const letter : LettersBeforeLast(chain)) {
    for (Letter const leaf : last.Of(letter)) {
      Summand const& summand = summands[leaf];
      if (summand.isSkipped) continue;
      for (std::size_t k = 0; k < sums.size(); ++k) sums[k] += summand.terms[k];
    }
  }
  return sums;
}

/// The same sums, with a shortcut where the sequence is much longer than its words.
Sums SumOver(WordChain const& chain, std::vector<Summand> const& summands) {
  std::size_t wordLetters = 0;
  for (Words const* words : chain.levels) wordLetters += words->letters.size();
  if (chain.length <= kShortcutCost * wordLetters) return RunThrough(chain, summands);

  SequenceSum sequence(chain.levels);
  std::vector<double> terms(summands.size());
  std::vector<bool> isSkipped(summands.size());
  Sums sums{};
  for (std::size_t i = 0; i < sums.size(); ++i) {
    for (std::size_t letter = 0; letter < summands.size(); ++letter) {
      terms[letter] = summands[letter].terms[i];
      isSkipped[letter] = summands[letter].isSkipped;
    }
    sums[i] = sequence.Sum(terms, isSkipped);
  }
  return sums;
}

/// What each letter adds to the area and the weighted centre.
Summand WeightedSummand(TriangleCentre const& triangle) {
  auto const& [area, centre] = triangle;
  return {{area, centre.x * area, centre.y * area}, IsDegenerate(triangle)};
}

/// What each letter adds to the plain sum of the centres of degenerate triangles.
Summand DegenerateSummand(TriangleCentre const& triangle) {
  return {{0.0, triangle.centre.x, triangle.centre.y}, !IsDegenerate(triangle)};
}

}  // namespace

Point CentreOfSequence(WordChain const& chain, CellLevel const& leaves) {
  std::vector<TriangleCentre> centres;
  centres.reserve(leaves.triangles.size());
  CentreSums sums;
  bool isAnyProper = false;
  for (std::size_t letter = 0; letter < leaves.triangles.size(); ++letter) {
    centres.push_back(Triangles::CentreOf(leaves.triangles[letter].triangle));
    if (IsDegenerate(centres.back())) {
      sums.degenerateCount += leaves.counts[letter];
    } else {
      isAnyProper = true;
    }
  }
  std::vector<Summand> summands(centres.size());
  if (isAnyProper) {
    std::transform(centres.begin(), centres.end(), summands.begin(), WeightedSummand);
    Sums const proper = SumOver(chain, summands);
    sums.area = proper[0];
    sums.weighted = {proper[1], proper[2]};
  }
  if (!sums.HasArea() && sums.degenerateCount > 0) {
    std::transform(centres.begin(), centres.end(), summands.begin(), DegenerateSummand);
    Sums const degenerate = SumOver(chain, summands);
    sums.degenerate = {degenerate[1], degenerate[2]};
  }
  return sums.Centre();
}

std::optional<RoughCentre> RoughCentreOf(CellLevel const& leaves) {
  double totalArea = 0.0;
  Point weighted;
  double largest = 0.0;
  for (std::size_t letter = 0; letter < leaves.triangles.size(); ++letter) {
    auto const [own, centre] = Triangles::CentreOf(leaves.triangles[letter].triangle);
    double const area = static_cast<double>(leaves.counts[letter]) * own;
    totalArea += area;
    weighted.x += area * centre.x;
    weighted.y += area * centre.y;
    largest = std::max({largest, std::fabs(centre.x), std::fabs(centre.y)});
  }
  bool const isUsable = totalArea > kLeastRoughArea && totalArea * largest < kLargestRoughSum;
  if (!isUsable) return std::nullopt;
  double const error = kRoughRoundings * kRounding * static_cast<double>(leaves.size) * largest;
  return RoughCentre{{weighted.x / totalArea, weighted.y / totalArea}, error};
}

}  // namespace Vorn::Cells
