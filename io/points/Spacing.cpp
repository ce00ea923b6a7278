#include "vorn/io/Spacing.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

constexpr double kSpacingFactor = 1.5;
constexpr int kDigits = 6;

bool AreTooClose(WPoint const& a, WPoint const& b, double sumOfTolerances) {
  double const needed = sumOfTolerances * kSpacingFactor;
  double const dx = b.x - a.x;
  double const dy = b.y - a.y;
  return needed * needed >= dx * dx + dy * dy;
}

bool AllPass(std::vector<WPoint> const& points, double tolerance) {
  for (std::size_t i = 1; i < points.size(); ++i) {
    if (AreTooClose(points[i - 1], points[i], tolerance + tolerance)) return false;
  }
  return true;
}

}  // namespace

double NeededDistance(WPoint const& a, WPoint const& b) { return (a.w + b.w) * kSpacingFactor; }

bool AreTooClose(WPoint const& a, WPoint const& b) { return AreTooClose(a, b, a.w + b.w); }

double Distance(WPoint const& a, WPoint const& b) { return std::hypot(b.x - a.x, b.y - a.y); }

std::optional<ClosePair> FindClosePair(std::vector<WPoint> const& points) {
  for (std::size_t i = 1; i < points.size(); ++i) {
    WPoint const& a = points[i - 1];
    WPoint const& b = points[i];
    if (AreTooClose(a, b, a.w + b.w)) {
      return ClosePair{i - 1, i, Distance(a, b), kSpacingFactor * (a.w + b.w)};
    }
  }
  return {};
}

std::optional<double> LargestSingleTolerance(std::vector<WPoint> const& points) {
  double smallest = std::numeric_limits<double>::infinity();
  for (std::size_t i = 1; i < points.size(); ++i) {
    smallest = std::min(smallest, Distance(points[i - 1], points[i]));
  }
  double const limit = smallest / (2.0 * kSpacingFactor);
  // Rounding to six digits may go up, past the limit; one or two steps of the last digit down
  // bring it below.
  double const lastDigit = std::pow(10.0, std::floor(std::log10(limit)) - (kDigits - 1));
  for (int steps = 0; steps < 4; ++steps) {
    std::optional<double> const rounded =
        ParseNumber(FormatShort(limit - steps * lastDigit, kDigits));
    if (rounded && *rounded > 0.0 && AllPass(points, *rounded)) return rounded;
  }
  return {};
}

std::string DescribeClosePair(PointFile const& file, ClosePair const& pair,
                              std::optional<double> largest) {
  std::string const text = file.NameOf(pair.first) + " and " + file.NameOf(pair.second) +
                           " are too close: distance " + FormatShort(pair.distance) +
                           ", needed more than " + FormatShort(pair.needed) +
                           " (1.5 times the sum of their tolerances)\n";
  if (!largest) return text + "no tolerance would pass: neighbours in this file coincide";
  return text + "the largest single tolerance that would pass for this file is " +
         FormatShort(*largest);
}

}  // namespace Vorn::IO
