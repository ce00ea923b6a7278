#include "io/formats/Wkt.h"

#include <utility>

#include "io/formats/Text.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

std::string Written(XY const& point) { return FormatExact(point.x) + " " + FormatExact(point.y); }

bool IsWrittenAsArc(Piece const& piece) {
  return piece.IsArc() && piece.sweep > 0.0 && !AreEqual(piece.start, piece.end);
}

/// Neighbours of one kind in one list: "LINESTRING (0 0, 1 1)".
struct Strand {
  bool isArcs = false;
  std::string points;
};

/// The pieces of a run, each from the start of its own to the start of the next; the last ends at
/// `end`.
std::vector<Strand> StrandsOf(std::vector<Piece> const& run, XY const& end) {
  std::vector<Strand> strands;
  for (std::size_t i = 0; i < run.size(); ++i) {
    bool const isArc = IsWrittenAsArc(run[i]);
    if (strands.empty() || strands.back().isArcs != isArc) {
      strands.push_back({isArc, Written(run[i].start)});
    }
    std::string& points = strands.back().points;
    if (isArc) points += ", " + Written(PointOnArc(run[i], run[i].sweep / 2.0));
    points += ", " + Written(i + 1 < run.size() ? run[i + 1].start : end);
  }
  return strands;
}

std::string CurveOf(std::vector<Piece> const& run, XY const& end) {
  std::vector<Strand> const strands = StrandsOf(run, end);
  if (strands.size() == 1) {
    return (strands[0].isArcs ? "CIRCULARSTRING (" : "LINESTRING (") + strands[0].points + ")";
  }
  std::string text;
  for (Strand const& strand : strands) {
    text += text.empty() ? "COMPOUNDCURVE (" : ", ";
    text += (strand.isArcs ? "CIRCULARSTRING (" : "(") + strand.points + ")";
  }
  return text + ")";
}

}  // namespace

std::string ToWkt(ContourFile const& contour) {
  ContourFile divided = contour;
  divided.pieces = WithoutWideArcs(contour.pieces);
  std::vector<ContourFile> const runs = RunsOf(divided);
  std::string text;
  for (ContourFile const& run : runs) {
    if (!text.empty()) text += ", ";
    // The ends of a closed curve must be the same to the last digit.
    XY const end = run.isClosed ? run.pieces.front().start : run.pieces.back().end;
    text += CurveOf(run.pieces, end);
  }
  return (runs.size() == 1 ? text : "MULTICURVE (" + text + ")") + "\n";
}

}  // namespace Vorn::IO
