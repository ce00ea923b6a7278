#include "io/formats/Dxf.h"

#include "io/formats/DxfEntities.h"
#include "io/formats/DxfWriter.h"
#include "io/formats/Text.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

using Dxf::Writer;

using Dxf::kArcLayer;
using Dxf::kContourLayer;
using Dxf::kLineLayer;

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
  dxf->Begin("TABLES");
  WriteLineType(dxf);
  dxf->Group(0, "TABLE");
  dxf->Group(2, "LAYER");
  dxf->Group(70, style == DxfStyle::Polyline ? "1" : "2");
  if (style == DxfStyle::Polyline) {
    WriteLayer(kContourLayer, Dxf::kBlackOrWhite, dxf);
  } else {
    WriteLayer(kLineLayer, Dxf::kBlue, dxf);
    WriteLayer(kArcLayer, Dxf::kRed, dxf);
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
  ContourFile divided = contour;
  divided.pieces = WithoutWideArcs(contour.pieces);
  for (ContourFile const& run : RunsOf(divided)) WritePolyline(run.pieces, run.isClosed, dxf);
}

/// Arcs run counter-clockwise from the first angle to the second.
void WriteArc(Piece const& arc, Writer* dxf) {
  dxf->Entity("ARC", kArcLayer);
  dxf->Circle(arc);
  dxf->Angles(arc);
}

void WriteLine(Piece const& line, Writer* dxf) {
  dxf->Entity("LINE", kLineLayer);
  dxf->At(10, line.start);
  dxf->At(11, line.end);
}

void WriteEntities(ContourFile const& contour, Writer* dxf) {
  for (Piece const& piece : WithoutWideArcs(contour.pieces)) {
    Dxf::IsWrittenAsArc(piece) ? WriteArc(piece, dxf) : WriteLine(piece, dxf);
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
