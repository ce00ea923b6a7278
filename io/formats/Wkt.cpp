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

/// The arc through three points; nothing when the middle one lies in a row with the ends, but not
/// between them. The bulge follows from the angle under which it sees them.
std::optional<Piece> ThroughPoints(XY const& start, XY const& middle, XY const& end) {
  XY const a = {start.x - middle.x, start.y - middle.y};
  XY const b = {end.x - middle.x, end.y - middle.y};
  double const cross = a.x * b.y - a.y * b.x;
  double const dot = a.x * b.x + a.y * b.y;
  double const lengths = Distance(start, middle) * Distance(end, middle);
  if (cross == 0.0 && dot > 0.0) return {};
  return MakeBulge(start, end, -cross / (lengths - dot));
}

class Reader {
 public:
  Reader(std::string_view text, std::string path) : text_(text), path_(std::move(path)) {}

  std::vector<Piece> Read() {
    SkipReference();
    TakeGeometry(Word());
    if (TakeSign(';')) SkipBlanks();
    if (!Rest().empty()) Refuse("does not belong here");
    return pieces_;
  }

 private:
  std::string_view Rest() {
    SkipBlanks();
    return text_.substr(at_);
  }

  void SkipBlanks() { at_ = std::min(text_.find_first_not_of(" \t\r\n", at_), text_.size()); }

  /// What stands here, quoted, or that nothing does.
  [[noreturn]] void Refuse(std::string const& complaint) {
    std::string_view const rest = Rest();
    std::string const what =
        rest.empty()
            ? "the text stops early"
            : Quoted(rest.substr(0, std::max<std::size_t>(1, rest.find_first_of(" ,()\t\r\n")))) +
                  " " + complaint;
    throw Failure(FailureKind::File, PlaceIn(text_, at_, path_), what);
  }

  bool TakeSign(char sign) {
    if (!Rest().starts_with(sign)) return false;
    ++at_;
    return true;
  }

  void RequireSign(char sign) {
    if (!TakeSign(sign)) Refuse(std::string("stands where a '") + sign + "' should be");
  }

  /// A word in lower case; empty when something else comes.
  std::string Word() {
    std::string_view const rest = Rest();
    std::size_t length = 0;
    while (length < rest.size() && IsLetter(rest[length])) ++length;
    at_ += length;
    return LowerCase(rest.substr(0, length));
  }

  static bool IsLetter(char c) { return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z'); }

  /// `SRID=4326;`
  void SkipReference() {
    if (!LowerCase(Rest().substr(0, 5)).starts_with("srid=")) return;
    std::size_t const end = text_.find(';', at_);
    if (end == std::string_view::npos) Refuse("has no ';' behind it");
    at_ = end + 1;
  }

  void TakeGeometry(std::string const& word) {
    if (word == "multicurve" || word == "multilinestring") {
      TakeMembers();
    } else if (word == "curvepolygon" || word == "polygon") {
      TakeMembers();
    } else if (word == "multipolygon") {
      TakePolygons();
    } else if (!TakeCurve(word)) {
      at_ -= word.size();
      Refuse("is no curve that holds a contour");
    }
  }

  bool TakeCurve(std::string const& word) {
    if (word == "linestring") {
      TakeLines();
    } else if (word == "circularstring") {
      TakeArcs();
    } else if (word == "compoundcurve") {
      TakeStrands();
    } else {
      return false;
    }
    return true;
  }

  /// Polygons, each a list of rings.
  void TakePolygons() {
    RequireSign('(');
    do {
      TakeMembers();
    } while (TakeSign(','));
    RequireSign(')');
  }

  /// Of a MULTICURVE or the rings of a polygon: any curve; a list without a word holds lines.
  void TakeMembers() {
    RequireSign('(');
    do {
      TakeMember();
    } while (TakeSign(','));
    RequireSign(')');
  }

  void TakeMember() {
    std::string const word = Word();
    if (word.empty()) {
      TakeLines();
    } else if (!TakeCurve(word)) {
      at_ -= word.size();
      Refuse("is no curve that holds a contour");
    }
  }

  /// Of a COMPOUNDCURVE: its parts are not compound themselves.
  void TakeStrands() {
    RequireSign('(');
    do {
      std::string const word = Word();
      if (word == "circularstring") {
        TakeArcs();
      } else if (word.empty() || word == "linestring") {
        TakeLines();
      } else {
        at_ -= word.size();
        Refuse("cannot be part of a compound curve");
      }
    } while (TakeSign(','));
    RequireSign(')');
  }

  double Number() {
    std::string_view const rest = Rest();
    std::size_t const end = std::min(rest.find_first_of(" ,()\t\r\n;"), rest.size());
    std::optional<double> const value = ParseNumber(rest.substr(0, end));
    if (!value) Refuse("is not a number");
    if (!IsUsable(*value)) Refuse("is not a finite number of usable size");
    at_ += end;
    return *value;
  }

  XY TakePoint() {
    double const x = Number();
    double const y = Number();
    std::string_view const rest = Rest();
    if (!rest.empty() && rest.front() != ',' && rest.front() != ')') {
      Refuse("follows x and y; a contour has no further coordinates");
    }
    return {x, y};
  }

  std::vector<XY> TakePoints() {
    RequireSign('(');
    std::vector<XY> points;
    do {
      points.push_back(TakePoint());
    } while (TakeSign(','));
    RequireSign(')');
    return points;
  }

  void TakeLines() {
    std::vector<XY> const points = TakePoints();
    if (points.size() < 2) RefuseList("a line needs at least two points");
    for (std::size_t i = 1; i < points.size(); ++i) {
      pieces_.push_back(MakeLine(points[i - 1], points[i]));
    }
  }

  void TakeArcs() {
    std::vector<XY> const points = TakePoints();
    if (points.size() < 3 || points.size() % 2 == 0) {
      RefuseList("arcs need an odd number of points, at least three, and here are " +
                 std::to_string(points.size()));
    }
    for (std::size_t i = 2; i < points.size(); i += 2) {
      TakeArc(points[i - 2], points[i - 1], points[i]);
    }
  }

  /// An arc that ends where it starts is a full circle with the middle point opposite.
  void TakeArc(XY const& start, XY const& middle, XY const& end) {
    if (!AreEqual(start, end)) {
      std::optional<Piece> const arc = ThroughPoints(start, middle, end);
      if (!arc) {
        RefuseList("the middle point of an arc lies in a row with its ends, but not between them");
      }
      pieces_.push_back(*arc);
      return;
    }
    if (AreEqual(start, middle)) RefuseList("the three points of an arc are one");
    pieces_.push_back(MakeBulge(start, middle, 1.0));
    pieces_.push_back(MakeBulge(middle, end, 1.0));
  }

  [[noreturn]] void RefuseList(std::string const& message) {
    throw Failure(FailureKind::File, PlaceIn(text_, at_, path_), message);
  }

  std::string_view text_;
  std::string path_;
  std::size_t at_ = 0;
  std::vector<Piece> pieces_;
};

}  // namespace

std::string ToWkt(ContourFile const& contour) {
  std::vector<Piece> const pieces = WithoutWideArcs(contour.pieces);
  auto const runs = ConnectedRuns(pieces, JointTolerance(pieces));
  // The ends of a closed curve must be the same to the last digit.
  bool const isLoop = contour.isClosed && ReturnsToStart(pieces);
  XY const end = isLoop ? pieces.front().start : pieces.back().end;
  std::string text;
  for (std::vector<Piece> const& run : runs) {
    if (!text.empty()) text += ", ";
    text += CurveOf(run, &run == &runs.back() ? end : run.back().end);
  }
  return (runs.size() == 1 ? text : "MULTICURVE (" + text + ")") + "\n";
}

ContourFile ParseWkt(std::string_view text, std::string const& path) {
  ContourFile contour;
  contour.pieces = Reader(text, path).Read();
  contour.isClosed = ReturnsToStart(contour.pieces);
  return contour;
}

}  // namespace Vorn::IO
