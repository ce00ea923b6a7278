#pragma once

#include <bit>
#include <cstddef>
#include <type_traits>

#include "math/Assert.h"
#include "vorn/GeometryUtils.h"

/// The common part of two triangles without allocation, for cells that are cut thousands of times.
namespace Vorn::Cells {

/// A vector of fixed capacity on the stack, for plain records. Room is left as it is until it is
/// used: most overlaps need less time than clearing it would take.
template <typename T, std::size_t kCapacity>
class InlineVector {
  static_assert(std::is_trivially_copyable_v<T>);

 public:
  InlineVector() {}  // NOLINT(modernize-use-equals-default): the union has no default

  /// Appends a value; there must be room.
  void push_back(T const& value) {
    VORN_ASSERT(size_ < kCapacity);
    items_[size_++] = value;
  }

  /// Drops the values from a size on.
  void resize(std::size_t size) {
    VORN_ASSERT(size <= size_);
    size_ = size;
  }
  void clear() { size_ = 0; }
  std::size_t size() const { return size_; }
  bool empty() const { return size_ == 0; }
  T& operator[](std::size_t i) { return items_[i]; }
  T const& operator[](std::size_t i) const { return items_[i]; }
  T* data() { return items_; }
  T const* begin() const { return items_; }
  T const* end() const { return items_ + size_; }

 private:
  union {
    T items_[kCapacity];
  };
  std::size_t size_ = 0;
};

/// A triangle with its box.
struct BoxedTriangle {
  explicit BoxedTriangle(GeometryUtils::Triangle const& from);

  /// Whether a point is beyond the box. False when a coordinate is not a number.
  bool IsOutOfBox(GeometryUtils::Point const& p) const {
    return (xMin > p.x) | (p.x > xMax) | (yMin > p.y) | (p.y > yMax);
  }

  GeometryUtils::Triangle triangle;
  double xMin, yMin, xMax, yMax;
};

/// A triangle with what every overlap asks of it.
struct Shape {
  explicit Shape(GeometryUtils::Triangle const& from);

  /// Whether the boxes have no point in common. False when a coordinate is not a number.
  bool IsApartFrom(Shape const& other) const {
    return xMin > other.xMax || other.xMin > xMax || yMin > other.yMax || other.yMin > yMax;
  }

  /// Where a point lies; as GetPointStatus.
  GeometryUtils::PointStatus StatusOf(GeometryUtils::Point const& p) const;

  /// Side i runs from vertex i to the next one.
  struct Side {
    double dx, dy;
    /// x(end) * y(start) - x(start) * y(end): the part of the side in the area of the triangle that
    /// it forms with a point.
    double term;
    double xLow, yLow, xHigh, yHigh;
  };

  GeometryUtils::Triangle triangle;
  Side sides[3];
  double xMin, yMin, xMax, yMax;
  /// Sign of the area.
  int sense;
  /// Whether all coordinates are numbers, so that boxes can be compared.
  bool isOrdered;

 private:
  GeometryUtils::PointStatus StatusNearSides(GeometryUtils::Point const& p,
                                             double const* areas) const;
};

/// How many times a contained triangle makes up the overlap. Deliberate: the copies weigh in the
/// centre of a cell and in its size.
inline constexpr int kCopiesOfContained = 3;

/// How many triangles an overlap can have: a walk takes at most four points on each of three sides,
/// and twelve points make ten triangles.
inline constexpr std::size_t kMostParts = 10;

/// What two triangles have in common.
struct Overlap {
  GeometryUtils::OverlappingStatus status = GeometryUtils::OverlappingStatus::NoOverlap;
  InlineVector<GeometryUtils::Triangle, kMostParts> parts;
};

/// What is known beforehand of two triangles.
struct Sight {
  /// Bit v: vertex v of the first triangle is inside the second one, otherwise outside.
  unsigned inside = 0;
  /// Bit v: vertex v of the second triangle is outside the first one, otherwise anywhere.
  unsigned outside = 0;
  /// Bit 3 i + j: side i of the first may cross side j of the second; the other sides do not.
  unsigned mayCross = 0;

  /// Whether every vertex of the second triangle is outside the first one.
  bool IsSecondOutside() const { return outside == 7U; }

  /// Whether one side of the second triangle cuts off one or two vertices of the first, and there
  /// is nothing else to it.
  bool IsOneCut() const {
    bool const hasTwoCrossings = std::has_single_bit(mayCross & (mayCross - 1));
    return inside != 0 && hasTwoCrossings && IsSecondOutside();
  }
};

/// The same triangles in the same order as GetOverlapping.
void FindOverlap(Shape const& first, Shape const& second, Overlap* overlap);

/// The same, with less left to find out.
void FindOverlap(BoxedTriangle const& first, Shape const& second, Sight const& sight,
                 Overlap* overlap);

/// On one side at most three crossings and three shared stretches of two ends each are found, of
/// which two stay.
using CrossingPoints = InlineVector<GeometryUtils::CrossingPoint, 12>;

/// Where the sides of one triangle cross those of another, by side of the first and along a side
/// by distance from its start: at most two points a side.
void FindCrossingPoints(Shape const& first, Shape const& second, CrossingPoints* points);

/// The same when only sides with a bit in `mayCross` need be looked at.
void FindCrossingPoints(GeometryUtils::Triangle const& first, GeometryUtils::Triangle const& second,
                        unsigned mayCross, CrossingPoints* points);

}  // namespace Vorn::Cells
