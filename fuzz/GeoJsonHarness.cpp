// GeoJSON of any nesting: the pieces that were put in come out, in their order and to the bit; and
// the same text with words lost, doubled or replaced.
#include <cstdint>
#include <cstdio>
#include <string>
#include <utility>
#include <vector>

#include "Input.h"
#include "Require.h"
#include "Texts.h"
#include "support/Bits.h"
#include "vorn/io/Formats.h"

namespace Vorn::Fuzz {
namespace {

using Testing::SameBits;

std::string NumberText(double value) {
  char text[40];
  std::snprintf(text, sizeof text, "%.17g", value);
  return text;
}

/// Makes documents and notes the lines in them.
class Document {
 public:
  explicit Document(Input* input) : input_(*input) {}

  /// An object of at most so many further levels.
  std::string Object(int levels) {
    int const kind = input_.Byte() % 10;
    if (kind < 2 && levels > 0) return Collection("GeometryCollection", "geometries", levels);
    if (kind == 2 && levels > 0) return Collection("FeatureCollection", "features", levels);
    if (kind == 3 && levels > 0) return Feature(levels);
    if (kind == 4) return R"({"type":"Point","coordinates":[1,2]})";
    if (kind == 5) return Geometry("MultiLineString", List(&Document::Line));
    if (kind == 6) return Geometry("Polygon", List(&Document::Ring));
    if (kind == 7) return Geometry("MultiPolygon", List(&Document::Rings));
    return Geometry("LineString", Line());
  }

  std::vector<std::pair<IO::XY, IO::XY>> const& Lines() const { return lines_; }
  std::size_t LinesWithoutLength() const { return linesWithoutLength_; }

 private:
  std::string Collection(char const* type, char const* member, int levels) {
    std::string text = std::string(R"({"type":")") + type + R"(",")" + member + R"(":[)";
    int const count = input_.Integer(0, 3);
    for (int i = 0; i < count; ++i) text += (i > 0 ? "," : "") + Object(levels - 1);
    return text + "]}";
  }

  std::string Feature(int levels) {
    std::string const properties = input_.Flip() ? R"("properties":{"units":"mm"},)" : "";
    return R"({"type":"Feature",)" + properties + R"("geometry":)" + Object(levels - 1) + "}";
  }

  static std::string Geometry(char const* type, std::string const& coordinates) {
    return std::string(R"({"type":")") + type + R"(","coordinates":)" + coordinates + "}";
  }

  std::string List(std::string (Document::*make)()) {
    std::string text = "[" + (this->*make)();
    while (input_.Byte() % 3 == 0 && !input_.IsEmpty()) text += "," + (this->*make)();
    return text + "]";
  }

  std::string Rings() { return List(&Document::Ring); }

  std::string Line() {
    std::vector<IO::XY> places = {input_.PointOnGrid()};
    for (int count = input_.Integer(1, 6); count > 0; --count) {
      places.push_back(input_.PointOnGrid());
    }
    return Noted(places);
  }

  std::string Ring() {
    std::vector<IO::XY> places;
    for (int count = input_.Integer(3, 6); count > 0; --count) {
      places.push_back(input_.PointOnGrid());
    }
    places.push_back(places.front());
    return Noted(places);
  }

  std::string Noted(std::vector<IO::XY> const& places) {
    std::string text = "[";
    for (std::size_t i = 0; i < places.size(); ++i) {
      if (i > 0) Note(places[i - 1], places[i]);
      text += (i > 0 ? ",[" : "[") + NumberText(places[i].x) + "," + NumberText(places[i].y) +
              (input_.Byte() % 16 == 1 ? ",7]" : "]");
    }
    return text + "]";
  }

  void Note(IO::XY const& from, IO::XY const& to) {
    if (from.x == to.x && from.y == to.y) {
      ++linesWithoutLength_;
    } else {
      lines_.emplace_back(from, to);
    }
  }

  Input& input_;
  std::vector<std::pair<IO::XY, IO::XY>> lines_;
  std::size_t linesWithoutLength_ = 0;
};

void RequireLines(IO::ContourFile const& contour, Document const& document) {
  Require(contour.pieces.size() == document.Lines().size(), "every line comes out");
  Require(contour.leftOut == document.LinesWithoutLength(), "lines without length are counted");
  for (std::size_t i = 0; i < contour.pieces.size(); ++i) {
    IO::Piece const& piece = contour.pieces[i];
    Require(!piece.IsArc(), "GeoJSON has no arcs");
    Require(SameBits(piece.start, document.Lines()[i].first) &&
                SameBits(piece.end, document.Lines()[i].second),
            "lines come out to the bit");
  }
}

void TryGood(std::string const& text, Document const& document) {
  try {
    RequireLines(IO::ParseContour(text, "f", IO::Format::GeoJson), document);
  } catch (IO::Failure const& failure) {
    RequirePlace(failure);
    Require(document.Lines().empty(), "good text with lines is read");
  }
}

}  // namespace
}  // namespace Vorn::Fuzz

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size) {
  namespace Fuzz = Vorn::Fuzz;
  constexpr int kLevels = 5;
  Fuzz::Input input(data, size);
  Fuzz::Document document(&input);
  std::string const text = document.Object(kLevels);
  Fuzz::TryGood(text, document);
  Fuzz::TryAnyText(Fuzz::Mangle(text, &input), Vorn::IO::Format::GeoJson);
  return 0;
}
