// Rotation matrices of 3 x 3 doubles, row-major: entry 3r + c is row r, column c.
//
// The elementary rotations turn the frame, not the point: they are the transposes of the usual
// right-handed ones. Products are summed from 0.0 in column order, so that composing a rotation
// gives the same bits however it is reached.

#include "vorn/Matrix.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <iterator>

#include "math/NumericConstants.h"

namespace Vorn {

using Numeric::kTangency;
using Numeric::kTruncatedHalfPi;

namespace {

constexpr int kOrder = 3;
constexpr int kElements = kOrder * kOrder;

/// Offsets of the second and the third row.
constexpr std::ptrdiff_t kRow1 = kOrder;
constexpr std::ptrdiff_t kRow2 = 2 * kRow1;

/// A row, and a matrix as its rows. Values, so that the steps of an operation stay in registers
/// instead of passing through memory.
struct Row {
  double x, y, z;
};
struct Rows {
  Row r0, r1, r2;
};

constexpr Rows kIdentity{{1.0, 0.0, 0.0}, {0.0, 1.0, 0.0}, {0.0, 0.0, 1.0}};

/// Coefficients of (1 + x)^(-1/2); the last term used is x^9.
constexpr double kInverseRootSeries[] = {
    1.0,         -0.5,         0.375,          -0.3125,           0.2734375,
    -0.24609375, 0.2255859375, -0.20947265625, 0.196380615234375, -0.1854705810546875};

Row ReadRow(double const* m) { return {m[0], m[1], m[2]}; }

Rows Read(double const* m) { return {ReadRow(m), ReadRow(m + kRow1), ReadRow(m + kRow2)}; }

void WriteRow(Row const& row, double* out) {
  out[0] = row.x;
  out[1] = row.y;
  out[2] = row.z;
}

void Write(Rows const& m, double* out) {
  WriteRow(m.r0, out);
  WriteRow(m.r1, out + kRow1);
  WriteRow(m.r2, out + kRow2);
}

/// row * m. The three sums are written side by side: none waits for another one, and two of them
/// fit into one instruction where the processor has such.
inline Row Times(Row const& row, Rows const& m) {
  return {((0.0 + row.x * m.r0.x) + row.y * m.r1.x) + row.z * m.r2.x,
          ((0.0 + row.x * m.r0.y) + row.y * m.r1.y) + row.z * m.r2.y,
          ((0.0 + row.x * m.r0.z) + row.y * m.r1.z) + row.z * m.r2.z};
}

inline Rows Times(Rows const& a, Rows const& b) {
  return {Times(a.r0, b), Times(a.r1, b), Times(a.r2, b)};
}

Rows Transposed(Rows const& m) {
  return {{m.r0.x, m.r1.x, m.r2.x}, {m.r0.y, m.r1.y, m.r2.y}, {m.r0.z, m.r1.z, m.r2.z}};
}

/// sum + factor * term
Row AddScaled(Row const& sum, double factor, Row const& term) {
  return {sum.x + factor * term.x, sum.y + factor * term.y, sum.z + factor * term.z};
}

Rows AddScaled(Rows const& sum, double factor, Rows const& term) {
  return {AddScaled(sum.r0, factor, term.r0), AddScaled(sum.r1, factor, term.r1),
          AddScaled(sum.r2, factor, term.r2)};
}

Rows RotationX(double angle) {
  double const c = std::cos(angle);
  double const s = std::sin(angle);
  return {{1.0, 0.0, 0.0}, {0.0, c, s}, {0.0, -s, c}};
}

Rows RotationY(double angle) {
  double const c = std::cos(angle);
  double const s = std::sin(angle);
  return {{c, 0.0, -s}, {0.0, 1.0, 0.0}, {s, 0.0, c}};
}

Rows RotationZ(double angle) {
  double const c = std::cos(angle);
  double const s = std::sin(angle);
  return {{c, s, 0.0}, {-s, c, 0.0}, {0.0, 0.0, 1.0}};
}

/// transpose(m) * m - I: zero exactly when m is orthogonal.
Rows OrthogonalityDrift(Rows const& m) {
  return AddScaled(Times(Transposed(m), m), -1.0, kIdentity);
}

/// (I + drift)^(-1/2), cut after the given number of terms.
Rows InverseRoot(Rows const& drift, int terms) {
  Rows sum = kIdentity;
  Rows power = kIdentity;
  for (int k = 1; k < terms; ++k) {
    power = Times(power, drift);
    sum = AddScaled(sum, kInverseRootSeries[k], power);
  }
  return sum;
}

}  // namespace

Matrix::Matrix() { InitI(); }

Matrix::Matrix(Mtrx const& elements) { std::copy_n(elements.m, kElements, m_); }

Matrix::~Matrix() = default;

Matrix& Matrix::operator=(Matrix const& other) {
  if (this != &other) std::copy_n(other.m_, kElements, m_);
  return *this;
}

Matrix Matrix::operator*(Matrix const& other) {
  Matrix product;
  Write(Times(Read(m_), Read(other.m_)), product.m_);
  return product;
}

double Matrix::Det() const {
  // The order of the terms is fixed: planes averaged from raw determinants cancel to exact zeros
  // only while every caller gets the same rounding.
  auto const [r0, r1, r2] = Read(m_);
  return r0.z * r1.x * r2.y + (r0.x * r1.y * r2.z + r0.y * r1.z * r2.x) - r0.z * r1.y * r2.x -
         r1.x * r0.y * r2.z - r0.x * r1.z * r2.y;
}

void Matrix::InitI() { Write(kIdentity, m_); }

void Matrix::InitMxMyMz(double ax, double ay, double az) {
  Write(Times(Times(RotationX(ax), RotationY(ay)), RotationZ(az)), m_);
}

void Matrix::InitMzMyMx(double ax, double ay, double az) {
  Write(Times(Times(RotationZ(az), RotationY(ay)), RotationX(ax)), m_);
}

void Matrix::GetAnglesFromMxMyMz(double* ax, double* ay, double* az) {
  double const minusAy = std::asin(m_[2]);
  if (std::fabs(std::cos(-minusAy)) > kTangency) {
    *ay = -minusAy;
    *az = std::atan2(m_[1], m_[0]);
    *ax = std::atan2(m_[5], m_[8]);
    return;
  }
  // Gimbal lock: the x and z rotations turn about one axis, and all of it is given to x.
  *az = 0.0;
  if (-minusAy > 0.0) {
    *ay = kTruncatedHalfPi;
    *ax = std::atan2(m_[3], m_[4]);
  } else {
    *ay = -kTruncatedHalfPi;
    *ax = std::atan2(-m_[3], m_[4]);
  }
}

void Matrix::GetAnglesFromMzMyMx(double* ax, double* ay, double* az) {
  double const asinY = std::asin(m_[6]);
  if (std::fabs(std::cos(asinY)) > kTangency) {
    *ay = asinY;
    *az = std::atan2(-m_[3], m_[0]);
    *ax = std::atan2(-m_[kRow2 + 1], m_[kRow2 + 2]);
    return;
  }
  // Gimbal lock, as above.
  *az = 0.0;
  if (asinY > 0.0) {
    *ay = kTruncatedHalfPi;
    *ax = std::atan2(m_[1], m_[4]);
  } else {
    *ay = -kTruncatedHalfPi;
    *ax = std::atan2(-m_[1], m_[4]);
  }
}

SpatVector Matrix::MxV(SpatVector& vector) {
  double const* const v = vector.v;
  auto const [r0, r1, r2] = Read(m_);
  return {{r0.x * v[0] + r0.y * v[1] + r0.z * v[2], r1.x * v[0] + r1.y * v[1] + r1.z * v[2],
           r2.x * v[0] + r2.y * v[1] + r2.z * v[2], v[3], v[4]}};
}

SpatVector Matrix::VxM(SpatVector& vector) {
  double const* const v = vector.v;
  auto const [r0, r1, r2] = Read(m_);
  return {{v[0] * r0.x + v[1] * r1.x + v[2] * r2.x, v[0] * r0.y + v[1] * r1.y + v[2] * r2.y,
           v[0] * r0.z + v[1] * r1.z + v[2] * r2.z, v[3], v[4]}};
}

int Matrix::QuantityOfDataElements() const { return kElements; }

bool Matrix::Reorth(int dimension, double* elements, int terms) {
  if (dimension != kOrder) return false;
  Rows const drifted = Read(elements);
  int const usedTerms = std::min(terms, static_cast<int>(std::size(kInverseRootSeries)));
  Write(Times(drifted, InverseRoot(OrthogonalityDrift(drifted), usedTerms)), elements);
  return true;
}

bool Matrix::Reorth(int terms) { return Reorth(kOrder, m_, terms); }

void Matrix::Transpose() { Write(Transposed(Read(m_)), m_); }

}  // namespace Vorn
