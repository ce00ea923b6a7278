#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "determinism/Digest.h"
#include "determinism/Inputs.h"
#include "determinism/Sections.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {

namespace {

using Contour = std::vector<GeometryUtils::Elem>;
using ElemType = GeometryUtils::ElemType;
using Point = GeometryUtils::Point;

constexpr int kRounds = 3000;

/// A chain of segments and arcs whose fields fit together or, one time in four, do not.
Contour DrawContour(Inputs* inputs, std::int32_t size) {
  RandomGeometry& random = inputs->Random();
  Contour contour;
  GeometryUtils::AddSegm(&contour, inputs->Point());
  for (std::int32_t i = 0; i < size; ++i) {
    Point const start = contour.back().end;
    Point const end = inputs->Point();
    if (random.Flip()) {
      GeometryUtils::AddSegm(&contour, end);
      continue;
    }
    Point const centre = inputs->Point();
    double const dx = start.x - centre.x;
    double const dy = start.y - centre.y;
    double const radius =
        random.Integer(0, 3) == 0 ? inputs->Number() : std::sqrt(dx * dx + dy * dy);
    GeometryUtils::AddArc(&contour, start, end, centre, radius, random.Flip());
  }
  if (random.Flip()) GeometryUtils::AddSegm(&contour, contour.front().end);
  if (random.Integer(0, 9) == 0) contour.back().type = static_cast<ElemType>(7);
  return contour;
}

/// A closed wave of segments and arcs that does not cross itself unless its amplitude is large;
/// long enough for the search that replaces the walk over all pairs.
Contour DrawWave(Inputs* inputs) {
  RandomGeometry& random = inputs->Random();
  std::int32_t const size = random.Integer(40, 90);
  double const amplitude = random.Uniform(0.0, 1.3);
  Contour contour;
  GeometryUtils::AddSegm(&contour, {10.0, 0.0});
  for (std::int32_t i = 1; i < size; ++i) {
    Point const start = contour.back().end;
    double const angle = 6.25 * i / size;
    double const radius = 10.0 + amplitude * random.Uniform(-1.0, 1.0);
    Point const end{radius * std::cos(angle), radius * std::sin(angle)};
    if (random.Integer(0, 2) > 0) {
      GeometryUtils::AddSegm(&contour, end);
      continue;
    }
    Point const centre{0.5 * (start.x + end.x) - (end.y - start.y),
                       0.5 * (start.y + end.y) + (end.x - start.x)};
    double const dx = start.x - centre.x;
    double const dy = start.y - centre.y;
    GeometryUtils::AddArc(&contour, start, end, centre, std::sqrt(dx * dx + dy * dy),
                          random.Flip());
  }
  GeometryUtils::AddSegm(&contour, contour.front().end);
  return contour;
}

void AddContour(Contour const& contour, Digest* digest) {
  double area = -1.0;
  digest->Add(GeometryUtils::CheckPolySelfIntersection(contour),
              GeometryUtils::GetArea(contour, &area));
  digest->Add(area);
}

void AddFlat(std::vector<double> coords, std::vector<std::int32_t> const& indices, Digest* digest) {
  double area = -1.0;
  bool found = false;
  digest->Add(GeometryUtils::GetArea(coords, indices, &area),
              GeometryUtils::GetPolyOrientation(coords, indices));
  digest->Add(GeometryUtils::CheckPolySelfIntersection(coords, indices, &found), coords.size());
  digest->Add(area, found);
  std::uint32_t run = 77;
  digest->Add(GeometryUtils::GetIndicesIndex(indices, 12, &run), run);
}

/// Runs of plain vertices and of records, most of which end where the entries say.
void AddMixedFlat(Inputs* inputs, Digest* digest) {
  RandomGeometry& random = inputs->Random();
  std::vector<std::int32_t> indices;
  std::int32_t end = 0;
  std::int32_t const runs = random.Integer(1, 3);
  for (std::int32_t run = 0; run < runs; ++run) {
    bool const isRecords = random.Integer(0, 2) == 0;
    end += (isRecords ? 8 : 2) * random.Integer(0, 5);
    indices.push_back(isRecords ? -end : end);
  }
  std::int32_t const beyond = random.Integer(0, 3) == 0 ? 0 : 10;
  std::vector<double> coords;
  for (std::int32_t i = 0; i < end + beyond; ++i) coords.push_back(inputs->Number());
  AddFlat(coords, indices, digest);
}

}  // namespace

std::uint64_t DigestChains() {
  return DigestRounds(301, kRounds, [](Inputs* inputs, Digest* digest) {
    Contour contour = DrawContour(inputs, inputs->Random().Integer(1, 4));
    Contour const replacements = DrawContour(inputs, 1);
    auto const [dx, dy, sx, sy] = inputs->Numbers<4>();
    int const parts = inputs->Random().Integer(1, 5);
    GeometryUtils::Elem shifted;
    std::array<GeometryUtils::Elem, 5> pieces{};
    Point end;
    digest->Add(GeometryUtils::ShiftElem(contour.back(), {dx, dy}, &shifted), shifted);
    digest->Add(GeometryUtils::SplitElem(contour.back(), parts, {sx, sy}, pieces.data()));
    for (auto const& piece : pieces) digest->Add(piece);
    digest->Add(GeometryUtils::GetElemPoint(&contour, &end), end);
    digest->Add(GeometryUtils::ReplaceElem(&contour, replacements.back()), contour);
    GeometryUtils::Elem removed;
    digest->Add(GeometryUtils::RemoveElem(&contour, &removed), removed, contour);
  });
}

std::uint64_t DigestContours() {
  return DigestRounds(302, kRounds, [](Inputs* inputs, Digest* digest) {
    AddContour(DrawContour(inputs, inputs->Random().Integer(1, 8)), digest);
    if (inputs->Random().Integer(0, 9) == 0) AddContour(DrawWave(inputs), digest);
  });
}

std::uint64_t DigestFlatPolylines() {
  return DigestRounds(303, kRounds, [](Inputs* inputs, Digest* digest) {
    AddMixedFlat(inputs, digest);
    if (inputs->Random().Integer(0, 9) > 0) return;
    Contour const wave = DrawWave(inputs);
    std::vector<double> coords;
    for (auto const& elem : wave) coords.insert(coords.end(), {elem.end.x, elem.end.y});
    AddFlat(coords, {static_cast<std::int32_t>(coords.size()) - 4}, digest);
  });
}

}  // namespace Vorn::Testing
