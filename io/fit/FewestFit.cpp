#include "io/fit/FewestFit.h"

#include <chrono>
#include <cmath>
#include <limits>
#include <utility>

#include "io/fit/FullCircle.h"
#include "vorn/FewestPieces.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Spacing.h"

namespace Vorn::IO {

namespace {

/// Of a closed contour the piece across the end of the input has its first point behind its last.
PointRange RangeOf(FewestPieces::Range const& range, std::size_t points) {
  auto const first = static_cast<std::size_t>(range.first);
  auto const last = static_cast<std::size_t>(range.last);
  return {first, (last + points - first) % points + 1};
}

FitAnswer AnswerOf(FewestPieces::Result result, std::size_t points) {
  FitAnswer answer;
  answer.code = ErrorCode::Ok;
  answer.contour = std::move(result.contour);
  answer.deviation = result.largestDeviation;
  answer.deviationIndex = result.largestDeviationIndex;
  answer.fewestPossible = static_cast<std::size_t>(result.fewestPossible);
  answer.ranges.emplace();
  for (FewestPieces::Range const& range : result.ranges) {
    answer.ranges->push_back(RangeOf(range, points));
  }
  return answer;
}

std::string WhyNone(ErrorCode code, std::vector<WPoint> const& points) {
  if (code == ErrorCode::Failed) {
    return "the points, their tolerances or the options are not what the fewest pieces can take";
  }
  if (DoPointsCoincide(points)) return "all points coincide within their tolerances";
  return "no lines and arcs pass the points in order, each within its tolerance, without crossing "
         "where the points do not";
}

/// Whether an arc of this radius may be taken for the points of a full circle, which are up to
/// kLargestCircleStep apart.
bool IsCircleAllowed(FewestPieces::Options const& options, double radius) {
  return !options.segmentsOnly && options.smallestRadius <= radius &&
         radius <= options.largestRadius && options.largestStep >= kLargestCircleStep &&
         std::isinf(options.farthestBetweenPoints);
}

/// The two half circles that pass all points of a closed contour, if there are any: two arcs of two
/// radii, which the service may answer, are no more pieces, but no circle either.
std::optional<std::vector<Piece>> CircleFor(FewestPieces::Options const& options,
                                            FitAnswer const& answer, Circuit const& circuit) {
  std::optional<std::vector<Piece>> circle = FitFullCircle(circuit.points);
  if (!circle) circle = FullCircleOf(PiecesOf(answer.contour), circuit.points);
  if (!circle || !IsCircleAllowed(options, circle->front().radius)) return {};
  return circle;
}

/// The answer that goes with a full circle: what the service says of its own pieces does not hold
/// for it, but for the bound.
FitAnswer AnswerOfCircle(FitAnswer const& answer) {
  FitAnswer ofCircle;
  ofCircle.code = ErrorCode::Ok;
  ofCircle.deviation = std::numeric_limits<double>::quiet_NaN();
  ofCircle.seconds = answer.seconds;
  ofCircle.fewestPossible = answer.fewestPossible;
  return ofCircle;
}

FitReport ReportClosed(FitInput input, FitChoice const& choice, FitAnswer answer) {
  std::size_t const seam = answer.ranges->front().first;
  Circuit const circuit = MakeCircuit(input.file.points, input.closure, seam);
  if (auto circle = CircleFor(choice.fewest, answer, circuit)) {
    return MakeClosedReport(std::move(input), choice.strategy, AnswerOfCircle(answer), circuit,
                            std::move(circle));
  }
  FitReport report = MakeReport(std::move(input), choice.strategy, std::move(answer));
  report.seam = seam;
  return report;
}

void RefuseStart(PointFile const& file, FitChoice const& choice) {
  if (!choice.start) return;
  throw Failure(
      FailureKind::BadArgument, {file.path},
      "a start is not for the fewest pieces, which find the seam themselves: the strategy mixed "
      "takes one");
}

}  // namespace

FitReport FitFewest(FitInput input, FitChoice const& choice, ExecutionState* progress) {
  PointFile const& file = input.file;
  RefuseStart(file, choice);
  FewestPieces::Options options = choice.fewest;
  options.closed = input.closure.isClosed;
  FewestPieces::Result result;
  auto const begin = std::chrono::steady_clock::now();
  ErrorCode const code = FewestPieces::Fit(file.points, options, &result, progress, kFullProgress);
  std::chrono::duration<double> const taken = std::chrono::steady_clock::now() - begin;
  if (code != ErrorCode::Ok) {
    throw Failure(FailureKind::NoFit, {file.path}, "no fit: " + WhyNone(code, file.points));
  }
  FitAnswer answer = AnswerOf(std::move(result), file.points.size());
  answer.seconds = taken.count();
  if (input.closure.isClosed) {
    return ReportClosed(std::move(input), choice, std::move(answer));
  }
  return MakeReport(std::move(input), choice.strategy, std::move(answer));
}

}  // namespace Vorn::IO
