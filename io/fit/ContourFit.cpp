#include <chrono>
#include <cstdint>
#include <limits>
#include <utility>

#include "io/fit/FewestFit.h"
#include "io/fit/Fit.h"
#include "io/fit/FullCircle.h"
#include "io/fit/LocalFrame.h"
#include "vorn/io/Failure.h"
#include "vorn/io/FitContour.h"
#include "vorn/io/Spacing.h"
#include "vorn/io/SpacingFailure.h"

namespace Vorn::IO {

namespace {

constexpr std::size_t kLeastClosedPoints = 3;

[[noreturn]] void RefuseTooClose(PointFile const& file, FitChoice const& choice,
                                 std::vector<WPoint> const& fitted, ClosePair const& pair) {
  throw SpacingFailure::TooClose(file, {pair, LargestSingleTolerance(fitted), choice.tolerance, 0});
}

void RefuseFailedFit(PointFile const& file, FitAnswer const& answer) {
  if (answer.code != ErrorCode::Ok) {
    throw Failure(FailureKind::NoFit, {file.path}, "no fit (code " + Describe(answer.code) + ")");
  }
  if (answer.contour.size() < 2) {
    throw Failure(FailureKind::NoFit, {file.path}, "no fit (the contour has no pieces)");
  }
}

FitReport FitOpen(FitInput input, FitChoice const& choice, ExecutionState* progress) {
  PointFile const& file = input.file;
  if (choice.start) {
    throw Failure(
        FailureKind::BadArgument, {file.path},
        "a start is for closed contours, and this one is open (" + input.closure.reason + ")",
        Remedy::CloseContour);
  }
  FitAnswer answer = Fit(file.points, choice.strategy, progress);
  if (answer.code == ErrorCode::PointsTooClose) {
    if (auto const pair = FindClosePair(file.points)) {
      RefuseTooClose(file, choice, file.points, *pair);
    }
  }
  RefuseFailedFit(file, answer);
  return MakeReport(std::move(input), choice.strategy, std::move(answer));
}

std::optional<std::size_t> SeamOf(FitInput const& input, FitChoice const& choice) {
  PointFile const& file = input.file;
  if (!choice.start) return SharpestCorner(file.points, input.closure);
  if (*choice.start >= file.points.size()) {
    throw Failure(FailureKind::BadArgument, {file.path},
                  "start " + std::to_string(*choice.start) + ": the points are counted from 0 to " +
                      std::to_string(file.points.size() - 1));
  }
  return *choice.start;
}

/// The spacing rule holds between any two neighbours of a closed contour, wherever it is cut.
void RefuseClosePair(PointFile const& file, FitChoice const& choice, Circuit const& circuit) {
  if (!NeedsSpacing(choice.strategy)) return;
  std::optional<ClosePair> pair = FindClosePair(circuit.points);
  if (!pair) return;
  pair->first = circuit.origin[pair->first];
  pair->second = circuit.origin[pair->second];
  RefuseTooClose(file, choice, circuit.points, *pair);
}

/// The answer that goes with a full circle: what the library says of an arc, if it was asked, does
/// not hold for it.
FitAnswer AnswerOfCircle(double seconds) {
  FitAnswer answer;
  answer.code = ErrorCode::Ok;
  answer.deviation = std::numeric_limits<double>::quiet_NaN();
  answer.seconds = seconds;
  return answer;
}

double SecondsSince(std::chrono::steady_clock::time_point begin) {
  return std::chrono::duration<double>(std::chrono::steady_clock::now() - begin).count();
}

FitReport FitFrom(std::size_t seam, FitInput input, FitChoice const& choice,
                  ExecutionState* progress) {
  Circuit const circuit = MakeCircuit(input.file.points, input.closure, seam);
  RefuseClosePair(input.file, choice, circuit);
  auto const begin = std::chrono::steady_clock::now();
  std::optional<std::vector<Piece>> circle = FitFullCircle(circuit.points);
  FitAnswer answer;
  if (!circle) {
    answer = Fit(circuit.points, choice.strategy, progress);
    RefuseFailedFit(input.file, answer);
    circle = FullCircleOf(PiecesOf(answer.contour), circuit.points);
  }
  if (circle) answer = AnswerOfCircle(SecondsSince(begin));
  return MakeClosedReport(std::move(input), choice.strategy, std::move(answer), circuit,
                          std::move(circle));
}

/// One of two halves of the progress.
class Half final : public ExecutionState {
 public:
  Half(ExecutionState* whole, std::int32_t before) : whole_(whole), before_(before) {}

  void SetProgress(std::int32_t percent) override {
    if (whole_ != nullptr) whole_->SetProgress(before_ + percent / 2);
  }

 private:
  ExecutionState* whole_;
  std::int32_t before_;
};

/// The last point of the first piece: a place where two pieces meet.
std::optional<std::size_t> JointOf(FitReport const& report) {
  if (report.isFullCircle || !report.ranges || report.ranges->front().count < 2) return {};
  std::size_t const count = report.file.points.size() - (report.closure.repeatsFirst ? 1 : 0);
  return (report.seam + report.ranges->front().count - 1) % count;
}

bool IsBetter(FitReport const& a, FitReport const& b) {
  return a.verdict == Verdict::WithinTolerance && a.Gap() <= b.Gap() &&
         a.pieces.size() < b.pieces.size();
}

/// A contour without a corner. Cut open at its first point it would in most cases have a piece too
/// many, so it is fitted again from a joint that the first attempt found.
FitReport FitSmooth(FitInput const& input, FitChoice const& choice, ExecutionState* progress) {
  Half firstHalf(progress, 0);
  Half secondHalf(progress, kFullProgress / 2);
  FitReport first = FitFrom(0, input, choice, &firstHalf);
  std::optional<std::size_t> const joint = JointOf(first);
  if (!joint) return first;
  try {
    FitReport second = FitFrom(*joint, input, choice, &secondHalf);
    double const seconds = first.fit.seconds + second.fit.seconds;
    FitReport& best = IsBetter(second, first) ? second : first;
    best.fit.seconds = seconds;
    return std::move(best);
  } catch (Failure const&) {
    return first;
  }
}

FitReport FitClosed(FitInput input, FitChoice const& choice, ExecutionState* progress) {
  std::optional<std::size_t> const seam = SeamOf(input, choice);
  if (!seam) return FitSmooth(input, choice, progress);
  return FitFrom(*seam, std::move(input), choice, progress);
}

void RequirePoints(PointFile const& file, Closure const& closure) {
  if (file.points.size() < kLeastClosedPoints + (closure.repeatsFirst ? 1 : 0)) {
    throw Failure(FailureKind::BadArgument, {file.path},
                  "a closed contour needs three different points");
  }
}

void WarnIfFine(PointFile const& file, FitChoice const& choice) {
  if (!choice.warnOfFineTolerance || !SuffersFromFineTolerances(choice.strategy)) return;
  std::optional<FineTolerance> const fine = FindFineTolerance(file.points);
  if (fine) choice.warnOfFineTolerance(file, *fine);
}

/// The points lie in a local frame already.
FitReport FitLocally(PointFile file, FitChoice const& choice, ExecutionState* progress) {
  Closure const closure = FindClosure(file.points, choice.closed);
  if (closure.isClosed) RequirePoints(file, closure);
  std::string source = AssignTolerances(choice.tolerance, &file, closure.isClosed);
  WarnIfFine(file, choice);
  auto const fit = choice.strategy == Strategy::Fewest ? FitFewest
                   : closure.isClosed                  ? FitClosed
                                                       : FitOpen;
  return fit({std::move(file), std::move(source), closure}, choice, progress);
}

}  // namespace

FitReport FitContour(PointFile file, FitChoice const& choice, ExecutionState* progress) {
  XY const origin = LocalOrigin(file.points);
  file.points = TakenOff(std::move(file.points), origin);
  FitReport report = FitLocally(std::move(file), choice, progress);
  PutBack(origin, &report);
  return report;
}

}  // namespace Vorn::IO
