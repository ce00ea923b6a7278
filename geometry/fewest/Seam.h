#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "geometry/fewest/Chain.h"
#include "geometry/fewest/Circuit.h"
#include "geometry/fewest/Path.h"

/// Closed contours: the places at which the chain may begin and end.
namespace Vorn::Fewest {

/// A gate of a closed path and the place on it at which the chain begins and ends.
struct Seam {
  Gate gate;
  double offset = 0.0;
  double turn = 0.0;      ///< 1 less the cosine of the angle by which the chain turns there
  std::size_t piece = 0;  ///< of a circuit, the one that starts there
};

/// The joints of a chain that was found as if it were open, the sharpest corners first: where the
/// path turns sharply every chain has a joint nearby. Of a chain of one piece the place where the
/// input ends.
std::vector<Seam> SharpestJoints(Path const& path, Chain const& open, std::size_t most);

/// The same for the joints of a circuit.
std::vector<Seam> SharpestJoints(Circuit const& circuit, std::size_t most);

/// A closed path cut open on a gate: `path` begins with point `rotation` of the whole.
struct CutPath {
  Path path;
  std::int32_t rotation = 0;
  /// The gate as the end of the path sees it, and an offset on it that an open chain took.
  Gate gate;
  double offset = 0.0;
};

/// The closed path cut at a seam.
CutPath CutAt(Path const& path, Seam const& seam);

/// How many points of a cut path 1, 2, ... pieces of a circuit cover at most behind the seam.
std::vector<std::int32_t> LeadsFrom(CutPath const& cut, Circuit const& circuit);

/// A chain along the gates of a circuit that begins and ends at one place of the gate at the seam,
/// where the path was cut and the piece of that number starts. Afterwards the path begins and ends
/// there. Empty when there is none.
Chain CloseCircuit(CutPath* cut, Circuit const& circuit, std::size_t piece, double share);

/// The shortest chain that begins and ends at one place of the gate of a cut path. Afterwards the
/// path begins and ends there. Empty when there is none, and as soon as the search is not to go on.
Chain CloseChain(CutPath* cut, double share, GoesOn const& goesOn);

}  // namespace Vorn::Fewest
