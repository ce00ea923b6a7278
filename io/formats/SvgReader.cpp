// SVG: from the shapes of a drawing to the pieces of a contour.
#include <algorithm>

#include "io/base/Words.h"
#include "io/formats/Svg.h"
#include "io/formats/SvgNumbers.h"
#include "io/formats/SvgPath.h"
#include "io/formats/SvgPen.h"
#include "io/formats/SvgTransform.h"
#include "vorn/io/Messages.h"

namespace Vorn::IO {

namespace {

bool IsOneOf(std::string_view name, std::initializer_list<std::string_view> names) {
  return std::find(names.begin(), names.end(), name) != names.end();
}

bool IsGroup(std::string_view name) { return IsOneOf(name, {"g", "a", "switch"}); }

bool IsShape(std::string_view name) {
  return IsOneOf(name, {"path", "polyline", "polygon", "line", "rect", "circle", "ellipse"});
}

/// Whether it is not drawn, by an attribute or by its style.
bool IsHidden(XmlElement const& element) {
  if (element["display"] == "none") return true;
  std::string style(element["style"].value_or(""));
  style.erase(std::remove(style.begin(), style.end(), ' '), style.end());
  if (style.find("transform:") != std::string::npos) {
    element.Refuse("a transform within a style is not supported");
  }
  return style.find("display:none") != std::string::npos;
}

/// A number of a shape, 0 where it is missing.
double Attribute(XmlElement const& element, char const* name) {
  std::optional<std::string_view> const text = element[name];
  if (!text) return 0.0;
  SvgLength const length = ParseSvgLength(element, *text);
  if (!length.unit.empty() && length.unit != "px") {
    element.Refuse(std::string(name) + " " + Quoted(*text) +
                   " is no plain number: only these are lengths of the drawing");
  }
  return length.value;
}

void DrawPoints(XmlElement const& element, bool isClosed, SvgPen* pen) {
  std::vector<double> const values = SvgNumberList(element, element["points"].value_or(""));
  if (values.size() % 2 != 0) element.Refuse("the last of its points has no y");
  for (std::size_t i = 0; i < values.size(); i += 2) {
    XY const at = {values[i], values[i + 1]};
    i == 0 ? pen->MoveTo(at) : pen->LineTo(at);
  }
  if (isClosed) pen->Close();
}

void DrawLine(XmlElement const& element, SvgPen* pen) {
  pen->MoveTo({Attribute(element, "x1"), Attribute(element, "y1")});
  pen->LineTo({Attribute(element, "x2"), Attribute(element, "y2")});
}

void DrawEllipse(XmlElement const& element, double rx, double ry, SvgPen* pen) {
  XY const center = {Attribute(element, "cx"), Attribute(element, "cy")};
  SvgArc const half = {rx, ry, 0.0, false, true};
  if (!(rx > 0.0) || !(ry > 0.0)) return;
  pen->MoveTo({center.x + rx, center.y});
  pen->ArcTo(half, {center.x - rx, center.y});
  pen->ArcTo(half, {center.x + rx, center.y});
}

/// A radius that is missing is the other one; neither is more than half the side.
SvgArc CornerOf(XmlElement const& element, double width, double height) {
  double const rx = Attribute(element, element["rx"] ? "rx" : "ry");
  double const ry = Attribute(element, element["ry"] ? "ry" : "rx");
  return {std::min(rx, width / 2.0), std::min(ry, height / 2.0), 0.0, false, true};
}

void DrawRect(XmlElement const& element, SvgPen* pen) {
  XY const low = {Attribute(element, "x"), Attribute(element, "y")};
  double const width = Attribute(element, "width");
  double const height = Attribute(element, "height");
  if (!(width > 0.0) || !(height > 0.0)) return;
  XY const high = {low.x + width, low.y + height};
  SvgArc const corner = CornerOf(element, width, height);
  pen->MoveTo({low.x + corner.rx, low.y});
  pen->LineTo({high.x - corner.rx, low.y});
  pen->ArcTo(corner, {high.x, low.y + corner.ry});
  pen->LineTo({high.x, high.y - corner.ry});
  pen->ArcTo(corner, {high.x - corner.rx, high.y});
  pen->LineTo({low.x + corner.rx, high.y});
  pen->ArcTo(corner, {low.x, high.y - corner.ry});
  pen->LineTo({low.x, low.y + corner.ry});
  pen->ArcTo(corner, {low.x + corner.rx, low.y});
}

void DrawShape(XmlElement const& element, SvgPen* pen) {
  std::string_view const name = element.tag;
  if (name == "path") return DrawSvgPath(element, element["d"].value_or(""), pen);
  if (name == "line") return DrawLine(element, pen);
  if (name == "rect") return DrawRect(element, pen);
  if (name == "circle") {
    double const radius = Attribute(element, "r");
    return DrawEllipse(element, radius, radius, pen);
  }
  if (name == "ellipse") {
    return DrawEllipse(element, Attribute(element, "rx"), Attribute(element, "ry"), pen);
  }
  DrawPoints(element, name == "polygon", pen);
}

/// Goes through the elements with the transforms of those around them.
class Reader final : public XmlVisitor {
 public:
  explicit Reader(ReadOptions const& options) : outcome_{{}, {options.flattening}, options.arcs} {}

  void Begin(XmlElement const& element) override {
    ++depth_;
    if (depth_ == 1) return BeginPage(element);
    if (hiddenFrom_ != 0) return;
    if (element.tag == "use") element.Refuse("is not followed: put a copy in its place");
    if (element.tag == "svg") element.Refuse("a drawing within a drawing is not supported");
    bool const isDrawn = IsGroup(element.tag) || IsShape(element.tag);
    if (!isDrawn || IsHidden(element)) {
      hiddenFrom_ = depth_;
      return;
    }
    maps_.push_back(maps_.back() * SvgTransform(element, element["transform"].value_or("")));
    SvgPen pen(element, maps_.back(), &outcome_);
    if (IsShape(element.tag)) DrawShape(element, &pen);
  }

  void End() override {
    if (hiddenFrom_ == 0) maps_.pop_back();
    if (hiddenFrom_ == depth_) hiddenFrom_ = 0;
    --depth_;
  }

  ContourFile Contour() const {
    ContourFile contour;
    contour.pieces = outcome_.pieces;
    contour.units = units_;
    contour.isClosed = ReturnsToStart(contour.pieces);
    return contour;
  }

 private:
  void BeginPage(XmlElement const& element) {
    if (element.tag != "svg") element.Refuse("is no SVG drawing");
    SvgPage const page = ReadSvgPage(element);
    units_ = page.units;
    maps_.push_back(page.map * SvgTransform(element, element["transform"].value_or("")));
  }

  SvgOutcome outcome_;
  std::string units_;
  std::vector<Affine> maps_;  ///< of the elements around, the innermost last
  std::size_t depth_ = 0;
  std::size_t hiddenFrom_ = 0;  ///< the depth of what is not drawn; 0: all around is
};

}  // namespace

ContourFile ParseSvg(std::string_view text, std::string const& path, ReadOptions const& options) {
  Reader reader(options);
  WalkXml(text, path, &reader);
  return reader.Contour();
}

}  // namespace Vorn::IO
