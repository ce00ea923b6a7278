#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "vorn/io/Export.h"
#include "vorn/io/Pieces.h"

namespace Vorn::IO {

/// A contour as files hold it.
struct ContourFile {
  std::string path;           ///< for messages; "-" is standard input
  std::vector<Piece> pieces;  ///< in the order of travel; neighbours need not meet
  bool isClosed = false;      ///< the last piece leads back to the start of the first
  std::string units;          ///< "mm", "inch" and so on; empty when nobody says
  std::size_t leftOut = 0;    ///< how many pieces without length the file held beside these
  bool hadHeights = false;    ///< further coordinates stood beside x and y and were dropped
};

/// Takes out the pieces that end where they start without a turn; they say nothing of the contour,
/// and not every format could tell them from a full circle or hold them at all. Readers and writers
/// leave them out alike.
/// @return how many there were
VORN_IO_EXPORT std::size_t RemovePiecesWithoutLength(std::vector<Piece>* pieces);

/// The contour cut at its gaps, piece by piece as it is: each run is closed when its ends meet, if
/// the contour is closed or there are several.
VORN_IO_EXPORT std::vector<ContourFile> RunsOf(ContourFile const& contour);

/// Two pieces that follow each other in a contour but do not meet.
struct Gap {
  std::size_t before = 0;  ///< index of the earlier piece; the other one is the next
  std::size_t after = 0;   ///< 0 for the seam of a closed contour
  double size = 0.0;       ///< how far the two ends are apart
};

/// The places where neighbours are further apart than rounding explains (see JointTolerance): in
/// the order of the contour, that of the seam last. Where an outline that is closed by itself ends
/// or begins, the next one lies elsewhere, which is no gap.
VORN_IO_EXPORT std::vector<Gap> FindGaps(ContourFile const& contour);

/// How far apart two ends may lie that are meant to be one point: 1e-9 of the extent, which nine
/// digits of a file keep, and the rounding of an end, which is 16 last places of the largest
/// coordinate and 1e-14 of the largest radius. At 1e8 of the unit that rounding is some 4e-7. Zero
/// without pieces.
VORN_IO_EXPORT double JointTolerance(std::vector<Piece> const& pieces);

/// Whether the last piece leads back to the start of the first, up to JointTolerance: what a file
/// without a flag of its own says about being closed.
VORN_IO_EXPORT bool ReturnsToStart(std::vector<Piece> const& pieces);

/// "pieces 3 and 4 do not meet: the gap is 0.01"; pieces counted from 1 as the tables do.
VORN_IO_EXPORT std::string Describe(Gap const& gap);

}  // namespace Vorn::IO
