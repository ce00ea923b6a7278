#include "geometry/fewest/promises/Coverage.h"

#include <algorithm>
#include <cmath>

namespace Vorn::Promises {

namespace {

using Point = GeometryUtils::Point;
using Elem = GeometryUtils::Elem;
using ElemType = GeometryUtils::ElemType;

bool IsFinite(Point const& p) { return std::isfinite(p.x) && std::isfinite(p.y); }

bool IsProperArc(GeometryUtils::Arc const& arc) {
  return IsFinite(arc.center) && std::isfinite(arc.radius) && arc.radius > 0.0 &&
         std::fabs(arc.direction) == 1.0 && std::isfinite(arc.startAngle) &&
         std::isfinite(arc.endAngle);
}

bool IsProper(Elem const& elem) {
  if (!IsFinite(elem.end)) return false;
  return elem.type == ElemType::Segment || (elem.type == ElemType::Arc && IsProperArc(elem));
}

bool HasPieces(Chain const& chain) {
  std::vector<Elem> const& contour = chain.contour;
  return !chain.points.empty() && contour.size() >= 2 &&
         chain.ranges.size() + 1 == contour.size() && contour.front().type == ElemType::Segment &&
         std::all_of(contour.begin(), contour.end(), IsProper);
}

}  // namespace

std::optional<Coverage> Coverage::Of(Chain const& chain) {
  if (!HasPieces(chain)) return std::nullopt;
  Coverage coverage(chain);
  if (!coverage.NumberPoints()) return std::nullopt;
  return coverage;
}

bool Coverage::NumberPoints() {
  std::size_t const size = chain_.points.size();
  auto next = static_cast<std::size_t>(chain_.ranges.front().first);
  std::size_t const end = next + size;
  if (!chain_.isClosed && next != 0) return false;
  ranges_.reserve(chain_.ranges.size());
  for (PieceRange const& range : chain_.ranges) {
    auto const first = static_cast<std::size_t>(range.first);
    auto const last = static_cast<std::size_t>(range.last);
    if (first >= size || last >= size || next >= end || first != next % size) return false;
    std::size_t const count = (last + size - first) % size + 1;
    if (!chain_.isClosed && last < first) return false;
    ranges_.push_back({next, next + count - 1});
    next += count;
  }
  return next == end;
}

std::size_t Coverage::Previous(std::size_t piece) const {
  if (piece > 0) return piece - 1;
  return IsClosed() ? PieceCount() - 1 : kNone;
}

std::size_t Coverage::Next(std::size_t piece) const {
  if (piece + 1 < PieceCount()) return piece + 1;
  return IsClosed() ? 0 : kNone;
}

}  // namespace Vorn::Promises
