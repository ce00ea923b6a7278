#include "io/formats/ToolPath.h"

#include <cmath>

#include "io/formats/LengthUnits.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

/// The radii at both ends of an arc must agree this well, in millimetres. Machines ask for 0.002
/// to 0.01 before they refuse an arc.
constexpr double kLargestRadiusError = 0.002;

/// Beyond, a double has no digit left for the rounding to be exact.
constexpr double kMostUnits = 1e15;

/// As many digits of a feed as anyone gives.
constexpr int kFeedDigits = 12;

}  // namespace

ToolPath::ToolPath(ContourFile const& contour, GCodeOptions const& options)
    : path_(contour.path),
      options_(options),
      decimals_(options.decimals.value_or(GCodeDecimals(contour.units, options.tolerance))),
      step_(std::pow(10.0, -decimals_)),
      largestRadiusError_(IsInch(contour.units) ? kLargestRadiusError / kMillimetresPerInch
                                                : kLargestRadiusError) {}

void ToolPath::MoveTo(XY const& point) {
  XY const to = Rounded(point);
  if (isPlaced_ && AreEqual(to, at_)) return;
  Retract();
  Line("G0" + EndWords(to));
  at_ = to;
  isPlaced_ = true;
}

void ToolPath::Retract() {
  if (!options_.safeHeight || (isPlaced_ && !isDown_)) return;
  Line("G0 Z" + Written(*options_.safeHeight));
  isDown_ = false;
}

void ToolPath::Plunge() {
  if (!options_.cutHeight || isDown_) return;
  std::optional<double> const feed = options_.plungeFeed ? options_.plungeFeed : options_.feed;
  Line("G1 Z" + Written(*options_.cutHeight) + (feed ? FeedWord(*feed) : ""));
  isDown_ = true;
}

void ToolPath::Cut(Piece const& piece, std::size_t number) {
  XY const to = Rounded(piece.end);
  if (AreEqual(to, at_)) return;
  Plunge();
  if (!piece.IsArc() || !CutArc(piece, to, number)) Line("G1" + EndWords(to) + CutFeedWord());
  at_ = to;
  hasCut_ = true;
}

void ToolPath::Refuse(std::string const& message) const {
  throw Failure(FailureKind::BadArgument, {path_}, message);
}

std::string ToolPath::Written(double value) const { return FormatFixed(value, decimals_); }

/// The number that the machine reads.
double ToolPath::Rounded(double value) const {
  if (!(std::fabs(value) < kMostUnits * step_)) {
    Refuse("G-code with " + Counted(static_cast<std::size_t>(decimals_), "decimal") +
           " cannot hold " + FormatShort(value, kFeedDigits));
  }
  return *ParseNumber(Written(value));
}

XY ToolPath::Rounded(XY const& point) const { return {Rounded(point.x), Rounded(point.y)}; }

std::string ToolPath::Words(char first, char second, XY const& values) const {
  return std::string(" ") + first + Written(values.x) + " " + second + Written(values.y);
}

std::string ToolPath::EndWords(XY const& to) const {
  return Words('X', options_.plane == GCodeOptions::Plane::G18 ? 'Z' : 'Y', to);
}

/// R is the radius in the middle between those at the ends; never less than half the chord.
std::string ToolPath::CenterWords(XY const& to, XY const& way) const {
  if (!options_.useRadiusWords) {
    return Words('I', options_.plane == GCodeOptions::Plane::G18 ? 'K' : 'J', way);
  }
  double const radius = (std::hypot(way.x, way.y) + RadiusAt(to, way)) / 2.0;
  double const halfChord = std::ceil(Distance(at_, to) / 2.0 / step_) * step_;
  return " R" + Written(std::max(radius, halfChord));
}

/// Nothing when the feed is said already.
std::string ToolPath::FeedWord(double feed) {
  if (feed == feedSaid_) return "";
  feedSaid_ = feed;
  return " F" + FormatShort(feed, kFeedDigits);
}

std::string ToolPath::CutFeedWord() { return options_.feed ? FeedWord(*options_.feed) : ""; }

/// The way from the tool to the centre, on the grid of the digits written: of the places around
/// the true one that from where both ends are nearest to the true radius.
XY ToolPath::WayToCenter(Piece const& arc, XY const& to) const {
  XY const exact = {arc.center.x - at_.x, arc.center.y - at_.y};
  XY best;
  double leastError = HUGE_VAL;
  for (int i = -1; i <= 1; ++i) {
    for (int j = -1; j <= 1; ++j) {
      XY const way = Rounded({exact.x + i * step_, exact.y + j * step_});
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

double ToolPath::RadiusAt(XY const& to, XY const& way) const {
  return std::hypot(to.x - (at_.x + way.x), to.y - (at_.y + way.y));
}

/// False when the arc is better written as a line.
bool ToolPath::CutArc(Piece const& arc, XY const& to, std::size_t number) {
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
  // G18 is looked at from the side on which Z turns into X, so that X and Z are mirrored in it.
  bool const isMirrored = options_.plane == GCodeOptions::Plane::G18;
  std::string const word = arc.counterClockwise != isMirrored ? "G3" : "G2";
  Line(word + EndWords(to) + CenterWords(to, way) + CutFeedWord());
  return true;
}

}  // namespace Vorn::IO
