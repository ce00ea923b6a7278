#pragma once

#include <cstdint>
#include <vector>

#include "geometry/fewest/Chain.h"
#include "geometry/fewest/Path.h"
#include "geometry/fewest/Stretch.h"

/// The path itself, from point to point, where pieces break a promise.
namespace Vorn::Fewest {

/// Puts edges of the path, the segments from one point to the next, in the place of pieces near
/// some points: edges break no promise with each other (see Promise::NotCrossing). The pieces
/// beside them are searched anew, from point to joint; all others stay. This is what is left where
/// no chain within smaller tolerances keeps its promises, and costs a piece for each edge.
class Retracing {
 public:
  /// `share` is that of the tolerances within which the chain was found. The path has to outlive
  /// this.
  Retracing(Path const& path, double share, Chain chain);

  /// The chain with the edges of all calls so far.
  Chain const& Current() const { return current_; }

  /// Follows the path within `reach` points of each of some points, by their positions on the path.
  /// False when no edge is new or points that coincide leave no way to the next joint.
  bool Follow(std::vector<std::int32_t> const& points, std::int32_t reach);

 private:
  /// Whether a point of a piece is to be a joint.
  bool IsTouched(ChainPiece const& piece) const;
  /// Searches the stretches of touched pieces of the original chain; false where one has none.
  bool Rebuild();
  /// The pieces of a stretch with the edges that were asked for; empty where there are none.
  Chain Search(Stretch const& stretch) const;

  Path const& path_;
  double share_;
  Chain original_;
  Chain current_;
  std::vector<char> isJoint_;  ///< for each point whether edges end there
};

/// The chain of a path in which the points that are marked are joints, and the way from one of them
/// to the next point, where that is marked too, is an edge. The first point of a path that begins
/// at no gate counts as marked, other outer points as not marked: a piece lies between them and the
/// ends. Empty when none was found.
Chain FindChainWithEdges(Path const& path, double share, std::vector<char> const& isJoint);

}  // namespace Vorn::Fewest
