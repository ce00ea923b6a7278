// DXF 2000: the tables, blocks and objects that this version asks for, and the contour among them.
#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

#include "io/formats/Dxf.h"
#include "io/formats/DxfUnits.h"
#include "io/formats/DxfWriter.h"
#include "io/formats/Text.h"
#include "io/pieces/Nesting.h"
#include "io/pieces/Shapes.h"

namespace Vorn::IO {

namespace {

/// A number that names an object of the drawing; written in hexadecimal.
using Handle = std::uint32_t;

/// No object: the owner of what nothing owns.
constexpr Handle kNobody = 0;

/// The extent of the drawing with some room, as a view shows it.
constexpr double kRoom = 1.1;
constexpr double kLens = 50.0;  // millimetres, as every program writes it

class Drawing {
 public:
  Drawing(ContourFile const& contour, DxfStyle style)
      : contour_(contour), style_(style), extent_(ExtentOf(contour.pieces)) {}

  std::string Text() {
    // The header names a handle that no object has, so it comes last.
    WriteTables();
    WriteBlocks();
    WriteEntities();
    WriteObjects();
    dxf_.Group(0, "EOF");
    return Header() + dxf_.Text();
  }

 private:
  static std::string Written(Handle handle) {
    char text[16];
    std::snprintf(text, sizeof text, "%X", handle);
    return text;
  }

  /// Gives the object that was begun its handle and its owner.
  Handle Name(Handle owner, int code = 5) {
    dxf_.Group(code, Written(next_));
    dxf_.Group(330, Written(owner));
    return next_++;
  }

  void Class(char const* name) { dxf_.Group(100, name); }

  std::string Header() const {
    Dxf::Writer header;
    if (!contour_.units.empty()) header.Group(999, "units " + OneLine(contour_.units));
    auto const variable = [&](char const* name, int code, std::string const& value) {
      header.Group(9, name);
      header.Group(code, value);
    };
    header.Begin("HEADER");
    variable("$ACADVER", 1, "AC1015");
    variable("$HANDSEED", 5, Written(next_));
    variable("$INSUNITS", 70, Dxf::NumberOfUnits(contour_.units));
    header.Group(9, "$EXTMIN");
    header.At(10, extent_.low);
    header.Group(9, "$EXTMAX");
    header.At(10, extent_.high);
    header.End();
    header.Begin("CLASSES");
    header.End();
    return header.Text();
  }

  Handle BeginTable(char const* name, int count) {
    dxf_.Group(0, "TABLE");
    dxf_.Group(2, name);
    Handle const handle = Name(kNobody);
    Class("AcDbSymbolTable");
    dxf_.Group(70, std::to_string(count));
    return handle;
  }

  void EndTable() { dxf_.Group(0, "ENDTAB"); }

  /// A record of a table up to its name.
  Handle BeginRecord(char const* type, char const* subclass, std::string const& name,
                     Handle table) {
    dxf_.Group(0, type);
    Handle const handle = Name(table, std::string(type) == "DIMSTYLE" ? 105 : 5);
    Class("AcDbSymbolTableRecord");
    Class(subclass);
    dxf_.Group(2, name);
    return handle;
  }

  void WriteTables() {
    dxf_.Begin("TABLES");
    WriteViewPort();
    WriteLineTypes();
    WriteLayers();
    WriteStyle();
    BeginTable("VIEW", 0);
    EndTable();
    BeginTable("UCS", 0);
    EndTable();
    Handle const applications = BeginTable("APPID", 1);
    BeginRecord("APPID", "AcDbRegAppTableRecord", "ACAD", applications);
    dxf_.Group(70, "0");
    EndTable();
    WriteDimensionStyle();
    WriteBlockRecords();
    dxf_.End();
  }

  /// Shows the whole contour.
  void WriteViewPort() {
    Handle const table = BeginTable("VPORT", 1);
    BeginRecord("VPORT", "AcDbViewportTableRecord", "*ACTIVE", table);
    double const width = extent_.high.x - extent_.low.x;
    double const height = extent_.high.y - extent_.low.y;
    dxf_.Group(70, "0");
    dxf_.Flat(10, {0.0, 0.0});
    dxf_.Flat(11, {1.0, 1.0});
    dxf_.Flat(12, {extent_.low.x + width / 2.0, extent_.low.y + height / 2.0});
    dxf_.At(16, {0.0, 0.0});
    dxf_.At(17, {0.0, 0.0});
    dxf_.Number(40, kRoom * std::max(width, height));
    dxf_.Number(41, 1.0);
    dxf_.Number(42, kLens);
    EndTable();
  }

  void WriteLineTypes() {
    Handle const table = BeginTable("LTYPE", 3);
    for (char const* name : {"ByBlock", "ByLayer", "Continuous"}) {
      BeginRecord("LTYPE", "AcDbLinetypeTableRecord", name, table);
      dxf_.Group(70, "0");
      dxf_.Group(3, "");
      dxf_.Group(72, "65");
      dxf_.Group(73, "0");
      dxf_.Number(40, 0.0);
    }
    EndTable();
  }

  void WriteLayer(std::string const& name, int color, Handle table) {
    BeginRecord("LAYER", "AcDbLayerTableRecord", name, table);
    dxf_.Group(70, "0");
    dxf_.Group(62, std::to_string(color));
    dxf_.Group(6, "Continuous");
  }

  void WriteLayers() {
    Handle const table = BeginTable("LAYER", 3);
    WriteLayer("0", Dxf::kBlackOrWhite, table);
    if (style_ == DxfStyle::Polyline) {
      WriteLayer(Dxf::kContourLayer, Dxf::kBlackOrWhite, table);
      WriteLayer(Dxf::kHoleLayer, Dxf::kRed, table);
    } else {
      WriteLayer(Dxf::kLineLayer, Dxf::kBlue, table);
      WriteLayer(Dxf::kArcLayer, Dxf::kRed, table);
    }
    EndTable();
  }

  void WriteStyle() {
    Handle const table = BeginTable("STYLE", 1);
    BeginRecord("STYLE", "AcDbTextStyleTableRecord", "Standard", table);
    dxf_.Group(70, "0");
    dxf_.Number(40, 0.0);
    dxf_.Number(41, 1.0);
    dxf_.Number(50, 0.0);
    dxf_.Group(71, "0");
    dxf_.Number(42, 2.5);
    dxf_.Group(3, "txt");
    dxf_.Group(4, "");
    EndTable();
  }

  void WriteDimensionStyle() {
    Handle const table = BeginTable("DIMSTYLE", 1);
    Class("AcDbDimStyleTable");
    BeginRecord("DIMSTYLE", "AcDbDimStyleTableRecord", "Standard", table);
    dxf_.Group(70, "0");
    EndTable();
  }

  void WriteBlockRecords() {
    Handle const table = BeginTable("BLOCK_RECORD", 2);
    modelSpace_ = BeginRecord("BLOCK_RECORD", "AcDbBlockTableRecord", "*Model_Space", table);
    paperSpace_ = BeginRecord("BLOCK_RECORD", "AcDbBlockTableRecord", "*Paper_Space", table);
    EndTable();
  }

  void BeginEntity(char const* type, char const* layer, Handle owner) {
    dxf_.Group(0, type);
    Name(owner);
    Class("AcDbEntity");
    if (owner == paperSpace_ && owner != kNobody) dxf_.Group(67, "1");
    dxf_.Group(8, layer);
  }

  void WriteBlock(char const* name, Handle record) {
    BeginEntity("BLOCK", "0", record);
    Class("AcDbBlockBegin");
    dxf_.Group(2, name);
    dxf_.Group(70, "0");
    dxf_.At(10, {0.0, 0.0});
    dxf_.Group(3, name);
    dxf_.Group(1, "");
    BeginEntity("ENDBLK", "0", record);
    Class("AcDbBlockEnd");
  }

  void WriteBlocks() {
    dxf_.Begin("BLOCKS");
    WriteBlock("*Model_Space", modelSpace_);
    WriteBlock("*Paper_Space", paperSpace_);
    dxf_.End();
  }

  void WriteEntities() {
    dxf_.Begin("ENTITIES");
    ContourFile divided = contour_;
    divided.pieces = WithoutWideArcs(contour_.pieces);
    if (style_ == DxfStyle::Polyline) {
      WritePolylines(RunsOf(divided));
    } else {
      for (Piece const& piece : divided.pieces) WritePiece(piece);
    }
    dxf_.End();
  }

  void WritePolylines(std::vector<ContourFile> const& runs) {
    std::vector<std::vector<std::size_t>> const containers = ContainersOf(runs);
    for (std::size_t i = 0; i < runs.size(); ++i) {
      bool const isHole = containers[i].size() % 2 != 0;
      WritePolyline(runs[i], isHole ? Dxf::kHoleLayer : Dxf::kContourLayer);
    }
  }

  void WritePolyline(ContourFile const& run, char const* layer) {
    BeginEntity("LWPOLYLINE", layer, modelSpace_);
    Class("AcDbPolyline");
    dxf_.Group(90, std::to_string(run.pieces.size() + (run.isClosed ? 0 : 1)));
    dxf_.Group(70, run.isClosed ? "1" : "0");
    for (Piece const& piece : run.pieces) {
      dxf_.Flat(10, piece.start);
      if (piece.IsArc()) dxf_.Number(42, BulgeOf(piece));
    }
    if (!run.isClosed) dxf_.Flat(10, run.pieces.back().end);
  }

  void WritePiece(Piece const& piece) {
    bool const isArc = Dxf::IsWrittenAsArc(piece);
    BeginEntity(isArc ? "ARC" : "LINE", isArc ? Dxf::kArcLayer : Dxf::kLineLayer, modelSpace_);
    Class(isArc ? "AcDbCircle" : "AcDbLine");
    if (isArc) {
      dxf_.Circle(piece);
      Class("AcDbArc");
      dxf_.Angles(piece);
    } else {
      dxf_.At(10, piece.start);
      dxf_.At(11, piece.end);
    }
  }

  void WriteObjects() {
    dxf_.Begin("OBJECTS");
    dxf_.Group(0, "DICTIONARY");
    Handle const root = Name(kNobody);
    Class("AcDbDictionary");
    dxf_.Group(281, "1");
    dxf_.Group(3, "ACAD_GROUP");
    dxf_.Group(350, Written(next_));
    dxf_.Group(0, "DICTIONARY");
    Name(root);
    Class("AcDbDictionary");
    dxf_.Group(281, "1");
    dxf_.End();
  }

  ContourFile const& contour_;
  DxfStyle style_;
  Extent extent_;
  Dxf::Writer dxf_;
  Handle next_ = 1;
  Handle modelSpace_ = kNobody;
  Handle paperSpace_ = kNobody;
};

}  // namespace

std::string ToDxf2000(ContourFile const& contour, DxfStyle style) {
  return Drawing(contour, style).Text();
}

}  // namespace Vorn::IO
