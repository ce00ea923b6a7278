#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <vector>

#include "geometry/cells/fast/Cutter.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Cells {

/// A point, and how far from it the one that is meant may be.
struct RoughCentre {
  GeometryUtils::Point at;
  double error;
};

/// A cell that is narrowed again and again, held without its copies.
///
/// Narrowing puts in the place of every triangle the triangles of its overlaps with another cell. A
/// contained triangle is replaced by three copies of itself, so after a few rounds a cell of
/// thousands of triangles consists of copies of a few dozen. Equal triangles have equal overlaps;
/// so each distinct one is overlapped once, and the cell as a sequence is what comes of the first
/// one by replacing letters by words, round after round:
///
///   level 0   A B            the triangles the cell began with
///   level 1   A -> C C C     B -> D E
///   level 2   C -> F F F     D -> G      E -> (nothing)
///
/// stands for F F F F F F F F F G. Letters of a level are numbered in the order in which they first
/// occur in the sequence. Order and number of the copies are kept exactly: the cell's centre is a
/// floating-point sum over them.
class CellSequence {
 public:
  CellSequence() = default;
  explicit CellSequence(std::span<GeometryUtils::Triangle const> triangles) { Begin(triangles); }

  /// The number of triangles, copies included.
  std::size_t size() const { return depth_ == 0 ? 0 : Last().size; }
  bool empty() const { return size() == 0; }

  /// Becomes the empty cell. What room the levels took is kept for those to come.
  void clear() { depth_ = 0; }

  /// Becomes a cell of these triangles.
  void Begin(std::span<GeometryUtils::Triangle const> triangles);

  /// Replaces every triangle by its overlaps with the triangles of another cell, in order.
  void NarrowBy(std::span<GeometryUtils::Triangle const> other);

  /// Whether narrowing by another cell would leave anything.
  bool Overlaps(std::span<GeometryUtils::Triangle const> other) const;

  /// How often the cell has been narrowed, plus one.
  std::size_t Depth() const { return depth_; }

  /// Goes back to what the cell was at a depth.
  void ReturnTo(std::size_t depth) { depth_ = depth; }

  /// As GetBoundingRect, GetCenter and the centre of what GetOverlapping gives for a candidate.
  bool BoundingRect(double* rect) const;
  bool Center(GeometryUtils::Point* center) const;
  /// The centre without its exact rounding, which takes no sum over the copies. Nothing for a cell
  /// without a proper triangle, or with one of extreme size.
  std::optional<RoughCentre> FindRoughCentre() const;
  bool CenterOfOverlapWith(GeometryUtils::Triangle const& candidate,
                           GeometryUtils::Point* center) const;

  /// The triangles one by one, copies included.
  std::vector<GeometryUtils::Triangle> Expand() const;

  /// The words that replace the letters of one level by letters of the next.
  struct Words {
    /// Where each word ends in `letters`; it begins where the one before ends.
    std::vector<std::uint32_t> ends;
    std::vector<std::uint32_t> letters;

    std::span<std::uint32_t const> Of(std::uint32_t letter) const {
      std::uint32_t const begin = letter == 0 ? 0 : ends[letter - 1];
      return {letters.data() + begin, letters.data() + ends[letter]};
    }

    void clear() {
      ends.clear();
      letters.clear();
    }
  };

 private:
  struct Level {
    Words words;
    std::vector<BoxedTriangle> triangles;
    /// Of all triangles that ever made up the cell. Parts of triangles are within both of them but
    /// for the rounding of crossing points, of which there is not enough to matter.
    Magnitude magnitude;
    /// How often each letter occurs in the sequence.
    std::vector<std::size_t> counts;
    std::size_t size = 0;

    void clear() {
      words.clear();
      triangles.clear();
      counts.clear();
      size = 0;
    }
  };

  /// Collects the words of a new level and numbers its letters.
  class LevelBuilder;

  Level const& Last() const { return levels_[depth_ - 1]; }
  std::span<Level const> Levels() const { return {levels_.data(), depth_}; }
  Level* AddLevel();
  Level OverlapWith(GeometryUtils::Triangle const& candidate) const;
  bool CenterWith(Level const* last, GeometryUtils::Point* center) const;

  /// The first `depth_` are the cell; those behind them are room to reuse.
  std::vector<Level> levels_;
  std::size_t depth_ = 0;
};

}  // namespace Vorn::Cells
