#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <vector>

#include "vorn/GeometryUtils.h"

/// The self-intersection tests as plain loops over all pairs in their order, rule by rule.
namespace Vorn::Testing {

using ReferenceElem = GeometryUtils::Elem;

inline int CountOfSegmentAndArc(GeometryUtils::Point const& a, GeometryUtils::Point const& b,
                                GeometryUtils::Arc const& arc) {
  double p[4];
  return GeometryUtils::GetLineSegmentAndCircleArcIntersection(
      a.x, a.y, b.x, b.y, arc.center.x, arc.center.y, arc.radius, arc.direction, arc.startAngle,
      arc.endAngle, p, p + 1, p + 2, p + 3);
}

inline int CountOfArcs(GeometryUtils::Arc const& a, GeometryUtils::Arc const& b) {
  double p[4];
  return GeometryUtils::GetCircleArcAndCircleArcIntersection(
      a.center.x, a.center.y, a.radius, a.direction, a.startAngle, a.endAngle, b.center.x,
      b.center.y, b.radius, b.direction, b.startAngle, b.endAngle, p, p + 1, p + 2, p + 3);
}

inline bool DoSegmentsCross(GeometryUtils::Point const& a, GeometryUtils::Point const& b,
                            GeometryUtils::Point const& c, GeometryUtils::Point const& d) {
  double x = 0.0;
  double y = 0.0;
  return GeometryUtils::GetLineSegmentsIntersection(a.x, a.y, b.x, b.y, c.x, c.y, d.x, d.y, &x,
                                                    &y) == SegmentsRelPosition::Intersecting;
}

/// The number of the next element that is not of zero length, or that of the end.
inline std::size_t NextOf(std::vector<ReferenceElem> const& contour, std::size_t from) {
  auto it = contour.begin() + static_cast<std::ptrdiff_t>(from);
  auto next = it;
  bool const isThere = GeometryUtils::GetNextIter(contour, it, &next) == ErrorCode::Ok;
  return isThere ? static_cast<std::size_t>(next - contour.begin()) : contour.size();
}

inline ErrorCode ReferenceCheckOfContour(std::vector<ReferenceElem> const& contour) {
  auto const isArc = [&](std::size_t e) { return contour[e].type == GeometryUtils::ElemType::Arc; };
  std::size_t const end = contour.size();
  if (contour.empty() || contour[0].type != GeometryUtils::ElemType::Segment) {
    return ErrorCode::Failed;
  }
  std::size_t const first = NextOf(contour, 0);
  if (first == end) return ErrorCode::Failed;
  for (std::size_t i = first; i != end; i = NextOf(contour, i)) {
    bool const isFirstPass = i == first;
    std::size_t const j = NextOf(contour, i);
    std::size_t const start = j != end && !isArc(i) && !isArc(j) ? NextOf(contour, j) : j;
    if (start == end) {
      if (isFirstPass) return ErrorCode::Failed;
      continue;
    }
    for (std::size_t k = start; k != end;) {
      bool const isClosing = isFirstPass && k == end - 1;
      auto const& s = contour[i - 1].end;
      auto const& t = contour[k - 1].end;
      if (!isArc(i) && isArc(k)) {
        int const n = CountOfSegmentAndArc(s, contour[i].end, contour[k]);
        if (n == -1) return ErrorCode::Failed;
        if (n == 2 || (n == 1 && !isClosing)) return ErrorCode::SelfIntersection;
      } else if (!isArc(i)) {
        if (isClosing) break;
        if (DoSegmentsCross(s, contour[i].end, t, contour[k].end)) {
          return ErrorCode::SelfIntersection;
        }
      } else if (isArc(k)) {
        int const n = CountOfArcs(contour[i], contour[k]);
        if (n < 0) return ErrorCode::Failed;
        if (n == 1 && (k == i + 1 || isClosing)) break;
        if (n > 0) return ErrorCode::SelfIntersection;
      } else {
        int const n = CountOfSegmentAndArc(t, contour[k].end, contour[i]);
        if (n == 2 || (n == 1 && k != start && !isClosing)) return ErrorCode::SelfIntersection;
      }
      std::size_t const next = NextOf(contour, k);
      if (next == end && isFirstPass && k != end - 1) return ErrorCode::Failed;
      k = next;
    }
  }
  return ErrorCode::Ok;
}

/// The check of a flat polyline that needs no closing vertex. Answers 100 for a crossing, otherwise
/// the number of the code.
class ReferenceFlatCheck {
 public:
  static constexpr int kCrossing = 100;

  ReferenceFlatCheck(std::vector<double> const& coords, std::vector<std::int32_t> const& indices)
      : coords_(coords), indices_(indices) {}

  int Answer() const {
    std::int64_t begin = 0;
    for (std::size_t r = 0; r < indices_.size(); ++r) {
      std::int64_t const end = EndOf(r);
      for (std::int64_t q = begin; q < end; q += StrideOf(r)) {
        int answer = Against(r, q, r, q + (IsStraight(r) ? 2 : 1) * StrideOf(r));
        for (std::size_t m = r + 1; m < indices_.size() && answer == 0; ++m) {
          answer = Against(r, q, m, end);
        }
        if (answer != 0) return answer;
      }
      begin = end;
    }
    return 0;
  }

 private:
  std::int64_t EndOf(std::size_t r) const { return std::abs(std::int64_t{indices_[r]}); }
  bool IsStraight(std::size_t r) const { return indices_[r] >= 1; }
  std::int64_t StrideOf(std::size_t r) const { return IsStraight(r) ? 2 : 8; }

  int Against(std::size_t r, std::int64_t q, std::size_t m, std::int64_t from) const {
    for (std::int64_t k = from; k < EndOf(m); k += StrideOf(m)) {
      int const answer = OfPair(IsStraight(r), q, IsStraight(m), k);
      if (answer != 0) return answer;
    }
    return 0;
  }

  int OfPair(bool isStraight1, std::int64_t p, bool isStraight2, std::int64_t q) const {
    auto const size = static_cast<std::int64_t>(coords_.size());
    if (p + (isStraight1 ? 4 : 8) > size || q + (isStraight2 ? 4 : 8) > size) return 2;
    if (isStraight1 && isStraight2) {
      return DoSegmentsCross(At(p), At(p + 2), At(q), At(q + 2)) ? kCrossing : 0;
    }
    if (isStraight1 || isStraight2) {
      std::int64_t const straight = isStraight1 ? p : q;
      std::int64_t const arc = isStraight1 ? q : p;
      int const n = CountOfSegmentAndArc(At(straight), At(straight + 2), ArcAt(arc));
      if (n < 0) return 2;
      return n == 2 || (n == 1 && !isStraight1) ? kCrossing : 0;
    }
    int const n = CountOfArcs(ArcAt(p), ArcAt(q));
    if (n < 0) return 1;
    return n == 2 || (n == 1 && q != p + 8) ? kCrossing : 0;
  }

  double Value(std::int64_t offset) const { return coords_[static_cast<std::size_t>(offset)]; }
  GeometryUtils::Point At(std::int64_t offset) const { return {Value(offset), Value(offset + 1)}; }
  GeometryUtils::Arc ArcAt(std::int64_t q) const {
    return {{}, At(q + 2), Value(q + 4), Value(q + 5), Value(q + 6), Value(q + 7)};
  }

  std::vector<double> const& coords_;
  std::vector<std::int32_t> const& indices_;
};

}  // namespace Vorn::Testing
