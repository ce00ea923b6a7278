#include "vorn/io/ContourFile.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "io/pieces/Shapes.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/Outlines.h"

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

namespace {

/// Pieces of a contour that follow each other: from `first` up to but not including `end`.
struct Stretch {
  std::size_t first = 0;
  std::size_t end = 0;
  bool isClosed = false;  ///< its end is its start
};

/// The contour cut where its pieces are too far apart to be chained.
std::vector<Stretch> StretchesOf(std::vector<Piece> const& pieces) {
  double const tolerance = ChainTolerance(pieces);
  auto const meet = [&](std::size_t before, std::size_t after) {
    return Distance(pieces[before].end, pieces[after].start) <= tolerance;
  };
  std::vector<Stretch> stretches;
  std::size_t first = 0;
  for (std::size_t end = 1; end <= pieces.size(); ++end) {
    if (end < pieces.size() && meet(end - 1, end)) continue;
    stretches.push_back({first, end, meet(end - 1, first)});
    first = end;
  }
  return stretches;
}

/// For each piece whether an outline that is closed by itself ends with it or begins behind it, so
/// that the way from there to the next piece is no gap.
std::vector<bool> EndsOfOutlines(ContourFile const& contour) {
  std::vector<bool> ends(contour.pieces.size(), false);
  std::vector<Stretch> const stretches = StretchesOf(contour.pieces);
  auto const isClosed = [](Stretch const& stretch) { return stretch.isClosed; };
  // One that says that it is closed, but is not made of outlines that are, is one with its gaps.
  if (contour.isClosed && !std::all_of(stretches.begin(), stretches.end(), isClosed)) return ends;
  for (std::size_t i = 0; i < stretches.size() && stretches.size() > 1; ++i) {
    Stretch const& next = stretches[(i + 1) % stretches.size()];
    ends[stretches[i].end - 1] = stretches[i].isClosed || next.isClosed;
  }
  return ends;
}

}  // namespace

std::vector<Gap> FindGaps(ContourFile const& contour) {
  std::vector<Gap> gaps;
  std::vector<Piece> const& pieces = contour.pieces;
  std::vector<bool> const endsOutline = EndsOfOutlines(contour);
  double const tolerance = JointTolerance(pieces);
  for (std::size_t i = 0; i < pieces.size(); ++i) {
    bool const isLast = i + 1 == pieces.size();
    if (isLast && !contour.isClosed) break;
    std::size_t const next = isLast ? 0 : i + 1;
    double const size = Distance(pieces[i].end, pieces[next].start);
    if (size > tolerance && !endsOutline[i]) gaps.push_back({i, next, size});
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
