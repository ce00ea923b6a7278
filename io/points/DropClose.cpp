#include "io/base/TextLines.h"
#include "vorn/io/Spacing.h"
#include "vorn/io/Thinning.h"

namespace Vorn::IO {

TooClose RuleOfTolerances() {
  return [](WPoint const& a, WPoint const& b) { return AreTooClose(a, b); };
}

TooClose RuleOfSpacing(double cap) {
  return [cap](WPoint a, WPoint b) {
    a.w = b.w = ToleranceForSpacing(cap, Distance(a, b));
    return !(a.w > 0.0) || AreTooClose(a, b);
  };
}

std::vector<std::size_t> KeepSpaced(std::vector<WPoint> const& points, TooClose const& tooClose) {
  std::vector<std::size_t> kept;
  if (points.empty()) return kept;
  std::size_t const last = points.size() - 1;
  for (std::size_t i = 0; i < last; ++i) {
    if (kept.empty() || !tooClose(points[kept.back()], points[i])) kept.push_back(i);
  }
  while (kept.size() > 1 && tooClose(points[kept.back()], points[last])) kept.pop_back();
  if (kept.empty() || !tooClose(points[kept.back()], points[last])) kept.push_back(last);
  return kept;
}

void DropCloseToFirst(std::vector<WPoint> const& points, TooClose const& tooClose,
                      std::vector<std::size_t>* kept) {
  while (kept->size() > 1 && tooClose(points[kept->back()], points[kept->front()])) {
    kept->pop_back();
  }
}

std::vector<std::size_t> Others(std::vector<std::size_t> const& kept, std::size_t count) {
  std::vector<std::size_t> others;
  others.reserve(count - kept.size());
  auto next = kept.begin();
  for (std::size_t i = 0; i < count; ++i) {
    if (next != kept.end() && *next == i) {
      ++next;
    } else {
      others.push_back(i);
    }
  }
  return others;
}

std::string WithoutLines(std::string_view text, std::vector<std::size_t> const& lines) {
  std::string rest;
  rest.reserve(text.size());
  auto next = lines.begin();
  TextLines walk(text);
  for (std::size_t line = 1; !walk.AtEnd(); ++line) {
    std::size_t const begin = walk.Position();
    walk.Take();
    if (next != lines.end() && *next == line) {
      ++next;
    } else {
      rest += text.substr(begin, walk.Position() - begin);
    }
  }
  return rest;
}

}  // namespace Vorn::IO
