#pragma once

#include <array>
#include <cmath>
#include <cstddef>

/// Exact sums and products of doubles: a number is kept as the sum of doubles that do not overlap,
/// least first. Exact as long as nothing overflows or underflows.
///   J. R. Shewchuk, "Adaptive Precision Floating-Point Arithmetic and Fast Robust Geometric
///   Predicates", Discrete & Computational Geometry 18, 1997.
namespace Vorn::Promises {

class Expansion {
 public:
  Expansion() = default;
  /// A double as it is.
  explicit Expansion(double value) { Add(value); }

  /// The exact difference of two doubles.
  static Expansion Difference(double a, double b) {
    Expansion result(a);
    result.Add(-b);
    return result;
  }

  /// Grows by one double, so that the parts stay in order and do not overlap.
  void Add(double value) {
    double carry = value;
    std::size_t kept = 0;
    for (std::size_t i = 0; i < size_; ++i) {
      double const sum = carry + parts_[i];
      double const shadow = sum - carry;
      double const lost = (carry - (sum - shadow)) + (parts_[i] - shadow);
      carry = sum;
      if (lost != 0.0) parts_[kept++] = lost;
    }
    if (carry != 0.0) parts_[kept++] = carry;
    size_ = kept;
  }

  /// Adds factor times the product of two numbers; the factor is +1 or -1.
  void AddProduct(Expansion const& a, Expansion const& b, double factor) {
    for (std::size_t i = 0; i < a.size_; ++i) {
      for (std::size_t k = 0; k < b.size_; ++k) {
        double const product = a.parts_[i] * b.parts_[k];
        Add(factor * std::fma(a.parts_[i], b.parts_[k], -product));
        Add(factor * product);
      }
    }
  }

  /// -1, 0 or +1. The last part outweighs all others.
  int Sign() const {
    if (size_ == 0) return 0;
    return parts_[size_ - 1] > 0.0 ? 1 : -1;
  }

  /// The nearest double but for the last bit.
  double Value() const {
    double sum = 0.0;
    for (std::size_t i = 0; i < size_; ++i) sum += parts_[i];
    return sum;
  }

 private:
  /// The square of the cross product of two differences has 512 parts at most, the square of a
  /// tolerance times a squared length 64.
  static constexpr std::size_t kCapacity = 640;

  std::array<double, kCapacity> parts_;
  std::size_t size_ = 0;
};

}  // namespace Vorn::Promises
