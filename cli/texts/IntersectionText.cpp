#include "cli/texts/IntersectionText.h"

#include <algorithm>

#include "cli/texts/Columns.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

namespace {

constexpr int kDigits = 10;

std::string Number(double value) { return FormatShort(value, kDigits); }

std::string KindOfPiece(ContourFile const& contour, std::size_t piece) {
  return contour.pieces[piece].IsArc() ? "arc" : "line";
}

std::string PieceText(ContourFile const& contour, OnContour const& place) {
  return std::to_string(place.piece + 1) + " " + KindOfPiece(contour, place.piece);
}

std::string Heading(std::vector<Intersection> const& found, ContourFile const& a,
                    ContourFile const* b) {
  std::string const who = b == nullptr ? a.path + " with itself" : a.path + " with " + b->path;
  if (found.empty()) return who + ": no intersections\n";
  return who + ": " + Describe(Tally(found)) + "\n";
}

}  // namespace

std::string ToText(std::vector<Intersection> const& found, ContourFile const& a,
                   ContourFile const* b) {
  std::string text = Heading(found, a, b);
  if (found.empty()) return text;
  std::vector<Row> rows = {
      {"no", "kind", "x", "y", "to x", "to y", "piece of A", "at", "piece of B", "at"}};
  for (Intersection const& one : found) {
    rows.push_back({std::to_string(rows.size()), NameOf(one.kind), Number(one.at.x),
                    Number(one.at.y), one.until ? Number(one.until->x) : "-",
                    one.until ? Number(one.until->y) : "-", PieceText(a, one.a),
                    Number(one.a.position), PieceText(b == nullptr ? a : *b, one.b),
                    Number(one.b.position)});
  }
  return text + "\n" + Aligned(rows);
}

}  // namespace Vorn::Cli
