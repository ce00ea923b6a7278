// DXF 2000: header, blocks and objects that this version asks for, and the contour among them.
#include <string>
#include <vector>

#include "io/formats/Dxf.h"
#include "io/formats/DxfObjects.h"
#include "io/formats/DxfTables.h"
#include "io/formats/DxfUnits.h"
#include "io/formats/Text.h"
#include "io/pieces/Nesting.h"
#include "io/pieces/Shapes.h"

namespace Vorn::IO {

namespace {

class Drawing {
 public:
  Drawing(ContourFile const& contour, DxfStyle style)
      : contour_(contour), style_(style), extent_(ExtentOf(contour.pieces)) {}

  std::string Text() {
    // The header names a handle that no object has, so it comes last.
    spaces_ = Dxf::WriteTables(extent_, style_, &dxf_);
    WriteBlocks();
    WriteEntities();
    WriteObjects();
    dxf_.Group(0, "EOF");
    return Header() + dxf_.Text();
  }

 private:
  std::string Header() const {
    Dxf::Writer header;
    if (!contour_.units.empty()) header.Group(999, "units " + OneLine(contour_.units));
    auto const variable = [&](char const* name, int code, std::string const& value) {
      header.Group(9, name);
      header.Group(code, value);
    };
    header.Begin("HEADER");
    variable("$ACADVER", 1, "AC1015");
    variable("$HANDSEED", 5, Dxf::Written(dxf_.Next()));
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

  void WriteBlock(char const* name, Dxf::Handle record, bool isOnPaper) {
    dxf_.BeginEntity("BLOCK", "0", record, isOnPaper);
    dxf_.Class("AcDbBlockBegin");
    dxf_.Group(2, name);
    dxf_.Group(70, "0");
    dxf_.At(10, {0.0, 0.0});
    dxf_.Group(3, name);
    dxf_.Group(1, "");
    dxf_.BeginEntity("ENDBLK", "0", record, isOnPaper);
    dxf_.Class("AcDbBlockEnd");
  }

  void WriteBlocks() {
    dxf_.Begin("BLOCKS");
    WriteBlock("*Model_Space", spaces_.model, false);
    WriteBlock("*Paper_Space", spaces_.paper, true);
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
    dxf_.BeginEntity("LWPOLYLINE", layer, spaces_.model);
    dxf_.Class("AcDbPolyline");
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
    dxf_.BeginEntity(isArc ? "ARC" : "LINE", isArc ? Dxf::kArcLayer : Dxf::kLineLayer,
                     spaces_.model);
    dxf_.Class(isArc ? "AcDbCircle" : "AcDbLine");
    if (isArc) {
      dxf_.Circle(piece);
      dxf_.Class("AcDbArc");
      dxf_.Angles(piece);
    } else {
      dxf_.At(10, piece.start);
      dxf_.At(11, piece.end);
    }
  }

  void WriteObjects() {
    dxf_.Begin("OBJECTS");
    dxf_.Group(0, "DICTIONARY");
    Dxf::Handle const root = dxf_.Name(Dxf::kNobody);
    dxf_.Class("AcDbDictionary");
    dxf_.Group(281, "1");
    dxf_.Group(3, "ACAD_GROUP");
    dxf_.Group(350, Dxf::Written(dxf_.Next()));
    dxf_.Group(0, "DICTIONARY");
    dxf_.Name(root);
    dxf_.Class("AcDbDictionary");
    dxf_.Group(281, "1");
    dxf_.End();
  }

  ContourFile const& contour_;
  DxfStyle style_;
  Extent extent_;
  Dxf::Objects dxf_;
  Dxf::Spaces spaces_;
};

}  // namespace

std::string ToDxf2000(ContourFile const& contour, DxfStyle style) {
  return Drawing(contour, style).Text();
}

}  // namespace Vorn::IO
