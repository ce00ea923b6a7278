#pragma once

#include <vector>

#include "io/formats/Affine.h"
#include "io/formats/Xml.h"
#include "io/pieces/Flattening.h"
#include "vorn/io/Formats.h"

namespace Vorn::IO {

/// What has been read of a drawing.
struct SvgOutcome {
  std::vector<Piece> pieces;
  Flattening flattening;
  ArcUse arcs = ArcUse::Keep;  ///< what becomes of arcs of circles
};

/// An arc of SVG: half axes, the turn of the first one against x, and which of the four there are.
struct SvgArc {
  double rx = 0.0;
  double ry = 0.0;
  double turn = 0.0;  ///< radians
  bool isLarge = false;
  bool isSweep = false;  ///< towards growing angles in the coordinates of the element
};

/// Draws the shapes of one element; places are in the coordinates of the element.
class SvgPen {
 public:
  /// All three must outlive it.
  SvgPen(XmlElement const& element, Affine const& map, SvgOutcome* outcome)
      : element_(element), map_(map), outcome_(*outcome) {}

  /// Where the pen is.
  XY const& At() const { return at_; }

  /// Goes there without drawing; Close comes back to it.
  void MoveTo(XY const& to);
  /// Draws a straight line.
  void LineTo(XY const& to);
  /// A Bezier curve whose control points follow that where the pen stands.
  void CurveTo(std::vector<XY> const& controls);
  /// Draws an arc of an ellipse.
  void ArcTo(SvgArc const& arc, XY const& to);
  /// Back to where the pen was moved to last.
  void Close();

 private:
  /// Adds a piece unless it has no length.
  void Add(Piece const& piece);
  /// Draws an arc whose half axes are equal.
  void CircleTo(SvgArc const& arc, XY const& to);
  /// Draws any other arc by curves.
  void EllipseTo(SvgArc const& arc, XY const& to);
  /// Draws chords of the curves.
  void AddChords(std::vector<BezierCurve> const& curves);

  XmlElement const& element_;
  Affine const& map_;
  SvgOutcome& outcome_;
  XY begin_;
  XY at_;
};

}  // namespace Vorn::IO
