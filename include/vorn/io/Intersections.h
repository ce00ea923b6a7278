#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

#include "vorn/io/ContourFile.h"
#include "vorn/io/Export.h"
#include "vorn/io/Pieces.h"

namespace Vorn::IO {

/// One contour at a place that two have in common.
struct OnContour {
  std::size_t piece = 0;  ///< index; at a joint the piece that ends there
  double position = 0.0;  ///< length of the contour up to there, gaps not counted
};

/// A place that two contours, or two parts of one, have in common.
struct Intersection {
  /// How two contours meet.
  enum class Kind {
    Crossing,  ///< each passes to the other side of the other one
    Touching,  ///< they stay on one side, run in one direction there, or one of them ends there
    Overlap,   ///< they share a stretch, from `at` to `until`
  };

  Kind kind = Kind::Crossing;  ///< how the two meet
  XY at;                       ///< the place; of a stretch its first one
  std::optional<XY> until;     ///< where a stretch ends
  OnContour a;                 ///< on the first contour
  OnContour b;                 ///< on the second contour, or the later part of the same
};

/// All places that the two have in common, sorted along the first. Pieces without length count for
/// nothing, and gaps are not bridged. A place at a joint, where pieces that follow each other
/// both pass, is one place; a stretch is told for each pair of pieces that share it.
VORN_IO_EXPORT std::vector<Intersection> IntersectionsOf(ContourFile const& a,
                                                         ContourFile const& b);

/// The places where the contour meets itself, but for the joints of pieces that follow each other.
VORN_IO_EXPORT std::vector<Intersection> SelfIntersectionsOf(ContourFile const& contour);

/// How many there are of each kind.
struct IntersectionTally {
  std::size_t crossings = 0;  ///< places where they cross
  std::size_t touches = 0;    ///< places where they touch
  std::size_t overlaps = 0;   ///< stretches that they share
};

/// Counts them.
VORN_IO_EXPORT IntersectionTally Tally(std::vector<Intersection> const& found);

/// "1 crossing, 0 touching, 2 overlaps".
VORN_IO_EXPORT std::string Describe(IntersectionTally const& tally);

/// "crossing", "touching", "overlap".
VORN_IO_EXPORT std::string NameOf(Intersection::Kind kind);

/// The intersections of `a` with `b`, or without `b` of `a` with itself, as JSON; pieces are
/// numbered from 1.
VORN_IO_EXPORT std::string ToJson(std::vector<Intersection> const& found, ContourFile const& a,
                                  ContourFile const* b);

/// The same as CSV.
VORN_IO_EXPORT std::string ToCsv(std::vector<Intersection> const& found, ContourFile const& a,
                                 ContourFile const* b);

}  // namespace Vorn::IO
