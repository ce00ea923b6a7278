#include "vorn/io/ContourFile.h"

#include <algorithm>
#include <cmath>

#include "io/pieces/Shapes.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

std::size_t RemovePiecesWithoutLength(std::vector<Piece>* pieces) {
  auto const isPoint = [](Piece const& piece) {
    return AreEqual(piece.start, piece.end) && (!piece.IsArc() || piece.sweep == 0.0);
  };
  return std::erase_if(*pieces, isPoint);
}

double JointTolerance(std::vector<Piece> const& pieces) {
  // Nine digits of a file are kept, and a centre far away loses some last digits at the ends.
  constexpr double kOfCoordinates = 1e-9;
  constexpr double kOfRadius = 1e-14;
  double coordinate = 0.0;
  double radius = 0.0;
  for (Piece const& piece : pieces) {
    for (XY const& end : {piece.start, piece.end}) {
      coordinate = std::max({coordinate, std::fabs(end.x), std::fabs(end.y)});
    }
    radius = std::max(radius, piece.radius);
  }
  return std::max(kOfCoordinates * coordinate, kOfRadius * radius);
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
