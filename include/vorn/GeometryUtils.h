/// @file
/// Plane geometry of measured contours: fitting, editing, area, intersections, tolerance cells.

#pragma once

#include <cstddef>
#include <type_traits>
#include <vector>

#include "vorn/Types.h"

namespace Vorn {

/// Plane geometry for contour measurement. All members are static: no object of this class can be
/// made. CreateFittingCurve is the main service; the private members are its inner steps, exported
/// so that they can be tested one by one.
///
/// Conventions
/// - Counter-clockwise (ccw) means counter-clockwise with the y axis pointing up.
/// - Areas carry the negated shoelace sign: positive for clockwise vertices in a y-up frame, which
///   is counter-clockwise on an image whose y axis points down.
/// - Angles are radians. Polar angles are atan2(dy, dx), in (-pi, pi]. Wraps use the literals
///   3.14159265358979, 6.28318530717958 and 1.570796326794895, called pi, 2*pi and pi/2 below; they
///   lie a few units in the last place below the true values, and results depend on them.
/// - A line is three doubles (a, b, c) with a*x + b*y + c = 0, not normalised.
/// - Tolerances are absolute, never scaled by the data. "Tiny" below means not above
///   2.2250738585072014e-308, the smallest normal double; "eps" is 2.220446049250313e-16. Triangle
///   predicates use exact signs.
/// - The sign of a double is -1, 0 (only for exactly 0.0) or +1; a not-a-number counts as +1.
/// - A relative deviation is a distance divided by the tolerance of the point: <= 1 is within
///   tolerance. An absolute deviation is a plain distance.
/// - A tolerance cell is a vector of triangles; (P, Q, Q) stands for a segment, (P, P, P) for a
///   point.
///
/// Errors
/// - Those of elementary operations stand with them, in eps. A value that is rounded once is off by
///   half an eps of itself at most. Where terms cancel, a bound is one of the terms: the result may
///   have no digit of its own left.
/// - They hold for coordinates whose squares and products neither overflow nor underflow. Bounds
///   called measured are half as large again, or more, as the largest error of 200,000 cases of
///   each operation, degenerate and ill-conditioned ones among them, beside numbers of 512 bits;
///   the others are derived, and no case broke them.
///
/// Contracts that hold for every member unless it says otherwise
/// - Pointers must not be null.
/// - Outputs are written only on success; on failure they keep what they held.
/// - Output vectors are appended to, never emptied.
/// - Bad geometry never throws and never logs; the only exception that leaves is std::bad_alloc
///   from a growing vector (and what the caller's own ExecutionState throws).
/// - There is no state: members may be called from several threads at once on distinct outputs.
/// - Rounding to nearest is assumed. Under another mode, or with denormals flushed to zero, every
///   operation still ends with an answer of the right form, but with other digits, which may miss
///   what is promised by as much as rounding does; the modes stay as they are.
/// - A not-a-number is not looked for; it runs through the arithmetic. Every loop ends on any
///   input, and nothing outside the given arrays is read.
class VORN_EXPORT GeometryUtils {
 public:
  /// There are no objects of this class.
  GeometryUtils() = delete;

  /// Kind of a contour element. Any other value marks an invalid element, which every operation
  /// that inspects elements rejects.
  enum class ElemType : std::int32_t {
    /// A straight segment; only its end is meaningful.
    Segment = 0,
    /// A circular arc.
    Arc = 1,
  };

  /// How CreateFittingCurve cuts the points into elements.
  enum class FittingStrategy : std::int32_t {
    /// Segments and arcs compete run by run: the longer reach wins.
    Mixed = 0,
    /// Segments first; the points skipped between them are covered by arcs over tolerance cells.
    MixedCells = 1,
    /// One arc through all points.
    SingleArc = 2,
  };

  /// How CalcOptimalRadius picks a radius for a given centre.
  enum class CircleRadiusFindingStrategy : std::int32_t {
    /// The middle of the admissible radius range.
    MidRange = 0,
    /// The mean distance of the points from the centre, weighted by the tolerances when each point
    /// brings its own.
    MeanDistance = 1,
  };

  /// Outcome of the overlap of two triangles or of a triangle and a cell.
  enum class OverlappingStatus : std::int32_t {
    /// There is a common part; its triangles were appended.
    Overlap = 0,
    /// There is no common part; nothing was appended.
    NoOverlap = 1,
    /// The configuration could not be resolved; nothing was appended.
    OverlapFailed = 2,
  };

  /// Where a point lies with respect to a triangle.
  enum class PointStatus : std::int32_t {
    /// On all three sides at once, which a triangle of non-zero area does not allow.
    Undefined = 0,
    /// Outside the triangle, a degenerate one included.
    Outside = 1,
    /// Strictly inside.
    Inside = 2,
    /// On exactly one side, not at a vertex.
    OnSide = 3,
    /// On two sides, that is, at a vertex.
    OnVertex = 4,
    /// On a side of a triangle of zero area.
    OnDegenerate = 5,
  };

  /// A point of the plane.
  struct Point {
    /// Abscissa.
    double x = 0.0;
    /// Ordinate.
    double y = 0.0;
  };

  /// A circular arc. Its start point is not stored: in a contour it is the end of the element
  /// before. The sweep follows from the two angles and the direction and is always below a full
  /// turn: equal angles mean an arc of length 0 (only SplitElem takes them for a full circle).
  struct Arc {
    /// End point.
    Point end;
    /// Centre of the circle.
    Point center;
    /// Radius; > 0 for a meaningful arc.
    double radius = 0.0;
    /// +1.0 counter-clockwise (the angle grows from start to end), -1.0 clockwise. Only the sign is
    /// looked at; 0 counts as clockwise, except in ReplaceElem and in the area of a contour.
    double direction = 0.0;
    /// Polar angle of the start point about the centre, in (-pi, pi].
    double startAngle = 0.0;
    /// Polar angle of the end point about the centre, in (-pi, pi].
    double endAngle = 0.0;
  };

  /// The tag in front of an element. A base class of its own, so that the tag comes first in memory
  /// and the arc fields follow it directly.
  struct ElemTag {
    /// Kind of the element.
    ElemType type = ElemType::Segment;
  };

  /// One element of a contour: a tag, followed by the fields of an arc. An arc element can be
  /// passed wherever an Arc is asked for; of a segment only the end is meaningful.
  ///
  /// A contour is a std::vector<Elem>. Its first element is a segment whose end is the start point
  /// of the whole contour (a segment from nowhere); every further element runs from the end of the
  /// element before to its own end. A contour of k pieces thus has k + 1 elements.
  struct Elem : ElemTag, Arc {};

  /// A triangle of a tolerance cell, in either orientation, possibly degenerate.
  struct Triangle {
    /// The vertices; side i runs from pts[i] to pts[(i + 1) % 3].
    Point pts[3];
  };

  /// A sample of an arc candidate and where it came from.
  struct IndexedPoint {
    /// The point.
    Point pt;
    /// Tolerance of the measured point it stands for.
    double w = 0.0;
    /// Index of that point in the vector of measured points.
    std::int32_t index = 0;
  };

  /// A point where a side of one triangle meets a side of another.
  struct CrossingPoint {
    /// The point.
    Point pt;
    /// Side of the first triangle, 0..2.
    int side1 = 0;
    /// Side of the second triangle, 0..2.
    int side2 = 0;
  };

  /// What a fitter needs to report progress.
  struct ProgressBase {
    /// The caller's sink; null for no reporting.
    ExecutionState* state = nullptr;
    /// Percentage to report when all points are done.
    std::int32_t maxPercent = 0;
    /// Number of points of the whole fit; below 1 nothing is reported.
    std::int32_t total = 0;
  };

  /// @name Angles, distances and deviations
  /// @{

  /// Polar angle of a displacement measured in an image, whose y axis points down.
  ///
  /// @param[in] dy displacement along the downward axis
  /// @param[in] dx displacement to the right
  /// @return atan2(-dy, dx): the counter-clockwise angle as seen on the screen, in [-pi, pi]
  /// @note Error: that of atan2 of the C library, below 1 eps of the angle on Debian 12.
  static double GetNaturalAngle(double dy, double dx);

  /// Azimuth (clockwise from the positive y axis, north = 0) of a natural angle
  /// (counter-clockwise from the positive x axis).
  ///
  /// @param[in] angle natural angle
  /// @return pi/2 - angle, plus 2*pi when that is negative; in [0, 2*pi) for angles in
  ///         (-3*pi/2, pi/2 + 2*pi]
  /// @note Deliberate: one correction only. An angle <= -3*pi/2 gives 2*pi or more, one above
  ///       pi/2 + 2*pi a negative value.
  /// @note Error: 1e-14 at most, mostly from the constants that are cut short.
  static double NaturalAngleToAzimuthRad(double angle);

  /// Azimuth of the tangent that belongs to a natural angle.
  ///
  /// @param[in] angle natural angle
  /// @param[in] flag  true: pi - angle, not wrapped. false: the angle negated, as 2*pi - angle when
  ///            it is positive.
  /// @return the azimuth; with flag false and an angle of 0 it is -0.0
  /// @note Deliberate: only one of the two branches wraps.
  /// @note Error: 1e-14 at most, as above.
  static double NaturalAngleToTangentialAzimuthRad(double angle, bool flag);

  /// Length of an arc.
  ///
  /// @param[in] arc radius, direction and both angles are used; direction > 0 is counter-clockwise,
  ///            everything else clockwise
  /// @return sweep times radius; 0 for equal angles. >= 0 for angles in (-pi, pi] and a radius >=
  /// 0,
  ///         except for a sweep of less than 7e-15 across the seam
  /// @note One wrap by 2*pi at most. Since 2*pi is cut short, a sweep across the seam comes out too
  ///       small by 7e-15 at most: the least ones below 0. O(1).
  /// @note Error: 1 eps of the length away from the seam, 1e-14 of the radius across it.
  static double GetArcLength(Arc const& arc);

  /// Sweep of an arc.
  ///
  /// @param[in] arc as for GetArcLength
  /// @return GetArcLength divided by the radius, in [0, 2*pi) with the same exception; 0.0 when the
  ///         radius is tiny, zero or negative
  /// @note Error: 1.5 eps of the sweep away from the seam, 1e-14 across it.
  static double GetArcAngleRad(Arc const& arc);

  /// Distance of the point (x, y) from the line a*x + b*y + c = 0.
  ///
  /// @param[in]  a,b,c the line, need not be normalised
  /// @param[in]  x,y   the point
  /// @param[out] dev   the distance, >= 0
  /// @return false, dev untouched, when sqrt(a*a + b*b) is tiny
  /// @note A not-a-number is not rejected: dev becomes one. O(1).
  /// @note Error: at most 3 eps of (|a*x| + |b*y| + |c|) / sqrt(a*a + b*b). Near the line, where
  ///       the terms cancel, that may be all of dev.
  static bool GetDeviation(double a, double b, double c, double x, double y, double* dev);

  /// Signed distance of the point (x, y) from the line a*x + b*y + c = 0.
  ///
  /// @param[in]  a,b,c the line, need not be normalised
  /// @param[in]  x,y   the point
  /// @param[out] dev   positive on the side away from the origin, so the origin itself never gets
  ///             more than 0; for c = 0 the sign of a*x + b*y
  /// @return false, dev untouched, when sqrt(a*a + b*b) is tiny
  /// @note Property: for c != 0, negating a, b and c changes nothing; for c = 0 it flips the sign.
  ///       O(1).
  /// @note Error: as for GetDeviation of a line.
  static bool GetSignedDeviation(double a, double b, double c, double x, double y, double* dev);

  /// Distance of a third point from the line through two others, from squared lengths alone.
  ///
  /// @param[in]  coords x1, y1, x2, y2, x3, y3
  /// @param[out] dev    distance of point 3 from the line through points 1 and 2
  /// @return false, dev untouched, when the squared distance of points 1 and 2 is tiny
  /// @note Deliberate: the difference under the root is not clamped. For a point very near the line
  ///       it may round to a negative value; dev is then a not-a-number and the answer still true.
  ///       Callers must count that as the worst case, not as 0. For the same reason the result is
  ///       only good to about 1e-8 of the distance between points 1 and 3. O(1).
  /// @note Error: with s the sum of the squared distances of the three points from each other and b
  ///       that of points 1 and 2, the square of dev is off by at most 19 eps of s*s / (4*b).
  static bool GetDeviation(double const* coords, double* dev);

  /// Whether two measured points are far enough apart to be neighbours in a fit: strictly farther
  /// than 1.5 times the sum of their tolerances.
  ///
  /// @param[in] a,b the points; their order does not matter
  /// @return true when (1.5 * (a.w + b.w))^2 < squared distance; also true when a not-a-number is
  ///         involved
  /// @note Error: the answer can be wrong only where both sides agree to 4.5 eps.
  static bool IsPointValidToFit(WPoint const& a, WPoint const& b);
  /// @}

  /// @name Circles through points
  /// @{

  /// Circle through three measured points, pushed outward by their tolerances (inward by negative
  /// ones).
  ///
  /// With equal tolerances (differences tiny) the circle through the points grows by the common
  /// tolerance. With different ones each point is moved along its ray from the centre by its own
  /// tolerance, in three rounds, each with the centre of the round before; when a round turns the
  /// sense of the three points over, the tolerances change sign for the next.
  ///
  /// @param[in]     a,b,c  the points; their w may be negative
  /// @param[out]    circle centre in x and y, radius in w
  /// @param[in,out] pa,pb,pc the moved points, for different tolerances. For equal tolerances they
  ///                are not written but read: ccw is the sense of what they hold, so preload them
  ///                with the measured points.
  /// @param[out]    ccw    true when pa, pb, pc run counter-clockwise
  /// @return false when the points admit no circle, a moved point cannot be found, or the sense is
  ///         undefined (the points in pa, pb, pc exactly collinear)
  /// @note Deliberate: the asymmetry of pa, pb, pc between the two cases. On failure circle, and
  ///       for different tolerances pa, pb and pc as well, may already be written; ccw is not.
  ///       O(1).
  /// @note Error: for equal tolerances that of the circle through the three points, see GetCircle
  ///       below, and 1 eps of the tolerance.
  static bool GetCircle(WPoint const& a, WPoint const& b, WPoint const& c, WPoint* circle,
                        Point* pa, Point* pb, Point* pc, bool* ccw);
  /// @}

  /// @name Intersections
  /// @{

  /// Relation of the segments (x1, y1)-(x2, y2) and (x3, y3)-(x4, y4), end points included.
  ///
  /// @param[in]  x1,y1,x2,y2 first segment; may be a point
  /// @param[in]  x3,y3,x4,y4 second segment; may be a point
  /// @param[out] x,y the common point for Intersecting, the middle of the common part for
  ///             Collinear; untouched otherwise
  /// @return Intersecting, Collinear, Parallel or Disjoint
  /// @note Deliberate: parallel segments are told apart by their raw line constants
  ///       c = x1*y2 - y1*x2, without normalising. Segments on one line that is not through the
  ///       origin are reported Parallel unless their constants agree exactly: (0,1)-(1,2) and
  ///       (1,2)-(3,4) are Parallel though they touch, and parallel ones of different lengths whose
  ///       constants happen to agree are Collinear though they lie apart: (7,-16)-(-16,7) and
  ///       (-7,-16)-(-16,-7). Segments whose bounding boxes do not meet are Disjoint, parallel or
  ///       not. Absolute thresholds; O(1).
  /// @note Error: with D the cross product of the segments and P the sum of the magnitudes of all
  ///       products of coordinate differences that it and the two parameters are made of, x is off
  ///       by at most 4 eps of P * |x2 - x1| / |D| + |x|, y likewise. Whether they intersect can be
  ///       wrong only where the crossing is nearer to an end than 4.3 eps of P / |D| of the
  ///       segment. Both hold where |D| is more than 16 eps of its own products.
  static SegmentsRelPosition GetLineSegmentsIntersection(double x1, double y1, double x2, double y2,
                                                         double x3, double y3, double x4, double y4,
                                                         double* x, double* y);
  /// @}

  /// @name Contour chains
  /// Building and editing at the end of a contour, and of single elements. Nothing here checks that
  /// an element fits the one before.
  /// @{

  /// Appends a segment. On an empty contour this places the start point.
  ///
  /// @param[in,out] contour the contour
  /// @param[in]     end     end point of the segment
  /// @return true
  static bool AddSegm(std::vector<Elem>* contour, Point end);

  /// Appends an arc; its angles are computed from the points.
  ///
  /// @param[in,out] contour   the contour
  /// @param[in]     start     start point; gives the start angle and is not stored
  /// @param[in]     end       end point
  /// @param[in]     center    centre
  /// @param[in]     radius    radius; not checked against the points
  /// @param[in]     clockwise true for direction -1.0, false for +1.0
  /// @return true
  static bool AddArc(std::vector<Elem>* contour, Point const& start, Point const& end,
                     Point const& center, double radius, bool clockwise);

  /// Takes the last element off.
  ///
  /// @param[in,out] contour the contour
  /// @param[out]    removed receives the element
  /// @return false for an empty contour
  static bool RemoveElem(std::vector<Elem>* contour, Elem* removed);

  /// Replaces the last element.
  ///
  /// @param[in,out] contour the contour; unchanged on failure
  /// @param[in]     elem    of a segment only the end is taken; of an arc end, centre, radius and
  ///                direction. Its angles are computed anew from the end of the element before; a
  ///                direction of exactly 0 counts as counter-clockwise here. May be an element of
  ///                the same contour.
  /// @return false for an empty contour, an unknown type, and an arc when there is no valid element
  ///         before the last one to start from
  static bool ReplaceElem(std::vector<Elem>* contour, Elem const& elem);

  /// Where the contour ends: the end point of its last element.
  ///
  /// @param[in]  contour the contour; not changed
  /// @param[out] point   the end point
  /// @return false for an empty contour or a last element of unknown type
  static bool GetElemPoint(std::vector<Elem>* contour, Point* point);

  /// A copy of an element moved by a vector.
  ///
  /// @param[in]  elem    the element
  /// @param[in]  shift   added to the end and, for an arc, to the centre; radius, direction and
  ///             angles stay
  /// @param[out] shifted receives the copy
  /// @return false for an unknown type
  static bool ShiftElem(Elem const& elem, Point2D<double> const& shift, Elem* shifted);

  /// Cuts an element into consecutive pieces of equal length.
  ///
  /// @param[in]  elem   the element
  /// @param[in]  parts  number of pieces, >= 2
  /// @param[in]  start  start point of a segment, normally the end of the element before; not used
  ///             for an arc
  /// @param[out] pieces room for that many elements. The last piece ends exactly where elem ends.
  /// @return false, nothing written, for parts < 2 or an unknown type
  /// @note Deliberate: an arc with equal angles is cut as a full circle, although GetArcLength
  ///       gives it length 0. Cut angles are wrapped once into [-pi, pi]. O(parts).
  static bool SplitElem(Elem const& elem, int parts, Point2D<double> const& start, Elem* pieces);

  /// Empties a contour. The vector keeps its capacity.
  ///
  /// @param[in,out] contour the contour
  static void DeleteFittingCurve(std::vector<Elem>* contour);
  /// @}

  /// @name Area and self-intersection
  /// @{

  /// Whether a contour crosses or touches itself.
  ///
  /// Elements of zero length are skipped. Neighbours may share their joint, and the closing element
  /// may end on the start of the first.
  ///
  /// @param[in] contour the contour, start element first; open or closed
  /// @return Ok when no crossing was found; SelfIntersection for a crossing or touch; Failed for an
  ///         empty contour, a first element that is no segment, an unknown type met on the way, an
  ///         arc of equal angles compared with a segment before it, two arcs compared of which one
  ///         has a radius <= 0, or too few elements of non-zero length to compare any two (fewer
  ///         than two, or just two segments)
  /// @note Deliberate: collinear overlapping segments are not a crossing; end points of arcs never
  ///       count; once two arcs meet in an accepted single point, the rest is not compared with the
  ///       first. About O(n log n), with memory for boxes, where few elements come near others.
  static ErrorCode CheckPolySelfIntersection(std::vector<Elem> const& contour);

  /// Signed area of a contour that does not cross itself.
  ///
  /// @param[in]  contour the contour, start element first
  /// @param[out] area    positive for a clockwise contour in a y-up frame. An open contour is not
  ///             closed: its trapezoids against the x axis are summed as far as it goes.
  /// @return the code of CheckPolySelfIntersection unless that is Ok; Failed for an empty contour
  ///         or an unknown type; Ok with area written otherwise
  /// @note Each arc adds its two chords to the centre and the sector between them. The check, then
  ///       O(n) for the sum.
  /// @note Error: for n segments at most (n + 3) / 4 eps of the sum of |(x2 - x1) * (y2 + y1)|; two
  ///       arcs of a circle of radius r about (x, y) are off by at most 16 eps of r * (2*r +
  ///       max(|x|, |y|)), measured.
  static ErrorCode GetArea(std::vector<Elem> const& contour, double* area);

  /// Signed area of a flat polyline.
  ///
  /// Each entry e of indices is one run: |e| is the offset in coords of the x of the run's last
  /// vertex, where the next run starts. e >= 1: plain vertices (x, y). e <= 0: records of eight
  /// doubles (x, y, centre x, centre y, radius, direction, start angle, end angle), the arc running
  /// from its vertex to the next.
  ///
  /// @param[in]  coords  vertex data, run after run
  /// @param[in]  indices one entry per run
  /// @param[out] area    positive for a clockwise polyline in a y-up frame; 0 for empty indices
  /// @return Ok, or Failed, area untouched, when the entries point outside coords. The terms of a
  ///         run of records read up to offset |e| + 8.
  /// @note Deliberate: within a run of records the sum advances by one double, not by a record, and
  ///       the direction is not read. Its result is an area only for runs of plain vertices.
  ///       O(size of coords).
  /// @note Error: for n plain vertices at most (n + 2) / 4 eps of the sum of |x2*y1| + |x1*y2|.
  static ErrorCode GetArea(std::vector<double> const& coords,
                           std::vector<std::int32_t> const& indices, double* area);

  /// Whether a flat polyline crosses or touches itself. The layout is that of GetArea.
  ///
  /// @param[in,out] coords  vertex data. When the last entry equals the number of doubles, the
  ///                closing vertex is missing and the first one is appended for the duration of the
  ///                call; on return the contents are what they were (the capacity may have grown).
  /// @param[in]     indices one entry per run
  /// @param[out]    found   true at the first crossing, false when there is none; written only
  ///                with Ok
  /// @return Ok in both cases; Failed for empty arrays, entries that point outside, or an arc with
  ///         equal angles tested against a straight piece; InvalidArcRadius when one of two arcs
  ///         tested has a radius <= 0
  /// @note Deliberate: a closed polyline of three or more plain pieces always answers found = true,
  ///       because its closing piece touches the first one and that touch is not exempted. A
  ///       straight piece and a later arc cross only with two common points, an arc and a later
  ///       straight piece already with one. Later runs are read from the end of the piece's own run
  ///       with their own layout. O(v^2) in the number v of vertices.
  static ErrorCode CheckPolySelfIntersection(std::vector<double>& coords,
                                             std::vector<std::int32_t> const& indices, bool* found);
  /// @}

  /// @name Tolerance polygons
  /// What the fitters see around the points, for drawings and for inspection.
  /// @{

  /// The four points where the two crossing common tangents touch the tolerance circles of two
  /// measured points.
  ///
  /// @param[in]  a,b  the points with their tolerances
  /// @param[out] rect eight doubles P0, P1, P2, P3 as (x, y) pairs: P0 and P1 on the circle of b,
  ///             P2 and P3 on that of a; P0-P2 and P1-P3 are the tangents, P1-P2 and P0-P3 join
  ///             their ends
  /// @return false, rect untouched, when the circles overlap (distance < a.w + b.w)
  /// @note Deliberate: when the sum of the tolerances is tiny or negative the result is (a, a, b,
  ///       b), a first, the reverse of the general case. Circles that touch give P0 = P1 and P2 =
  ///       P3 up to rounding. O(1).
  static bool GetPermissibleRect(WPoint a, WPoint b, double* rect);

  /// The line tolerance cell of two measured points: the quadrilateral, in the plane of line
  /// parameters, of the lines that pass between the tolerance circles' crossing tangents.
  ///
  /// A point (u, v) of that plane is the line v*x + y + u = 0, or v*y + x + u = 0 in the exchanged
  /// form.
  ///
  /// @param[in]     a,b       the points with their tolerances
  /// @param[in,out] formFixed false: this call chooses the form, sets xOfY and turns formFixed
  ///                true; true: xOfY is taken as given. Pass both on unchanged to get all cells of
  ///                a run in one form.
  /// @param[in,out] xOfY      true for the exchanged form (x as a function of y)
  /// @param[out]    polygon   room for four vertices, in boundary order
  /// @return Ok; Failed when the tolerance circles overlap; InvalidLineCell when the lines cannot
  ///         be written in the form (a form chosen here is switched once before giving up).
  /// @note On failure polygon is untouched, but formFixed and xOfY may have been set; after a
  ///       failed switch xOfY holds the form tried last. O(1).
  static ErrorCode GetLinePolygon(WPoint a, WPoint b, bool* formFixed, bool* xOfY,
                                  Point2D<double>* const polygon);

  /// The circle tolerance cell of three measured points: the polygon, in the plane of centres,
  /// whose corners are the centres of the extreme circles through the tolerance bands.
  ///
  /// Every point is moved inward and outward by its tolerance along its ray from the circumcentre;
  /// the corners are the centres of the circles through mixed choices of inner and outer points.
  ///
  /// @param[in]  first,middle,last the points in the order in which the arc passes them
  /// @param[in]  firstFixed  the circle passes exactly through first; its tolerance is ignored
  /// @param[in]  lastFixed   likewise for last
  /// @param[in]  orientation wanted sign of the triangle area of each extreme triple: +1 clockwise,
  ///             -1 counter-clockwise; others are skipped. 0 takes the sign of the first triple and
  ///             asks it of all. Looked at only when neither end is fixed; otherwise as 0.
  /// @param[out] vertexCount number of vertices: 3 to 6 with both ends free, 4 with one end fixed,
  ///             3 with both fixed (of which two are equal: the cell is a segment)
  /// @param[out] vertices    room for six vertices, in cyclic order
  /// @return Ok; Failed when the points are collinear (the elimination meets an exact zero), the
  ///         circumradius is tiny or an extreme circle does not exist; OrientationMismatch when the
  ///         triples do not all turn the same way or fewer than three turn the wanted way
  /// @note A tolerance above the circumradius puts the inner point beyond the centre; no special
  ///       case is made. O(1).
  static ErrorCode GetCirclePolygon(WPoint first, WPoint middle, WPoint last, bool firstFixed,
                                    bool lastFixed, int orientation, int* vertexCount,
                                    Point2D<double>* const vertices);
  /// @}

  /// @name Contour fitting
  /// @{

  /// Turns measured points into a contour of segments and arcs that passes within the tolerance of
  /// the points.
  ///
  /// With strategy Mixed the line fitter and the arc fitter are asked from the current point how
  /// many points one element can cover; the longer reach wins, a tie goes to the arc if its
  /// deviation is not larger, and the next run starts at the last point of this one. With
  /// MixedCells segments are searched first and the points between them are covered by arcs that
  /// end where the segments begin. With SingleArc one arc is fitted to all points and refined by
  /// least squares. The method, with drawings, is told in docs/method.md.
  ///
  /// @code
  /// std::vector<Vorn::WPoint> points = ...;  // x, y, tolerance
  /// std::vector<Vorn::GeometryUtils::Elem> contour;
  /// double deviation = 0.0;
  /// std::int32_t index = -1;
  /// Vorn::ErrorCode const code = Vorn::GeometryUtils::CreateFittingCurve(
  ///     points, Vorn::GeometryUtils::FittingStrategy::Mixed, &contour, &deviation, &index,
  ///     nullptr, 100);
  /// @endcode
  ///
  /// @param[in]     points   measured points in contour order
  /// @param[in]     strategy see FittingStrategy
  /// @param[in,out] contour  pass an empty vector: elements are appended. On an error elements
  ///                appended so far stay, except that SingleArc empties the vector before it stores
  ///                its final arc. Null answers Failed.
  /// @param[out]    maxDeviation largest deviation of a point from its element: relative (in units
  ///                of the point's tolerance) with Mixed and MixedCells, an absolute distance with
  ///                SingleArc. 0.0 for two points, or three with SingleArc; -1.0 when no element
  ///                was made. Written on success; SingleArc writes both outputs already before and
  ///                during its refinement, so a failure there leaves values of a passing circle.
  /// @param[out]    maxDeviationIndex index in points of the point with that deviation (the first
  ///                of equal ones); -1 when there is none and always with SingleArc. Written
  ///                together with maxDeviation.
  /// @param[in]     executionState receives the progress; may be null
  /// @param[in]     maxPercent     percentage that means "all done", normally 100
  /// @return
  /// - Ok: see the note on what that does and does not promise
  /// - Failed: null contour, fewer than 2 points (3 with SingleArc) or more than an std::int32_t
  ///   counts, an unknown strategy with more than 2 points, or a step that failed inside
  /// - PointsTooClose: two consecutive points fail IsPointValidToFit; not tested with SingleArc
  /// - NoFit: no circle within the tolerances
  /// - the code of an inner step, with MixedCells and SingleArc
  ///
  /// @note Deliberate: with Mixed the answer is Ok also when neither fitter can go on; the contour
  ///       then ends early. Compare the end of the last element with the last point. A segment over
  ///       just two points is not tested against their tolerances. With MixedCells, segments put in
  ///       place of an arc that could not be fitted may leave the tolerance of the points between.
  ///       SingleArc judges by absolute distances and does not compare its final arc with the
  ///       tolerances; when its first fit covered only some of the points, the final arc ends where
  ///       that fit ended, which may be off the circle and short of the last point, and its sense
  ///       is that of as many points from the first.
  /// @note Far from the origin: the digits that an offset takes up are lost to centres and line
  ///       parameters, and pieces fall apart. 200 points 1 apart along (0.8, 0.6) with tolerance
  ///       0.001 give one segment at the origin, 2 at an offset of 1e5 and 136 at one of 5e6
  ///       (Mixed). Map and machine coordinates are like that. Take an offset off first that makes
  ///       every difference exact, such as a whole number near the middle of the points, and add it
  ///       to the ends and centres of the result; the program does so.
  /// @note Cost, in narrowings of a cell, each of which cuts the triangles of one cell by those of
  ///       another. Running cells are bounded at 78125 triangles (lines) and 19531 (arcs), copies
  ///       included, of which equal ones are cut once. Mixed takes at most five narrowings a point
  ///       on lines, arcs, spirals and zigzags, exact or noisy, with tolerances over six orders of
  ///       magnitude: 1 to 200 us a point. MixedCells takes less on the same points where its arcs
  ///       fit; where they do not, they are tried again for every length, up to one narrowing a
  ///       point for each point. SingleArc compares all pairs of points, O(n^2), in nanoseconds.
  /// @note Costly inputs: tolerances of zero, and those below 1e-8 of the points' extent. Cells
  /// then
  ///       accept a run that its measurement refuses, and it is grown again for every length: n/2
  ///       narrowings a point with Mixed. 1000 exactly straight points with a tolerance of 1e-12 of
  ///       their extent take 30 ms a point. With a tolerance of zero, cells also fill up with
  ///       copies, all of which every centre sums: MixedCells takes 45 ms a point for 50 points and
  ///       minutes for 250. Use FewestPieces for such points; the program warns of them.
  static ErrorCode CreateFittingCurve(std::vector<WPoint> const& points, FittingStrategy strategy,
                                      std::vector<Elem>* contour, double* maxDeviation,
                                      std::int32_t* maxDeviationIndex,
                                      ExecutionState* executionState, std::int32_t maxPercent);
  /// @}

 private:
  /// @name Inner steps: angles, distances and deviations
  /// @{

  /// Difference of two angles, wrapped once.
  ///
  /// @param[in] a,b angles
  /// @return a - b, minus 2*pi when it is >= pi, plus 2*pi when it is <= -pi; in (-pi, pi) as long
  ///         as a - b lies within one turn, ends aside
  /// @note Deliberate: the ends swap. A difference of exactly pi comes back as -pi, one of -pi as
  ///       pi.
  /// @note Error: 1e-14 at most.
  static double SubtrAng(double a, double b);

  /// Squared distance of two points.
  ///
  /// @param[in] p,q the points
  /// @return (p.y - q.y)^2 + (p.x - q.x)^2, added in this order
  /// @note Error: 2 eps of the result at most.
  static double GetDist2(Point const& p, Point const& q);

  /// The line through two points.
  ///
  /// @param[in]  x1,y1 first point
  /// @param[in]  x2,y2 second point
  /// @param[out] a,b,c the line: a = y1 - y2, b = x2 - x1, c = x1*y2 - y1*x2. Not normalised; the
  ///             normal (a, b) is the direction turned by a quarter: for the x axis run to the
  ///             right it points up.
  /// @return false when the points differ by no more than a tiny amount in both coordinates
  /// @note Error: a and b are rounded once; c is off by at most 1 eps of |x1*y2| + |y1*x2|.
  static bool GetLineParameters(double x1, double y1, double x2, double y2, double* a, double* b,
                                double* c);

  /// The line through p perpendicular to another.
  ///
  /// @param[in]  a,b,c the given line; c is not used
  /// @param[in]  p     the point
  /// @param[out] na,nb,nc the perpendicular: b, -a, a*p.y - b*p.x
  /// @note Error: nb and na are exact; nc is off by at most 1 eps of |a*p.y| + |b*p.x|.
  static void GetNormal(double a, double b, double c, Point const& p, double* na, double* nb,
                        double* nc);

  /// Bounding box of two points.
  ///
  /// @param[in]  x1,y1 first point
  /// @param[in]  x2,y2 second point
  /// @param[out] box   four doubles: least x, least y, greatest x, greatest y
  static void GetXyminXymax(double x1, double y1, double x2, double y2, double* box);
  /// @}

  /// @name Inner steps: circles through points
  /// @{

  /// Circle through three points given by coordinates.
  ///
  /// @param[in]  x1,y1 first point; the radius is measured at it
  /// @param[in]  x2,y2 second point
  /// @param[in]  x3,y3 third point
  /// @param[out] cx,cy centre
  /// @param[out] r     radius
  /// @return Failed only when x1 = x2 = x3 exactly
  /// @note Deliberate: other collinear points answer Ok with a huge or non-finite centre, since the
  ///       solver does not check its last pivot. Test the sense first (IsCcw). O(1).
  /// @note Error: with m the largest distance of a point from the origin, c that of the centre, and
  ///       s the square of the longest side over twice the area of the triangle, centre and radius
  ///       are off by at most 2 eps of s * (m + c), measured up to s = 1e12.
  static ErrorCode GetCircle(double x1, double y1, double x2, double y2, double x3, double y3,
                             double* cx, double* cy, double* r);

  /// Circle through three points.
  ///
  /// @param[in]  a,b,c  the points; a is paired with each of the others
  /// @param[out] center centre
  /// @param[out] radius mean of the three distances from the centre
  /// @return false only when a.x = b.x = c.x exactly; other collinear points as above
  /// @note Error: as above.
  static bool GetCircle(Point const& a, Point const& b, Point const& c, Point* center,
                        double* radius);

  /// Sense in which a, b, c turn.
  ///
  /// @param[in]  a,b,c the points in order
  /// @param[out] ccw   true for counter-clockwise (negative triangle area)
  /// @return Failed, ccw untouched, when the triangle area is exactly 0.0
  /// @note Error: can be wrong only where twice the area is below 2 eps of the sum of the six
  ///       products |x*y'|; exact for whole numbers below 2^25.
  static ErrorCode IsCcw(Point const& a, Point const& b, Point const& c, bool* ccw);
  /// @}

  /// @name Inner steps: straight-line intersections
  /// @{

  /// Crossing of two lines.
  ///
  /// @param[in]  a1,b1,c1 first line
  /// @param[in]  a2,b2,c2 second line
  /// @param[out] x,y      the crossing
  /// @return Parallel, outputs untouched, when the magnitude of a1*b2 - b1*a2 is below the smallest
  ///         normal double (strictly), coincident lines included; Intersecting otherwise. Never
  ///         another value.
  /// @note Error: where det = a1*b2 - b1*a2 is more than 16 eps of its products p = |a1*b2| +
  ///       |b1*a2|, x is off by at most 1.6 eps of (|b1*c2| + |c1*b2| + |x|*p) / |det|, y likewise.
  static SegmentsRelPosition GetLinesIntersection(double a1, double b1, double c1, double a2,
                                                  double b2, double c2, double* x, double* y);

  /// Crossing of a line with a segment, end points included.
  ///
  /// @param[in]  a,b,c       the line
  /// @param[in]  x1,y1,x2,y2 the segment
  /// @param[out] x,y         the crossing
  /// @return false for a degenerate segment, a parallel one, or a crossing outside the segment's
  ///         bounding box (bounds included)
  /// @note Error: that of the crossing of the line with the one through the ends, of which c is
  ///       |x1*y2| + |y1*x2| for this purpose, with 2 eps in place of 1.6, measured.
  static bool GetLineAndSegmentIntersection(double a, double b, double c, double x1, double y1,
                                            double x2, double y2, double* x, double* y);

  /// Whether two segments cross, end points included.
  ///
  /// @param[in] x1,y1,x2,y2 first segment
  /// @param[in] x3,y3,x4,y4 second segment
  /// @return false also for all parallel segments, overlapping ones included: their cross product
  ///         is not above eps
  /// @note Deliberate: the threshold is eps here, while GetLineSegmentsIntersection uses the
  ///       smallest normal double.
  /// @note Error: as for GetLineSegmentsIntersection, where the cross product is above 1e-15.
  static bool AreLineSegmentsIntersect(double x1, double y1, double x2, double y2, double x3,
                                       double y3, double x4, double y4);

  /// Foot of the perpendicular from a point on a line.
  ///
  /// @param[in]  a,b,c the line
  /// @param[in]  p     the point
  /// @param[out] foot  its foot
  /// @return false when a*a + b*b is below the smallest normal double
  /// @note Error: each coordinate is off by at most 4 eps of |c| / sqrt(a*a + b*b) + |p.x| + |p.y|.
  static bool GetNearestPointOnLine(double a, double b, double c, Point const& p, Point* foot);
  /// @}

  /// @name Inner steps: circle and arc intersections
  /// Results are numbers of points: the first goes to (ax, ay), the second to (bx, by), and outputs
  /// beyond the number are not written. The range of an arc is open: from its start angle to its
  /// end angle in its direction, without the ends and without the angles +-3.1415926535897905 where
  /// a wrapping range is split. A direction > 0 is counter-clockwise, everything else clockwise.
  /// @{

  /// Segment and full circle.
  ///
  /// @param[in]  x1,y1,x2,y2 the segment, end points included
  /// @param[in]  cx,cy,r     the circle
  /// @param[out] ax,ay       first point: of two, the one nearer to (x2, y2)
  /// @param[out] bx,by       second point
  /// @return 0, 1 or 2; a discriminant not above eps counts as one touching point. 0 for a segment
  ///         of zero length.
  /// @note Error: with f the distance of (x1, y1) from the centre and h half the chord that the
  ///       line has in the circle, a point is off by at most 4 eps of (f*f + r*r) / h and of the
  ///       largest coordinates of the start and the centre, measured; the number of points can be
  ///       wrong only by points that are so near to an end. Nearer to a tangent than h*h = 64 eps
  ///       of f*f + r*r, nothing is said.
  static int GetLineSegmentAndCircleIntersection(double x1, double y1, double x2, double y2,
                                                 double cx, double cy, double r, double* ax,
                                                 double* ay, double* bx, double* by);

  /// Line and full circle, through a segment on the line that reaches 2*r to either side of the
  /// foot of the centre.
  ///
  /// @param[in]  a,b,c   the line
  /// @param[in]  cx,cy,r the circle
  /// @param[out] ax,ay   first point: of two, the one with the lesser x (the lesser y when
  ///             |a| > |b|)
  /// @param[out] bx,by   second point
  /// @return 0, 1 (tangent) or 2; 0 when the line is degenerate or farther from the centre than r
  /// @note Error: with h half the chord and g the largest coordinate of the centre plus the
  ///       distance of the origin from the line, a point is off by at most 24 eps of r * (r + g) /
  ///       h + g, measured where h*h is above 64 eps of r * (r + g).
  static int GetLineAndCircleIntersection(double a, double b, double c, double cx, double cy,
                                          double r, double* ax, double* ay, double* bx, double* by);

  /// Segment and arc.
  ///
  /// @param[in]  x1,y1,x2,y2 the segment, end points included
  /// @param[in]  cx,cy,r,d   circle and direction of the arc
  /// @param[in]  startAngle,endAngle polar angles of the arc's ends, open range
  /// @param[out] ax,ay       first point: of two, the one nearer to (x2, y2)
  /// @param[out] bx,by       second point
  /// @return 0, 1 or 2; -1 when the two angles are equal
  /// @note Error: that of the points on the full circle; a point that lies as near to an end of the
  ///       range may be missing or there.
  static int GetLineSegmentAndCircleArcIntersection(double x1, double y1, double x2, double y2,
                                                    double cx, double cy, double r, double d,
                                                    double startAngle, double endAngle, double* ax,
                                                    double* ay, double* bx, double* by);

  /// Arc and arc.
  ///
  /// @param[in]  cx1,cy1,r1,d1 circle and direction of the first arc
  /// @param[in]  startAngle1,endAngle1 polar angles of its ends, open range
  /// @param[in]  cx2,cy2,r2,d2 circle and direction of the second arc
  /// @param[in]  startAngle2,endAngle2 polar angles of its ends, open range
  /// @param[out] ax,ay first point: of two, the one on the left when looking from the centre of the
  ///             bigger circle to that of the smaller (for equal radii, from the first)
  /// @param[out] bx,by second point
  /// @return 0, 1 or 2; -1 when a radius is <= 0. Coincident circles give 0.
  /// @note A half chord not above eps counts as one touching point.
  /// @note Error: with R the larger radius, d the distance of the centres and h half the common
  ///       chord, a point is off by at most 2 eps of R/h * (r1*r1 + r2*r2 + d*d) / d and of the
  ///       largest coordinates of the centres, measured where h*h is above 64 eps of R * (r1*r1 +
  ///       r2*r2 + d*d) / d.
  static int GetCircleArcAndCircleArcIntersection(double cx1, double cy1, double r1, double d1,
                                                  double startAngle1, double endAngle1, double cx2,
                                                  double cy2, double r2, double d2,
                                                  double startAngle2, double endAngle2, double* ax,
                                                  double* ay, double* bx, double* by);

  /// The point of a circle that is nearest to p.
  ///
  /// @param[in]  center,radius the circle
  /// @param[in]  p       the point
  /// @param[out] nearest the projection of p
  /// @return false when p lies nearer to the centre than radius/2
  /// @note Deliberate: the projection is found on the segment from the centre to twice the distance
  ///       of p, hence the limit. It keeps points near the centre, whose direction says nothing,
  ///       out.
  /// @note Error: at most 4 eps of the largest coordinate of the centre plus the radius, measured.
  static bool GetNearestPointOnCircle(Point const& center, double radius, Point const& p,
                                      Point* nearest);
  /// @}

  /// @name Inner steps: contour chains
  /// @{

  /// End point of an element.
  ///
  /// @param[in]  it    the element; must be dereferenceable
  /// @param[out] point its end
  /// @return Failed for an unknown type
  static ErrorCode GetElemPoint(std::vector<Elem>::const_iterator& it, Point2D<double>* point);

  /// Whether an element ends where the one before it ends.
  ///
  /// @param[in]  prev       the element before; must be dereferenceable
  /// @param[in]  elem       the element; must be dereferenceable
  /// @param[out] zeroLength true when the ends differ by no more than a tiny amount in x and in y
  /// @return Failed when one of the two is of an unknown type
  static ErrorCode CheckLength(std::vector<Elem>::const_iterator& prev,
                               std::vector<Elem>::const_iterator& elem, bool* zeroLength);

  /// The next element that does not end where the element at it ends.
  ///
  /// @param[in]  contour the contour
  /// @param[in]  it      where to start; not moved. May be the end.
  /// @param[out] next    the element found
  /// @return Failed when the contour ends first or an unknown type is met. O(n).
  static ErrorCode GetNextIter(std::vector<Elem> const& contour,
                               std::vector<Elem>::const_iterator& it,
                               std::vector<Elem>::const_iterator* next);
  /// @}

  /// @name Inner steps: flat polylines
  /// @{

  /// Sense of a flat polyline, judged at its lowest vertex.
  ///
  /// @param[in] coords  vertex data, laid out as for GetArea
  /// @param[in] indices one entry per run
  /// @return Cw or Ccw by the directions to the two neighbours of the lowest vertex (the first of
  ///         equal ones); OrientationDegenerate when both stand straight above it;
  ///         OrientationUnknown for empty indices or entries that point outside coords
  /// @note Deliberate: whether the lowest vertex is the last one is judged with a stride taken from
  ///       the number of runs, not from the last run. O(number of vertices).
  static PolyOrientation GetPolyOrientation(std::vector<double> const& coords,
                                            std::vector<std::int32_t> const& indices);

  /// Layout of the run that an index entry stands for.
  ///
  /// @param[in]  entry >= 1: kind 0, stride 2; <= 0: kind 1, stride 8
  /// @param[out] param the layout
  /// @return true
  static bool GetPolylineParam(std::int32_t entry, PolylineParam* param);

  /// Stride of the run that an index entry stands for.
  ///
  /// @param[in] entry index entry
  /// @return 2 for an entry >= 1, 8 otherwise
  static std::uint32_t GetIncrement(std::int32_t entry);

  /// Which run holds a coordinate offset.
  ///
  /// @param[in]  indices one entry per run
  /// @param[in]  offset  offset in the coordinates
  /// @param[out] k       number of the first run whose |entry| is above offset (strictly)
  /// @return false when there is none. O(number of runs).
  static bool GetIndicesIndex(std::vector<std::int32_t> const& indices, std::uint32_t offset,
                              std::uint32_t* k);
  /// @}

  /// @name Inner steps: triangles and crossing points
  /// Signs are exact: a triangle is degenerate only when its area is exactly 0.0, a point is on a
  /// side only when the triangle it makes with that side has area exactly 0.0.
  /// @{

  /// Signed area of a triangle.
  ///
  /// @param[in] triangle the triangle
  /// @return positive for vertices that run clockwise in a y-up frame
  /// @note Error: at most 1 eps of the sum of the six products |x*y'|.
  static double GetArea(Triangle const& triangle);

  /// Whether a triangle has an area.
  ///
  /// @param[in] triangle the triangle
  /// @return true unless its area is exactly 0.0
  static bool IsValidTriangle(Triangle const& triangle);

  /// An inner point of a triangle that stays well conditioned for slim ones.
  ///
  /// @param[in]  triangle the triangle
  /// @param[out] center   the centroid, as the crossing of the medians from the two longer sides;
  ///             the middle between the midpoints of these sides when the shortest side has a tiny
  ///             squared length or the medians do not meet
  /// @return true
  static bool CalcCenter(Triangle const& triangle, Point* center);

  /// Where a point lies with respect to a triangle of either orientation.
  ///
  /// @param[in] p the point
  /// @param[in] triangle the triangle
  /// @return see PointStatus
  static PointStatus GetPointStatus(Point const& p, Triangle const& triangle);

  /// Crossings of the sides of two triangles as plain points.
  ///
  /// @param[in]     first     triangle whose sides are followed
  /// @param[in]     startSide side of first to begin with, 0..2
  /// @param[in]     second    the other triangle
  /// @param[in,out] points    crossings are appended: side by side of first, two on one side by
  ///                distance from its start. Overlaps along a common line are not crossings here.
  /// @return true
  static bool GetCrossingPoints(Triangle const& first, int startSide, Triangle const& second,
                                std::vector<Point>* points);

  /// Crossings of the sides of two triangles with the sides they lie on.
  ///
  /// @param[in]     first  triangle whose sides are followed, 0 to 2
  /// @param[in]     second the other triangle
  /// @param[in,out] points crossings are appended: at most two per side of first, the nearer to its
  ///                start first. Where sides overlap on a common line, the two ends of the common
  ///                stretch are taken.
  /// @note Deliberate: of three or more candidates on a side the two farthest apart survive, and
  ///       the side number is then rewritten as side1 of the one and side2 of the other. A single
  ///       crossing waiting for its partner is dropped when an overlap turns up on the same side.
  static void GetCrossingPoints(Triangle const& first, Triangle const& second,
                                std::vector<CrossingPoint>* points);
  /// @}

  /// @name Inner steps: convex overlap and polygon division
  /// @{

  /// Common part of two triangles.
  ///
  /// @param[in]     first,second the triangles
  /// @param[in,out] result triangles of the common part are appended
  /// @return Overlap, also when the common polygon divides into degenerate triangles; NoOverlap
  ///         when there is no common polygon; OverlapFailed when a vertex has no defined status,
  ///         the containment is inconsistent or the polygon cannot be divided
  /// @note Deliberate: a triangle that lies inside the other is appended three times. O(1).
  /// @note Error: in general position - both triangles turn the same way, no vertex of one is on
  ///       the line of a side of the other, no sides are parallel, each by more than 16 eps of the
  ///       squared coordinates - twice the area of the common part is off by at most 8 eps of the
  ///       square of the largest coordinate, measured. Elsewhere parts may be missing: of triangles
  ///       that turn opposite ways, or where a vertex is on a side; and where parallel sides have
  ///       equal line constants, points outside both may come in (see GetLineSegmentsIntersection).
  static OverlappingStatus GetOverlapping(Triangle const& first, Triangle const& second,
                                          std::vector<Triangle>* result);

  /// Common part of a triangle and a cell. To overlap two cells, call it once per triangle of one
  /// of them.
  ///
  /// @param[in]     first  the triangle
  /// @param[in]     cell   the cell; its triangles are taken in order. Must not be result.
  /// @param[in,out] result triangles of all common parts are appended
  /// @return Overlap when at least one pair overlaps, NoOverlap otherwise, also for an empty cell
  /// @note Deliberate: a pair that cannot be resolved counts as one without overlap. O(size of
  ///       cell).
  static OverlappingStatus GetOverlapping(Triangle const& first, std::vector<Triangle> const* cell,
                                          std::vector<Triangle>* result);

  /// Divides a polygon into triangles by cutting ears; a convex one becomes the fan around its
  /// first vertex.
  ///
  /// @param[in]     polygon   vertices in boundary order
  /// @param[in]     first     first vertex of the range; looked at only for count = 3, larger
  ///                ranges start at vertex 0
  /// @param[in]     count     number of vertices
  /// @param[in,out] triangles triangles are appended, count - 2 of them for a convex polygon
  /// @return false for count < 3 or a range that leaves the polygon, nothing appended, and when no
  ///         ear is found (triangles cut before stay)
  /// @note The area of the triangles is not looked at: a degenerate polygon passes as it is. O(n^2)
  ///       for a convex polygon.
  static bool ConvexPolygonDivide(std::vector<Point> const& polygon, int first, int count,
                                  std::vector<Triangle>* triangles);

  /// Whether a run of consecutive vertices encloses none of the other vertices, so that it can be
  /// cut off.
  ///
  /// @param[in] polygon vertices in boundary order
  /// @param[in] start   first vertex of the run
  /// @param[in] count   number of live vertices of the polygon
  /// @param[in] size    number of vertices of the run
  /// @return false for size > count or size < 3; true for size = count
  /// @note Deliberate: start and size are handed on as begin and end of the tested range, and a run
  ///       that wraps skips one vertex. Both are exact for start = 0, the only case a convex
  ///       polygon reaches. O(count * size).
  static bool SimplePolygonIsValid(std::vector<Point> const& polygon, int start, int count,
                                   int size);

  /// Even-odd test of a point against the closed polygon of vertices begin to end - 1.
  ///
  /// @param[in] p       the point
  /// @param[in] polygon vertices
  /// @param[in] begin   first vertex
  /// @param[in] end     one past the last vertex
  /// @return true when p is inside; false for begin >= end. A point on the boundary falls on one
  ///         side or the other depending on the edge. O(end - begin).
  static bool PointIsInsideOfPolygon(Point const& p, std::vector<Point> const& polygon, int begin,
                                     int end);
  /// @}

  /// @name Inner steps: line tolerance cells
  /// @{

  /// GetPermissibleRect for two points of the same tolerance.
  ///
  /// @param[in]  x1,y1 first point
  /// @param[in]  x2,y2 second point
  /// @param[in]  r     common tolerance
  /// @param[out] rect  eight doubles as in the public form, P0 and P1 at the second point
  /// @return false, rect untouched, when the circles overlap (4*r*r above the squared distance)
  /// @note Equals the public form up to the last bits; it divides by the larger of the two
  ///       coordinate differences. For a tiny r*r the result is the points (1, 1, 2, 2).
  static bool GetPermissibleRect(double x1, double y1, double x2, double y2, double r,
                                 double* rect);

  /// Whether lines can be written with denominators of one sign: all positive
  /// or all negative.
  ///
  /// @param[in] den denominators of n lines
  /// @param[in] num numerators of n lines
  /// @param[in] n   number of lines; fewer than 4 answer false
  /// @return false when a denominator is tiny in magnitude; otherwise whether the angles
  ///         atan2(num, den) of the lines 0 and 3 lie on the same side of a right angle
  /// @note Deliberate: only the lines 0 and 3 are compared, the outermost of a cell's bunch.
  static bool IsValidBunch(double const* den, double const* num, int n);

  /// The line tolerance cell of two measured points as triangles.
  ///
  /// @param[in]     a,b       the points with their tolerances
  /// @param[in,out] formFixed see GetLinePolygon
  /// @param[in,out] xOfY      see GetLinePolygon
  /// @param[out]    cell      replaced by the two triangles of the cell
  /// @return the code of GetLinePolygon; Failed when the quadrilateral cannot be divided
  static ErrorCode GetLineTriangles(WPoint a, WPoint b, bool* formFixed, bool* xOfY,
                                    std::vector<Triangle>* cell);

  /// The line tolerance cell of two points of the same tolerance as triangles. No other operation
  /// uses it.
  ///
  /// @param[in]     x1,y1     first point
  /// @param[in]     x2,y2     second point
  /// @param[in]     r         common tolerance
  /// @param[in,out] formFixed see GetLinePolygon
  /// @param[in,out] xOfY      see GetLinePolygon
  /// @param[out]    cell      replaced by the two triangles of the cell
  /// @return Ok; Failed when the circles overlap or the quadrilateral cannot be divided;
  ///         InvalidLineCell as in GetLinePolygon
  static ErrorCode GetLineTriangles(double x1, double y1, double x2, double y2, double r,
                                    bool* formFixed, bool* xOfY, std::vector<Triangle>* cell);

  /// Whether the circle through three points is bigger than the common tolerance.
  ///
  /// @param[in]  a,b,c the points
  /// @param[in]  r     common tolerance
  /// @param[out] out   never written; may be null
  /// @return true when the circle exists and its radius is above r (strictly)
  static bool GetPermissibleHexagon(Point const& a, Point const& b, Point const& c, double r,
                                    double* out);
  /// @}

  /// @name Inner steps: circle tolerance cells
  /// @{

  /// The circle tolerance cell of three measured points as triangles.
  ///
  /// @param[in]     first,middle,last see GetCirclePolygon
  /// @param[in]     firstFixed        see GetCirclePolygon
  /// @param[in]     lastFixed         see GetCirclePolygon
  /// @param[in]     orientation       see GetCirclePolygon
  /// @param[in,out] triangles         the triangles of the cell are appended
  /// @return the code of GetCirclePolygon; Failed when the polygon cannot be divided
  static ErrorCode GetCircleTriangles(WPoint first, WPoint middle, WPoint last, bool firstFixed,
                                      bool lastFixed, int orientation,
                                      std::vector<Triangle>* triangles);
  /// @}

  /// @name Inner steps: cell centres and bounds
  /// The bounding circle of a cell stands around the middle of its bounding rectangle, with half
  /// the diagonal as radius.
  /// @{

  /// Bounding rectangle of a cell.
  ///
  /// @param[in]  cell the cell
  /// @param[out] rect four doubles: least x, least y, greatest x, greatest y
  /// @return false for an empty cell. O(size of cell).
  static bool GetBoundingRect(std::vector<Triangle> const* cell, double* rect);

  /// The chord that a line cuts from the bounding circle of a cell, as a degenerate triangle.
  ///
  /// @param[in]  cell  the cell
  /// @param[in]  a,b,c the line
  /// @param[out] chord (P, Q, Q), or (P, P, P) for a tangent
  /// @return false for an empty cell or a line that misses the circle
  static bool GetBoundingCircleAndLineIntersectionTriangle(std::vector<Triangle> const* cell,
                                                           double a, double b, double c,
                                                           Triangle* chord);

  /// Area-weighted centre of a cell.
  ///
  /// @param[in]  cell   the cell
  /// @param[out] center the mean of the triangle centres weighted by area. Triangles of tiny area
  ///             are left out as soon as the areas of the others add up to something; when there
  ///             are only such, the plain mean of their centres.
  /// @return false for an empty cell. O(size of cell).
  static bool GetCenter(std::vector<Triangle> const* cell, Point* center);

  /// A centre of the cell that is equally far from two points. No other operation uses it.
  ///
  /// @param[in]  p1,p2  the points
  /// @param[in]  cell   cell in the plane of centres
  /// @param[out] center centre of the part of the cell on the perpendicular bisector
  /// @return false for equal points, an empty cell, or a bisector that misses the cell
  static bool GetCenterForCircle(Point const& p1, Point const& p2,
                                 std::vector<Triangle> const* cell, Point* center);

  /// A point of a line cell whose line passes through the given points.
  ///
  /// @param[in]  hasP1   p1 is given
  /// @param[in]  p1      first point to pass through
  /// @param[in]  hasP2   p2 is given
  /// @param[in]  p2      second point to pass through
  /// @param[in]  swapped true for the form x as a function of y
  /// @param[in]  cell    cell in the plane of line parameters
  /// @param[out] center  (u, v) for the line v*x + y + u = 0 (swapped: v*y + x + u = 0). Without
  ///             points the centre of the cell; with one point the centre of the part of the cell
  ///             whose lines pass through it; with two points their line
  /// @return false for an empty cell, or when no line of the cell passes through the points
  static bool GetCenterForLine(bool hasP1, Point const& p1, bool hasP2, Point const& p2,
                               bool swapped, std::vector<Triangle> const* cell, Point* center);
  /// @}

  /// @name Inner steps: line fitting
  /// @{

  /// The longest run of measured points, from a given one, that one segment passes within
  /// tolerance.
  ///
  /// The run grows point by point while the line cells of its consecutive pairs have a common part
  /// and the points keep moving away from the first. The segment is the line at the centre of that
  /// part, cut at the run's ends; it is then measured against every point, and the run is shortened
  /// when a point lies outside its tolerance.
  ///
  /// @param[in]     points     all measured points
  /// @param[in]     start      index of the first point of the run
  /// @param[in]     count      most points the run may take, >= 2
  /// @param[in]     startFixed the segment begins exactly at *startPoint
  /// @param[in,out] startPoint in: the fixed start, if any; out: start of the segment
  /// @param[in]     endFixed   the segment ends exactly at *endPoint
  /// @param[in,out] endPoint   in: the fixed end, if any; out: end of the segment
  /// @param[in]     lastAttempt no further attempt follows: shorten until within tolerance (or two
  ///                points). Otherwise a full run out of tolerance is returned as it is, with
  ///                indexList filled for the next attempt.
  /// @param[out]    lineCount  number of points covered
  /// @param[out]    lineDeviation largest relative deviation of the covered points; above 1.0 for a
  ///                full run out of tolerance, and possible for a run of two points
  /// @param[out]    lineDeviationIndex index in points of the point with that deviation; -1 if none
  /// @param[in,out] indexList  in: points where earlier attempts deviated most, heeded when an
  ///                oversized cell is rebuilt; out: emptied when the run is within tolerance or has
  ///                two points, otherwise the points of least and greatest signed deviation are
  ///                appended
  /// @param[out]    lineCode   Ok, or SelfIntersection when the run ended because the points turn
  ///                back; set once the arguments are valid
  /// @param[in]     progress   told after every accepted point
  /// @return Failed when count < 2, start < 0 or the run leaves the points (nothing is written), or
  ///         when a deviation cannot be computed; Ok otherwise, the quality being told by the
  ///         outputs
  /// @note Deliberate: a run of two points is not tested against the tolerances. Above 78125
  ///       triangles the cell is rebuilt from the points that deviate most. Each restart costs one
  ///       pass; a pass over m points takes m overlaps of a pair cell with the running cell.
  static ErrorCode GetFittingLine(std::vector<WPoint> const& points, std::int32_t start,
                                  std::int32_t count, bool startFixed, Point* startPoint,
                                  bool endFixed, Point* endPoint, bool lastAttempt,
                                  std::int32_t* lineCount, double* lineDeviation,
                                  std::int32_t* lineDeviationIndex,
                                  std::vector<std::int32_t>* indexList, ErrorCode* lineCode,
                                  ProgressBase const& progress);

  /// Largest relative deviation of a run from the line through two points.
  ///
  /// @param[in]  points all measured points
  /// @param[in]  start  index of the first point of the run
  /// @param[in]  count  number of points of the run
  /// @param[in]  a,b    two points of the line
  /// @param[out] index  index in points of the first point with the largest value; -1 with a result
  ///             of 0.0 for a bad run or a line through equal points. Always written.
  /// @return the largest distance / tolerance; a not-a-number of the first point stays. O(count).
  static double GetMaxDeviationFromLine(std::vector<WPoint> const& points, std::int32_t start,
                                        std::int32_t count, Point const& a, Point const& b,
                                        std::int32_t* index);

  /// Least and greatest signed distance of a run from the line through two points.
  ///
  /// @param[in]  a,b          two points of the line
  /// @param[in]  points       all measured points
  /// @param[in]  start        index of the first point of the run
  /// @param[in]  count        number of points of the run
  /// @param[out] minDeviation least signed distance, as GetSignedDeviation
  /// @param[out] maxDeviation greatest signed distance
  /// @param[out] minIndex     index in points of the first point with the least
  /// @param[out] maxIndex     index in points of the first point with the greatest
  /// @return false for equal a and b or a run that leaves the points. O(count).
  static bool GetDeviationFromLineParameters(Point const& a, Point const& b,
                                             std::vector<WPoint> const& points, std::int32_t start,
                                             std::int32_t count, double* minDeviation,
                                             double* maxDeviation, std::int32_t* minIndex,
                                             std::int32_t* maxIndex);

  /// Where a run deviates most from the line through two points, to either side.
  ///
  /// @param[in]     a,b     two points of the line
  /// @param[in]     points  all measured points
  /// @param[in]     start   index of the first point of the run
  /// @param[in]     count   number of points of the run
  /// @param[in,out] indices the two indices of the form above are appended in ascending order, or
  ///                one when they are equal
  /// @return false, nothing appended, as the form above
  static bool GetDeviationFromLineParameters(Point const& a, Point const& b,
                                             std::vector<WPoint> const& points, std::int32_t start,
                                             std::int32_t count,
                                             std::vector<std::int32_t>* indices);

  /// The segment at the centre of a line cell.
  ///
  /// @param[in]  cell       cell in the plane of line parameters
  /// @param[in]  x1,y1      point whose foot is the start, unless the start is fixed
  /// @param[in]  x2,y2      point whose foot is the end, unless the end is fixed
  /// @param[in]  xOfY       form of the cell
  /// @param[in]  startFixed the line passes through startPoint and the segment begins there
  /// @param[in]  startPoint the fixed start
  /// @param[in]  endFixed   the line passes through endPoint and the segment ends there
  /// @param[in]  endPoint   the fixed end
  /// @param[out] sx,sy      start of the segment
  /// @param[out] ex,ey      end of the segment
  /// @return false when the cell has no such line or a foot cannot be found
  static bool GetOptimalLineSegment(std::vector<Triangle> const* cell, double x1, double y1,
                                    double x2, double y2, bool xOfY, bool startFixed,
                                    Point startPoint, bool endFixed, Point endPoint, double* sx,
                                    double* sy, double* ex, double* ey);

  /// Whether points keep moving away from the first: last is strictly farther from it than middle,
  /// and the angle at middle is obtuse.
  ///
  /// @param[in] first  first point of a run
  /// @param[in] middle a later point
  /// @param[in] last   the point after that
  /// @return true when the order holds; decided on squared distances
  static bool IsValidLineOrder(Point const& first, Point const& middle, Point const& last);

  /// Refits a run as a line over its ends and the two points farthest from their chord. No other
  /// operation uses it.
  ///
  /// @param[in]  points    all measured points
  /// @param[in]  start     index of the first point of the run
  /// @param[in]  count     number of points of the run, >= 4
  /// @param[in]  tolerance not used
  /// @param[out] cell      emptied, and deliberately left so, once the extreme points are found
  /// @return true when the line fitter answers Ok over the short run; false for a run that is too
  ///         short or leaves the points, or when its ends coincide
  static bool ReduceOverlappedTrianglesQuantityForStraightLine(std::vector<WPoint> const& points,
                                                               int start, int count,
                                                               double tolerance,
                                                               std::vector<Triangle>* cell);

  /// Tells the caller's sink how far a fit has come.
  ///
  /// @param[in] progress sink, final percentage and number of points; with a null sink or fewer
  ///            than one point nothing happens
  /// @param[in] current  number of points done. The percentage is maxPercent minus
  ///            (total - current) * 100 / total (truncated towards zero) while points are open; 0
  ///            is replaced by 1.
  static void SetProgressState(ProgressBase const& progress, std::int32_t current);
  /// @}

  /// @name Inner steps: arc fitting over cells
  /// @{

  /// One arc over a run of fixed length.
  ///
  /// Triples of the samples, spread over the run, each give a cell of admissible centres; the arc's
  /// centre is the centre of their common part, its radius the middle of the range that the points'
  /// tolerances leave (or the distance to a fixed end).
  ///
  /// @param[in]     points     all measured points
  /// @param[in]     first      index of the first point of the run
  /// @param[in]     count      number of points of the run, >= 3
  /// @param[in]     startFixed the arc begins exactly at *start
  /// @param[in,out] start      in: the fixed start, if any; out: start of the arc
  /// @param[in]     endFixed   the arc ends exactly at *end
  /// @param[in,out] end        in: the fixed end, if any; out: end of the arc
  /// @param[in,out] indexedPoints the samples. Empty on entry: one per point of the run. Otherwise
  ///                the samples of a shorter try from the same first point; the ends of the run are
  ///                put in place of the first one and behind the last one. On return the list used,
  ///                also on failures after the sense was found.
  /// @param[in,out] cells      scratch; what it holds on entry does not matter. On return the
  ///                common part of the centre cells, also on failures after the sense was found.
  ///                May be null: then the cell, which may hold thousands of triangles, is not
  ///                handed out.
  /// @param[out]    arcCount   count
  /// @param[out]    centre     centre of the arc
  /// @param[out]    radius     radius of the arc
  /// @param[out]    ccw        true when the arc runs counter-clockwise
  /// @param[out]    deviation  largest relative deviation of the run's points from the circle
  /// @param[out]    deviationIndex index in points of the first point with that deviation; set to
  ///                -1 on entry
  /// @return Failed for a bad run, first, middle and last point exactly collinear, or an end that
  ///         cannot be moved onto the circle; NoFit when the cells have no common part or the
  ///         radius leaves its range; otherwise the code of the first triple that has no cell
  ///         (OrientationMismatch for nearly straight points)
  /// @note Above 19531 triangles the samples are thinned by ReduceCircleArcPoints and the cell is
  ///       built again; the deviation is measured over all points of the run in any case. O(count)
  ///       overlaps of a triple cell with the running cell.
  static ErrorCode GetFittingCircleO(std::vector<WPoint> const& points, std::int32_t first,
                                     std::int32_t count, bool startFixed, Point* start,
                                     bool endFixed, Point* end,
                                     std::vector<IndexedPoint>* indexedPoints,
                                     std::vector<Triangle>* cells, std::int32_t* arcCount,
                                     Point* centre, double* radius, bool* ccw, double* deviation,
                                     std::int32_t* deviationIndex);

  /// The longest run of measured points, from a given one, that one arc can follow: tried from the
  /// shortest length upwards.
  ///
  /// Nearly straight beginnings are stepped over; the search ends at the first other failure, at a
  /// point out of the arc's order or at a change of its sense, and the last success stands.
  ///
  /// @param[in]     points     all measured points
  /// @param[in]     first      index of the first point of the run
  /// @param[in]     maxCount   most points the run may take
  /// @param[in]     minCount   fewest points the run may have
  /// @param[in]     startFixed the arc begins exactly at *start
  /// @param[in,out] start      in: the fixed start, if any; out: start of the arc
  /// @param[in]     endFixed   the arc ends exactly at *end if it reaches the last measured point
  /// @param[in,out] end        in: the fixed end, if any; out: end of the arc
  /// @param[in,out] cells      may be null; emptied first; on return the centre cell of the run
  /// @param[out]    arcCount   number of points covered
  /// @param[out]    centre     centre of the arc
  /// @param[out]    radius     radius of the arc
  /// @param[out]    ccw        true when the arc runs counter-clockwise
  /// @param[out]    deviation  largest relative deviation of the covered points
  /// @param[out]    deviationIndex index in points of the point with that deviation
  /// @param[in]     progress   told after every successful length
  /// @return Ok when some length succeeded; Failed for minCount > maxCount; otherwise the code that
  ///         ended the search, SelfIntersection for points that turn back, leave the order or take
  ///         a step of a right angle or more
  /// @note On failure the outputs may hold values of a try that was given up. O(m^2) triples for a
  ///       run of m points.
  static ErrorCode GetFittingCircle2(std::vector<WPoint> const& points, std::int32_t first,
                                     std::int32_t maxCount, std::int32_t minCount, bool startFixed,
                                     Point* start, bool endFixed, Point* end,
                                     std::vector<Triangle>* cells, std::int32_t* arcCount,
                                     Point* centre, double* radius, bool* ccw, double* deviation,
                                     std::int32_t* deviationIndex, ProgressBase const& progress);

  /// The longest run that one arc can follow, tried from the longest length downwards. No other
  /// operation uses it.
  ///
  /// @param[in]     points     all measured points
  /// @param[in]     first      index of the first point of the run
  /// @param[in]     maxCount   most points the run may take
  /// @param[in]     minCount   fewest points the run may have
  /// @param[in]     startFixed the arc begins exactly at *start
  /// @param[in,out] start      in: the fixed start, if any; out: start of the arc
  /// @param[in]     endFixed   the arc ends exactly at *end; heeded for the full length only
  /// @param[in,out] end        in: the fixed end, if any; out: end of the arc
  /// @param[out]    arcCount   number of points covered
  /// @param[out]    centre     centre of the arc
  /// @param[out]    radius     radius of the arc
  /// @param[out]    ccw        true when the arc runs counter-clockwise
  /// @param[out]    deviation  largest relative deviation of the covered points
  /// @param[out]    deviationIndex index in points of the point with that deviation
  /// @return NoFit when no length succeeds, minCount > maxCount included
  /// @note On failure start and the deviation index may have been written by a try. O(m^2) triples.
  static ErrorCode GetFittingCircle1(std::vector<WPoint> const& points, std::int32_t first,
                                     std::int32_t maxCount, std::int32_t minCount, bool startFixed,
                                     Point* start, bool endFixed, Point* end,
                                     std::int32_t* arcCount, Point* centre, double* radius,
                                     bool* ccw, double* deviation, std::int32_t* deviationIndex);

  /// Whether a further point continues an arc: in order as by the form with five arguments, and no
  /// step of a right angle or more.
  ///
  /// @param[in] centre       centre of the arc
  /// @param[in] ccw          direction of the arc, true for counter-clockwise
  /// @param[in] p1           start of the arc
  /// @param[in] p2           the point before
  /// @param[in] p3           the further point
  /// @param[in] skipFirstGap the step from p1 to p2 is not tested
  /// @return true when p3 continues the arc
  static bool IsValidArcOrder(Point const& centre, bool ccw, Point const& p1, Point const& p2,
                              Point const& p3, bool skipFirstGap);
  /// @}

  /// @name Inner steps: arc point reduction
  /// @{

  /// Thins the samples of an arc candidate: of those used by the triples only the ends, the nearest
  /// to and the farthest from the centre stay, and the measured point in the angular middle of the
  /// arc comes in.
  ///
  /// @param[in,out] samples    the samples in order; replaced by the thinned list on success
  /// @param[in,out] cell       the centre cell; read, and emptied on success
  /// @param[in]     steps      number of triple steps made so far, below the number of samples
  /// @param[in]     firstFixed the arc begins at *first
  /// @param[in]     first      the fixed start; not written
  /// @param[in]     lastFixed  the arc ends at *last
  /// @param[in]     last       the fixed end; not written
  /// @param[in]     wpoints    all measured points
  /// @param[in]     begin      index of the first point of the run
  /// @param[in]     count      number of points of the run
  /// @param[in]     ccw        direction of the arc, true for counter-clockwise
  /// @return Failed, samples and cell untouched, for a bad run, an empty cell, fewer than five
  ///         samples in use, coinciding ends, or a circle without a defined middle; Ok otherwise
  /// @note Deliberate: the records of the nearest and the farthest sample carry index 0 and the
  ///       tolerance entered last; a sample of the middle point that no triple used is kept besides
  ///       the inserted one, so that point may occur twice. O(samples + count).
  static ErrorCode ReduceCircleArcPoints(std::vector<IndexedPoint>* samples,
                                         std::vector<Triangle>* cell, int steps, bool firstFixed,
                                         Point* first, bool lastFixed, Point* last,
                                         std::vector<WPoint> const& wpoints, std::int32_t begin,
                                         std::int32_t count, bool ccw);

  /// The three sample positions of a triple.
  ///
  /// @param[in]  step     number of the step, from 1
  /// @param[in]  size     number of samples
  /// @param[in]  mirror   1 reflects the triple end for end
  /// @param[out] i0,i1,i2 positions in ascending order: (step, (step - 1 + size) / 2, size - 1)
  ///             while step < size / 3, then (0, step, size - 1). Stays inside the list while
  ///             step < size.
  static void GetTriPointIndices(int step, int size, int mirror, int* i0, int* i1, int* i2);

  /// Coordinates of a triple, fixed ends put in place of the samples they stand for.
  ///
  /// @param[in]  samples    the samples
  /// @param[in]  i0,i1,i2   positions of the triple
  /// @param[in]  firstFixed first replaces sample 0
  /// @param[in]  first      the fixed start
  /// @param[in]  lastFixed  last replaces the last sample
  /// @param[in]  last       the fixed end
  /// @param[out] usedFirst  true when first was put in place
  /// @param[out] usedLast   true when last was put in place
  /// @param[out] coords     six doubles, x and y of each point
  static void TriPointsCoordsToArray(std::vector<IndexedPoint> const* samples, int i0, int i1,
                                     int i2, bool firstFixed, Point const& first, bool lastFixed,
                                     Point const& last, bool* usedFirst, bool* usedLast,
                                     double* const coords);

  /// Whether p2 lies on the arc from p1 to p3 around a centre, by angle, ends included.
  ///
  /// @param[in] center centre of the arc
  /// @param[in] ccw    direction of the arc, true for counter-clockwise
  /// @param[in] p1     start of the arc
  /// @param[in] p2     the point asked for
  /// @param[in] p3     end of the arc
  /// @return true when it does; the seam of atan2 is taken into account
  static bool IsValidArcOrder(Point const& center, bool ccw, Point const& p1, Point const& p2,
                              Point const& p3);
  /// @}

  /// @name Inner steps: circle estimation and radius choice
  /// @{

  /// A first circle: through the farthest pair of points and the point nearest to their
  /// perpendicular bisector.
  ///
  /// @param[in]  points     measured points, at least 3; tolerances are not used
  /// @param[out] first,last the farthest pair, in index order (the first pair of equal ones)
  /// @param[out] middle     the point whose distances from the two differ least
  /// @param[out] center     centre of the circle through the three
  /// @param[out] radius     its radius
  /// @param[out] minSpacing least distance of any two points
  /// @return false for fewer than 3 points or when the circle does not exist. O(n^2).
  static bool GetEstimatedCircle(std::vector<WPoint> const& points, Point* first, Point* middle,
                                 Point* last, Point* center, double* radius, double* minSpacing);

  /// How much deviation to allow for an estimated circle: the sagitta of its shorter half chord, at
  /// most a quarter of the radius.
  ///
  /// @param[in]  first,middle,last points of the circle
  /// @param[in]  radius    its radius
  /// @param[out] deviation min(radius / 4, least squared half chord / (4 * radius))
  /// @return true
  static bool GetEstimatedMaxDeviationForCircle(Point const& first, Point const& middle,
                                                Point const& last, double radius,
                                                double* deviation);

  /// A common tolerance for fitting one circle, and the points that lie too close together for it.
  ///
  /// @param[in]  points    measured points, at least 3; their tolerances are not used
  /// @param[out] tolerance common tolerance (the allowance of the estimated circle)
  /// @param[out] excluded  emptied and filled with the indices to leave out, ascending, such that
  ///             kept neighbours are at least three tolerances apart. Emptied on failure too, once
  ///             the estimate exists.
  /// @param[out] center    centre of the estimated circle
  /// @param[out] radius    radius of the estimated circle
  /// @return false for fewer than 3 points, coinciding points anywhere, no circle, or fewer than 3
  ///         points left. O(n^2).
  static bool GetEstimatedDeviationForCircle(std::vector<WPoint> const& points, double* tolerance,
                                             std::vector<std::int32_t>* excluded, Point* center,
                                             double* radius);

  /// The radii at which a circle around a given centre passes within tolerance of a run.
  ///
  /// @param[in]  points    all measured points
  /// @param[in]  first     index of the first point of the run
  /// @param[in]  count     number of points of the run
  /// @param[in]  cx,cy     centre
  /// @param[in]  tolerance common tolerance; negative: each point's own
  /// @param[out] minRadius least radius
  /// @param[out] maxRadius greatest radius
  /// @return false when no radius satisfies all points or the run leaves the points. For count <= 0
  ///         true with nothing written. O(count).
  static bool GetRadiusRange(std::vector<WPoint> const& points, std::int32_t first,
                             std::int32_t count, double cx, double cy, double tolerance,
                             double* minRadius, double* maxRadius);

  /// One radius for a given centre.
  ///
  /// @param[in]  points    all measured points
  /// @param[in]  first     index of the first point of the run
  /// @param[in]  count     number of points of the run, >= 1
  /// @param[in]  cx,cy     centre
  /// @param[in]  tolerance common tolerance; negative: each point's own, which then also weighs the
  ///             mean
  /// @param[in]  strategy  middle of the range or mean distance
  /// @param[out] radius    the radius
  /// @return false for a bad run, an empty radius range, an unknown strategy or a tiny sum of
  ///       weights
  /// @note With MeanDistance the range must exist but the mean is not held inside it. O(count).
  static bool CalcOptimalRadius(std::vector<WPoint> const& points, std::int32_t first,
                                std::int32_t count, double cx, double cy, double tolerance,
                                CircleRadiusFindingStrategy strategy, double* radius);

  /// Deviations of a run from a trial circle, weighted by the tolerances.
  ///
  /// @param[in]     points all measured points
  /// @param[in]     first  index of the first point of the run
  /// @param[in]     count  number of points of the run, >= 1
  /// @param[in]     center trial centre
  /// @param[in]     radius trial radius
  /// @param[in,out] curve  one sample per point is appended; then the weights of all its samples,
  ///                earlier ones included, are divided by the mean tolerance of the run
  /// @return false for a bad run, nothing appended, or a tiny sum of tolerances, the samples then
  ///         staying with unscaled weights. O(size of curve).
  static bool CalcDeviationCurve(std::vector<WPoint> const& points, std::int32_t first,
                                 std::int32_t count, Point const& center, double radius,
                                 std::vector<WPoint2>* curve);

  /// The shift of the centre that best explains the radial deviations, by weighted linear least
  /// squares for a radius change and two shifts.
  ///
  /// @param[in]  curve samples of a deviation curve, at least 3
  /// @param[out] shift to be added to the centre
  /// @return false for fewer than 3 samples, a sample at the centre or a singular system
  /// @note Deliberate: the shift is taken through polar form with the truncated right angle, which
  ///       turns it by a few units in the last place. O(size of curve).
  static bool CalcCorrectionShiftForCircle(std::vector<WPoint2> const& curve, Point* shift);

  /// Largest absolute distance of a run from a circle.
  ///
  /// @param[in]  points all measured points
  /// @param[in]  first  index of the first point of the run
  /// @param[in]  count  number of points of the run
  /// @param[in]  center centre
  /// @param[in]  radius radius
  /// @param[out] index  position within the run (0 for the point at first) of the first point with
  ///             that distance; -1 for an empty run. Always written.
  /// @return the distance; -1.0 for an empty run. O(count).
  static double GetMaxObtainedDeviation(std::vector<WPoint> const& points, std::int32_t first,
                                        std::int32_t count, Point const& center, double radius,
                                        std::int32_t* index);

  /// Least and greatest signed distance of a run from a circle; positive inside.
  ///
  /// @param[in]  points    all measured points
  /// @param[in]  first     index of the first point of the run
  /// @param[in]  count     number of points of the run
  /// @param[in]  center    centre
  /// @param[in]  radius    radius
  /// @param[out] minSigned least radius - distance; -1.0 for an empty run
  /// @param[out] maxSigned greatest radius - distance; -1.0 for an empty run
  /// @return true. O(count).
  static bool GetMaxObtainedDeviation(std::vector<WPoint> const& points, std::int32_t first,
                                      std::int32_t count, Point const& center, double radius,
                                      double* minSigned, double* maxSigned);
  /// @}

  /// @name Inner steps: circle fit by mean circumcentre
  /// @{

  /// Fits a circle to the longest leading stretch of a run, around the mean of the circumcentres of
  /// its consecutive triples. An alternative to the fit over cells; no other operation uses it.
  ///
  /// @param[in]     wpoints    all measured points; the run must lie within
  /// @param[in]     begin      index of the first point of the run
  /// @param[in]     count      number of points of the run, >= 3
  /// @param[in]     firstFixed the circle passes through *first
  /// @param[in,out] first      in: the fixed start, if any; out: start of the arc
  /// @param[in]     lastFixed  the circle of the full run passes through *last
  /// @param[in,out] last       in: the fixed end, if any; out: end of the arc
  /// @param[out]    fitCount   number of points covered
  /// @param[out]    center     centre
  /// @param[out]    radius     radius
  /// @param[out]    ccw        true when the stretch runs counter-clockwise
  /// @param[in]     extra      neither read nor written; may be null
  /// @return Ok when the stretch ended at a point out of tolerance or at the end of the run; Failed
  ///         for fewer than 3 points, a first stretch out of tolerance, a singular triple or an end
  ///         that cannot be snapped; OutOfMemory when a work array could not be allocated
  /// @note Deliberate: outputs are written for every accepted length. After a Failed at a later
  ///       length they hold the fit of the length before. O(count^2).
  static ErrorCode GetFittingCircle(std::vector<WPoint> const& wpoints, std::int32_t begin,
                                    std::int32_t count, bool firstFixed, Point* first,
                                    bool lastFixed, Point* last, std::int32_t* fitCount,
                                    Point* center, double* radius, bool* ccw, double* extra);

  /// The radii at which a circle around a given centre passes within tolerance of a run whose ends
  /// may be fixed.
  ///
  /// @param[in]  wpoints    all measured points; the run must lie within
  /// @param[in]  begin      index of the first point of the run
  /// @param[in]  count      number of points of the run
  /// @param[in]  cx,cy      centre
  /// @param[in]  tolerance  common tolerance; negative: each point's own
  /// @param[in]  firstFixed *first replaces the first point, with that point's tolerance
  /// @param[in]  first      the fixed start; may be null when there is none
  /// @param[in]  lastFixed  *last replaces the last point, with that point's tolerance
  /// @param[in]  last       the fixed end; may be null when there is none
  /// @param[out] failIndex  position within the run of the point that failed; count on success.
  ///             Written as the walk goes.
  /// @param[out] rmin,rmax  the range, both the distance of the last fixed end when there is one.
  ///             Written as the walk goes: on failure the range reached before.
  /// @return false when a tolerance reaches the centre, no radius satisfies all points, or the
  ///         fixed end is outside the range. O(count).
  static bool GetRadiusRange(std::vector<WPoint> const& wpoints, std::int32_t begin,
                             std::int32_t count, double cx, double cy, double tolerance,
                             bool firstFixed, Point const* first, bool lastFixed, Point const* last,
                             std::int32_t* failIndex, double* rmin, double* rmax);

  /// Moves a centre onto the perpendicular bisector of two points, so that a circle passes through
  /// both.
  ///
  /// @param[in]  p1,p2    the points
  /// @param[in]  center   the centre
  /// @param[out] adjusted foot of the centre on the bisector
  /// @return false for coinciding points
  static bool AdjustCenter(Point const& p1, Point const& p2, Point const& center, Point* adjusted);

  /// Sense of a run, from its first, middle and last point.
  ///
  /// @param[in]  wpoints    all measured points; the run must lie within
  /// @param[in]  begin      index of the first point of the run
  /// @param[in]  count      number of points of the run, >= 3
  /// @param[in]  firstFixed first is taken in place of the first point
  /// @param[in]  first      the fixed start
  /// @param[in]  lastFixed  last is taken in place of the last point
  /// @param[in]  last       the fixed end
  /// @param[in]  center     not used
  /// @param[out] ccw        true for counter-clockwise
  /// @return Failed for a run that is too short or whose three points are exactly collinear
  static ErrorCode IsCcw(std::vector<WPoint> const& wpoints, std::int32_t begin, std::int32_t count,
                         bool firstFixed, Point const& first, bool lastFixed, Point const& last,
                         Point const& center, bool* ccw);
  /// @}
};

static_assert(sizeof(GeometryUtils::Point) == 16);
static_assert(sizeof(GeometryUtils::Arc) == 64);
static_assert(offsetof(GeometryUtils::Arc, center) == 16);
static_assert(offsetof(GeometryUtils::Arc, radius) == 32);
static_assert(offsetof(GeometryUtils::Arc, direction) == 40);
static_assert(offsetof(GeometryUtils::Arc, startAngle) == 48);
static_assert(offsetof(GeometryUtils::Arc, endAngle) == 56);
static_assert(sizeof(GeometryUtils::Elem) == 72);
static_assert(std::is_trivially_copyable_v<GeometryUtils::Elem>);
static_assert(sizeof(GeometryUtils::Triangle) == 48);
static_assert(sizeof(GeometryUtils::IndexedPoint) == 32);
static_assert(sizeof(GeometryUtils::CrossingPoint) == 24);
static_assert(sizeof(GeometryUtils::ProgressBase) == 16);

}  // namespace Vorn
