// Numbers of 512 bits: sums and products of a few doubles of moderate exponents are exact in them,
// quotients and roots good to 150 digits. By MPFR, which shares nothing with the library.
#pragma once

#include <mpfr.h>

#include <cmath>

namespace Vorn::Oracle {

/// A number of 512 bits; every operation is rounded to nearest.
class Real {
 public:
  Real() : Real(0.0) {}
  Real(double value) {  // NOLINT(google-explicit-constructor): a double is such a number
    Begin();
    mpfr_set_d(value_, value, MPFR_RNDN);
  }
  Real(Real const& other) {
    Begin();
    mpfr_set(value_, other.value_, MPFR_RNDN);
  }
  Real& operator=(Real const& other) {
    mpfr_set(value_, other.value_, MPFR_RNDN);
    return *this;
  }

  /// The nearest double.
  double ToDouble() const { return mpfr_get_d(value_, MPFR_RNDN); }
  /// -1, 0 or 1.
  int Sign() const { return mpfr_sgn(value_); }

  friend Real operator+(Real const& a, Real const& b) { return Made(mpfr_add, a, b); }
  friend Real operator-(Real const& a, Real const& b) { return Made(mpfr_sub, a, b); }
  friend Real operator*(Real const& a, Real const& b) { return Made(mpfr_mul, a, b); }
  friend Real operator/(Real const& a, Real const& b) { return Made(mpfr_div, a, b); }
  friend Real operator-(Real const& a) { return Real(0.0) - a; }
  friend bool operator<(Real const& a, Real const& b) { return mpfr_less_p(a.value_, b.value_); }
  friend bool operator<=(Real const& a, Real const& b) { return !(b < a); }
  friend bool operator>(Real const& a, Real const& b) { return b < a; }
  friend bool operator>=(Real const& a, Real const& b) { return !(a < b); }
  friend bool operator==(Real const& a, Real const& b) { return mpfr_equal_p(a.value_, b.value_); }

  friend Real Abs(Real const& a) { return a.Sign() < 0 ? -a : a; }
  friend Real Sqrt(Real const& a) { return Made(mpfr_sqrt, a); }
  /// The polar angle of (x, y).
  friend Real Atan2(Real const& y, Real const& x) { return Made(mpfr_atan2, y, x); }

  static Real Pi() {
    Real pi;
    mpfr_const_pi(pi.value_, MPFR_RNDN);
    return pi;
  }

 private:
  static constexpr mpfr_prec_t kBits = 512;

  /// The digits lie in the object itself: no allocation.
  void Begin() {
    mpfr_custom_init(digits_, kBits);
    mpfr_custom_init_set(value_, MPFR_ZERO_KIND, 0, kBits, digits_);
  }

  template <typename Operation, typename... Numbers>
  static Real Made(Operation operation, Numbers const&... numbers) {
    Real result;
    operation(result.value_, numbers.value_..., MPFR_RNDN);
    return result;
  }

  mp_limb_t digits_[kBits / 64];
  mpfr_t value_;
};

inline Real Square(Real const& a) { return a * a; }
inline Real Larger(Real const& a, Real const& b) { return a < b ? b : a; }
inline Real Smaller(Real const& a, Real const& b) { return a < b ? a : b; }

/// A point with such coordinates.
struct RealPoint {
  Real x;
  Real y;
};

inline RealPoint operator+(RealPoint const& a, RealPoint const& b) {
  return {a.x + b.x, a.y + b.y};
}
inline RealPoint operator-(RealPoint const& a, RealPoint const& b) {
  return {a.x - b.x, a.y - b.y};
}
inline RealPoint operator*(Real const& t, RealPoint const& a) { return {t * a.x, t * a.y}; }
inline Real Cross(RealPoint const& a, RealPoint const& b) { return a.x * b.y - a.y * b.x; }
inline Real Dot(RealPoint const& a, RealPoint const& b) { return a.x * b.x + a.y * b.y; }
inline Real Length(RealPoint const& a) { return Sqrt(Dot(a, a)); }

}  // namespace Vorn::Oracle
