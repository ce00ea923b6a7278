#include "cli/texts/IntersectionText.h"

#include <algorithm>

#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

namespace {

using Row = std::vector<std::string>;

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

std::string Aligned(std::vector<Row> const& rows) {
  std::vector<std::size_t> widths(rows.front().size());
  for (Row const& row : rows) {
    for (std::size_t i = 0; i < row.size(); ++i) widths[i] = std::max(widths[i], row[i].size());
  }
  std::string text;
  for (Row const& row : rows) {
    for (std::size_t i = 0; i < row.size(); ++i) {
      text += i == 0 ? "" : "  ";
      text.append(widths[i] - row[i].size(), ' ');
      text += row[i];
    }
    text += "\n";
  }
  return text;
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
