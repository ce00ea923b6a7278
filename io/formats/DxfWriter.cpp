#include "io/formats/DxfWriter.h"

#include <numbers>

#include "io/formats/Text.h"

namespace Vorn::IO::Dxf {

namespace {

/// In [0, 360).
double Degrees(double angle) {
  double const degrees = angle * (180.0 / std::numbers::pi);
  return degrees < 0.0 ? degrees + 360.0 : degrees;
}

}  // namespace

void Writer::Group(int code, std::string const& value) {
  text_ += std::to_string(code) + "\n" + value + "\n";
}

void Writer::Number(int code, double value) { Group(code, FormatPlain(value)); }

void Writer::Flat(int code, XY const& point) {
  Number(code, point.x);
  Number(code + 10, point.y);
}

void Writer::At(int code, XY const& point) {
  Flat(code, point);
  Number(code + 20, 0.0);
}

void Writer::Circle(Piece const& arc) {
  At(10, arc.center);
  Number(40, arc.radius);
}

void Writer::Angles(Piece const& arc) {
  Number(50, Degrees(arc.counterClockwise ? arc.startAngle : arc.endAngle));
  Number(51, Degrees(arc.counterClockwise ? arc.endAngle : arc.startAngle));
}

void Writer::Begin(std::string const& section) {
  Group(0, "SECTION");
  Group(2, section);
}

void Writer::End() { Group(0, "ENDSEC"); }

void Writer::Entity(std::string const& type, std::string const& layer) {
  Group(0, type);
  Group(8, layer);
}

bool IsWrittenAsArc(Piece const& piece) {
  return piece.IsArc() && Degrees(piece.startAngle) != Degrees(piece.endAngle);
}

}  // namespace Vorn::IO::Dxf
