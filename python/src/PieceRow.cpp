#include "PieceRow.h"

#include <cstring>
#include <limits>
#include <utility>

namespace py = pybind11;

namespace Vorn::Python {

namespace {

constexpr double kNone = std::numeric_limits<double>::quiet_NaN();

void FillArc(IO::Piece const& arc, PieceRow* row) {
  row->centerX = arc.center.x;
  row->centerY = arc.center.y;
  row->radius = arc.radius;
  row->startAngle = arc.startAngle;
  row->endAngle = arc.endAngle;
  row->sweep = arc.sweep;
  row->isArc = true;
  row->ccw = arc.counterClockwise;
}

PieceRow RowOf(IO::Piece const& piece, CoveredPoints const& covered) {
  PieceRow row;
  // The bytes between the fields count when rows are pickled.
  std::memset(&row, 0, sizeof row);
  row.startX = piece.start.x;
  row.startY = piece.start.y;
  row.endX = piece.end.x;
  row.endY = piece.end.y;
  row.length = piece.length;
  row.firstPoint = covered.first;
  row.lastPoint = covered.last;
  row.centerX = row.centerY = row.radius = row.startAngle = row.endAngle = kNone;
  if (piece.IsArc()) FillArc(piece, &row);
  return row;
}

IO::Piece PieceFrom(PieceRow const& row) {
  IO::Piece piece;
  piece.start = {row.startX, row.startY};
  piece.end = {row.endX, row.endY};
  piece.length = row.length;
  if (!row.isArc) return piece;
  piece.kind = IO::Piece::Kind::Arc;
  piece.center = {row.centerX, row.centerY};
  piece.radius = row.radius;
  piece.counterClockwise = row.ccw;
  piece.startAngle = row.startAngle;
  piece.endAngle = row.endAngle;
  piece.sweep = row.sweep;
  return piece;
}

}  // namespace

PieceRows RowsOf(std::vector<IO::Piece> const& pieces, std::vector<CoveredPoints> const& covered) {
  PieceRows rows(static_cast<py::ssize_t>(pieces.size()));
  PieceRow* const out = rows.mutable_data();
  for (std::size_t i = 0; i < pieces.size(); ++i) {
    PieceRow const row = RowOf(pieces[i], covered.empty() ? CoveredPoints() : covered[i]);
    std::memcpy(out + i, &row, sizeof row);
  }
  return rows;
}

PieceRows RowsOf(std::vector<IO::Piece> const& pieces) { return RowsOf(pieces, {}); }

std::vector<IO::Piece> PiecesFrom(PieceRows const& rows) {
  std::vector<IO::Piece> pieces;
  pieces.reserve(static_cast<std::size_t>(rows.size()));
  PieceRow const* const data = rows.data();
  for (py::ssize_t i = 0; i < rows.size(); ++i) pieces.push_back(PieceFrom(data[i]));
  return pieces;
}

IO::ContourFile ContourFrom(PieceRows const& rows, bool isClosed, std::string units) {
  IO::ContourFile contour;
  contour.pieces = PiecesFrom(rows);
  contour.isClosed = isClosed;
  contour.units = std::move(units);
  return contour;
}

void RegisterPieceRow() {
  PYBIND11_NUMPY_DTYPE_EX(PieceRow, startX, "start_x", startY, "start_y", endX, "end_x", endY,
                          "end_y", centerX, "center_x", centerY, "center_y", radius, "radius",
                          startAngle, "start_angle", endAngle, "end_angle", sweep, "sweep", length,
                          "length", firstPoint, "first_point", lastPoint, "last_point", isArc,
                          "is_arc", ccw, "ccw");
}

}  // namespace Vorn::Python
