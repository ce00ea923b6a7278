#pragma once

#include <algorithm>
#include <array>
#include <cstddef>
#include <iterator>
#include <optional>
#include <utility>
#include <vector>

#include "vorn/Types.h"

/// Whether one circle or line passes within tolerance of every point of a set, by looking at every
/// edge of the polytope of its coefficients. Works on any exact or inexact field of numbers.
///
/// With f(p) = a |p|^2 + b p + d and |b|^2 - 4 a d = 1 a point is within w of the circle, for w up
/// to the radius, exactly when |f(p) - a w^2| <= w. The rows |..| <= w bound a polytope that is
/// symmetric about 0, and multiples of its elements fill it; so the set is coverable exactly when
/// the form |b|^2 - 4 a d reaches 1 somewhere on it. The form has one negative direction, so that
/// its largest value on a face of two or more dimensions is never inside: edges are enough, with
/// their ends and the place inside where the form is largest.
namespace Vorn::Testing {

template <typename Number>
class CoverOracle {
 public:
  using Circle = std::array<Number, 4>;  ///< a, bx, by, d

  /// Tolerances are multiplied by factor. Coordinates are taken from the first point.
  CoverOracle(std::vector<WPoint> const& points, Number const& factor) {
    for (WPoint const& p : points) {
      Number const x = Number(p.x) - Number(points.front().x);
      Number const y = Number(p.y) - Number(points.front().y);
      Number const w = factor * Number(p.w);
      rows_.push_back({x * x + y * y - w * w, x, y, Number(1)});
      limits_.push_back(w);
    }
  }

  /// A multiple of a circle within the tolerances; nothing when there is none. For sets in which no
  /// three rows are independent, such as those of less than three places, ask IsCoverable.
  std::optional<Circle> FindCover() {
    best_ = Number(-1);
    for (std::size_t i = 0; i < rows_.size(); ++i) {
      for (std::size_t j = i + 1; j < rows_.size(); ++j) {
        for (std::size_t k = j + 1; k < rows_.size(); ++k) TakeEdgesOf(i, j, k);
      }
    }
    if (best_ >= Number(1)) return bestCircle_;
    return std::nullopt;
  }

  /// The largest value of the form on the polytope; after FindCover.
  Number const& LargestForm() const { return best_; }

 private:
  static Number Form(Circle const& c, Circle const& o) {
    return c[1] * o[1] + c[2] * o[2] - Number(2) * (c[0] * o[3] + c[3] * o[0]);
  }
  static Number Apply(Circle const& row, Circle const& c) {
    return row[0] * c[0] + row[1] * c[1] + row[2] * c[2] + row[3] * c[3];
  }

  /// The three coefficients of the rows without one of the four.
  Number Minor(std::array<std::size_t, 3> const& rows, int without) const {
    std::array<int, 3> c{};
    for (int i = 0, at = 0; i < 4; ++i) {
      if (i != without) c[static_cast<std::size_t>(at++)] = i;
    }
    auto const at = [&](int r, int k) -> Number const& {
      return rows_[rows[static_cast<std::size_t>(r)]]
                  [static_cast<std::size_t>(c[static_cast<std::size_t>(k)])];
    };
    return at(0, 0) * (at(1, 1) * at(2, 2) - at(1, 2) * at(2, 1)) -
           at(0, 1) * (at(1, 0) * at(2, 2) - at(1, 2) * at(2, 0)) +
           at(0, 2) * (at(1, 0) * at(2, 1) - at(1, 1) * at(2, 0));
  }

  /// The directions along which three rows stay as they are, and the four sign patterns (the
  /// opposite ones give the same circles) at which they are at their limits.
  void TakeEdgesOf(std::size_t i, std::size_t j, std::size_t k) {
    std::array<std::size_t, 3> const rows{i, j, k};
    Circle const along{Minor(rows, 0), -Minor(rows, 1), Minor(rows, 2), -Minor(rows, 3)};
    for (int signs = 0; signs < 4; ++signs) {
      std::array<Number, 3> const values{limits_[i], (signs & 1) != 0 ? -limits_[j] : limits_[j],
                                         (signs & 2) != 0 ? -limits_[k] : limits_[k]};
      if (auto const origin = Solve(rows, values, along)) TakeEdge(rows, *origin, along);
    }
  }

  /// A circle at which three rows have given values: one coefficient is 0, the others follow from
  /// Cramer's rule.
  std::optional<Circle> Solve(std::array<std::size_t, 3> const& rows,
                              std::array<Number, 3> const& values, Circle const& along) const {
    for (int without = 0; without < 4; ++without) {
      Number const& det = along[static_cast<std::size_t>(without)];
      if (det == Number(0)) continue;
      return Cramer(rows, values, without);
    }
    return std::nullopt;
  }

  Circle Cramer(std::array<std::size_t, 3> const& rows, std::array<Number, 3> const& values,
                int without) const {
    auto const det3 = [](std::array<std::array<Number, 3>, 3> const& m) -> Number {
      return m[0][0] * (m[1][1] * m[2][2] - m[1][2] * m[2][1]) -
             m[0][1] * (m[1][0] * m[2][2] - m[1][2] * m[2][0]) +
             m[0][2] * (m[1][0] * m[2][1] - m[1][1] * m[2][0]);
    };
    std::array<std::array<Number, 3>, 3> matrix;
    std::array<std::size_t, 3> columns{};
    for (std::size_t i = 0, at = 0; i < 4; ++i) {
      if (static_cast<int>(i) != without) columns[at++] = i;
    }
    for (std::size_t r = 0; r < 3; ++r) {
      for (std::size_t c = 0; c < 3; ++c) matrix[r][c] = rows_[rows[r]][columns[c]];
    }
    Number const det = det3(matrix);
    Circle circle{Number(0), Number(0), Number(0), Number(0)};
    for (std::size_t c = 0; c < 3; ++c) {
      auto replaced = matrix;
      for (std::size_t r = 0; r < 3; ++r) replaced[r][c] = values[r];
      circle[columns[c]] = det3(replaced) / det;
    }
    return circle;
  }

  static Circle Moved(Circle const& origin, Circle const& along, Number const& t) {
    return {origin[0] + t * along[0], origin[1] + t * along[1], origin[2] + t * along[2],
            origin[3] + t * along[3]};
  }

  void TakeEdge(std::array<std::size_t, 3> const& rows, Circle const& origin, Circle const& along) {
    std::optional<Number> low;
    std::optional<Number> high;
    for (std::size_t i = 0; i < rows_.size(); ++i) {
      if (i == rows[0] || i == rows[1] || i == rows[2]) continue;
      Number const at = Apply(rows_[i], origin);
      Number const slope = Apply(rows_[i], along);
      if (slope == Number(0)) {
        if (at > limits_[i] || -at > limits_[i]) return;
        continue;
      }
      Number first = (limits_[i] - at) / slope;
      Number second = (-limits_[i] - at) / slope;
      if (second < first) std::swap(first, second);
      if (!low || first > *low) low = first;
      if (!high || second < *high) high = second;
      if (*high < *low) return;
    }
    if (!low) return TakeOpenLine(origin, along);
    TakeCircle(Moved(origin, along, *low));
    TakeCircle(Moved(origin, along, *high));
    Number const bend = Form(along, along);
    if (bend >= Number(0)) return;
    Number const peak = -Form(origin, along) / bend;
    if (*low < peak && peak < *high) TakeCircle(Moved(origin, along, peak));
  }

  /// No row bounds the line: all points lie on the circle whose coefficients are its direction, or
  /// that circle is imaginary.
  void TakeOpenLine(Circle const& origin, Circle const& along) {
    Number const bend = Form(along, along);
    Number const slope = Form(origin, along);
    if (bend < Number(0)) return TakeCircle(Moved(origin, along, -slope / bend));
    if (bend == Number(0) && slope == Number(0)) return TakeCircle(origin);
    best_ = Number(1);
    bestCircle_ = along;
  }

  void TakeCircle(Circle const& circle) {
    Number const form = Form(circle, circle);
    if (form <= best_) return;
    best_ = form;
    bestCircle_ = circle;
  }

  std::vector<Circle> rows_;
  std::vector<Number> limits_;
  Number best_ = Number(-1);
  Circle bestCircle_{};
};

inline std::size_t CountPlaces(std::vector<WPoint> const& points) {
  std::vector<std::pair<double, double>> places;
  for (WPoint const& p : points) places.emplace_back(p.x, p.y);
  std::sort(places.begin(), places.end());
  return static_cast<std::size_t>(
      std::distance(places.begin(), std::unique(places.begin(), places.end())));
}

/// A circle or line passes through any three places.
template <typename Number>
bool IsCoverableIn(std::vector<WPoint> const& points, Number const& factor) {
  return CountPlaces(points) <= 3 || CoverOracle<Number>(points, factor).FindCover().has_value();
}

/// In extended precision: not sure very near the border.
inline bool IsCoverable(std::vector<WPoint> const& points, long double factor = 1.0L) {
  return IsCoverableIn<long double>(points, factor);
}

}  // namespace Vorn::Testing
