#include "NoFit.h"

#include <algorithm>
#include <cmath>
#include <optional>
#include <string>
#include <utility>

#include "vorn/io/LeastSquares.h"
#include "vorn/io/Numbers.h"
#include "vorn/io/Pieces.h"

namespace Vorn::Python {

namespace {

/// The point furthest from the circle of least squares in units of its tolerance.
struct Furthest {
  std::size_t point = 0;
  double distance = 0.0;
  double relative = 0.0;
};

std::optional<Furthest> FurthestFromCircle(std::vector<WPoint> const& points) {
  std::vector<IO::XY> places;
  places.reserve(points.size());
  for (WPoint const& point : points) places.push_back({point.x, point.y});
  std::optional<IO::LeastSquaresCircle> const circle = IO::FitCircle(places);
  if (!circle) return {};
  Furthest furthest;
  for (std::size_t i = 0; i < points.size(); ++i) {
    double const distance = std::abs(IO::Distance(places[i], circle->center) - circle->radius);
    double const relative = distance / points[i].w;
    if (relative > furthest.relative) furthest = {i, distance, relative};
  }
  return furthest;
}

Problem NoArc(std::vector<WPoint> const& points) {
  std::string const what = "no single arc passes the points within their tolerances";
  std::string const ways = "; \"fewest\" and \"mixed\" make several pieces";
  std::optional<Furthest> const furthest = FurthestFromCircle(points);
  if (!furthest) return {ErrorCode::NoFit, what + ": no circle runs through them" + ways, {}};
  if (!(furthest->relative > 1.0)) return {ErrorCode::NoFit, what + ways, {}};
  return {ErrorCode::NoFit,
          what + ": point " + std::to_string(furthest->point) + " is " +
              IO::FormatShort(furthest->distance, 3) + " from the circle of least squares, " +
              IO::FormatShort(furthest->relative, 3) + " times its tolerance" + ways,
          {static_cast<std::int64_t>(furthest->point)}};
}

/// Whether the first `count` points have a contour by themselves.
bool HasContour(std::vector<WPoint> const& points, std::size_t count, IO::FitChoice const& choice,
                Progress* progress) {
  IO::PointFile beginning;
  beginning.points.assign(points.begin(), points.begin() + static_cast<std::ptrdiff_t>(count));
  beginning.hasTolerances = true;
  try {
    return !IO::FitContour(std::move(beginning), choice, progress).pieces.empty();
  } catch (IO::Failure const&) {
    return false;
  }
}

/// The point with which a beginning of the points first has no contour; nothing when the points
/// have one as an open path.
std::optional<std::size_t> FirstWithout(std::vector<WPoint> const& points,
                                        IO::FitChoice const& choice, Progress* progress) {
  if (HasContour(points, points.size(), choice, progress)) return {};
  std::size_t with = 1;
  std::size_t without = points.size();
  while (without - with > 1) {
    std::size_t const middle = with + (without - with) / 2;
    (HasContour(points, middle, choice, progress) ? with : without) = middle;
  }
  return without - 1;
}

Problem NoCells(std::vector<WPoint> const& points, IO::FitChoice choice, Progress* progress) {
  std::string const what = "the strategy \"" + IO::NameOf(choice.strategy) +
                           "\" finds no lines and arcs within the tolerances";
  choice.closed = IO::ClosedChoice::No;
  choice.start.reset();
  choice.warnOfFineTolerance = nullptr;
  std::optional<std::size_t> const first = FirstWithout(points, choice, progress);
  if (!first) return {ErrorCode::NoFit, what + " once around, but does for an open contour", {}};
  std::string const where = *first < 2 ? " for points 0 and 1"
                                       : ": it does for points 0 to " + std::to_string(*first - 1) +
                                             ", but not with point " + std::to_string(*first);
  return {ErrorCode::NoFit,
          what + where + "; \"fewest\" takes every shape",
          {static_cast<std::int64_t>(*first)}};
}

}  // namespace

Problem ExplainNoFit(Problem problem, std::vector<WPoint> const& points,
                     IO::FitChoice const& choice, Progress* progress) {
  switch (choice.strategy) {
    case IO::Strategy::Arc:
      return NoArc(points);
    case IO::Strategy::Mixed:
    case IO::Strategy::Cells:
      return NoCells(points, choice, progress);
    case IO::Strategy::Fewest:
      break;
  }
  return problem;
}

}  // namespace Vorn::Python
