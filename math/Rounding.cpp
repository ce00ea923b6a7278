// Whole numbers around a value, and the crossing of two lines in slope form.

#include <cmath>
#include <cstdint>
#include <limits>

#include "math/NumericConstants.h"
#include "vorn/MathUtils.h"

namespace Vorn {

namespace {

/// What x86 answers for a value that a 32-bit integer cannot hold. Spelled out, since the language
/// leaves such a conversion undefined and other processors saturate.
constexpr std::int32_t kIntegerIndefinite = std::numeric_limits<std::int32_t>::min();

std::int32_t ToInt32(double whole) {
  bool const fits = whole >= static_cast<double>(std::numeric_limits<std::int32_t>::min()) &&
                    whole <= static_cast<double>(std::numeric_limits<std::int32_t>::max());
  return fits ? static_cast<std::int32_t>(whole) : kIntegerIndefinite;
}

/// The two lines may differ by this much at the crossing. Absolute on purpose: it only catches
/// crossings so far out that the coordinates have lost all meaning.
constexpr double kLargestResidual = 0.5;

}  // namespace

std::int32_t MathUtils::GetOutsideMax(double value) { return ToInt32(std::ceil(value)); }

std::int32_t MathUtils::GetOutsideMin(double value) { return ToInt32(std::floor(value)); }

bool MathUtils::GetLinesIntersection(double k1, double m1, double k2, double m2, double& x,
                                     double& y) {
  if (std::fabs(k1 - k2) <= Numeric::kTangency) return false;
  double const crossing = (m2 - m1) / (k1 - k2);
  double const y1 = k1 * crossing + m1;
  if (std::fabs((k2 * crossing + m2) - y1) > kLargestResidual) return false;
  x = crossing;
  y = y1;
  return true;
}

}  // namespace Vorn
