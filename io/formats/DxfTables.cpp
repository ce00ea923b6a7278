#include "io/formats/DxfTables.h"

#include <algorithm>

namespace Vorn::IO::Dxf {

namespace {

/// The view shows the extent with some room around it.
constexpr double kRoom = 1.1;
constexpr double kLens = 50.0;  // millimetres, as every program writes it

/// Shows the whole contour.
void WriteViewPort(Extent const& extent, Objects* dxf) {
  Handle const table = dxf->BeginTable("VPORT", 1);
  dxf->BeginRecord("VPORT", "AcDbViewportTableRecord", "*ACTIVE", table);
  double const width = extent.high.x - extent.low.x;
  double const height = extent.high.y - extent.low.y;
  dxf->Group(70, "0");
  dxf->Flat(10, {0.0, 0.0});
  dxf->Flat(11, {1.0, 1.0});
  dxf->Flat(12, {extent.low.x + width / 2.0, extent.low.y + height / 2.0});
  dxf->At(16, {0.0, 0.0});
  dxf->At(17, {0.0, 0.0});
  dxf->Number(40, kRoom * std::max(width, height));
  dxf->Number(41, 1.0);
  dxf->Number(42, kLens);
  dxf->EndTable();
}

/// Lines are drawn through; the two names before say that entities may ask their layer or block.
void WriteLineTypes(Objects* dxf) {
  Handle const table = dxf->BeginTable("LTYPE", 3);
  for (char const* name : {"ByBlock", "ByLayer", "Continuous"}) {
    dxf->BeginRecord("LTYPE", "AcDbLinetypeTableRecord", name, table);
    dxf->Group(70, "0");
    dxf->Group(3, "");
    dxf->Group(72, "65");
    dxf->Group(73, "0");
    dxf->Number(40, 0.0);
  }
  dxf->EndTable();
}

void WriteLayer(std::string const& name, int color, Handle table, Objects* dxf) {
  dxf->BeginRecord("LAYER", "AcDbLayerTableRecord", name, table);
  dxf->Group(70, "0");
  dxf->Group(62, std::to_string(color));
  dxf->Group(6, "Continuous");
}

void WriteLayers(DxfStyle style, Objects* dxf) {
  Handle const table = dxf->BeginTable("LAYER", 3);
  WriteLayer("0", kBlackOrWhite, table, dxf);
  if (style == DxfStyle::Polyline) {
    WriteLayer(kContourLayer, kBlackOrWhite, table, dxf);
    WriteLayer(kHoleLayer, kRed, table, dxf);
  } else {
    WriteLayer(kLineLayer, kBlue, table, dxf);
    WriteLayer(kArcLayer, kRed, table, dxf);
  }
  dxf->EndTable();
}

/// The style of texts, of which the contour has none.
void WriteStyle(Objects* dxf) {
  Handle const table = dxf->BeginTable("STYLE", 1);
  dxf->BeginRecord("STYLE", "AcDbTextStyleTableRecord", "Standard", table);
  dxf->Group(70, "0");
  dxf->Number(40, 0.0);
  dxf->Number(41, 1.0);
  dxf->Number(50, 0.0);
  dxf->Group(71, "0");
  dxf->Number(42, 2.5);
  dxf->Group(3, "txt");
  dxf->Group(4, "");
  dxf->EndTable();
}

void WriteDimensionStyle(Objects* dxf) {
  Handle const table = dxf->BeginTable("DIMSTYLE", 1);
  dxf->Class("AcDbDimStyleTable");
  dxf->BeginRecord("DIMSTYLE", "AcDbDimStyleTableRecord", "Standard", table);
  dxf->Group(70, "0");
  dxf->EndTable();
}

Spaces WriteBlockRecords(Objects* dxf) {
  Handle const table = dxf->BeginTable("BLOCK_RECORD", 2);
  Spaces spaces;
  spaces.model = dxf->BeginRecord("BLOCK_RECORD", "AcDbBlockTableRecord", "*Model_Space", table);
  spaces.paper = dxf->BeginRecord("BLOCK_RECORD", "AcDbBlockTableRecord", "*Paper_Space", table);
  dxf->EndTable();
  return spaces;
}

}  // namespace

Spaces WriteTables(Extent const& extent, DxfStyle style, Objects* dxf) {
  dxf->Begin("TABLES");
  WriteViewPort(extent, dxf);
  WriteLineTypes(dxf);
  WriteLayers(style, dxf);
  WriteStyle(dxf);
  dxf->BeginTable("VIEW", 0);
  dxf->EndTable();
  dxf->BeginTable("UCS", 0);
  dxf->EndTable();
  Handle const applications = dxf->BeginTable("APPID", 1);
  dxf->BeginRecord("APPID", "AcDbRegAppTableRecord", "ACAD", applications);
  dxf->Group(70, "0");
  dxf->EndTable();
  WriteDimensionStyle(dxf);
  Spaces const spaces = WriteBlockRecords(dxf);
  dxf->End();
  return spaces;
}

}  // namespace Vorn::IO::Dxf
