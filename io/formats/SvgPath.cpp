#include "io/formats/SvgPath.h"

#include <numbers>
#include <string>

#include "io/formats/SvgNumbers.h"
#include "vorn/io/Messages.h"

namespace Vorn::IO {

namespace {

constexpr double kRadians = std::numbers::pi / 180.0;

class Path {
 public:
  Path(XmlElement const& element, std::string_view data, SvgPen* pen)
      : numbers_(element, data), pen_(*pen) {}

  void Draw() {
    while (!numbers_.AtEnd()) {
      bool const isRepeated = numbers_.IsNumberNext();
      if (isRepeated && !CanRepeat()) numbers_.Refuse("follows no command");
      if (!isRepeated) TakeCommand();
      Step();
    }
  }

 private:
  bool CanRepeat() const { return command_ != ' ' && command_ != 'z'; }

  void TakeCommand() {
    constexpr std::string_view kKnown = "mlhvzcsqta";
    char const letter = numbers_.Take();
    command_ = LowerCase(std::string_view(&letter, 1)).front();
    isRelative_ = letter == command_;
    if (kKnown.find(command_) == std::string_view::npos) {
      numbers_.Refuse("stands behind '" + std::string(1, letter) + "', which is no command");
    }
    if (!hasBegun_ && command_ != 'm') numbers_.Refuse("is drawn before the first move");
  }

  void Step() {
    constexpr std::string_view kCurves = "csqt";
    if (kCurves.find(command_) != std::string_view::npos) return CurveTo();
    handleOf_ = ' ';
    if (command_ == 'm') return MoveTo();
    if (command_ == 'a') return ArcTo();
    if (command_ == 'z') return pen_.Close();
    pen_.LineTo(EndOfLine());
  }

  /// Numbers that go on behind a move are lines.
  void MoveTo() {
    pen_.MoveTo(Point());
    hasBegun_ = true;
    command_ = 'l';
  }

  XY EndOfLine() {
    XY const at = pen_.At();
    if (command_ == 'h') return {(isRelative_ ? at.x : 0.0) + numbers_.Number(), at.y};
    if (command_ == 'v') return {at.x, (isRelative_ ? at.y : 0.0) + numbers_.Number()};
    return Point();
  }

  XY Point() {
    XY const from = isRelative_ ? pen_.At() : XY{0.0, 0.0};
    double const x = numbers_.Number();
    return {from.x + x, from.y + numbers_.Number()};
  }

  /// Cubic curves have two control points ahead of the end, quadratic ones have one; S and T take
  /// the first from the curve before.
  void CurveTo() {
    bool const isCubic = command_ == 'c' || command_ == 's';
    bool const isSmooth = command_ == 's' || command_ == 't';
    std::vector<XY> controls;
    controls.push_back(isSmooth ? Mirrored(isCubic ? 'c' : 'q') : Point());
    if (isCubic) controls.push_back(Point());
    handle_ = controls.back();
    controls.push_back(Point());
    pen_.CurveTo(controls);
    handleOf_ = isCubic ? 'c' : 'q';
  }

  /// The last control point mirrored at the place of the pen; that place when the step before was
  /// no such curve.
  XY Mirrored(char kind) const {
    XY const at = pen_.At();
    bool const isBehindCurve = handleOf_ == kind;
    return isBehindCurve ? XY{2.0 * at.x - handle_.x, 2.0 * at.y - handle_.y} : at;
  }

  void ArcTo() {
    SvgArc arc;
    arc.rx = numbers_.Number();
    arc.ry = numbers_.Number();
    arc.turn = numbers_.Number() * kRadians;
    arc.isLarge = numbers_.Flag();
    arc.isSweep = numbers_.Flag();
    pen_.ArcTo(arc, Point());
  }

  SvgNumbers numbers_;
  SvgPen& pen_;
  char command_ = ' ';
  bool isRelative_ = false;
  bool hasBegun_ = false;
  XY handle_;            ///< the last control point of the curve before
  char handleOf_ = ' ';  ///< what kind of curve that was: c, q, or none
};

}  // namespace

void DrawSvgPath(XmlElement const& element, std::string_view data, SvgPen* pen) {
  Path(element, data, pen).Draw();
}

}  // namespace Vorn::IO
