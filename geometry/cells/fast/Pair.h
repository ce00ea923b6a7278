// Two doubles that are worked on at once. Lanes never meet in a sum, so the results are those of
// plain doubles.
//
// Compilers with vector types work on both lanes in one instruction; this is where a fit spends a
// quarter of its time. Everywhere else, and where VORN_PLAIN_PAIRS is defined, the same operations
// are written out for each lane, which makes a fit an eighth slower. A test holds the two together.

#pragma once

#include <cmath>
#include <cstdint>

namespace Vorn::Cells {

/// Two sets of bits, one a lane, for any compiler.
struct PlainBits {
  std::int64_t lanes[2];

  /// The bits of a lane.
  std::int64_t operator[](int lane) const { return lanes[lane]; }

  /// The bits that both have, lane by lane.
  friend PlainBits operator&(PlainBits const& a, PlainBits const& b) {
    return {{a[0] & b[0], a[1] & b[1]}};
  }
  /// The bits that one of them has, lane by lane.
  friend PlainBits operator|(PlainBits const& a, PlainBits const& b) {
    return {{a[0] | b[0], a[1] | b[1]}};
  }
  /// The bits moved up, lane by lane.
  friend PlainBits operator<<(PlainBits const& a, int count) {
    return {{a[0] << count, a[1] << count}};
  }
};

/// Two doubles, for any compiler. A comparison gives all bits of the lanes where it holds, none of
/// the others.
struct PlainPair {
  double lanes[2];

  /// The value of a lane.
  double operator[](int lane) const { return lanes[lane]; }
  /// The value of a lane, to be written.
  double& operator[](int lane) { return lanes[lane]; }

  /// The differences, lane by lane.
  friend PlainPair operator-(PlainPair const& a, PlainPair const& b) {
    return {{a[0] - b[0], a[1] - b[1]}};
  }
  /// The differences of a number and each lane.
  friend PlainPair operator-(double a, PlainPair const& b) { return {{a - b[0], a - b[1]}}; }
  /// The products, lane by lane.
  friend PlainPair operator*(PlainPair const& a, PlainPair const& b) {
    return {{a[0] * b[0], a[1] * b[1]}};
  }
  /// The lanes above a number.
  friend PlainBits operator>(PlainPair const& a, double b) {
    return {{-std::int64_t{a[0] > b}, -std::int64_t{a[1] > b}}};
  }
  /// The lanes below a number.
  friend PlainBits operator>(double a, PlainPair const& b) {
    return {{-std::int64_t{a > b[0]}, -std::int64_t{a > b[1]}}};
  }
  /// The lanes not above a number.
  friend PlainBits operator<=(PlainPair const& a, double b) {
    return {{-std::int64_t{a[0] <= b}, -std::int64_t{a[1] <= b}}};
  }
};

/// The lesser value in each lane; the first where one is not a number.
inline PlainPair Least(PlainPair const& a, PlainPair const& b) {
  return {{b[0] < a[0] ? b[0] : a[0], b[1] < a[1] ? b[1] : a[1]}};
}

/// The greater value in each lane; the first where one is not a number.
inline PlainPair Most(PlainPair const& a, PlainPair const& b) {
  return {{b[0] > a[0] ? b[0] : a[0], b[1] > a[1] ? b[1] : a[1]}};
}

/// The values without their signs.
inline PlainPair Sizes(PlainPair const& a) { return {{std::fabs(a[0]), std::fabs(a[1])}}; }

#if defined(__GNUC__) && !defined(VORN_PLAIN_PAIRS)

/// PlainBits as a vector type of the compiler.
using VectorBits [[gnu::vector_size(16)]] = std::int64_t;

/// PlainPair as a vector type of the compiler.
using VectorPair [[gnu::vector_size(16)]] = double;

/// As for PlainPair.
inline VectorPair Least(VectorPair const& a, VectorPair const& b) { return b < a ? b : a; }

/// As for PlainPair.
inline VectorPair Most(VectorPair const& a, VectorPair const& b) { return b > a ? b : a; }

/// As for PlainPair.
inline VectorPair Sizes(VectorPair const& a) {
  return reinterpret_cast<VectorPair>(reinterpret_cast<VectorBits>(a) & INT64_MAX);
}

using Pair = VectorPair;
using PairBits = VectorBits;

#else

using Pair = PlainPair;
using PairBits = PlainBits;

#endif

/// The bits of both lanes.
template <typename AnyBits>
unsigned Union(AnyBits const& bits) {
  return static_cast<unsigned>(bits[0] | bits[1]);
}

}  // namespace Vorn::Cells
