#pragma once

#include <cstddef>
#include <cstdint>

#include "geometry/fewest/BackwardPass.h"
#include "geometry/fewest/Path.h"

/// Part of a chain as a chain of its own, between joints that stay where they are.
namespace Vorn::Fewest {

/// The pieces [first, end) of a chain.
struct Stretch {
  std::size_t first = 0;
  std::size_t end = 0;

  /// How many pieces there are.
  std::size_t Size() const { return end - first; }
  /// As many pieces more as it has, half of them on either side, within a chain of `count`.
  Stretch Widened(std::size_t count) const;
};

/// Whether both outer pieces of a stretch cover points. Where one does not, the stretch has no
/// first or no last point to be searched from, and PathOf must not be asked for it.
bool HasOuterPoints(Chain const& chain, Stretch const& stretch);

/// An end of a part of a path: its first point, or the one behind its last, and where it begins or
/// ends.
struct PathEnd {
  std::int32_t point = 0;
  Opening opening;
};

/// The points between two ends as a path.
Path PathBetween(Path const& path, PathEnd const& start, PathEnd const& finish);

/// The points of a stretch as a path from joint to joint.
Path PathOf(Path const& path, Chain const& chain, Stretch const& stretch);

/// The pieces of a stretch, the points counted from its first one.
Chain PartOf(Chain const& chain, Stretch const& stretch);

/// The same pieces, the points counted from a place `by` points before.
Chain MovedBy(Chain chain, std::int32_t by);

/// Adds the pieces of a part behind those of a chain, and the gates between them.
void Append(Chain const& part, Chain* chain);

/// Puts pieces in the place of those of a stretch, as many as it has.
void Put(Chain const& part, Stretch const& stretch, Chain* chain);

/// A chain in which some stretches are replaced, one after the other, each by any number of pieces.
class Splicing {
 public:
  /// The chain has to outlive this.
  explicit Splicing(Chain const& chain) : chain_(chain) {}

  /// Takes the pieces of a part, which count their points from the first one of the stretch, in the
  /// place of those of a stretch, which lies behind the last one.
  void Replace(Stretch const& stretch, Chain const& part);
  /// The chain with all parts; to be called once.
  Chain Finish();

 private:
  /// Takes the pieces up to `end` that are not taken yet.
  void KeepUpTo(std::size_t end);
  /// Takes the gate behind a piece; the last piece has none.
  void AddGateBehind(std::size_t piece);

  Chain const& chain_;
  Chain spliced_;
  std::size_t next_ = 0;
};

}  // namespace Vorn::Fewest
