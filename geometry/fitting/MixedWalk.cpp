// Strategy Mixed.

#include <algorithm>
#include <cstdint>
#include <optional>
#include <vector>

#include "geometry/fitting/PieceElements.h"
#include "geometry/fitting/Strategies.h"
#include "geometry/fitting/arc/ArcSearch.h"
#include "geometry/fitting/line/LineFit.h"
#include "geometry/fitting/runs/Pieces.h"
#include "geometry/fitting/runs/Runs.h"
#include "math/Assert.h"

namespace Vorn::Fitting {

namespace {

/// Tries of the line fitter on one run, each fed with the points that deviated most in the one
/// before.
constexpr int kLineAttempts = 3;

/// The walk from point to point.
class MixedWalk {
 public:
  explicit MixedWalk(CurveTask const& task) : task_(task) {}

  /// Appends elements up to the last point, or as far as either fitter gets.
  LargestDeviation Walk() {
    while (Rest().count > 1 && AppendNext()) {
    }
    return largest_;
  }

 private:
  /// The points from the last covered one on.
  Run Rest() const {
    return {task_.points, first_, static_cast<std::int32_t>(task_.points.size()) - first_};
  }

  /// Appends the element with the longer reach. False when there is none. Deliberate: the contour
  /// made so far then stands, which is no error.
  bool AppendNext() {
    std::optional<FittedLine> const line = FindLine();
    std::optional<FittedArc> const arc = FindArc(line);
    if (arc && (!line || IsBetter(*arc, *line))) return Append(*arc);
    return line && Append(*line);
  }

  /// Nothing when the line fitter reports an error. Of an attempt only the points that deviate most
  /// go on to the next one.
  std::optional<FittedLine> FindLine() {
    offenders_.clear();
    std::optional<FittedLine> line;
    for (int attempt = 1; attempt <= kLineAttempts; ++attempt) {
      bool const isLast = attempt == kLineAttempts;
      LineFitResult const result =
          FitLine({Rest(), {fixedStart_, std::nullopt}, isLast, task_.progress}, &offenders_);
      if (result.code != ErrorCode::Ok) return std::nullopt;
      line = result.line;
      if (offenders_.empty()) break;
    }
    return line;
  }

  /// An arc that reaches no less far than the line.
  std::optional<FittedArc> FindArc(std::optional<FittedLine> const& line) {
    // Deliberate: a line of two points that ends where the points turn back is taken unasked; an
    // arc could only run on past the turn.
    if (line && line->count == 2 && line->hasTurnedBack) return std::nullopt;
    std::int32_t const minCount = line ? std::max(line->count, kFewestArcPoints) : kFewestArcPoints;
    ArcSearchResult const result = FindLongestArc(
        {Rest(), minCount, {fixedStart_, std::nullopt}, task_.progress, AfterFailure::NoCell});
    return result.code == ErrorCode::Ok ? result.arc : std::nullopt;
  }

  static bool IsBetter(FittedArc const& arc, FittedLine const& line) {
    return arc.count > line.count ||
           (arc.count == line.count && arc.deviation.value <= line.deviation.value);
  }

  bool Append(FittedLine const& line) {
    BeginAt(line.start);
    task_.contour.push_back(Contours::SegmentTo(line.end));
    GoOnBehind(line);
    return true;
  }

  bool Append(FittedArc const& arc) {
    BeginAt(arc.start);
    task_.contour.push_back(ElementOf(arc));
    GoOnBehind(arc);
    return true;
  }

  void BeginAt(Point const& start) {
    if (task_.contour.empty()) task_.contour.push_back(Contours::SegmentTo(start));
  }

  /// The last point of one run is the first point of the next.
  void GoOnBehind(Piece const& piece) {
    largest_.Take(piece.deviation);
    fixedStart_ = piece.end;
    VORN_ASSERT(piece.count >= 2);
    first_ += piece.count - 1;
  }

  CurveTask const& task_;
  /// The last point that an element covers, at first the first point.
  std::int32_t first_ = 0;
  /// Where the next element begins; nothing for the first one.
  std::optional<Point> fixedStart_;
  std::vector<std::int32_t> offenders_;
  LargestDeviation largest_;
};

}  // namespace

CurveResult FitMixed(CurveTask const& task) {
  return {ErrorCode::Ok, MixedWalk(task).Walk().Get()};
}

}  // namespace Vorn::Fitting
