#pragma once

#include "vorn/io/Pieces.h"

/// How far an arc turns from one direction to another.
namespace Vorn::IO {

/// Radians turned from the direction `from` to the direction `to` in the sense said. Directions
/// are polar angles in [-pi, pi], as atan2 gives them; equal ones mean no turn.
double TurnBetween(double from, double to, bool counterClockwise);

/// Radians turned by the arc from its start to the polar angle `polar`, in its own sense and in
/// [0, 2 pi). Angles of any number of turns are understood.
double TurnTo(Piece const& arc, double polar);

/// The same to the direction in which (x, y) lies from the centre.
double TurnTo(Piece const& arc, double x, double y);

}  // namespace Vorn::IO
