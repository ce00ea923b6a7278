#pragma once

#include <bit>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <type_traits>
#include <vector>

#include "vorn/GeometryUtils.h"
#include "vorn/Matrix.h"

namespace Vorn::Testing {

/// A hash of the bits of results in their order: FNV-1a over the bytes, lowest first. All
/// not-a-numbers count as one, because their sign and payload depend on the compiler.
class Digest {
 public:
  std::uint64_t Value() const { return value_; }

  template <typename... Values>
  void Add(Values const&... values) {
    (AddOne(values), ...);
  }

 private:
  static constexpr std::uint64_t kStart = 0xcbf29ce484222325U;
  static constexpr std::uint64_t kFactor = 0x100000001b3U;
  static constexpr std::uint64_t kQuietNaN = 0x7ff8000000000000U;

  void AddBits(std::uint64_t bits) {
    for (unsigned shift = 0; shift < 64; shift += 8) {
      value_ = (value_ ^ ((bits >> shift) & 0xffU)) * kFactor;
    }
  }

  void AddOne(double value) {
    AddBits(std::isnan(value) ? kQuietNaN : std::bit_cast<std::uint64_t>(value));
  }

  /// Numbers, truth values and enums.
  template <typename Whole>
  requires(std::is_integral_v<Whole> || std::is_enum_v<Whole>) void AddOne(Whole value) {
    AddBits(static_cast<std::uint64_t>(value));
  }

  void AddOne(GeometryUtils::Point const& p) { Add(p.x, p.y); }
  void AddOne(Point2D<double> const& p) { Add(p.x, p.y); }
  void AddOne(WPoint const& p) { Add(p.x, p.y, p.w); }
  void AddOne(GeometryUtils::Triangle const& t) { Add(t.pts); }
  void AddOne(GeometryUtils::CrossingPoint const& p) { Add(p.pt, p.side1, p.side2); }
  void AddOne(SpatVector const& vector) { Add(vector.v); }

  /// Of a segment only the end means anything.
  void AddOne(GeometryUtils::Elem const& e) {
    Add(e.type, e.end);
    if (e.type == GeometryUtils::ElemType::Segment) return;
    Add(e.center, e.radius, e.direction, e.startAngle, e.endAngle);
  }

  template <typename Item, std::size_t kCount>
  void AddOne(Item const (&items)[kCount]) {
    for (Item const& item : items) AddOne(item);
  }

  template <typename Item>
  void AddOne(std::vector<Item> const& items) {
    Add(items.size());
    for (Item const& item : items) AddOne(item);
  }

  std::uint64_t value_ = kStart;
};

}  // namespace Vorn::Testing
