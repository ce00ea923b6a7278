#include <algorithm>
#include <cmath>

#include "io/measure/Normalised.h"
#include "vorn/io/LeastSquares.h"

namespace Vorn::IO {

namespace {

constexpr double kParameters = 2.0;

/// Second moments of points about their mean.
struct Moments {
  double xx = 0.0;
  double xy = 0.0;
  double yy = 0.0;
};

Moments MomentsOf(std::vector<XY> const& points) {
  Moments moments;
  for (XY const& at : points) {
    moments.xx += at.x * at.x;
    moments.xy += at.x * at.y;
    moments.yy += at.y * at.y;
  }
  return moments;
}

/// The larger axis of the ellipse of inertia.
double MainDirection(Moments const& moments) {
  return 0.5 * std::atan2(2.0 * moments.xy, moments.xx - moments.yy);
}

}  // namespace

std::optional<LeastSquaresLine> FitLine(std::vector<XY> const& points) {
  std::optional<Normalised> const normalised = Normalise(points);
  if (!normalised) return {};
  LeastSquaresLine line;
  line.at = normalised->mean;
  line.direction = MainDirection(MomentsOf(normalised->at));
  double const cosine = std::cos(line.direction);
  double const sine = std::sin(line.direction);
  double least = 0.0;
  double most = 0.0;
  double squares = 0.0;
  double lengthwise = 0.0;
  for (XY const& at : normalised->at) {
    double const aside = cosine * at.y - sine * at.x;
    double const along = cosine * at.x + sine * at.y;
    least = std::min(least, aside);
    most = std::max(most, aside);
    squares += aside * aside;
    lengthwise += along * along;
  }
  line.scatter.formError = normalised->size * (most - least);
  auto const count = static_cast<double>(points.size());
  if (count <= kParameters) return line;
  double const deviation = std::sqrt(squares / (count - kParameters));
  line.scatter.standardDeviation = normalised->size * deviation;
  line.directionDeviation = deviation / std::sqrt(lengthwise);
  return line;
}

}  // namespace Vorn::IO
