#include "io/formats/Dxf.h"

#include <cmath>
#include <numbers>

#include "io/formats/DxfEntities.h"
#include "io/formats/Text.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

constexpr double kDegrees = 180.0 / std::numbers::pi;

constexpr char const* kContourLayer = "CONTOUR";
constexpr char const* kLineLayer = "CONTOUR_LINES";
constexpr char const* kArcLayer = "CONTOUR_ARCS";

/// The text of a file, group by group.
class Writer {
 public:
  void Group(int code, std::string const& value) {
    text_ += std::to_string(code) + "\n" + value + "\n";
  }

  void Number(int code, double value) { Group(code, FormatPlain(value)); }

  /// x and y under `code` and `code` + 10, and a z of 0.
  void At(int code, XY const& point) {
    Number(code, point.x);
    Number(code + 10, point.y);
    Number(code + 20, 0.0);
  }

  void Begin(std::string const& section) {
    Group(0, "SECTION");
    Group(2, section);
  }

  void End() { Group(0, "ENDSEC"); }

  void Entity(std::string const& type, std::string const& layer) {
    Group(0, type);
    Group(8, layer);
  }

  std::string const& Text() const { return text_; }

 private:
  std::string text_;
};

void WriteHeader(ContourFile const& contour, Writer* dxf) {
  if (!contour.units.empty()) dxf->Group(999, "units " + OneLine(contour.units));
  Extent const extent = ExtentOf(contour.pieces);
  dxf->Begin("HEADER");
  dxf->Group(9, "$ACADVER");
  dxf->Group(1, "AC1009");
  dxf->Group(9, "$EXTMIN");
  dxf->At(10, extent.low);
  dxf->Group(9, "$EXTMAX");
  dxf->At(10, extent.high);
  dxf->End();
}

void WriteLineType(Writer* dxf) {
  dxf->Group(0, "TABLE");
  dxf->Group(2, "LTYPE");
  dxf->Group(70, "1");
  dxf->Group(0, "LTYPE");
  dxf->Group(2, "CONTINUOUS");
  dxf->Group(70, "0");
  dxf->Group(3, "Solid line");
  dxf->Group(72, "65");
  dxf->Group(73, "0");
  dxf->Number(40, 0.0);
  dxf->Group(0, "ENDTAB");
}

void WriteLayer(std::string const& name, int color, Writer* dxf) {
  dxf->Group(0, "LAYER");
  dxf->Group(2, name);
  dxf->Group(70, "0");
  dxf->Group(62, std::to_string(color));
  dxf->Group(6, "CONTINUOUS");
}

void WriteTables(DxfStyle style, Writer* dxf) {
  constexpr int kBlackOrWhite = 7;
  constexpr int kBlue = 5;
  constexpr int kRed = 1;
  dxf->Begin("TABLES");
  WriteLineType(dxf);
  dxf->Group(0, "TABLE");
  dxf->Group(2, "LAYER");
  dxf->Group(70, style == DxfStyle::Polyline ? "1" : "2");
  if (style == DxfStyle::Polyline) {
    WriteLayer(kContourLayer, kBlackOrWhite, dxf);
  } else {
    WriteLayer(kLineLayer, kBlue, dxf);
    WriteLayer(kArcLayer, kRed, dxf);
  }
  dxf->Group(0, "ENDTAB");
  dxf->End();
}

void WriteVertex(XY const& point, double bulge, Writer* dxf) {
  dxf->Entity("VERTEX", kContourLayer);
  dxf->At(10, point);
  if (bulge != 0.0) dxf->Number(42, bulge);
}

void WritePolyline(std::vector<Piece> const& run, bool isClosed, Writer* dxf) {
  dxf->Entity("POLYLINE", kContourLayer);
  dxf->Group(66, "1");
  dxf->At(10, {0.0, 0.0});
  dxf->Group(70, isClosed ? "1" : "0");
  for (Piece const& piece : run) WriteVertex(piece.start, BulgeOf(piece), dxf);
  if (!isClosed) WriteVertex(run.back().end, 0.0, dxf);
  dxf->Entity("SEQEND", kContourLayer);
}

void WritePolylines(ContourFile const& contour, Writer* dxf) {
  std::vector<Piece> const pieces = WithoutWideArcs(contour.pieces);
  auto const runs = ConnectedRuns(pieces, JointTolerance(pieces));
  bool const isLoop = contour.isClosed && runs.size() == 1 && ReturnsToStart(pieces);
  for (std::vector<Piece> const& run : runs) WritePolyline(run, isLoop, dxf);
}

/// In [0, 360).
double Degrees(double angle) {
  double const degrees = angle * kDegrees;
  return degrees < 0.0 ? degrees + 360.0 : degrees;
}

/// Arcs run counter-clockwise from the first angle to the second.
void WriteArc(Piece const& arc, Writer* dxf) {
  dxf->Entity("ARC", kArcLayer);
  dxf->At(10, arc.center);
  dxf->Number(40, arc.radius);
  dxf->Number(50, Degrees(arc.counterClockwise ? arc.startAngle : arc.endAngle));
  dxf->Number(51, Degrees(arc.counterClockwise ? arc.endAngle : arc.startAngle));
}

void WriteLine(Piece const& line, Writer* dxf) {
  dxf->Entity("LINE", kLineLayer);
  dxf->At(10, line.start);
  dxf->At(11, line.end);
}

void WriteEntities(ContourFile const& contour, Writer* dxf) {
  for (Piece const& piece : WithoutWideArcs(contour.pieces)) {
    // Two equal angles would be read as a full circle.
    bool const isArc = piece.IsArc() && Degrees(piece.startAngle) != Degrees(piece.endAngle);
    isArc ? WriteArc(piece, dxf) : WriteLine(piece, dxf);
  }
}

}  // namespace

std::string ToDxf(ContourFile const& contour, DxfStyle style) {
  Writer dxf;
  WriteHeader(contour, &dxf);
  WriteTables(style, &dxf);
  dxf.Begin("ENTITIES");
  style == DxfStyle::Polyline ? WritePolylines(contour, &dxf) : WriteEntities(contour, &dxf);
  dxf.End();
  dxf.Group(0, "EOF");
  return dxf.Text();
}

}  // namespace Vorn::IO
