#include "io/formats/GCode.h"

#include <algorithm>
#include <cmath>

#include "io/base/Failure.h"
#include "io/base/Numbers.h"
#include "io/formats/Text.h"
#include "io/pieces/Shapes.h"

namespace Vorn::IO {

namespace {

constexpr double kMillimetresPerInch = 25.4;

/// The radii at both ends of an arc must agree this well, in millimetres. Machines ask for 0.002
/// to 0.01 before they refuse an arc.
constexpr double kLargestRadiusError = 0.002;

/// Beyond, a double has no digit left for the rounding to be exact.
constexpr double kMostUnits = 1e15;

bool IsInch(std::string const& units) {
  std::string const lower = LowerCase(units);
  return lower == "in" || lower == "inch" || lower == "inches";
}

bool IsMillimetre(std::string const& units) {
  std::string const lower = LowerCase(units);
  return lower == "mm" || lower == "millimetre" || lower == "millimeter";
}

/// Writes a tool path from rounded numbers only: what it remembers is what the machine knows.
class ToolPath {
 public:
  ToolPath(ContourFile const& contour, GCodeOptions const& options)
      : path_(contour.path),
        decimals_(options.decimals.value_or(DefaultGCodeDecimals(contour.units))),
        step_(std::pow(10.0, -decimals_)),
        largestRadiusError_(IsInch(contour.units) ? kLargestRadiusError / kMillimetresPerInch
                                                  : kLargestRadiusError) {
    if (options.feed) feed_ = " F" + FormatShort(*options.feed, 12);
  }

  void Line(std::string const& line) { text_ += line + "\n"; }

  void MoveTo(XY const& point) {
    XY const to = Rounded(point);
    if (isPlaced_ && AreEqual(to, at_)) return;
    Line("G0" + Words('X', 'Y', to));
    at_ = to;
    isPlaced_ = true;
  }

  void Cut(Piece const& piece, std::size_t number) {
    XY const to = Rounded(piece.end);
    if (AreEqual(to, at_)) return;
    if (!piece.IsArc() || !CutArc(piece, to, number)) CutLine(to);
    at_ = to;
    feed_.clear();
    hasCut_ = true;
  }

  bool HasCut() const { return hasCut_; }
  std::string const& Text() const { return text_; }

 private:
  [[noreturn]] void Refuse(std::string const& message) const {
    throw Failure(FailureKind::BadArgument, path_ + ": " + message);
  }

  std::string Written(double value) const { return FormatFixed(value, decimals_); }

  /// The number that the machine reads.
  double Rounded(double value) const {
    if (!(std::fabs(value) < kMostUnits * step_)) {
      Refuse("G-code with " + Counted(static_cast<std::size_t>(decimals_), "decimal") +
             " cannot hold " + FormatShort(value, 12));
    }
    return *ParseNumber(Written(value));
  }

  XY Rounded(XY const& point) const { return {Rounded(point.x), Rounded(point.y)}; }

  std::string Words(char first, char second, XY const& values) const {
    return std::string(" ") + first + Written(values.x) + " " + second + Written(values.y);
  }

  void CutLine(XY const& to) { Line("G1" + Words('X', 'Y', to) + feed_); }

  /// The way from the tool to the centre, on the grid of the digits written: of the places around
  /// the true one that from where both ends are nearest to the true radius.
  XY WayToCenter(Piece const& arc, XY const& to) const {
    XY const true_ = {arc.center.x - at_.x, arc.center.y - at_.y};
    XY best;
    double leastError = HUGE_VAL;
    for (int i = -1; i <= 1; ++i) {
      for (int j = -1; j <= 1; ++j) {
        XY const way = Rounded({true_.x + i * step_, true_.y + j * step_});
        double const error = std::fabs(std::hypot(way.x, way.y) - arc.radius) +
                             std::fabs(RadiusAt(to, way) - arc.radius);
        if (error < leastError) {
          leastError = error;
          best = way;
        }
      }
    }
    return best;
  }

  double RadiusAt(XY const& to, XY const& way) const {
    return std::hypot(to.x - (at_.x + way.x), to.y - (at_.y + way.y));
  }

  /// False when the arc is better written as a line.
  bool CutArc(Piece const& arc, XY const& to, std::size_t number) {
    double const quarter = std::sin(arc.sweep / 4.0);
    double const rise = 2.0 * arc.radius * quarter * quarter;
    if (rise < step_ / 2.0) return false;
    XY const way = WayToCenter(arc, to);
    double const radius = std::hypot(way.x, way.y);
    if (radius == 0.0) return false;
    Piece const written =
        MakeArc(at_, to, {at_.x + way.x, at_.y + way.y}, radius, arc.counterClockwise);
    // Rounding can carry the end of a tiny arc past its start, and the machine would go all the
    // way round.
    if (std::fabs(written.sweep - arc.sweep) > kWidestArc / 2.0) return false;
    double const error = std::fabs(RadiusAt(to, way) - radius);
    if (!(error <= largestRadiusError_)) {
      Refuse("G-code with " + Counted(static_cast<std::size_t>(decimals_), "decimal") +
             " is too coarse for piece " + std::to_string(number) +
             ": the radii at its ends would differ by " + FormatShort(error));
    }
    Line((arc.counterClockwise ? "G3" : "G2") + Words('X', 'Y', to) + Words('I', 'J', way) + feed_);
    return true;
  }

  std::string path_;
  int decimals_;
  double step_;
  double largestRadiusError_;
  std::string text_;
  std::string feed_;  ///< for the next cut; empty once it is said
  XY at_;
  bool isPlaced_ = false;
  bool hasCut_ = false;
};

void WriteUnits(ContourFile const& contour, ToolPath* tool) {
  if (IsInch(contour.units)) {
    tool->Line("G20");
  } else if (IsMillimetre(contour.units)) {
    tool->Line("G21");
  } else if (contour.units.empty()) {
    tool->Line("(units not known: neither G20 nor G21)");
  } else {
    throw Failure(FailureKind::BadArgument,
                  contour.path + ": G-code is in mm or inch, and the contour is in " +
                      Quoted(contour.units) + "; see --units");
  }
}

}  // namespace

int DefaultGCodeDecimals(std::string const& units) { return IsInch(units) ? 5 : 4; }

std::string ToGCode(ContourFile const& contour, GCodeOptions const& options) {
  ToolPath tool(contour, options);
  WriteUnits(contour, &tool);
  tool.Line("G17 G90 G91.1");
  double const tolerance = JointTolerance(contour.pieces);
  for (std::size_t i = 0; i < contour.pieces.size(); ++i) {
    Piece const& piece = contour.pieces[i];
    bool const isJoined = i > 0 && Distance(contour.pieces[i - 1].end, piece.start) <= tolerance;
    if (!isJoined) tool.MoveTo(piece.start);
    for (Piece const& part : WithoutWideArcs({piece})) tool.Cut(part, i + 1);
  }
  if (!tool.HasCut()) {
    throw Failure(FailureKind::BadArgument,
                  contour.path + ": is smaller than the last digit of the G-code");
  }
  return tool.Text();
}

}  // namespace Vorn::IO
