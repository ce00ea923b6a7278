#include "io/pieces/Turning.h"

#include <cmath>
#include <numbers>

namespace Vorn::IO {

namespace {

constexpr double kFullTurn = 2.0 * std::numbers::pi;

double Turned(double from, double to, bool counterClockwise) {
  return counterClockwise ? to - from : from - to;
}

double NotNegative(double turn) { return turn < 0.0 ? turn + kFullTurn : turn; }

}  // namespace

double TurnBetween(double from, double to, bool counterClockwise) {
  return NotNegative(Turned(from, to, counterClockwise));
}

double TurnTo(Piece const& arc, double polar) {
  double const turned = Turned(arc.startAngle, polar, arc.counterClockwise);
  double const turn = NotNegative(std::fmod(turned, kFullTurn));
  // A turn just below zero rounds to a full one.
  return turn < kFullTurn ? turn : 0.0;
}

double TurnTo(Piece const& arc, double x, double y) {
  return TurnTo(arc, std::atan2(y - arc.center.y, x - arc.center.x));
}

}  // namespace Vorn::IO
