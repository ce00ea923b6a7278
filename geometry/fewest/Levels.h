#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "geometry/fewest/BackwardPass.h"
#include "geometry/fewest/Gates.h"
#include "geometry/fewest/Path.h"
#include "geometry/fewest/PieceSearch.h"

/// The forward half of the search: level by level the gates that can be reached with one piece
/// more, and the offsets on them.
namespace Vorn::Fewest {

/// Offsets on a gate that a chain can reach, and how far a piece leads from there.
struct State {
  Opening opening;
  /// The pieces before it that end at the ends of the opening.
  PlacedCircle atLow;
  PlacedCircle atHigh;
  std::int32_t previous = -1;  ///< position in the level before
  Reach reach;
};

/// The levels of one search. The first holds the start of the path.
class Levels {
 public:
  /// Reads the path in place; tolerances are multiplied by `share`.
  Levels(Path const& path, double share);

  /// How many levels there are, which is the number of pieces that the last one leads to.
  std::size_t Count() const { return levels_.size(); }
  /// The states of the last level.
  std::vector<State> const& Last() const { return levels_.back(); }
  /// Finds how far the pieces from the states of the last level lead; one past the last point.
  std::int32_t FindFarthest();
  /// Adds the level of the gates before that end; false where no gate can be reached or none leads
  /// farther.
  bool Add(std::int32_t farthest);
  /// Where the pieces of a chain may start that leads through a state of the last level.
  std::vector<Link> LinksThrough(std::size_t state) const;
  /// The search of single pieces, for what follows on the levels.
  PieceSearch& Search() { return search_; }

 private:
  using Level = std::vector<State>;

  Level MakeStates(Level const& level, std::int32_t farthest);
  /// Adds the gates of a gap: that of a corner or the one in its middle, else one at a point.
  void AddGates(Level const& level, std::int32_t split, Level* next);
  /// The gate at one of the points beside a gap, square to the piece before and to the path behind.
  /// A joint on it is within tolerance of the point, so that it matters little to which of the two
  /// pieces the point belongs: mostly the one before the gap is enough, the other one has its turn
  /// at the next split.
  void AddPointGate(Level const& level, std::int32_t split, std::int32_t point, Level* next);
  bool MakeCornerGate(Level const& level, std::int32_t split, Gate* gate);
  /// The circle of the points that follow a gap.
  PieceFit FitShortlyBehind(std::int32_t split);
  /// The circle of a piece that ends before a gap. Noise near the tolerance leaves both circles of
  /// a corner hardly any room, so that the gate has to pass within a small share of the tolerance
  /// of their crossing: then the smallest largest ratio counts, not only that it is below 1.
  PlacedCircle BeforeCorner(State const& from, std::int32_t split);
  /// Adds the gate with the offsets that the pieces before it can reach: first from the state that
  /// reaches farthest, then from others as far as they add offsets.
  void AddState(Level const& level, Gate const& gate, Level* next);

  Path const& path_;
  PieceSearch search_;
  std::vector<Level> levels_;
  std::int32_t before_ = 0;    ///< the farthest end of the level before the last
  std::int32_t expected_ = 0;  ///< a guess of the farthest end of the last level
};

}  // namespace Vorn::Fewest
