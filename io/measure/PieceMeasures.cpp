#include "vorn/io/PieceMeasures.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "vorn/io/CheckReport.h"

namespace Vorn::IO {

namespace {

using std::numbers::pi;

/// Even, so that the middle of the histogram tells left from right.
constexpr std::size_t kRanges = 20;

std::vector<std::vector<XY>> PointsByPiece(std::vector<WPoint> const& points,
                                           std::vector<PointDeviation> const& deviations,
                                           std::size_t pieces) {
  std::vector<std::vector<XY>> sorted(pieces);
  for (std::size_t i = 0; i < points.size(); ++i) {
    sorted[deviations[i].piece].push_back({points[i].x, points[i].y});
  }
  return sorted;
}

/// To (-pi, pi].
double Principal(double angle) {
  double const turned = std::remainder(angle, 2.0 * pi);
  return turned <= -pi ? pi : turned;
}

/// Direction of travel at one end of the piece.
double DirectionAt(Piece const& piece, bool isStart) {
  if (!piece.IsArc()) {
    return std::atan2(piece.end.y - piece.start.y, piece.end.x - piece.start.x);
  }
  double const polar = isStart ? piece.startAngle : piece.endAngle;
  return polar + (piece.counterClockwise ? 0.5 : -0.5) * pi;
}

double TurnBetweenPieces(Piece const& before, Piece const& after) {
  return Principal(DirectionAt(after, true) - DirectionAt(before, false));
}

/// The line's direction along the piece in place of either way.
std::optional<LeastSquaresLine> FitAlong(Piece const& piece, std::vector<XY> const& points) {
  std::optional<LeastSquaresLine> line = FitLine(points);
  if (!line) return line;
  double const turned = Principal(line->direction - DirectionAt(piece, true));
  if (std::fabs(turned) > 0.5 * pi) line->direction = Principal(line->direction + pi);
  return line;
}

void Count(double value, Histogram* histogram) {
  double const range = std::floor((value - histogram->low) / histogram->width);
  auto const count = static_cast<double>(histogram->counts.size());
  if (value < histogram->low) {
    ++histogram->below;
  } else if (value <= -histogram->low) {
    // What is exactly at the upper end belongs to the last range.
    ++histogram->counts[static_cast<std::size_t>(std::clamp(range, 0.0, count - 1.0))];
  } else {
    ++histogram->above;
  }
}

/// The end of the histogram when there are no tolerances.
double LargestDistance(std::vector<PointDeviation> const& deviations) {
  double largest = 0.0;
  for (PointDeviation const& deviation : deviations) {
    if (std::isfinite(deviation.distance)) largest = std::max(largest, deviation.distance);
  }
  return largest > 0.0 ? largest : 1.0;
}

}  // namespace

Scatter const* PieceMeasure::ScatterOfPoints() const {
  if (line) return &line->scatter;
  return circle ? &circle->scatter : nullptr;
}

std::vector<PieceMeasure> MeasurePieces(std::vector<WPoint> const& points,
                                        std::vector<PointDeviation> const& deviations,
                                        std::vector<Piece> const& pieces, bool isClosed) {
  std::vector<std::vector<XY>> const sorted = PointsByPiece(points, deviations, pieces.size());
  std::vector<PieceMeasure> measures(pieces.size());
  for (std::size_t i = 0; i < pieces.size(); ++i) {
    PieceMeasure& measure = measures[i];
    measure.points = sorted[i].size();
    if (pieces[i].IsArc()) {
      measure.circle = FitCircle(sorted[i]);
    } else {
      measure.line = FitAlong(pieces[i], sorted[i]);
    }
    bool const isLast = i + 1 == pieces.size();
    if (!isLast || isClosed) {
      measure.turn = TurnBetweenPieces(pieces[i], pieces[isLast ? 0 : i + 1]);
    }
  }
  return measures;
}

DeviationSummary Summarise(std::vector<WPoint> const& points,
                           std::vector<PointDeviation> const& deviations, bool hasTolerances) {
  DeviationSummary summary;
  summary.isRelative = hasTolerances;
  summary.histogram.low = hasTolerances ? -1.0 : -LargestDistance(deviations);
  summary.histogram.width = -2.0 * summary.histogram.low / static_cast<double>(kRanges);
  summary.histogram.counts.assign(kRanges, 0);
  auto const count = static_cast<double>(deviations.size());
  double meanSquare = 0.0;
  for (std::size_t i = 0; i < deviations.size(); ++i) {
    double const distance = SignedDistance(deviations[i]);
    summary.mean += distance / count;
    meanSquare += distance * distance / count;
    bool const isOutside = hasTolerances && !IsWithinTolerance(deviations[i], points[i]);
    if (isOutside) ++summary.outside;
    double const limited =
        isOutside ? distance / points[i].w : std::clamp(distance / points[i].w, -1.0, 1.0);
    Count(hasTolerances ? limited : distance, &summary.histogram);
  }
  summary.rootMeanSquare = std::sqrt(meanSquare);
  return summary;
}

}  // namespace Vorn::IO
