// Rotation matrices of 3 x 3 doubles, row-major: entry 3r + c is row r, column c.
//
// The elementary rotations turn the frame, not the point: they are the transposes of the usual
// right-handed ones. Products are summed from 0.0 in column order, so that composing a rotation
// gives the same bits however it is reached.

#include "vorn/Matrix.h"

#include <algorithm>
#include <cmath>
#include <iterator>
#include <utility>

#include "math/NumericConstants.h"

namespace Vorn {

using Numeric::kTangency;
using Numeric::kTruncatedHalfPi;

namespace {

constexpr int kOrder = 3;
constexpr int kElements = kOrder * kOrder;

constexpr double kIdentity[kElements] = {1.0, 0.0, 0.0, 0.0, 1.0, 0.0, 0.0, 0.0, 1.0};

/// Coefficients of (1 + x)^(-1/2); the last term used is x^9.
constexpr double kInverseRootSeries[] = {
    1.0,         -0.5,         0.375,          -0.3125,           0.2734375,
    -0.24609375, 0.2255859375, -0.20947265625, 0.196380615234375, -0.1854705810546875};

/// product = a * b. The product must be another array than both factors.
void Multiply(double const* a, double const* b, double* product) {
  for (int row = 0; row < kOrder; ++row) {
    for (int column = 0; column < kOrder; ++column) {
      double sum = 0.0;
      for (int k = 0; k < kOrder; ++k) sum += a[kOrder * row + k] * b[kOrder * k + column];
      product[kOrder * row + column] = sum;
    }
  }
}

void TransposeInPlace(double* m) {
  for (int row = 0; row < kOrder; ++row) {
    for (int column = row + 1; column < kOrder; ++column) {
      std::swap(m[kOrder * row + column], m[kOrder * column + row]);
    }
  }
}

Matrix RotationX(double angle) {
  double const c = std::cos(angle);
  double const s = std::sin(angle);
  return Mtrx{{1.0, 0.0, 0.0, 0.0, c, s, 0.0, -s, c}};
}

Matrix RotationY(double angle) {
  double const c = std::cos(angle);
  double const s = std::sin(angle);
  return Mtrx{{c, 0.0, -s, 0.0, 1.0, 0.0, s, 0.0, c}};
}

Matrix RotationZ(double angle) {
  double const c = std::cos(angle);
  double const s = std::sin(angle);
  return Mtrx{{c, s, 0.0, -s, c, 0.0, 0.0, 0.0, 1.0}};
}

/// drift = transpose(m) * m - I: zero exactly when m is orthogonal.
void OrthogonalityDrift(double const* m, double* drift) {
  double transposed[kElements];
  std::copy_n(m, kElements, transposed);
  TransposeInPlace(transposed);
  Multiply(transposed, m, drift);
  for (int i = 0; i < kElements; ++i) drift[i] -= kIdentity[i];
}

/// sum = (I + drift)^(-1/2), cut after the given number of terms.
void InverseRoot(double const* drift, int terms, double* sum) {
  double power[kElements];
  double raised[kElements];
  std::copy_n(kIdentity, kElements, sum);
  std::copy_n(kIdentity, kElements, power);
  for (int k = 1; k < terms; ++k) {
    Multiply(power, drift, raised);
    std::copy_n(raised, kElements, power);
    for (int i = 0; i < kElements; ++i) sum[i] += kInverseRootSeries[k] * power[i];
  }
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
  Multiply(m_, other.m_, product.m_);
  return product;
}

double Matrix::Det() const {
  // The order of the terms is fixed: planes averaged from raw determinants cancel to exact zeros
  // only while every caller gets the same rounding.
  return m_[2] * m_[3] * m_[7] + (m_[0] * m_[4] * m_[8] + m_[1] * m_[5] * m_[6]) -
         m_[2] * m_[4] * m_[6] - m_[3] * m_[1] * m_[8] - m_[0] * m_[5] * m_[7];
}

void Matrix::InitI() { std::copy_n(kIdentity, kElements, m_); }

void Matrix::InitMxMyMz(double ax, double ay, double az) {
  *this = RotationX(ax) * RotationY(ay) * RotationZ(az);
}

void Matrix::InitMzMyMx(double ax, double ay, double az) {
  *this = RotationZ(az) * RotationY(ay) * RotationX(ax);
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
    *ax = std::atan2(-m_[7], m_[8]);
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
  SpatVector result = vector;  // carries the entries past z along
  double const* v = vector.v;
  for (int i = 0; i < kOrder; ++i) {
    double const* row = m_ + kOrder * i;
    result.v[i] = row[0] * v[0] + row[1] * v[1] + row[2] * v[2];
  }
  return result;
}

SpatVector Matrix::VxM(SpatVector& vector) {
  SpatVector result = vector;  // carries the entries past z along
  double const* v = vector.v;
  for (int j = 0; j < kOrder; ++j) {
    result.v[j] = v[0] * m_[j] + v[1] * m_[kOrder + j] + v[2] * m_[2 * kOrder + j];
  }
  return result;
}

int Matrix::QuantityOfDataElements() const { return kElements; }

bool Matrix::Reorth(int dimension, double* elements, int terms) {
  if (dimension != kOrder) return false;
  double drift[kElements];
  double inverseRoot[kElements];
  double corrected[kElements];
  OrthogonalityDrift(elements, drift);
  InverseRoot(drift, std::min(terms, static_cast<int>(std::size(kInverseRootSeries))), inverseRoot);
  Multiply(elements, inverseRoot, corrected);
  std::copy_n(corrected, kElements, elements);
  return true;
}

bool Matrix::Reorth(int terms) { return Reorth(kOrder, m_, terms); }

void Matrix::Transpose() { TransposeInPlace(m_); }

}  // namespace Vorn
