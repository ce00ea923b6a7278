#include "vorn/io/ContourFile.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "io/pieces/Shapes.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

std::size_t RemovePiecesWithoutLength(std::vector<Piece>* pieces) {
  auto const isPoint = [](Piece const& piece) {
    return AreEqual(piece.start, piece.end) && (!piece.IsArc() || piece.sweep == 0.0);
  };
  return std::erase_if(*pieces, isPoint);
}

namespace {

/// Files write nine digits of what they show, which is the extent and not the offset of it.
constexpr double kOfExtent = 1e-9;

/// An end that is taken off an offset, turned or read from text is rounded a few times, each time
/// by half a last place of its coordinates at most. Two ends of three roundings in x and y are
/// 2 * 3 * 0.5 * sqrt(2) = 4.3 last places apart; sixteen leave room for longer ways.
constexpr double kOfCoordinates = 16.0 * std::numeric_limits<double>::epsilon();

/// An end that follows from centre c, radius r and angle is rounded, with u half a last place of
/// one, by u (|c| + |end|) for the offset and the sum, by u r for the radius and by 2 pi r times 3
/// u for an angle of up to one turn that comes in degrees: with |c| <= |end| + r by u (2 |end| + 21
/// r). Two such ends in x and y are 2 * sqrt(2) times that apart: 60 u r = 6.6e-15 r, and below
/// three last places of the coordinates, which kOfCoordinates has room for.
constexpr double kOfRadius = 1e-14;

double LargestCoordinate(std::vector<Piece> const& pieces) {
  double largest = 0.0;
  for (Piece const& piece : pieces) {
    for (XY const& end : {piece.start, piece.end}) {
      largest = std::max({largest, std::fabs(end.x), std::fabs(end.y)});
    }
  }
  return largest;
}

double LargestRadius(std::vector<Piece> const& pieces) {
  double largest = 0.0;
  for (Piece const& piece : pieces) largest = std::max(largest, piece.radius);
  return largest;
}

}  // namespace

double JointTolerance(std::vector<Piece> const& pieces) {
  if (pieces.empty()) return 0.0;
  Extent const extent = ExtentOf(pieces);
  double const size = std::max(extent.high.x - extent.low.x, extent.high.y - extent.low.y);
  return kOfExtent * size + kOfCoordinates * LargestCoordinate(pieces) +
         kOfRadius * LargestRadius(pieces);
}

bool ReturnsToStart(std::vector<Piece> const& pieces) {
  if (pieces.empty()) return false;
  if (pieces.empty()) return false;
  return Distance(pieces.back().end, pieces.front().start) <= JointTolerance(pieces);
}

std::vector<ContourFile> RunsOf(ContourFile const& contour) {
  auto const runs = ConnectedRuns(contour.pieces, JointTolerance(contour.pieces));
  std::vector<ContourFile> result;
  for (std::vector<Piece> const& run : runs) {
    bool const isClosed = (contour.isClosed || runs.size() > 1) && ReturnsToStart(run);
    result.push_back({contour.path, run, isClosed, contour.units, 0});
  }
  return result;
}

std::vector<Gap> FindGaps(ContourFile const& contour) {
  std::vector<Gap> gaps;
  std::vector<Piece> const& pieces = contour.pieces;
  double const tolerance = JointTolerance(pieces);
  for (std::size_t i = 0; i < pieces.size(); ++i) {
    bool const isLast = i + 1 == pieces.size();
    if (isLast && !contour.isClosed) break;
    std::size_t const next = isLast ? 0 : i + 1;
    double const size = Distance(pieces[i].end, pieces[next].start);
    if (size > tolerance) gaps.push_back({i, next, size});
  }
  return gaps;
}

std::string Describe(Gap const& gap) {
  std::string const size = ": the gap is " + FormatShort(gap.size);
  if (gap.after == 0) return "the contour is closed, but its ends do not meet" + size;
  return "pieces " + std::to_string(gap.before + 1) + " and " + std::to_string(gap.after + 1) +
         " do not meet" + size;
}

}  // namespace Vorn::IO
