#include "geometry/cells/CellSequence.h"

#include <bit>
#include <cmath>
#include <cstring>

#include "geometry/cells/SequenceSum.h"
#include "geometry/cells/TriangleCentre.h"
#include "math/NumericConstants.h"

namespace Vorn::Cells {

namespace {

using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;

/// Triangles are one letter when all their bits are equal: a zero and a negative zero are not.
bool AreIdentical(Triangle const& a, Triangle const& b) {
  return std::memcmp(&a, &b, sizeof(Triangle)) == 0;
}

/// Multiplies and folds the words of a triangle; by the constant of Fibonacci hashing, 2^64 over
/// the golden ratio.
std::size_t HashOf(Triangle const& triangle) {
  std::uint64_t hash = 0;
  for (Point const& p : triangle.pts) {
    for (double const coordinate : {p.x, p.y}) {
      hash = (std::rotl(hash, 5) ^ std::bit_cast<std::uint64_t>(coordinate)) *
             std::uint64_t{0x9E3779B97F4A7C15};
    }
  }
  return static_cast<std::size_t>(hash ^ (hash >> 32));
}

}  // namespace

class CellSequence::LevelBuilder {
 public:
  /// For the overlaps of a level's letters, each of which occurs as often as `counts` says.
  explicit LevelBuilder(std::vector<std::size_t> const& counts) : counts_(counts) {
    level_.words.ends.reserve(counts.size());
    level_.shapes.reserve(2 * counts.size());
  }

  void AddToWord(Triangle const& triangle) {
    std::uint32_t const letter = LetterOf(triangle);
    level_.words.letters.push_back(letter);
    std::size_t const occurrences = counts_[level_.words.ends.size()];
    level_.counts[letter] += occurrences;
    level_.size += occurrences;
  }

  void EndWord() {
    level_.words.ends.push_back(static_cast<std::uint32_t>(level_.words.letters.size()));
  }

  Level Take() { return std::move(level_); }

 private:
  static constexpr std::uint32_t kFree = UINT32_MAX;
  static constexpr std::size_t kFirstTableSize = 64;

  std::uint32_t LetterOf(Triangle const& triangle) {
    // Copies follow each other.
    if (!level_.words.letters.empty()) {
      std::uint32_t const previous = level_.words.letters.back();
      if (AreIdentical(level_.shapes[previous].triangle, triangle)) return previous;
    }
    if (level_.shapes.size() * 2 >= table_.size()) Enlarge();
    std::uint32_t& slot = table_[SlotOf(triangle)];
    if (slot == kFree) {
      slot = static_cast<std::uint32_t>(level_.shapes.size());
      level_.shapes.emplace_back(triangle);
      level_.counts.push_back(0);
    }
    return slot;
  }

  /// Where the triangle stands in the table, or where it belongs.
  std::size_t SlotOf(Triangle const& triangle) const {
    std::size_t const mask = table_.size() - 1;
    std::size_t at = HashOf(triangle) & mask;
    while (table_[at] != kFree && !AreIdentical(level_.shapes[table_[at]].triangle, triangle)) {
      at = (at + 1) & mask;
    }
    return at;
  }

  void Enlarge() {
    table_.assign(table_.empty() ? kFirstTableSize : table_.size() * 2, kFree);
    for (std::uint32_t letter = 0; letter < level_.shapes.size(); ++letter) {
      table_[SlotOf(level_.shapes[letter].triangle)] = letter;
    }
  }

  std::vector<std::size_t> const& counts_;
  Level level_;
  /// Letters by the hash of their triangle; a power of two of slots, at most half of them taken.
  std::vector<std::uint32_t> table_;
};

CellSequence::CellSequence(std::span<Triangle const> triangles) {
  std::vector<std::size_t> const once = {1};
  LevelBuilder builder(once);
  for (Triangle const& triangle : triangles) builder.AddToWord(triangle);
  builder.EndWord();
  levels_.push_back(builder.Take());
}

void CellSequence::NarrowBy(std::span<Triangle const> other) {
  if (levels_.empty()) return;
  std::vector<Shape> otherShapes;
  otherShapes.reserve(other.size());
  for (Triangle const& triangle : other) otherShapes.emplace_back(triangle);

  Level const& last = levels_.back();
  LevelBuilder builder(last.counts);
  Overlap overlap;
  for (Shape const& shape : last.shapes) {
    for (Shape const& otherShape : otherShapes) {
      FindOverlap(shape, otherShape, &overlap);
      for (Triangle const& part : overlap.parts) builder.AddToWord(part);
    }
    builder.EndWord();
  }
  levels_.push_back(builder.Take());
}

/// What GetOverlapping gives for a candidate and this cell, as a further level.
CellSequence::Level CellSequence::OverlapWith(Shape const& candidate) const {
  LevelBuilder builder(levels_.back().counts);
  Overlap overlap;
  for (Shape const& shape : levels_.back().shapes) {
    FindOverlap(candidate, shape, &overlap);
    for (Triangle const& part : overlap.parts) builder.AddToWord(part);
    builder.EndWord();
  }
  return builder.Take();
}

bool CellSequence::BoundingRect(double* rect) const {
  if (empty()) return false;
  // Letters stand in the order in which they first occur, so the first of equal extremes is the
  // same as in a run over all copies.
  std::vector<Shape> const& shapes = levels_.back().shapes;
  Point const& first = shapes.front().triangle.pts[0];
  rect[0] = rect[2] = first.x;
  rect[1] = rect[3] = first.y;
  for (Shape const& shape : shapes) ExtendRect(shape.triangle, rect);
  return true;
}

bool CellSequence::Center(Point* center) const { return !empty() && CenterWith(nullptr, center); }

bool CellSequence::CenterOfOverlapWith(Triangle const& candidate, Point* center) const {
  if (empty()) return false;
  Level const overlap = OverlapWith(Shape(candidate));
  return overlap.size > 0 && CenterWith(&overlap, center);
}

bool CellSequence::CenterWith(Level const* last, Point* center) const {
  std::vector<Words const*> chain;
  chain.reserve(levels_.size() + 1);
  for (Level const& level : levels_) chain.push_back(&level.words);
  if (last != nullptr) chain.push_back(&last->words);
  Level const& leaves = last != nullptr ? *last : levels_.back();

  std::size_t const letters = leaves.shapes.size();
  std::vector<double> areas(letters);
  std::vector<double> weightedX(letters);
  std::vector<double> weightedY(letters);
  std::vector<double> ownX(letters);
  std::vector<double> ownY(letters);
  std::vector<bool> isDegenerate(letters);
  std::vector<bool> isProper(letters);
  std::size_t degenerateCount = 0;
  bool isAnyProper = false;
  for (std::size_t letter = 0; letter < letters; ++letter) {
    TriangleCentre const own(leaves.shapes[letter].triangle);
    areas[letter] = own.area;
    ownX[letter] = own.center.x;
    ownY[letter] = own.center.y;
    weightedX[letter] = own.center.x * own.area;
    weightedY[letter] = own.center.y * own.area;
    isDegenerate[letter] = Numeric::IsZero(own.area);
    isProper[letter] = !isDegenerate[letter];
    if (isDegenerate[letter]) {
      degenerateCount += leaves.counts[letter];
    } else {
      isAnyProper = true;
    }
  }
  SequenceSum sequence(chain);
  double const totalArea = isAnyProper ? sequence.Sum(areas, isDegenerate) : 0.0;
  if (totalArea >= Numeric::kZero) {
    *center = {sequence.Sum(weightedX, isDegenerate) / totalArea,
               sequence.Sum(weightedY, isDegenerate) / totalArea};
  } else if (degenerateCount > 0) {
    auto const count = static_cast<double>(degenerateCount);
    *center = {sequence.Sum(ownX, isProper) / count, sequence.Sum(ownY, isProper) / count};
  } else {
    *center = {sequence.Sum(weightedX, isDegenerate), sequence.Sum(weightedY, isDegenerate)};
  }
  return true;
}

std::vector<Triangle> CellSequence::Expand() const {
  if (levels_.empty()) return {};
  std::vector<std::uint32_t> letters = {0};
  for (Level const& level : levels_) {
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
    triangles.push_back(levels_.back().shapes[letter].triangle);
  }
  return triangles;
}

}  // namespace Vorn::Cells
