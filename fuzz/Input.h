// Geometry out of the bytes that a fuzzer makes. Coordinates come in quantised steps, so that exact
// coincidences, collinear points and touching circles are common, with odd values among them.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <string>
#include <vector>

#include "vorn/GeometryUtils.h"

namespace Vorn::Fuzz {

/// Takes values from a run of bytes; when they are used up, everything is 0.
class Input {
 public:
  Input(std::uint8_t const* data, std::size_t size) : data_(data), end_(data + size) {}

  bool IsEmpty() const { return data_ == end_; }

  std::uint8_t Byte() { return IsEmpty() ? std::uint8_t{0} : *data_++; }

  bool Flip() { return (Byte() & 1U) != 0; }

  /// low to high, both included; at most 65,536 values.
  int Integer(int low, int high) {
    unsigned const value = (unsigned{Byte()} << 8U) | Byte();
    return low + static_cast<int>(value % static_cast<unsigned>(high - low + 1));
  }

  /// A multiple of 1/4 from -16 to 15.75: sums and products of a few of them are exact.
  double OnGrid() { return 0.25 * (Byte() - 64); }

  /// Mostly a multiple of 1/64 of moderate size; now and then one that programs stumble over.
  double Number() {
    std::uint8_t const kind = Byte();
    if (kind < 240) return Integer(-32768, 32767) / 64.0;
    return kOdd[kind % (sizeof(kOdd) / sizeof(kOdd[0]))];
  }

  GeometryUtils::Point PointOnGrid() {
    double const x = OnGrid();
    return {x, OnGrid()};
  }

  GeometryUtils::Triangle TriangleOnGrid() {
    GeometryUtils::Triangle triangle;
    for (GeometryUtils::Point& vertex : triangle.pts) vertex = PointOnGrid();
    return triangle;
  }

  /// A path of quantised steps that keep the spacing rule of the fits more often than not, at most
  /// `most` points. One byte of the path gives a turn and a length, so that straight runs and arcs
  /// are likely.
  std::vector<WPoint> Path(int most) {
    PathStart const start = TakePathStart();
    return Walk(start, Integer(0, most));
  }

  /// The same with a point for each byte but the last `kept` ones, at most `most`: no step is
  /// made up, so that the cost follows the length of the input.
  std::vector<WPoint> PathOfRest(int most, int kept) {
    PathStart const start = TakePathStart();
    return Walk(start, std::clamp(static_cast<int>(end_ - data_) - kept, 0, most));
  }

  /// The bytes that Spoil takes at most.
  static constexpr int kBytesToSpoil = 6;

  /// What no measuring machine delivers, put in the place of one value of one point.
  void Spoil(std::vector<WPoint>* points) {
    if (points->empty()) return;
    WPoint& point = (*points)[static_cast<std::size_t>(Integer(0, 65535)) % points->size()];
    double* const values[] = {&point.x, &point.y, &point.w};
    *values[Byte() % 3U] = Number();
  }

  std::string Rest() {
    std::string text(data_, end_);
    data_ = end_;
    return text;
  }

 private:
  static constexpr int kHeadings = 48;
  static constexpr double kTolerances[] = {0.01, 0.05, 0.125, 0.25, 0.3, 1e-3, 1e-6, 0.0};
  static constexpr double kOdd[] = {std::numeric_limits<double>::quiet_NaN(),
                                    std::numeric_limits<double>::infinity(),
                                    -std::numeric_limits<double>::infinity(),
                                    -0.0,
                                    1e300,
                                    -1e300,
                                    1e-300,
                                    5e-324,
                                    1e12,
                                    0.1,
                                    1e-9,
                                    2.2250738585072014e-308};

  struct PathStart {
    double tolerance = 0.0;
    double x = 0.0;
    double y = 0.0;
    int heading = 0;
  };

  PathStart TakePathStart() {
    PathStart start;
    start.tolerance = kTolerances[Byte() % 8U];
    start.x = OnGrid();
    start.y = OnGrid();
    start.heading = Byte() % kHeadings;
    return start;
  }

  std::vector<WPoint> Walk(PathStart const& start, int count) {
    std::vector<WPoint> points;
    double const tolerance = start.tolerance;
    double x = start.x;
    double y = start.y;
    int heading = start.heading;
    int turn = 0;
    for (int i = 0; i < count; ++i) {
      std::uint8_t const step = Byte();
      if (step < 64) turn = step % 7 - 3;
      heading = (heading + turn + kHeadings) % kHeadings;
      double const length = step % 32U == 31 ? 0.125 : 1.0;
      x += length * Cosine(heading);
      y += length * Cosine(heading + kHeadings - kHeadings / 4);
      double const across = tolerance * (static_cast<int>(step % 5U) - 2) / 4.0;
      points.push_back({x + across, y - across, step % 16U == 15 ? 0.5 * tolerance : tolerance});
    }
    return points;
  }

  /// A dyadic wave with the period of one turn: headings repeat exactly, on every machine.
  static double Cosine(int heading) {
    int const quarter = kHeadings / 4;
    int const at = heading % kHeadings;
    int const folded = at <= kHeadings / 2 ? at : kHeadings - at;
    bool const isNegative = folded > quarter;
    double const t = static_cast<double>(isNegative ? kHeadings / 2 - folded : folded) / quarter;
    double const value = (1.0 - t * t) * (1.0 - 0.25 * t * t);
    return isNegative ? -value : value;
  }

  std::uint8_t const* data_;
  std::uint8_t const* end_;
};

}  // namespace Vorn::Fuzz
