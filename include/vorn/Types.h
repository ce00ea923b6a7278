/// @file
/// The records, enums and the progress interface shared by all classes of the library.

#pragma once

#include <cstdint>

/// Marks what the shared library exports; everything else stays hidden.
#if defined(_WIN32)
#if defined(GeometryUtils_EXPORTS)
#define VORN_EXPORT __declspec(dllexport)
#else
#define VORN_EXPORT __declspec(dllimport)
#endif
#else
#define VORN_EXPORT __attribute__((visibility("default")))
#endif

/// Plane geometry for contour measurement: everything the library offers lives here.
///
/// All records are plain values without invariants of their own: they own nothing, may be copied
/// freely, and hold whatever the caller stores, a not-a-number included. Lengths are in the
/// caller's unit (the same everywhere in one call), angles in radians.
namespace Vorn {

/// Outcome of an operation that can fail in more than one way. Only the values listed here are
/// ever returned; the numbers are part of the binary interface.
enum class ErrorCode : std::int32_t {
  /// Success; the outputs are written.
  Ok = 0,
  /// An arc of a flat polyline has a radius <= 0, met while two arcs are tested for a crossing.
  InvalidArcRadius = 1,
  /// The general failure: empty or too short input, an element of an unknown type, a degenerate
  /// configuration (collinear points for a circle, an element of zero length), a null output where
  /// one is needed, or a step that failed inside.
  Failed = 2,
  /// A work array of the circle fit by mean circumcentre could not be allocated. Everywhere else
  /// an allocation failure leaves as std::bad_alloc.
  OutOfMemory = 4,
  /// Two arcs of a flat polyline have no defined intersection. Kept for callers that switch over
  /// the codes: no intersection routine of the library produces it.
  IntersectionUndefined = 6,
  /// A contour crosses or touches itself, or a run of measured points turns back on itself.
  SelfIntersection = 19,
  /// Two consecutive measured points are not farther apart than 1.5 times the sum of their
  /// tolerances; see GeometryUtils::IsPointValidToFit.
  PointsTooClose = 20,
  /// The extreme circles of a circle tolerance cell do not all turn the same way, or too few of
  /// them turn the wanted way.
  OrientationMismatch = 21,
  /// No arc passes within the tolerances: the centre cells have no common part, the radius leaves
  /// its admissible range, or no run length succeeds.
  NoFit = 23,
  /// The lines near two measured points cannot be written with one sign of the denominator in any
  /// allowed form, so they have no convex line cell.
  InvalidLineCell = 24,
};

/// How two lines or two segments lie to each other.
enum class SegmentsRelPosition : std::int32_t {
  /// No common point.
  Disjoint = -1,
  /// Parallel without a common point as far as the test can tell; see
  /// GeometryUtils::GetLineSegmentsIntersection for the collinear segments that end up here.
  Parallel = 0,
  /// Both segments lie on one line and overlap; the output is the middle of the common part.
  Collinear = 1,
  /// Exactly one common point, written to the output.
  Intersecting = 2,
};

/// Sense in which a flat polyline runs around its inside, in a frame whose y axis points up.
enum class PolyOrientation : std::int32_t {
  /// Clockwise.
  Cw = 0,
  /// Counter-clockwise: the sum of x[i]*y[i+1] - x[i+1]*y[i] is positive.
  Ccw = 1,
  /// The index array is empty or does not match the coordinates.
  OrientationUnknown = 2,
  /// Both neighbours of the lowest vertex stand straight above it, so it shows no sense.
  OrientationDegenerate = 3,
};

/// A measured point with a tolerance of its own: the input of curve fitting.
struct WPoint {
  /// Abscissa.
  double x = 0.0;
  /// Ordinate.
  double y = 0.0;
  /// Tolerance: how far the fitted curve may pass from this point (half the width of the band), in
  /// the unit of x and y. Expected >= 0; nothing checks it. A relative deviation divides by it, so
  /// with w = 0 a point off the curve has an infinite one and a point on it a not-a-number.
  double w = 0.0;
};

/// One sample of a deviation curve: how a measured point lies to a trial circle.
struct WPoint2 {
  /// Abscissa of the point minus that of the trial centre.
  double dx = 0.0;
  /// Ordinate of the point minus that of the trial centre.
  double dy = 0.0;
  /// Distance of the point from the trial centre minus the trial radius; positive outside.
  double dev = 0.0;
  /// Tolerance of the point divided by the mean tolerance of its run, so the weights average 1.
  double weight = 0.0;
};

/// A pair of coordinates as it is passed across the public boundary: shifts, split points and
/// vertices of tolerance polygons.
///
/// @tparam T coordinate type; the library uses double
template <typename T>
struct Point2D {
  /// Abscissa.
  T x{};
  /// Ordinate.
  T y{};
};

/// Layout of one run of a flat polyline.
struct PolylineParam {
  /// 0: plain vertices (x, y). 1: records with arc data (x, y, centre x, centre y, radius,
  /// direction, start angle, end angle).
  std::int32_t kind = 0;
  /// Doubles per vertex: 2 for kind 0, 8 for kind 1.
  std::int32_t stride = 0;
};

/// Receives the progress of a fit. The caller derives from it and passes a pointer to
/// GeometryUtils::CreateFittingCurve.
///
/// The library calls SetProgress and nothing else; it never makes, copies or deletes an
/// ExecutionState. Calls come on the thread of the fitting call, inside it. What SetProgress throws
/// passes through the fit to the caller: elements appended so far stay in the contour.
///
/// The virtual table is part of the binary interface: SetProgress is its second slot. That is why
/// a function stands before it, and why the destructor is not virtual (the Itanium ABI would give
/// it two slots) but protected.
class ExecutionState {
 public:
  /// Occupies the first slot of the virtual table. The library never calls it.
  virtual void Reserved() {}

  /// Told by the fitters after every accepted point and every finished run.
  ///
  /// @param[in] percent the maxPercent of the fit minus the points still open in per cent of all
  ///            points (truncated towards zero); 0 is replaced by 1. With maxPercent = 100 it lies
  ///            in 1..100; with a smaller one it may be negative.
  /// @note Not monotone: the line and the arc fitter try the same points one after the other, and a
  ///       run that is shortened starts again. Show the largest value so far.
  virtual void SetProgress(std::int32_t percent) = 0;

 protected:
  /// For derived classes only.
  ExecutionState() = default;
  /// For derived classes only: the base has no state to copy.
  ExecutionState(ExecutionState const&) = default;
  /// For derived classes only: the base has no state to copy.
  /// @return this object
  ExecutionState& operator=(ExecutionState const&) = default;
  /// Not virtual on purpose, see the class comment; protected, so nobody deletes through the base.
  ~ExecutionState() = default;
};

static_assert(sizeof(ErrorCode) == 4);
static_assert(sizeof(SegmentsRelPosition) == 4);
static_assert(sizeof(PolyOrientation) == 4);
static_assert(sizeof(WPoint) == 24);
static_assert(sizeof(WPoint2) == 32);
static_assert(sizeof(Point2D<double>) == 16);
static_assert(sizeof(PolylineParam) == 8);
static_assert(sizeof(ExecutionState) == sizeof(void*));

}  // namespace Vorn
