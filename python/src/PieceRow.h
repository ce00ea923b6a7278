#pragma once

#include <pybind11/numpy.h>

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "vorn/io/ContourFile.h"
#include "vorn/io/Pieces.h"

namespace Vorn::Python {

/// One piece of a contour as Python keeps it: a row of a structured array. What a line has not is
/// not-a-number; points that are not known are -1.
struct PieceRow {
  double startX, startY;
  double endX, endY;
  double centerX, centerY;
  double radius;
  double startAngle, endAngle;  ///< polar angles of the ends from the centre, radians
  double sweep;                 ///< radians turned from start to end; 0 for a line
  double length;
  std::int64_t firstPoint, lastPoint;  ///< the points covered; first > last across the seam
  bool isArc;
  bool ccw;
};

using PieceRows = pybind11::array_t<PieceRow, pybind11::array::c_style>;

/// The points of one piece.
struct CoveredPoints {
  std::int64_t first = -1;
  std::int64_t last = -1;
};

/// The pieces as an array; `covered` is empty or has an entry for each.
PieceRows RowsOf(std::vector<IO::Piece> const& pieces, std::vector<CoveredPoints> const& covered);

/// The same without points.
PieceRows RowsOf(std::vector<IO::Piece> const& pieces);

/// The pieces that the rows stand for.
std::vector<IO::Piece> PiecesFrom(PieceRows const& rows);

/// A contour with these pieces.
IO::ContourFile ContourFrom(PieceRows const& rows, bool isClosed, std::string units);

/// Makes the type of the rows known to NumPy; once, when the module is loaded.
void RegisterPieceRow();

}  // namespace Vorn::Python
