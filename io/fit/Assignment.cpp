#include "io/fit/Assignment.h"

#include <algorithm>
#include <limits>

#include "vorn/io/Deviations.h"

namespace Vorn::IO {

namespace {

constexpr std::size_t kLargestTable = 20'000'000;

/// Far outside is far outside: without a ceiling the squares of absurd distances would drown the
/// differences that decide elsewhere.
constexpr double kLargestCost = 1e12;

double Cost(WPoint const& point, Piece const& piece) {
  double const relative = DistanceTo(piece, point.x, point.y) / point.w;
  return std::min(relative * relative, kLargestCost);
}

}  // namespace

std::optional<std::vector<PointRange>> AssignPoints(std::vector<WPoint> const& points,
                                                    std::vector<Piece> const& pieces) {
  std::size_t const columns = pieces.size();
  if (columns == 0 || points.size() > kLargestTable / columns) return {};

  // best[k]: least cost of the points so far with the latest one on piece k. origin: the piece of
  // the point before on the way there.
  std::vector<double> best(columns, std::numeric_limits<double>::infinity());
  best.front() = 0.0;
  std::vector<std::uint32_t> origin;
  origin.reserve(points.size() * columns);
  for (WPoint const& point : points) {
    std::size_t from = 0;
    double fromCost = best.front();
    for (std::size_t k = 0; k < columns; ++k) {
      if (best[k] < fromCost) {
        from = k;
        fromCost = best[k];
      }
      origin.push_back(static_cast<std::uint32_t>(from));
      best[k] = fromCost + Cost(point, pieces[k]);
    }
  }

  std::vector<PointRange> ranges(columns);
  auto piece = static_cast<std::size_t>(std::min_element(best.begin(), best.end()) - best.begin());
  for (std::size_t i = points.size(); i-- > 0;) {
    ranges[piece].first = i;
    ++ranges[piece].count;
    piece = origin[i * columns + piece];
  }
  return ranges;
}

}  // namespace Vorn::IO
