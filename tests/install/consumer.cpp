// What a program of another project does with the library: fit a contour, edit it, measure it.

#include <vorn/GeometryUtils.h>
#include <vorn/MathUtils.h>
#include <vorn/Matrix.h>

#include <cstdio>
#include <vector>

namespace {

using Vorn::GeometryUtils;

class LastPercent final : public Vorn::ExecutionState {
 public:
  void SetProgress(std::int32_t percent) override { value = percent; }
  std::int32_t value = -1;
};

// A corner: ten units along x, then ten along y.
std::vector<Vorn::WPoint> Corner() {
  std::vector<Vorn::WPoint> points;
  for (int i = 0; i <= 10; ++i) points.push_back({1.0 * i, 0.0, 0.05});
  for (int i = 1; i <= 10; ++i) points.push_back({10.0, 1.0 * i, 0.05});
  return points;
}

bool PrintFit() {
  std::vector<GeometryUtils::Elem> contour;
  double deviation = 0.0;
  std::int32_t worst = 0;
  LastPercent progress;
  Vorn::ErrorCode const code =
      GeometryUtils::CreateFittingCurve(Corner(), GeometryUtils::FittingStrategy::Mixed, &contour,
                                        &deviation, &worst, &progress, 100);
  if (code != Vorn::ErrorCode::Ok || contour.empty()) return false;
  GeometryUtils::Point const& end = contour.back().end;
  std::printf("pieces %zu\n", contour.size() - 1);
  std::printf("ends at %.1f %.1f\n", end.x, end.y);
  std::printf("within tolerance %d\n", deviation <= 1.0);
  return GeometryUtils::AddSegm(&contour, contour.front().end);
}

bool PrintArea() {
  std::vector<GeometryUtils::Elem> square;
  double const corners[5][2] = {{0, 0}, {0, 2}, {2, 2}, {2, 0}, {0, 0}};
  for (auto const& corner : corners) {
    if (!GeometryUtils::AddSegm(&square, {corner[0], corner[1]})) return false;
  }
  double area = 0.0;
  if (GeometryUtils::GetArea(square, &area) != Vorn::ErrorCode::Ok) return false;
  std::printf("area %.1f\n", area);
  return true;
}

bool PrintSolution() {
  double matrix[4] = {2.0, 0.0, 0.0, 4.0};
  double rhs[2] = {2.0, 2.0};
  double solution[2] = {};
  if (!Vorn::MathUtils::LinearEquationSystemSolve(2, matrix, rhs, solution)) return false;
  std::printf("solution %.1f %.1f\n", solution[0], solution[1]);
  Vorn::Matrix rotation;
  rotation.InitI();
  std::printf("determinant %.1f\n", rotation.Det());
  return true;
}

}  // namespace

int main() { return PrintFit() && PrintArea() && PrintSolution() ? 0 : 1; }
