#include <numbers>

#include "io/formats/LengthUnits.h"
#include "io/formats/Svg.h"
#include "io/formats/Text.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Messages.h"

namespace Vorn::IO {

namespace {

constexpr double kWidestPathArc = 2.0 * std::numbers::pi / 3.0;

/// A tenth of a millimetre: thin enough for a cutter to take it for a line to follow.
constexpr double kLineWidth = 0.1;

std::string PageUnit(ContourFile const& contour) {
  if (IsInch(contour.units)) return "in";
  if (contour.units.empty() || IsMillimetre(contour.units)) return "mm";
  throw Failure(FailureKind::BadArgument, {contour.path},
                "a plain SVG is in mm or inch, and the units are " + Quoted(contour.units),
                Remedy::ChooseUnits);
}

/// y points down in SVG; a zero carries no sign.
std::string Written(XY const& at) {
  return FormatPlain(at.x) + " " + FormatPlain(at.y == 0.0 ? 0.0 : -at.y);
}

std::string StepOf(Piece const& piece) {
  if (!piece.IsArc()) return "L " + Written(piece.end);
  std::string const radius = FormatPlain(piece.radius);
  return "A " + radius + " " + radius + " 0 0 " + (piece.counterClockwise ? "0 " : "1 ") +
         Written(piece.end);
}

std::string PathOf(ContourFile const& run) {
  std::string data = "M " + Written(run.pieces.front().start);
  for (Piece const& piece : WithoutArcsBeyond(kWidestPathArc, run.pieces)) {
    data += " " + StepOf(piece);
  }
  return R"(<path d=")" + data + (run.isClosed ? " Z" : "") + "\"/>\n";
}

/// The page around the contour, with room for the width of the lines.
std::string PageOf(ContourFile const& contour, double lineWidth) {
  Extent const extent = ExtentOf(contour.pieces);
  std::string const unit = PageUnit(contour);
  std::string const width = FormatPlain(extent.high.x - extent.low.x + 2.0 * lineWidth);
  std::string const height = FormatPlain(extent.high.y - extent.low.y + 2.0 * lineWidth);
  XY const corner = {extent.low.x - lineWidth, extent.high.y + lineWidth};
  return R"(<svg xmlns="http://www.w3.org/2000/svg" width=")" + width + unit + "\" height=\"" +
         height + unit + "\" viewBox=\"" + Written(corner) + " " + width + " " + height + "\">\n";
}

}  // namespace

std::string ToPlainSvg(ContourFile const& contour) {
  double const lineWidth =
      PageUnit(contour) == "in" ? kLineWidth / kMillimetresPerInch : kLineWidth;
  std::string text = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n" + PageOf(contour, lineWidth) +
                     R"(<g fill="none" stroke="black" stroke-width=")" + FormatPlain(lineWidth) +
                     "\">\n";
  for (ContourFile const& run : RunsOf(contour)) text += PathOf(run);
  return text + "</g>\n</svg>\n";
}

}  // namespace Vorn::IO
