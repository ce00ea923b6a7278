#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "determinism/Digest.h"
#include "determinism/Inputs.h"
#include "determinism/Sections.h"
#include "vorn/MathUtils.h"
#include "vorn/Matrix.h"

namespace Vorn::Testing {

namespace {

constexpr int kRounds = 3000;

Matrix DrawMatrix(Inputs* inputs) {
  auto const numbers = inputs->Numbers<9>();
  Mtrx elements;
  std::copy(numbers.begin(), numbers.end(), elements.m);
  return Matrix(elements);
}

void AddMatrix(Matrix const& matrix, Digest* digest) { digest->Add(matrix.m_); }

}  // namespace

std::uint64_t DigestSolver() {
  return DigestRounds(401, kRounds, [](Inputs* inputs, Digest* digest) {
    auto const order = static_cast<std::size_t>(inputs->Random().Integer(1, 6));
    std::vector<double> matrix(order * order);
    std::vector<double> rhs(order);
    std::vector<double> solution(order, -1.0);
    for (double& element : matrix) element = inputs->Number();
    for (double& element : rhs) element = inputs->Number();
    digest->Add(MathUtils::LinearEquationSystemSolve(static_cast<int>(order), matrix.data(),
                                                     rhs.data(), solution.data()),
                matrix, rhs, solution);
    auto const [k1, m1, k2, m2, value] = inputs->Numbers<5>();
    double x = -1.0;
    double y = -1.0;
    digest->Add(MathUtils::GetLinesIntersection(k1, m1, k2, m2, x, y), x, y,
                MathUtils::GetOutsideMax(value), MathUtils::GetOutsideMin(value));
  });
}

std::uint64_t DigestSpace() {
  return DigestRounds(402, kRounds, [](Inputs* inputs, Digest* digest) {
    auto const p1 = inputs->Numbers<3>();
    auto const p2 = inputs->Numbers<3>();
    auto const q1 = inputs->Numbers<3>();
    auto const q2 = inputs->Numbers<3>();
    double out1[3] = {-1.0, -1.0, -1.0};
    double out2[3] = {-1.0, -1.0, -1.0};
    digest->Add(
        MathUtils::CalcNormalized3DVectors(p1.data(), p2.data(), q1.data(), q2.data(), out1, out2),
        out1, out2);
    Matrix a = DrawMatrix(inputs);
    Matrix const b = DrawMatrix(inputs);
    SpatVector vector;
    for (double& entry : vector.v) entry = inputs->Number();
    AddMatrix(a * b, digest);
    digest->Add(a.Det(), a.MxV(vector), a.VxM(vector));
    a.Reorth(inputs->Random().Integer(0, 11));
    AddMatrix(a, digest);
    a.Transpose();
    AddMatrix(a, digest);
  });
}

std::uint64_t DigestRotations() {
  return DigestRounds(403, kRounds, [](Inputs* inputs, Digest* digest) {
    auto const [x, y, z] = inputs->Numbers<3>();
    double angles[3] = {-1.0, -1.0, -1.0};
    Matrix rotation;
    rotation.InitMxMyMz(x, y, z);
    AddMatrix(rotation, digest);
    rotation.GetAnglesFromMxMyMz(&angles[0], &angles[1], &angles[2]);
    digest->Add(angles);
    rotation.InitMzMyMx(x, y, z);
    AddMatrix(rotation, digest);
    rotation.GetAnglesFromMzMyMx(&angles[0], &angles[1], &angles[2]);
    digest->Add(angles);
  });
}

std::vector<Section> const& AllSections() {
  using enum DependsOn;
  static std::vector<Section> const sections = {
      {"mixedFits", Libm, DigestMixedFits},
      {"mixedCellsFits", Libm, DigestMixedCellsFits},
      {"singleArcFits", Libm, DigestSingleArcFits},
      {"fewestProfiles", Libm, DigestFewestProfiles},
      {"fewestScans", Libm, DigestFewestScans},
      {"fewestScribbles", Libm, DigestFewestScribbles},
      {"angles", Libm, DigestAngles},
      {"distances", Arithmetic, DigestDistances},
      {"circles", Arithmetic, DigestCircles},
      {"lineIntersections", Arithmetic, DigestLineIntersections},
      {"arcIntersections", Libm, DigestArcIntersections},
      {"triangles", Arithmetic, DigestTriangles},
      {"polygons", Arithmetic, DigestPolygons},
      {"cells", Arithmetic, DigestCells},
      {"chains", Libm, DigestChains},
      {"contours", Libm, DigestContours},
      {"flatPolylines", Libm, DigestFlatPolylines},
      {"solver", Arithmetic, DigestSolver},
      {"space", Arithmetic, DigestSpace},
      {"rotations", Libm, DigestRotations},
  };
  return sections;
}

}  // namespace Vorn::Testing
