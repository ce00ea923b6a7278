#include "geometry/fewest/Growth.h"

#include <algorithm>

namespace Vorn::Fewest {

void FreeRun::Begin(std::int32_t start, std::int32_t expected) {
  start_ = start;
  auto const count = static_cast<std::int32_t>(points_.size());
  std::int32_t const probe = std::min(count, start + expected);
  auto const first = points_.subspan(static_cast<std::size_t>(start));
  frame_.originX = first.front().x;
  frame_.originY = first.front().y;
  frame_.scale = ScaleOf(ExtentOf(first.first(static_cast<std::size_t>(probe - start))));
  double least = points_[static_cast<std::size_t>(start)].w;
  for (WPoint const& p : first.first(static_cast<std::size_t>(probe - start))) {
    least = std::min(least, p.w);
  }
  slack_ = SlackFor(1.0 / (frame_.scale * least));
  columns_.Clear();
  basis_ = Basis();
  programme_ = Programme();
  programme_.columns = &columns_;
  if (limits_.segmentsOnly) {
    programme_.Add({{1.0, 0.0, 0.0, 0.0}, Condition::Kind::Equality, 0.0});
  } else if (limits_.smallestRadius > 0.0) {
    double const limit = 0.5 / (limits_.smallestRadius * frame_.scale);
    programme_.Add({{1.0, 0.0, 0.0, 0.0}, Condition::Kind::Slab, limit});
  }
}

void FreeRun::Extend(std::int32_t end) {
  for (std::int32_t i = start_ + columns_.Size(); i < end; ++i) {
    columns_.Append(frame_.ToLocal(points_[static_cast<std::size_t>(i)]));
  }
  programme_.first = 0;
  programme_.last = end - start_;
}

bool FreeRun::Try(std::int32_t end) {
  Extend(end);
  Simplex simplex(slack_);
  Basis basis = basis_;
  RunFit const fit = FitRun(programme_, {circle_, 0.0, false}, true, &simplex, &basis);
  if (!fit.isFound || fit.ratio > 1.0 + slack_) return false;
  // The slack of a programme grows with its objective, which may exceed the size of the circle.
  Columns::Worst const worst = columns_.FindWorst(programme_.first, programme_.last, fit.circle);
  if (worst.value > 1.0 + 2.0 * slack_) return false;
  basis_ = basis;
  circle_ = fit.circle;
  return true;
}

std::int32_t FreeRun::ExtendCovered(std::int32_t good, std::int32_t bad) {
  auto const count = static_cast<std::int32_t>(points_.size());
  while (good + 1 < bad && good < count) {
    Extend(good + 1);
    std::int32_t const next = good - start_;
    if (columns_.FindFirstAbove(next, next + 1, circle_, 1.0) <= next) break;
    ++good;
  }
  return good;
}

std::int32_t FreeRun::FindEnd(std::int32_t start, std::int32_t expected) {
  auto const count = static_cast<std::int32_t>(points_.size());
  Begin(start, std::max(expected, 2));
  if (count - start <= 3) return count;
  std::int32_t const probe = std::min(count - 1, start + std::max(expected / 2, 2));
  circle_ = LineThrough(PlaceOf(frame_.ToLocal(points_[static_cast<std::size_t>(start)])),
                        PlaceOf(frame_.ToLocal(points_[static_cast<std::size_t>(probe)])));
  std::int32_t good = start + 2;
  std::int32_t bad = count + 1;
  std::int32_t target = std::min(count, std::max(good + 2, start + expected));
  Simplex simplex(slack_);
  while (good < count) {
    if (Try(target)) {
      good = ExtendCovered(target, bad);
    } else {
      bad = target;
    }
    if (bad == good + 1 && bad <= count) {
      Extend(bad);
      RunFit const proof = ProveRun(programme_, basis_, &simplex, &polytope_);
      if (!proof.isFound) return good;
      good = bad;
      bad = count + 1;
      if (proof.ratio <= 1.0 + simplex.Slack()) circle_ = proof.circle;
    }
    std::int32_t const doubled = good + (good - start);
    target = bad <= count ? good + std::max(1, (bad - good) / 2) : std::min(count, doubled);
  }
  return count;
}

}  // namespace Vorn::Fewest
