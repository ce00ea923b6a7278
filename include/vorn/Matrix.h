/// @file
/// Rotation matrices of space and the vectors they act on.

#pragma once

#include "vorn/Types.h"

namespace Vorn {

/// Nine doubles of a 3x3 matrix, row-major: the form in which callers hand a matrix in.
union Mtrx {
  /// All elements in a row; element (row r, column c) is m[3*r + c].
  double m[9];
  /// The same elements as rows[r][c].
  double rows[3][3];
};

/// A spatial vector with two values that ride along: the matrix products leave them as they are.
struct SpatVector {
  /// Entries 0, 1, 2 are x, y, z; entries 3 and 4 are the caller's own.
  double v[5] = {0.0, 0.0, 0.0, 0.0, 0.0};

  /// Number of doubles in the vector.
  /// @return 5
  int QuantityOfDataElements() const { return 5; }
};

/// A 3x3 rotation matrix as a plain value: nine row-major doubles and nothing else.
///
/// - Angles are radians. The elementary rotations, with c = cos t and s = sin t, are
///
///       Mx(t) = | 1  0  0 |    My(t) = | c  0 -s |    Mz(t) = | c  s  0 |
///               | 0  c  s |            | 0  1  0 |            |-s  c  0 |
///               | 0 -s  c |            | s  0  c |            | 0  0  1 |
///
///   that is, the transposes of the usual right-handed ones: they turn the frame, not the point.
/// - Nothing checks that the elements form a rotation; every operation works on any nine doubles.
/// - Nothing is thrown and nothing is allocated. Distinct objects may be used from several threads.
/// - Some members that only read (operator*, MxV, VxM, the angle getters) are not const; this is
///   the fixed interface.
/// - Pointers must not be null.
class VORN_EXPORT Matrix {
 public:
  /// The identity.
  Matrix();

  /// Takes the nine elements over.
  /// @param[in] elements row-major elements, copied bit for bit
  Matrix(Mtrx const& elements);

  /// Copies the nine elements.
  /// @param[in] other the matrix to copy
  Matrix(Matrix const& other) = default;

  /// Nothing to release; exported, so it stays out of the header.
  ~Matrix();  // NOLINT(performance-trivially-destructible)

  /// Copies the nine elements; assigning a matrix to itself changes nothing.
  /// @param[in] other the matrix to copy
  /// @return this matrix
  Matrix& operator=(Matrix const& other);

  /// The product this * other. Neither factor changes.
  /// @param[in] other right factor
  /// @return the product; each element is summed from 0.0 over the inner index in ascending order
  Matrix operator*(Matrix const& other);

  /// Determinant by the rule of Sarrus, terms in a fixed order.
  /// @return the determinant; 1 up to rounding for a rotation
  double Det() const;

  /// Makes this matrix the identity.
  void InitI();

  /// Makes this matrix (Mx(ax) * My(ay)) * Mz(az).
  /// @param[in] ax,ay,az angles about the axes x, y and z, any values
  void InitMxMyMz(double ax, double ay, double az);

  /// Makes this matrix (Mz(az) * My(ay)) * Mx(ax). The arguments keep the order x, y, z.
  /// @param[in] ax,ay,az angles about the axes x, y and z, any values
  void InitMzMyMx(double ax, double ay, double az);

  /// Angles that InitMxMyMz would build this matrix from. The matrix does not change.
  ///
  /// @param[out] ax angle about x, in (-pi, pi]
  /// @param[out] ay angle about y, in [-pi/2, pi/2]
  /// @param[out] az angle about z, in (-pi, pi]; 0.0 in gimbal lock
  /// @note Gimbal lock, when |cos(ay)| is not above 2.220446049250313e-16: ay is then
  ///       +-1.570796326794895 (a truncated right angle, kept on purpose), the whole turn about the
  ///       common axis goes into ax. An element (0, 2) outside [-1, 1], or a not-a-number there, is
  ///       taken for the lock with ay negative. Property: for |ay| < pi/2 the angles of InitMxMyMz
  ///       come back up to rounding.
  void GetAnglesFromMxMyMz(double* ax, double* ay, double* az);

  /// Angles that InitMzMyMx would build this matrix from. The matrix does not change.
  ///
  /// @param[out] ax angle about x, in (-pi, pi]
  /// @param[out] ay angle about y, in [-pi/2, pi/2]
  /// @param[out] az angle about z, in (-pi, pi]; 0.0 in gimbal lock
  /// @note Gimbal lock as in GetAnglesFromMxMyMz, with the element (2, 0) in the place of (0, 2).
  ///       Property: for |ay| < pi/2 the angles of InitMzMyMx come back up to rounding.
  void GetAnglesFromMzMyMx(double* ax, double* ay, double* az);

  /// Matrix times column vector. Neither operand changes.
  /// @param[in] vector the column vector
  /// @return entries 0 to 2 the product, entries 3 and 4 copied from vector
  SpatVector MxV(SpatVector& vector);

  /// Row vector times matrix, the same as the transpose applied to the vector. Neither operand
  /// changes.
  /// @param[in] vector the row vector
  /// @return entries 0 to 2 the product, entries 3 and 4 copied from vector
  SpatVector VxM(SpatVector& vector);

  /// Number of doubles in the matrix.
  /// @return 9
  int QuantityOfDataElements() const;

  /// Pulls a matrix M that has drifted from orthogonality back to a rotation, in place:
  /// M * (M^T*M)^(-1/2), the inverse root by the binomial series of (I + E)^(-1/2) with
  /// E = M^T*M - I.
  ///
  /// @param[in]     dimension must be 3
  /// @param[in,out] elements  nine row-major doubles; replaced on success
  /// @param[in]     terms     number of series terms including the leading 1; more than 10 count as
  ///                10, fewer than 2 leave the series at the identity
  /// @return false, elements untouched, unless dimension is 3; true otherwise
  /// @note The series converges while the eigenvalues of E stay inside (-1, 1). An exactly
  ///       orthogonal matrix does not change, whatever the number of terms. O(terms).
  static bool Reorth(int dimension, double* elements, int terms);

  /// Reorth on this matrix's own elements.
  /// @param[in] terms number of series terms, as above
  /// @return true
  bool Reorth(int terms);

  /// Exchanges rows and columns, in place.
  void Transpose();

 private:
  /// The elements, row-major: element (row r, column c) is m_[3*r + c].
  double m_[9];
};

static_assert(sizeof(Mtrx) == 72);
static_assert(sizeof(SpatVector) == 40);
static_assert(sizeof(Matrix) == 72);

}  // namespace Vorn
