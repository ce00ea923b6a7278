#include <string>
#include <utility>
#include <vector>

#include "io/formats/Text.h"
#include "io/formats/Wkt.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

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
  Reader(std::string_view text, std::string path, ArcUse arcs)
      : text_(text), path_(std::move(path)), arcs_(arcs) {}

  bool HadHeights() const { return hadHeights_; }

  std::vector<Piece> Read() {
    SkipReference();
    TakeGeometry(Name());
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
    if (word == "multicurve" || word == "multilinestring" || word == "curvepolygon" ||
        word == "polygon") {
      TakeMembers();
    } else if (word == "multipolygon") {
      TakePolygons();
    } else if (!TakeCurve(word)) {
      at_ -= word.size();
      Refuse("is no curve that holds a contour");
    }
  }

  /// What a geometry says of its coordinates, Z, M or ZM, apart from its name or at its end.
  std::string WithoutDimensions(std::string const& word) {
    for (std::string_view const ending : {"zm", "z", "m"}) {
      // "linestringm", but not a word that ends so by itself.
      if (word.ends_with(ending) && word.size() > ending.size()) {
        std::string base = word.substr(0, word.size() - ending.size());
        if (base.ends_with("string") || base.ends_with("curve") || base.ends_with("polygon")) {
          return base;
        }
      }
    }
    std::size_t const before = at_;
    std::string const next = Word();
    if (next != "z" && next != "m" && next != "zm") at_ = before;
    return word;
  }

  /// The name of a geometry.
  std::string Name() {
    std::string const word = Word();
    return word.empty() ? word : WithoutDimensions(word);
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
    std::string const word = Name();
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
      std::string const word = Name();
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

  bool IsAtEndOfPoint() {
    std::string_view const rest = Rest();
    return rest.empty() || rest.front() == ',' || rest.front() == ')';
  }

  /// A contour lies in a plane: height and measure of a point are read and dropped.
  XY TakePoint() {
    constexpr int kMostFurther = 2;
    double const x = Number();
    double const y = Number();
    for (int i = 0; i < kMostFurther && !IsAtEndOfPoint(); ++i) {
      Number();
      hadHeights_ = true;
    }
    if (!IsAtEndOfPoint()) Refuse("is more than the four coordinates that a point may have");
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
      return AddArc(*arc);
    }
    if (AreEqual(start, middle)) RefuseList("the three points of an arc are one");
    AddArc(MakeBulge(start, middle, 1.0));
    AddArc(MakeBulge(middle, end, 1.0));
  }

  /// Three points in a row are a line.
  void AddArc(Piece const& arc) {
    bool const isRefused = arc.IsArc() && arcs_ == ArcUse::Refuse;
    if (isRefused) RefuseArc(arc, PlaceIn(text_, at_, path_));
    pieces_.push_back(arc);
  }

  [[noreturn]] void RefuseList(std::string const& message) {
    throw Failure(FailureKind::File, PlaceIn(text_, at_, path_), message);
  }

  std::string_view text_;
  std::string path_;
  ArcUse arcs_;
  std::size_t at_ = 0;
  bool hadHeights_ = false;
  std::vector<Piece> pieces_;
};

}  // namespace

ContourFile ParseWkt(std::string_view text, std::string const& path, ArcUse arcs) {
  ContourFile contour;
  Reader reader(text, path, arcs);
  contour.pieces = reader.Read();
  contour.hadHeights = reader.HadHeights();
  contour.isClosed = ReturnsToStart(contour.pieces);
  return contour;
}

}  // namespace Vorn::IO
