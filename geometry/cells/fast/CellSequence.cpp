#include "geometry/cells/fast/CellSequence.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cmath>
#include <cstring>
#include <memory>
#include <utility>

#include "geometry/cells/fast/SequenceSum.h"
#include "geometry/triangles/TriangleCentre.h"
#include "math/NumericConstants.h"

namespace Vorn::Cells {

namespace {

using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;

/// Triangles are one letter when all their bits are equal: a zero and a negative zero are not.
bool AreIdentical(Triangle const& a, Triangle const& b) {
  return std::memcmp(&a, &b, sizeof(Triangle)) == 0;
}

/// Multiplies and folds the words of a triangle, each by itself so that no product waits for the
/// one before; the odd constants are arbitrary.
std::uint32_t HashOf(Triangle const& triangle) {
  auto const word = [](double coordinate, std::uint64_t factor) {
    return std::bit_cast<std::uint64_t>(coordinate) * factor;
  };
  Point const* const pts = triangle.pts;
  std::uint64_t const hash =
      (word(pts[0].x, 0x9E3779B97F4A7C15) ^ word(pts[0].y, 0xC2B2AE3D27D4EB4F)) +
      (word(pts[1].x, 0x165667B19E3779F9) ^ word(pts[1].y, 0xD6E8FEB86659FD93)) +
      (word(pts[2].x, 0xA0761D6478BD642F) ^ word(pts[2].y, 0xE7037ED1A0B428DB));
  return static_cast<std::uint32_t>(hash >> 32);
}

/// The words from the first level to the last one.
struct WordChain {
  void Append(CellSequence::Words const& words, std::size_t letters) {
    levels.push_back(&words);
    length += letters;
    widest = std::max(widest, letters);
  }

  std::vector<CellSequence::Words const*> levels;
  /// The number of letters in the expansions of all levels, and of the level that has most.
  std::size_t length = 0;
  std::size_t widest = 1;
};
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

/// The error of a rough centre for each triangle, relative to the largest coordinate: 2 x 2 x
/// sqrt(2) roundings of 2^-53, and some to spare.
constexpr double kRoughness = 0x1p-50;

/// How many letters of an expansion are run through in the time that the shortcuts take for one
/// letter of the words (measured; they look at it once for every binade that the sums pass).
constexpr std::size_t kShortcutCost = 20;

/// The sums over the sequence, each taken term by term in order.
Sums RunThrough(WordChain const& chain, std::vector<Summand> const& summands) {
  // Up to the letters that the last words replace.
  auto letters = std::make_unique_for_overwrite<std::uint32_t[]>(chain.widest);
  auto next = std::make_unique_for_overwrite<std::uint32_t[]>(chain.widest);
  std::size_t size = 1;
  letters[0] = 0;
  for (std::size_t level = 0; level + 1 < chain.levels.size(); ++level) {
    std::size_t nextSize = 0;
    for (std::size_t i = 0; i < size; ++i) {
      for (std::uint32_t const letter : chain.levels[level]->Of(letters[i])) {
        next[nextSize++] = letter;
      }
    }
    size = nextSize;
    letters.swap(next);
  }
  Sums sums{};
  for (std::size_t i = 0; i < size; ++i) {
    for (std::uint32_t const leaf : chain.levels.back()->Of(letters[i])) {
      Summand const& summand = summands[leaf];
      if (summand.isSkipped) continue;
      for (std::size_t k = 0; k < sums.size(); ++k) sums[k] += summand.terms[k];
    }
  }
  return sums;
}

Sums SumOver(WordChain const& chain, std::vector<Summand> const& summands) {
  std::size_t wordLetters = 0;
  for (CellSequence::Words const* words : chain.levels) wordLetters += words->letters.size();
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

}  // namespace

class CellSequence::LevelBuilder {
 public:
  /// For the overlaps of a level's letters, each of which occurs as often as `counts` says.
  LevelBuilder(std::vector<std::size_t> const& counts, Level* level)
      : counts_(counts), level_(*level), slots_(std::bit_ceil(kSlotsPerLetter * counts.size())) {
    level_.clear();
    level_.words.ends.reserve(counts.size());
  }

  /// Adds a letter as it is, some copies of it. No other letter has an equal triangle among its
  /// parts, or it stays a letter of its own.
  void Keep(BoxedTriangle const& boxed, std::size_t copies) { Append(NewLetter(boxed), copies); }

  void Add(Triangle const& part) { Append(LetterOf(part), 1); }

  void EndWord() {
    level_.words.ends.push_back(static_cast<std::uint32_t>(level_.words.letters.size()));
  }

 private:
  static constexpr std::uint32_t kFree = UINT32_MAX;
  /// About half the letters of a level are parts of others.
  static constexpr std::size_t kSlotsPerLetter = 2;

  /// A letter and the hash of its triangle.
  struct Slot {
    std::uint32_t letter = kFree;
    std::uint32_t hash = 0;
  };

  void Append(std::uint32_t letter, std::size_t copies) {
    for (std::size_t copy = 0; copy < copies; ++copy) level_.words.letters.push_back(letter);
    std::size_t const occurrences = copies * counts_[level_.words.ends.size()];
    level_.counts[letter] += occurrences;
    level_.size += occurrences;
  }

  std::uint32_t NewLetter(BoxedTriangle const& boxed) {
    auto const letter = static_cast<std::uint32_t>(level_.triangles.size());
    level_.triangles.push_back(boxed);
    level_.counts.push_back(0);
    return letter;
  }

  std::uint32_t LetterOf(Triangle const& triangle) {
    // Copies follow each other.
    if (!level_.words.letters.empty()) {
      std::uint32_t const previous = level_.words.letters.back();
      if (AreIdentical(level_.triangles[previous].triangle, triangle)) return previous;
    }
    if (taken_ * 2 >= slots_.size()) Enlarge();
    std::uint32_t const hash = HashOf(triangle);
    Slot& slot = SlotOf(triangle, hash);
    if (slot.letter == kFree) {
      slot = {NewLetter(BoxedTriangle(triangle)), hash};
      ++taken_;
    }
    return slot.letter;
  }

  /// Where the triangle stands in the table, or where it belongs.
  Slot& SlotOf(Triangle const& triangle, std::uint32_t hash) {
    std::size_t const mask = slots_.size() - 1;
    std::size_t at = hash & mask;
    while (slots_[at].letter != kFree &&
           !(slots_[at].hash == hash &&
             AreIdentical(level_.triangles[slots_[at].letter].triangle, triangle))) {
      at = (at + 1) & mask;
    }
    return slots_[at];
  }

  void Enlarge() {
    std::vector<Slot> const old = std::move(slots_);
    slots_.assign(old.size() * 2, {});
    std::size_t const mask = slots_.size() - 1;
    for (Slot const& slot : old) {
      if (slot.letter == kFree) continue;
      std::size_t at = slot.hash & mask;
      while (slots_[at].letter != kFree) at = (at + 1) & mask;
      slots_[at] = slot;
    }
  }

  std::vector<std::size_t> const& counts_;
  Level& level_;
  /// Letters by hash; a power of two of slots, at most half of them taken.
  std::vector<Slot> slots_;
  std::size_t taken_ = 0;
};

CellSequence::Level* CellSequence::AddLevel() {
  if (depth_ == levels_.size()) levels_.emplace_back();
  return &levels_[depth_++];
}

void CellSequence::Begin(std::span<Triangle const> triangles) {
  clear();
  std::vector<std::size_t> const once = {1};
  Level* const first = AddLevel();
  first->magnitude = {};
  first->magnitude.Include(triangles);
  LevelBuilder builder(once, first);
  for (Triangle const& triangle : triangles) builder.Add(triangle);
  builder.EndWord();
}

void CellSequence::NarrowBy(std::span<Triangle const> other) {
  if (depth_ == 0) return;
  Level* const next = AddLevel();
  Level const& last = levels_[depth_ - 2];
  std::vector<Cutter> cutters;
  cutters.reserve(other.size());
  for (Triangle const& triangle : other) cutters.emplace_back(triangle, last.magnitude);

  next->magnitude = last.magnitude;
  next->magnitude.Include(other);
  LevelBuilder builder(last.counts, next);
  Overlap overlap;
  for (BoxedTriangle const& boxed : last.triangles) {
    for (Cutter const& cutter : cutters) {
      if (cutter.Cut(boxed, &overlap) == Cutter::Rest::Whole) {
        builder.Keep(boxed, kCopiesOfContained);
      } else {
        for (Triangle const& part : overlap.parts) builder.Add(part);
      }
    }
    builder.EndWord();
  }
}

bool CellSequence::Overlaps(std::span<Triangle const> other) const {
  if (depth_ == 0) return false;
  Overlap overlap;
  for (Triangle const& triangle : other) {
    Cutter const cutter(triangle, Last().magnitude);
    for (BoxedTriangle const& boxed : Last().triangles) {
      bool const isWhole = cutter.Cut(boxed, &overlap) == Cutter::Rest::Whole;
      if (isWhole || !overlap.parts.empty()) return true;
    }
  }
  return false;
}

/// What GetOverlapping gives for a candidate and this cell, as a further level.
CellSequence::Level CellSequence::OverlapWith(Triangle const& candidate) const {
  Level level;
  ChordCutter const cutter(candidate, Last().magnitude);
  LevelBuilder builder(Last().counts, &level);
  Overlap overlap;
  for (BoxedTriangle const& boxed : Last().triangles) {
    cutter.FindOverlapWith(boxed, &overlap);
    for (Triangle const& part : overlap.parts) builder.Add(part);
    builder.EndWord();
  }
  return level;
}

bool CellSequence::BoundingRect(double* rect) const {
  if (empty()) return false;
  // Letters stand in the order in which they first occur, so the first of equal extremes is the
  // same as in a run over all copies.
  std::vector<BoxedTriangle> const& triangles = Last().triangles;
  Point const& first = triangles.front().triangle.pts[0];
  rect[0] = rect[2] = first.x;
  rect[1] = rect[3] = first.y;
  for (BoxedTriangle const& boxed : triangles) ExtendRect(boxed.triangle, rect);
  return true;
}

bool CellSequence::Center(Point* center) const { return !empty() && CenterWith(nullptr, center); }

std::optional<RoughCentre> CellSequence::FindRoughCentre() const {
  if (empty()) return std::nullopt;
  double totalArea = 0.0;
  Point weighted{0.0, 0.0};
  double largest = 0.0;
  for (std::size_t letter = 0; letter < Last().triangles.size(); ++letter) {
    TriangleCentre const centre(Last().triangles[letter].triangle);
    double const area = static_cast<double>(Last().counts[letter]) * centre.area;
    totalArea += area;
    weighted.x += area * centre.center.x;
    weighted.y += area * centre.center.y;
    largest = std::max({largest, std::fabs(centre.center.x), std::fabs(centre.center.y)});
  }
  bool const isUsable = totalArea > kLeastRoughArea && totalArea * largest < kLargestRoughSum;
  if (!isUsable) return std::nullopt;
  // A sum of n terms of one sign is off by n roundings at most, and a mean of values up to the
  // largest by twice that, times the largest; so is this one.
  double const error = kRoughness * static_cast<double>(size()) * largest;
  return RoughCentre{{weighted.x / totalArea, weighted.y / totalArea}, error};
}

bool CellSequence::CenterOfOverlapWith(Triangle const& candidate, Point* center) const {
  if (empty()) return false;
  Level const overlap = OverlapWith(candidate);
  return overlap.size > 0 && CenterWith(&overlap, center);
}

bool CellSequence::CenterWith(Level const* last, Point* center) const {
  WordChain chain;
  chain.levels.reserve(depth_ + 1);
  for (Level const& level : Levels()) chain.Append(level.words, level.size);
  if (last != nullptr) chain.Append(last->words, last->size);
  Level const& leaves = last != nullptr ? *last : Last();

  std::vector<Summand> weighted;
  std::vector<Summand> own;
  weighted.reserve(leaves.triangles.size());
  own.reserve(leaves.triangles.size());
  std::size_t degenerateCount = 0;
  bool isAnyProper = false;
  for (std::size_t letter = 0; letter < leaves.triangles.size(); ++letter) {
    TriangleCentre const centre(leaves.triangles[letter].triangle);
    auto const& [x, y] = centre.center;
    bool const isDegenerate = Numeric::IsZero(centre.area);
    weighted.push_back({{centre.area, x * centre.area, y * centre.area}, isDegenerate});
    own.push_back({{0.0, x, y}, !isDegenerate});
    if (isDegenerate) {
      degenerateCount += leaves.counts[letter];
    } else {
      isAnyProper = true;
    }
  }
  Sums proper{};
  if (isAnyProper) proper = SumOver(chain, weighted);
  double const totalArea = proper[0];
  if (totalArea >= Numeric::kZero) {
    *center = {proper[1] / totalArea, proper[2] / totalArea};
  } else if (degenerateCount > 0) {
    Sums const degenerate = SumOver(chain, own);
    auto const count = static_cast<double>(degenerateCount);
    *center = {degenerate[1] / count, degenerate[2] / count};
  } else {
    *center = {proper[1], proper[2]};
  }
  return true;
}

std::vector<Triangle> CellSequence::Expand() const {
  if (depth_ == 0) return {};
  std::vector<std::uint32_t> letters = {0};
  for (Level const& level : Levels()) {
    std::vector<std::uint32_t> next;
    next.reserve(level.size);
    for (std::uint32_t const letter : letters) {
      for (std::uint32_t const replacement : level.words.Of(letter)) next.push_back(replacement);
    }
    letters.swap(next);
  }
  std::vector<Triangle> triangles;
  triangles.reserve(letters.size());
  for (std::uint32_t const letter : letters) {
    triangles.push_back(Last().triangles[letter].triangle);
  }
  return triangles;
}

}  // namespace Vorn::Cells
