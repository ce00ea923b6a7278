#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

#include "vorn/io/Failure.h"
#include "vorn/io/Pieces.h"

/// Curves as chains of chords.
namespace Vorn::IO {

/// So many chords are made of all curves of a file at most: a tolerance far too fine for them must
/// not fill the memory.
inline constexpr std::size_t kMostChords = 2000000;

/// A control point of a rational curve.
struct ControlPoint {
  XY at;
  double weight = 1.0;  ///< above 0
};

/// A rational Bezier curve of any degree: at least two control points.
using BezierCurve = std::vector<ControlPoint>;

/// Appends the points where the chords end, the last one the end of the curve exactly. The curve
/// starts where the caller's points end.
///
/// No point of the curve is further than `tolerance` from its chord: a curve of positive weights
/// lies within the hull of its control points, so it is halved until all of these are so near to
/// the chord. Rounding adds some last digits of the coordinates.
///
/// @return false, with some points appended, when it would take more than `mostChords`, as it does
///         for a tolerance that is not above 0
bool AppendChords(BezierCurve const& curve, double tolerance, std::size_t mostChords,
                  std::vector<XY>* points);

/// The same for an arc piece. The chords are of one length, as few as the tolerance allows.
bool AppendChords(Piece const& arc, double tolerance, std::size_t mostChords,
                  std::vector<XY>* points);

/// A piece of an ellipse: centre + first * cos t + second * sin t for t from `from` to `to`. The
/// half axes need not be perpendicular to each other.
struct EllipseArc {
  XY center;
  XY first;
  XY second;
  double from = 0.0;
  double to = 0.0;
};

/// The point of the ellipse at t.
XY PointOf(EllipseArc const& arc, double t);

/// As rational curves of a quarter turn at most, in the order from `from` to `to`.
std::vector<BezierCurve> CurvesOf(EllipseArc const& arc);

/// What may be made of the curves of a file.
struct Flattening {
  std::optional<double> tolerance;       ///< nothing: curves are refused
  std::size_t chordsLeft = kMostChords;  ///< of all curves together

  /// What helps where a curve was refused.
  Remedy Help() const { return tolerance ? Remedy::None : Remedy::FlattenCurves; }
};

/// Appends the chords of curves that follow each other.
/// @return what is wrong, for a message: that nobody asked for chords, or that they are too many
std::optional<std::string> AppendChords(std::vector<BezierCurve> const& curves,
                                        Flattening* flattening, std::vector<Piece>* pieces);

}  // namespace Vorn::IO
