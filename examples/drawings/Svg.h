#pragma once

#include <cstdio>
#include <string>
#include <string_view>
#include <vector>

/// A small SVG writer: a canvas in pixels, and panels that show a stretch of the plane on it.
namespace Drawing {

/// A point of the plane or of the canvas.
struct Xy {
  double x = 0.0;
  double y = 0.0;
};

/// A number with so few decimals that the last bits of the platform's sine do not show.
inline std::string Number(double value) {
  char text[40];
  std::snprintf(text, sizeof text, "%.2f", value == 0.0 ? 0.0 : value);
  std::string const number = text;
  return number == "-0.00" ? "0.00" : number;
}

/// The canvas: an SVG document that grows by one shape per call. Styles are plain SVG attributes.
class Canvas {
 public:
  Canvas(int width, int height) {
    std::string const w = std::to_string(width);
    std::string const h = std::to_string(height);
    text_ = R"(<svg xmlns="http://www.w3.org/2000/svg" width=")" + w + "\" height=\"" + h +
            "\" viewBox=\"0 0 " + w + " " + h +
            "\" font-family=\"sans-serif\" font-size=\"14\">\n"
            "<rect width=\"100%\" height=\"100%\" fill=\"#ffffff\"/>\n";
  }

  void Path(std::string const& data, std::string_view style) {
    Add("<path d=\"" + data + "\" " + std::string(style) + "/>");
  }

  void Circle(Xy centre, double radius, std::string_view style) {
    Add("<circle cx=\"" + Number(centre.x) + "\" cy=\"" + Number(centre.y) + "\" r=\"" +
        Number(radius) + "\" " + std::string(style) + "/>");
  }

  void Text(Xy at, std::string const& text, std::string_view style = "") {
    Add("<text x=\"" + Number(at.x) + "\" y=\"" + Number(at.y) + "\" " + std::string(style) + ">" +
        text + "</text>");
  }

  /// Everything until the next call is clipped to the rectangle.
  void BeginClip(Xy low, Xy high) {
    std::string const id = "clip" + std::to_string(++clips_);
    Add("<clipPath id=\"" + id + "\"><rect x=\"" + Number(low.x) + "\" y=\"" + Number(low.y) +
        "\" width=\"" + Number(high.x - low.x) + "\" height=\"" + Number(high.y - low.y) +
        "\"/></clipPath><g clip-path=\"url(#" + id + ")\">");
  }

  void EndClip() { Add("</g>"); }

  [[nodiscard]] bool Write(std::string const& path) const {
    std::FILE* file = std::fopen(path.c_str(), "wb");
    if (file == nullptr) return false;
    std::string const document = text_ + "</svg>\n";
    bool const written = std::fwrite(document.data(), 1, document.size(), file) == document.size();
    return std::fclose(file) == 0 && written;
  }

 private:
  void Add(std::string const& shape) { text_ += shape + "\n"; }

  std::string text_;
  int clips_ = 0;
};

/// A window of the canvas onto the plane, y upward.
class Panel {
 public:
  /// The window between two corners of the canvas shows the plane between two corners, each axis
  /// with a scale of its own.
  Panel(Canvas& canvas, Xy pixelLow, Xy pixelHigh, Xy low, Xy high)
      : canvas_(canvas),
        pixelLow_(pixelLow),
        pixelHigh_(pixelHigh),
        low_(low),
        scale_{(pixelHigh.x - pixelLow.x) / (high.x - low.x),
               (pixelHigh.y - pixelLow.y) / (high.y - low.y)} {}

  [[nodiscard]] Xy At(Xy p) const {
    return {pixelLow_.x + (p.x - low_.x) * scale_.x, pixelHigh_.y - (p.y - low_.y) * scale_.y};
  }

  void Frame(std::string const& title) const {
    Xy const a = pixelLow_;
    Xy const b = pixelHigh_;
    canvas_.Path(
        "M" + Pair(a) + "L" + Pair({b.x, a.y}) + "L" + Pair(b) + "L" + Pair({a.x, b.y}) + "Z",
        R"(fill="none" stroke="#c8cdd3")");
    canvas_.Text({a.x, a.y - 8.0}, title, R"(font-weight="bold" fill="#222222")");
  }

  void BeginClip() const { canvas_.BeginClip(pixelLow_, pixelHigh_); }
  void EndClip() const { canvas_.EndClip(); }

  void Lines(std::vector<Xy> const& points, bool closed, std::string_view style) const {
    std::string data;
    for (Xy const& p : points) data += (data.empty() ? "M" : "L") + Pair(At(p));
    canvas_.Path(data + (closed ? "Z" : ""), style);
  }

  void Dot(Xy p, double pixels, std::string_view style) const {
    canvas_.Circle(At(p), pixels, style);
  }

  void Disc(Xy p, double radius, std::string_view style) const {
    canvas_.Circle(At(p), radius * scale_.x, style);
  }

  void Label(Xy p, Xy shift, std::string const& text, std::string_view style = "") const {
    Xy const at = At(p);
    canvas_.Text({at.x + shift.x, at.y + shift.y}, text, style);
  }

 private:
  static std::string Pair(Xy p) { return Number(p.x) + " " + Number(p.y); }

  Canvas& canvas_;
  Xy pixelLow_;
  Xy pixelHigh_;
  Xy low_;
  Xy scale_;
};

}  // namespace Drawing
