// A cell that is narrowed again and again, held without its copies. It stands for a plain cell
// (PlainCell) narrowed by Triangles::AppendOverlaps, triangle by triangle.

#pragma once

#include <cstddef>
#include <optional>
#include <span>
#include <vector>

#include "geometry/cells/Bounds.h"
#include "geometry/cells/fast/CellLevel.h"
#include "geometry/cells/fast/SequenceCentre.h"
#include "geometry/triangles/Triangle.h"

namespace Vorn::Cells {

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
  /// The empty cell.
  CellSequence() = default;

  /// A cell of these triangles.
  explicit CellSequence(std::span<Triangle const> triangles) { Begin(triangles); }

  /// The number of triangles, copies included.
  std::size_t size() const { return depth_ == 0 ? 0 : Last().size; }

  /// Whether there is no triangle.
  bool empty() const { return size() == 0; }

  /// Becomes the empty cell. What room the levels took is kept for those to come.
  void clear() { depth_ = 0; }

  /// Becomes a cell of these triangles.
  void Begin(std::span<Triangle const> triangles);

  /// Replaces every triangle by its overlaps with the triangles of another cell, in order. O(number
  /// of distinct triangles times the size of the other cell).
  void NarrowBy(std::span<Triangle const> other);

  /// Whether narrowing by another cell would leave anything.
  bool Overlaps(std::span<Triangle const> other) const;

  /// How often the cell has been narrowed, plus one; 0 before it began.
  std::size_t Depth() const { return depth_; }

  /// Goes back to what the cell was at a depth, which must not be above the present one.
  void ReturnTo(std::size_t depth);

  /// As Cells::BoundingRect.
  std::optional<Rect> BoundingRect() const;

  /// As CentreOf.
  std::optional<Point> Centre() const;

  /// The centre without its exact rounding, which takes no sum over the copies. Nothing for a cell
  /// without a proper triangle, or with one of extreme size.
  std::optional<RoughCentre> FindRoughCentre() const;

  /// As PlainCell::CentreOfOverlapWith.
  std::optional<Point> CentreOfOverlapWith(Triangle const& candidate) const;

  /// The triangles one by one, copies included. O(size).
  std::vector<Triangle> Expand() const;

 private:
  /// The level that the cell is at; there must be one.
  CellLevel const& Last() const { return levels_[depth_ - 1]; }
  /// The levels up to that one.
  std::span<CellLevel const> Levels() const { return {levels_.data(), depth_}; }

  /// The words of all levels, with room for one more.
  WordChain Chain() const;

  /// A further level, empty but for the room it took before.
  CellLevel* AddLevel();

  /// The common parts of a candidate and this cell, as a further level.
  CellLevel OverlapWith(Triangle const& candidate) const;

  /// The first `depth_` are the cell; those behind them are room to reuse.
  std::vector<CellLevel> levels_;
  std::size_t depth_ = 0;
};

}  // namespace Vorn::Cells
