/// @file
/// Small numeric kit: linear systems, 3D normals, outward rounding, lines in slope form.

#pragma once

#include "vorn/Types.h"

namespace Vorn {

/// Numeric helpers, all static: no object of this class can be made.
///
/// - No state: every member may be called from several threads at once on distinct outputs.
/// - Nothing is thrown and nothing is allocated.
/// - Pointers must not be null unless a member says otherwise.
/// - Thresholds are absolute, never scaled by the data.
class VORN_EXPORT MathUtils {
 public:
  /// There are no objects of this class.
  MathUtils() = delete;

  /// Solves matrix * solution = rhs by Gaussian elimination with row pivoting and back
  /// substitution, in place.
  ///
  /// @param[in]     n        order of the system; for n <= 0 nothing is read or written
  /// @param[in,out] matrix   n*n doubles, row-major (row r, column c at r*n + c). On return the
  ///                upper triangle with its diagonal holds the eliminated system, the part below
  ///                the diagonal stale values: pass a scratch copy.
  /// @param[in,out] rhs      n doubles; on return the transformed right-hand side
  /// @param[out]    solution n doubles; written only on success
  /// @return false only when all candidates of a pivot column before the last one are exactly 0.0;
  ///         matrix and rhs are then partly transformed. True otherwise, also for n <= 0.
  /// @note Deliberate: there is no tolerance and the last diagonal element is not checked. A system
  ///       that turns out singular only there (n = 1 with a zero coefficient included) answers true
  ///       with infinities or not-a-numbers in solution. Among pivots of equal magnitude the
  ///       topmost row wins; a not-a-number in the pivot position stays the pivot. O(n^3), no
  ///       allocation.
  /// @note Error: each row of the system is solved up to 2 eps of n * max|solution| + |rhs| for
  ///       entries of up to 1, measured for n up to 6; what that means for the solution depends on
  ///       the matrix.
  static bool LinearEquationSystemSolve(int n, double* matrix, double* rhs, double* solution);

  /// For both ends of the 3D segment p1-p2, a point beside the segment: end + normal, where the
  /// normal is perpendicular to the segment and lies in a plane through it.
  ///
  /// The plane is the mean of the planes (p1, p2, q1) and (p1, p2, q2), taken on their raw,
  /// unnormalised coefficients. Each result is displaced by exactly the segment's length L along
  /// one coordinate axis, in its positive sense; of the axes whose system can be solved, the one
  /// whose point is nearest to the end is taken (the first on a tie).
  ///
  /// @param[in]  p1,p2 ends of the segment, three doubles each
  /// @param[in]  q1,q2 points that fix the two planes, three doubles each
  /// @param[out] out1  point beside p1, three doubles
  /// @param[out] out2  point beside p2, three doubles
  /// @return true when both ends have a solvable system; false otherwise, and then out1 may have
  ///         been written while out2 has not.
  /// @note q1 and q2 on opposite sides of the segment pull the mean plane against each other; when
  ///       they are mirror images the coefficients cancel to zero. With p1 = p2 the answer follows
  ///       LinearEquationSystemSolve: false, or true with non-finite points. O(1).
  static bool CalcNormalized3DVectors(double const* p1, double const* p2, double const* q1,
                                      double const* q2, double* out1, double* out2);

  /// The smallest whole number that is not below value: the upper bound of an interval rounded
  /// outward.
  ///
  /// @param[in] value any double
  /// @return ceil(value); -2147483648 when that does not fit 32 bits or value is a not-a-number
  static std::int32_t GetOutsideMax(double value);

  /// The largest whole number that is not above value: the lower bound of an interval rounded
  /// outward.
  ///
  /// @param[in] value any double
  /// @return floor(value); -2147483648 when that does not fit 32 bits or value is a not-a-number
  static std::int32_t GetOutsideMin(double value);

  /// Crossing of the lines y = k1*x + m1 and y = k2*x + m2.
  ///
  /// @param[in]  k1,m1 slope and ordinate at x = 0 of the first line
  /// @param[in]  k2,m2 slope and ordinate at x = 0 of the second line
  /// @param[out] x,y   the crossing; y is taken on the first line. Written only on success.
  /// @return false when the slopes differ by no more than 2.220446049250313e-16 (absolute), or when
  ///         the two ordinates at the crossing differ by more than 0.5.
  /// @note Deliberate: the bound of one half is absolute. It rejects only crossings so far out that
  ///       rounding has taken all sense from them. A not-a-number is not rejected: the answer is
  ///       true with a not-a-number in the outputs. O(1).
  /// @note Error: 1.5 eps of x at most, and 2.5 eps of |k1*x| + |m1| for y.
  static bool GetLinesIntersection(double k1, double m1, double k2, double m2, double& x,
                                   double& y);
};

}  // namespace Vorn
