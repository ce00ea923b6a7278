#include "io/formats/CsvPieces.h"

#include <map>
#include <utility>
#include <vector>

#include "io/base/Words.h"
#include "io/formats/Text.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

constexpr char const* kHeader =
    "type,start_x,start_y,end_x,end_y,center_x,center_y,radius,direction\n";

std::string Row(Piece const& piece) {
  auto const point = [](XY const& p) { return FormatExact(p.x) + "," + FormatExact(p.y); };
  std::string const ends = "," + point(piece.start) + "," + point(piece.end) + ",";
  if (!piece.IsArc()) return "line" + ends + ",,,\n";
  return "arc" + ends + point(piece.center) + "," + FormatExact(piece.radius) + "," +
         (piece.counterClockwise ? "ccw" : "cw") + "\n";
}

/// "units" and "mm" of `# units mm`.
struct Remark {
  std::string word;
  std::string_view value;
};

Remark RemarkOf(std::string_view comment) {
  std::string_view const text = Trimmed(comment.substr(1));
  std::size_t const end = text.find_first_of(" \t:");
  if (end == std::string_view::npos) return {LowerCase(text), {}};
  return {LowerCase(text.substr(0, end)), Trimmed(text.substr(end + 1))};
}

char SeparatorOf(std::string_view header) {
  for (char const separator : {';', '\t'}) {
    if (header.find(separator) != std::string_view::npos) return separator;
  }
  return ',';
}

std::vector<std::string_view> Cells(std::string_view line, char separator) {
  std::vector<std::string_view> cells;
  for (;;) {
    std::size_t const end = line.find(separator);
    cells.push_back(Trimmed(line.substr(0, end)));
    if (end == std::string_view::npos) return cells;
    line.remove_prefix(end + 1);
  }
}

class Reader {
 public:
  Reader(std::string_view text, std::string path, ArcUse arcs)
      : path_(std::move(path)), lines_(text), arcs_(arcs) {}

  ContourFile Read() {
    std::string_view line;
    while (lines_.Next(&line)) {
      line = Trimmed(line);
      if (line.empty()) continue;
      if (line.starts_with('#')) {
        TakeRemark(RemarkOf(line));
      } else if (columns_.empty()) {
        TakeHeader(line);
      } else {
        TakeRow(line);
      }
    }
    contour_.isClosed = closed_ ? *closed_ : ReturnsToStart(contour_.pieces);
    return contour_;
  }

 private:
  [[noreturn]] void Refuse(std::string const& message) const {
    RefuseLine(path_, lines_.Number(), message);
  }

  void TakeRemark(Remark const& remark) {
    if (remark.word == "units") contour_.units = remark.value;
    if (remark.word != "closed") return;
    std::string const answer = LowerCase(remark.value);
    if (answer != "yes" && answer != "no") {
      Refuse("closed " + Quoted(remark.value) + " is neither yes nor no");
    }
    closed_ = answer == "yes";
  }

  void TakeHeader(std::string_view line) {
    separator_ = SeparatorOf(line);
    std::vector<std::string_view> const names = Cells(line, separator_);
    for (std::size_t i = 0; i < names.size(); ++i) {
      std::string name = LowerCase(names[i]);
      if (name.starts_with("centre_")) name = "center_" + name.substr(7);
      columns_.emplace(std::move(name), i);
    }
    for (char const* const name : {"type", "start_x", "start_y", "end_x", "end_y"}) {
      if (columns_.count(name) == 0) {
        Refuse("the header has no column '" + std::string(name) + "': " + Quoted(line));
      }
    }
  }

  std::string_view Cell(std::string const& name) const {
    auto const column = columns_.find(name);
    if (column == columns_.end() || column->second >= cells_.size()) return {};
    return cells_[column->second];
  }

  double Number(std::string const& name) const {
    std::string_view const cell = Cell(name);
    if (cell.empty()) Refuse(name + " is missing");
    return RequireNumber(cell, name, path_, lines_.Number());
  }

  XY PointAt(std::string const& name) const { return {Number(name + "_x"), Number(name + "_y")}; }

  bool IsCounterClockwise() const {
    std::string const direction = LowerCase(Cell("direction"));
    if (direction != "ccw" && direction != "cw") {
      Refuse("direction " + Quoted(Cell("direction")) + " is neither ccw nor cw");
    }
    return direction == "ccw";
  }

  void TakeArc() {
    XY const start = PointAt("start");
    XY const end = PointAt("end");
    XY const center = PointAt("center");
    double const radius = Number("radius");
    bool const isCounterClockwise = IsCounterClockwise();
    std::vector<Piece> const arcs =
        AreEqual(start, end)
            ? MakeCircle(start, center, radius, isCounterClockwise)
            : std::vector<Piece>{MakeArc(start, end, center, radius, isCounterClockwise)};
    for (Piece const& arc : arcs) {
      if (auto const fault = FaultOf(arc)) Refuse("is no arc: " + *fault);
      if (arcs_ == ArcUse::Refuse) RefuseArc(arc, {path_, lines_.Number()});
      contour_.pieces.push_back(arc);
    }
  }

  void TakeRow(std::string_view line) {
    cells_ = Cells(line, separator_);
    std::string const type = LowerCase(Cell("type"));
    if (type == "line") {
      contour_.pieces.push_back(MakeLine(PointAt("start"), PointAt("end")));
    } else if (type == "arc") {
      TakeArc();
    } else {
      Refuse("type " + Quoted(Cell("type")) + " is neither line nor arc");
    }
  }

  std::string path_;
  Lines lines_;
  ArcUse arcs_;
  ContourFile contour_;
  std::optional<bool> closed_;
  char separator_ = ',';
  std::map<std::string, std::size_t> columns_;
  std::vector<std::string_view> cells_;
};

}  // namespace

std::string ToCsv(ContourFile const& contour) {
  std::string text;
  if (!contour.units.empty()) text += "# units " + OneLine(contour.units) + "\n";
  text += contour.isClosed ? "# closed yes\n" : "# closed no\n";
  text += kHeader;
  for (Piece const& piece : contour.pieces) text += Row(piece);
  return text;
}

ContourFile ParseCsvPieces(std::string_view text, std::string const& path, ArcUse arcs) {
  return Reader(text, path, arcs).Read();
}

}  // namespace Vorn::IO
