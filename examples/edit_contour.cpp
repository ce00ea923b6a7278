// Edits a fitted contour: moves it, splits an arc into equal parts, replaces the last element.

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <vector>

#include "vorn/GeometryUtils.h"

using Vorn::GeometryUtils;

namespace {

using Contour = std::vector<GeometryUtils::Elem>;

// Half a circle of radius 10 around (15, 3), clockwise from (5, 3) over the top to (25, 3).
Contour FitHalfCircle() {
  double const halfTurn = std::acos(-1.0);
  std::vector<Vorn::WPoint> points;
  for (int i = 0; i <= 30; ++i) {
    double const angle = halfTurn * (1.0 - i / 30.0);
    points.push_back({15.0 + 10.0 * std::cos(angle), 3.0 + 10.0 * std::sin(angle), 0.01});
  }
  Contour contour;
  double deviation = 0.0;
  std::int32_t index = -1;
  GeometryUtils::CreateFittingCurve(points, GeometryUtils::FittingStrategy::Mixed, &contour,
                                    &deviation, &index, nullptr, 100);
  return contour;
}

void Print(char const* title, Contour const& contour) {
  std::printf("%s\n", title);
  std::printf("  starts at  (%.2f, %.2f)\n", contour.front().end.x, contour.front().end.y);
  for (std::size_t i = 1; i < contour.size(); ++i) {
    GeometryUtils::Elem const& elem = contour[i];
    bool const isArc = elem.type == GeometryUtils::ElemType::Arc;
    std::printf("  %-7s to (%.2f, %.2f)", isArc ? "arc" : "segment", elem.end.x, elem.end.y);
    if (isArc) std::printf(", length %.2f", GeometryUtils::GetArcLength(elem));
    std::printf("\n");
  }
}

}  // namespace

int main() {
  Contour contour = FitHalfCircle();
  if (contour.empty()) return 1;
  Print("fitted", contour);

  // Moving a contour means moving every element, the start element included.
  for (GeometryUtils::Elem& elem : contour) {
    GeometryUtils::Elem const original = elem;
    if (!GeometryUtils::ShiftElem(original, {0.0, 5.0}, &elem)) return 1;
  }
  Print("moved up by 5", contour);

  // Splitting writes the parts into an array; here they take the place of the last element. The
  // start point is looked at for segments only, which do not store it either.
  constexpr int kParts = 3;
  GeometryUtils::Elem whole;
  GeometryUtils::Elem parts[kParts];
  if (!GeometryUtils::RemoveElem(&contour, &whole)) return 1;
  GeometryUtils::Point const start = contour.back().end;
  if (!GeometryUtils::SplitElem(whole, kParts, {start.x, start.y}, parts)) return 1;
  contour.insert(contour.end(), parts, parts + kParts);
  Print("arc cut into three", contour);

  // Replacing changes the last element: here the last third of the arc becomes its chord.
  GeometryUtils::Elem chord;
  chord.type = GeometryUtils::ElemType::Segment;
  chord.end = contour.back().end;
  if (!GeometryUtils::ReplaceElem(&contour, chord)) return 1;
  Print("last part replaced by its chord", contour);
  return 0;
}
